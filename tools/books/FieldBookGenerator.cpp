#include "FieldBookGenerator.h"

#include <cstdio>
#include <string>

namespace pyr::books {

namespace {

// A GSI-16 book: a station block (84, 85, 86, 88) every 200 lines, then sightings of seven words
// (point, Hz, V, slope distance, ppm and prism constant, reflector and instrument heights), one in ten with
// a code (71).
class GsiBook {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 200);
        long long point = 1000;
        int station = 0;
        for (int line = 0; line < lines; ++line) {
            if (line % (kSightingsPerStation + 1) == 0) {
                ++station;
                text += Word("*110001", "ST" + std::to_string(station));
                text += Word("84..10", std::to_string(651000000 + m_random.Next(100000000)));
                text += Word("85..10", std::to_string(6862000000 + m_random.Next(100000000)));
                text += Word("86..10", std::to_string(50000 + m_random.Next(10000)));
                text += Word("88..10", std::to_string(1400 + m_random.Next(300)));
            } else {
                text += Word("*11" + Block(line), std::to_string(point++));
                text += Word("21.322", std::to_string(m_random.Next(40000000)));
                text += Word("22.322", std::to_string(9000000 + m_random.Next(2000000)));
                text += Word("31..00", std::to_string(1000 + m_random.Next(500000)));
                text += Word("51....", "000000000000+000");
                text += Word("87..10", "1300");
                if (line % 10 == 0) text += Word("71....", "ARB");
                text += Word("88..10", "1550");
            }
            text += "\r\n";
        }
        return text;
    }

private:
    static std::string Block(int line) {
        std::string number = std::to_string(line % 10000);
        return std::string(4 - number.size(), '0') + number;
    }
    static std::string Word(const std::string& header, const std::string& data) {
        std::string word = header[0] == '*' ? header.substr(1) : header;
        word += '+';
        word += std::string(16 - data.size(), '0') + data + ' ';
        return header[0] == '*' ? '*' + word : word;
    }
    BookRandom m_random{20240611};
};

// A GDM job file in degrees, minutes, seconds: a station block (2, 3, 62) every 200 sightings, each
// sighting a point block of its number, Hz, V and slope distance, one in ten with a code (4).
class GdmBook {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 14);
        text += "50=BENCH\r\n23=3111\r\n";
        int line = 2, station = 0, sightings = 0;
        long long point = 1000;
        while (line < lines) {
            if (sightings % kSightingsPerStation == 0) {
                text += "2=ST" + std::to_string(++station) + "\r\n3=1.55" +
                        std::to_string(m_random.Next(10)) + "\r\n62=" + std::to_string(point) + "\r\n";
                line += 3;
            }
            text += "5=" + std::to_string(point++) + "\r\n";
            if (sightings % 10 == 0) {
                text += "4=ARB\r\n";
                ++line;
            }
            const std::string hz = Dms(360);
            const std::string v = Dms(20, 80);
            const long long metres = 1 + m_random.Next(500);
            const long long millimetres = 100 + m_random.Next(900);
            text += "7=" + hz + "\r\n8=" + v + "\r\n9=" + std::to_string(metres) + "." +
                    std::to_string(millimetres) + "\r\n";
            line += 4;
            ++sightings;
        }
        return text;
    }

private:
    std::string Dms(int range, int from = 0) {
        char text[32];
        const int degrees = from + static_cast<int>(m_random.Next(range));
        const int minutes = static_cast<int>(m_random.Next(60));
        const int seconds = static_cast<int>(m_random.Next(60));
        std::snprintf(text, sizeof text, "%d.%02d%02d", degrees, minutes, seconds);
        return text;
    }
    BookRandom m_random{20240612};
};

// A Nikon raw V2.00 book in grads (or, `dms`, in ddd.mmss) and metres: a station and its backsight every
// 200 lines, then side shots (point, target height, slope distance, Hz, V, time, code).
class NikonRawBook {
public:
    explicit NikonRawBook(bool dms) : m_dms(dms) {}
    std::string Make(int lines) {
        std::string text = std::string("CO,Nikon RAW data format V2.00\r\nCO,Dist Units: Metres\r\n") +
                           (m_dms ? "CO,Angle Units: DDDMMSS\r\n" : "CO,Angle Units: Gons\r\n") +
                           "CO,Zero VA: Zenith\r\nCO,Coord Order: NEZ\r\n";
        text.reserve(static_cast<std::size_t>(lines) * 56);
        long long point = 1000;
        int station = 0;
        char buffer[160];
        for (int line = 5; line < lines; ++line) {
            const int place = (line - 5) % (kSightingsPerStation + 2);
            int size = 0;
            if (place == 0) {
                ++station;
                const double hi = 1.4 + m_random.Next(300) / 1000.0;
                const std::string azimuth = Circle();
                const std::string hz = Circle();
                size = std::snprintf(buffer, sizeof buffer, "ST,S%d,,S%d,,%.3f,%s,%s\r\n", station,
                                     station + 1, hi, azimuth.c_str(), hz.c_str());
            } else if (place == 1) {
                const double distance = 10.0 + m_random.Next(500000) / 1000.0;
                const std::string hz = Circle();
                size = std::snprintf(buffer, sizeof buffer, "F1,,1.300,%.3f,%s,%s,10:00:00\r\n", distance,
                                     hz.c_str(), Zenith().c_str());
            } else {
                const double distance = 1.0 + m_random.Next(500000) / 1000.0;
                const std::string hz = Circle();
                const std::string v = Zenith();
                size = std::snprintf(buffer, sizeof buffer, "SS,%lld,1.300,%.3f,%s,%s,10:%02d:%02d,%s\r\n",
                                     point++, distance, hz.c_str(), v.c_str(), line % 60, (line / 60) % 60,
                                     line % 10 == 0 ? "ARB" : "");
            }
            text.append(buffer, static_cast<std::size_t>(size));
        }
        return text;
    }

private:
    // A direction on the whole circle, and a zenith angle near the horizon.
    std::string Circle() { return Angle(m_dms ? m_random.Next(360 * 3600) : m_random.Next(4000000)); }
    std::string Zenith() {
        return Angle(m_dms ? 81 * 3600 + m_random.Next(18 * 3600) : 900000 + m_random.Next(200000));
    }
    // Grads with four decimals from ten-thousandths, or ddd.mmss from seconds.
    std::string Angle(long long count) const {
        char text[32];
        if (m_dms)
            std::snprintf(text, sizeof text, "%lld.%02lld%02lld", count / 3600, count / 60 % 60, count % 60);
        else
            std::snprintf(text, sizeof text, "%.4f", static_cast<double>(count) / 10000.0);
        return text;
    }
    bool m_dms;
    BookRandom m_random{20240611};
};

// An older Nikon DTM-series book, in metres and grads: a station on its point with the instrument height
// ("S1-1.550") every 200 lines, then observations (state, type 0, units, point, slope distance, Hz, V,
// target height).
class NikonDtmBook {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 56);
        long long point = 1000;
        int station = 0;
        char buffer[160];
        for (int line = 0; line < lines; ++line) {
            int size = 0;
            const long long a = m_random.Next(100000000), b = m_random.Next(100000000);
            if (line % (kSightingsPerStation + 1) == 0) {
                const int hi = static_cast<int>(400 + m_random.Next(300));
                size = std::snprintf(buffer, sizeof buffer, "1 , 2 , MG , S%d-1.%03d, %.3f, %.3f\r\n",
                                     ++station, hi, 6862000.0 + a / 1000.0, 651000.0 + b / 1000.0);
            } else {
                const long long v = m_random.Next(200000);
                size = std::snprintf(buffer, sizeof buffer,
                                     "1 , 0 , MG , %lld , %.3f , %.4f , %.4f , 1.300\r\n", point++,
                                     1.0 + a % 500000 / 1000.0, b % 4000000 / 10000.0, 90.0 + v / 10000.0);
            }
            text.append(buffer, static_cast<std::size_t>(size));
        }
        return text;
    }

private:
    BookRandom m_random{20261125};
};

// An SDR33 book: a header, then a station (02) and its target height (03) every 200 lines, then
// observations (09F1) with a description on one in ten; the fields on 16 characters.
class SdrBook {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 102);
        text += "00NMSDR33 V04-04.02     22-Nov-26 10:15 211111\r\n";
        long long point = 1000;
        int station = 0;
        for (int line = 1; line < lines; ++line) {
            if (line % (kSightingsPerStation + 2) == 1) {
                ++station;
                const std::string name = "ST" + std::to_string(station);
                const long long north = 6862000 + m_random.Next(100000);
                const long long east = 651000 + m_random.Next(100000);
                const long long height = 50 + m_random.Next(100);
                const double hi = 1.4 + m_random.Next(300) / 1000.0;
                text += "02TP" + Id(name) + Real(static_cast<double>(north), 3) +
                        Real(static_cast<double>(east), 3) + Real(static_cast<double>(height), 3) +
                        Real(hi, 3) + Field("") + "\r\n";
            } else if (line % (kSightingsPerStation + 2) == 2) {
                text += "03NM" + Real(1.3, 3) + "\r\n";
            } else {
                const double distance = 1 + m_random.Next(500000) / 1000.0;
                const double zenith = 90 + m_random.Next(2000000) / 100000.0;
                const double hz = m_random.Next(40000000) / 100000.0;
                text += "09F1" + Id("ST" + std::to_string(station)) + Id(std::to_string(point++)) +
                        Real(distance, 3) + Real(zenith, 5) + Real(hz, 5) +
                        Field(line % 10 == 0 ? "ARB" : "") + "\r\n";
            }
        }
        return text;
    }

private:
    static std::string Field(const std::string& text) { return text + std::string(16 - text.size(), ' '); }
    static std::string Id(const std::string& id) { return std::string(16 - id.size(), ' ') + id; }
    static std::string Real(double value, int decimals) {
        char buffer[32];
        std::snprintf(buffer, sizeof buffer, "%-16.*f", decimals, value);
        return buffer;
    }
    BookRandom m_random{20261122};
};

// A GTS-7 book in metres and ddd.mmss: a station with its coordinates every 400 lines, then side shots
// (SS with a code one time in ten) each followed by its slope distance line.
std::string MakeTopconBook(int lines) {
    constexpr int kLinesPerStation = 2 * (kSightingsPerStation + 1) - 2;
    std::string text;
    text.reserve(static_cast<std::size_t>(lines) * 36);
    text += "JOB     BENCH,\r\nUNITS   M,D\r\n";
    BookRandom random(20240611);
    const auto next = [&random](std::uint64_t range) {
        return static_cast<std::uint64_t>(random.Next(static_cast<long long>(range)));
    };
    // ddd.mmss with its tenths of a second, from a count of tenths of a second.
    const auto dms = [](std::uint64_t tenths) {
        char out[24];
        std::snprintf(
            out, sizeof out, "%llu.%02llu%02llu%llu", static_cast<unsigned long long>(tenths / 36000),
            static_cast<unsigned long long>(tenths / 600 % 60),
            static_cast<unsigned long long>(tenths / 10 % 60), static_cast<unsigned long long>(tenths % 10));
        return std::string(out);
    };
    char line[96];
    long long point = 1000;
    int station = 0;
    for (int written = 2; written < lines; written += 2) {
        if ((written - 2) % kLinesPerStation == 0) {
            const int hi = static_cast<int>(next(600));
            const double x = 651000.0 + static_cast<double>(next(100000000)) / 1000.0;
            const double y = 6862000.0 + static_cast<double>(next(100000000)) / 1000.0;
            const double z = 50.0 + static_cast<double>(next(10000)) / 1000.0;
            std::snprintf(line, sizeof line, "STN     ST%d,1.%03d,\r\nXYZ     %.3f,%.3f,%.3f\r\n", ++station,
                          hi, x, y, z);
        } else {
            const long long id = point++;
            const std::string hz = dms(next(360 * 36000));
            const std::string v = dms(80 * 36000 + next(20 * 36000));
            const double distance = 1.0 + static_cast<double>(next(5000000)) / 1e4;
            std::snprintf(line, sizeof line, "SS      %lld,1.300,%s\r\nSD      %s,%s,%.4f\r\n", id,
                          id % 10 == 0 ? "ARB" : "", hz.c_str(), v.c_str(), distance);
        }
        text += line;
    }
    return text;
}

// An M5 book as the instrument writes it: a station line (its coordinates) every 200 lines, then
// sightings of a slope distance, a Hz and a zenith angle with their units, one in ten with a code.
class M5Book {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 121);
        char line[160];
        long long point = 1000;
        int station = 0;
        for (int address = 1; address <= lines; ++address) {
            const long long a = m_random.Next(100000000), b = m_random.Next(100000000),
                            c = m_random.Next(200000);
            if ((address - 1) % (kSightingsPerStation + 1) == 0) {
                const std::string name = "ST" + std::to_string(++station);
                std::snprintf(
                    line, sizeof line,
                    "For M5|Adr %05d|PI1 %19s%-5s   |X  %14.3f m   |Y  %14.3f m   |Z  %14.3f m   | ",
                    address % 100000, name.c_str(), "S", 6862000.0 + a / 1000.0, 651000.0 + b / 1000.0,
                    500.0 + c % 10000 / 100.0);
            } else {
                const std::string name = std::to_string(point++);
                std::snprintf(
                    line, sizeof line,
                    "For M5|Adr %05d|PI1 %19s%-5s   |SD %14.3f m   |Hz %14.4f gon |V1 %14.4f gon | ",
                    address % 100000, name.c_str(), address % 10 == 0 ? "ARB" : "", 1.0 + a % 500000 / 1000.0,
                    b % 4000000 / 10000.0, 90.0 + c / 10000.0);
            }
            text += line;
            text += "\r\n";
        }
        return text;
    }

private:
    BookRandom m_random{20240611};
};

// The records of a survey written by the surveyor's own means: for every station its known coordinates and
// the station itself, then a backsight and side shots, one in ten with a code. `write` gives them their
// layout.
class SurveyRecords {
public:
    enum class Record { Point, Station, Reference, Mesure };
    struct Values {
        std::string name;
        double a = 0, b = 0, c = 0, d = 0; // x y z, or hi, or ah av di
        const char* code = "";
    };
    template <class Write>
    void Make(int lines, Write&& write) {
        long long point = 1000;
        int station = 0;
        for (int line = 0; line < lines; ++line) {
            const int place = line % (kSightingsPerStation + 2);
            Values v;
            if (place == 0) {
                ++station;
                v.name = "ST" + std::to_string(station);
                v.a = 651000.0 + m_random.Next(100000000) / 1000.0;
                v.b = 6862000.0 + m_random.Next(100000000) / 1000.0;
                v.c = 50.0 + m_random.Next(10000) / 100.0;
                write(Record::Point, v);
            } else if (place == 1) {
                v.name = "ST" + std::to_string(station);
                v.a = 1.4 + m_random.Next(300) / 1000.0;
                write(Record::Station, v);
            } else {
                const bool backsight = place == 2;
                v.name = backsight ? "ST" + std::to_string(station + 1) : std::to_string(point++);
                v.a = m_random.Next(4000000) / 10000.0;
                v.b = 90.0 + m_random.Next(200000) / 10000.0;
                v.c = 1.0 + m_random.Next(500000) / 1000.0;
                v.code = line % 10 == 0 ? "ARB" : "";
                write(backsight ? Record::Reference : Record::Mesure, v);
            }
        }
    }

private:
    BookRandom m_random{20261122};
};

std::string MakeDelimitedBook(int lines) {
    using Record = SurveyRecords::Record;
    std::string text;
    text.reserve(static_cast<std::size_t>(lines) * 48);
    char buffer[128];
    SurveyRecords().Make(lines, [&](Record record, const SurveyRecords::Values& v) {
        int size = 0;
        if (record == Record::Point)
            size = std::snprintf(buffer, sizeof buffer, "PT;%s;%.3f;%.3f;%.3f;\r\n", v.name.c_str(), v.a, v.b,
                                 v.c);
        else if (record == Record::Station)
            size = std::snprintf(buffer, sizeof buffer, "ST;%s;%.3f;\r\n", v.name.c_str(), v.a);
        else
            size = std::snprintf(buffer, sizeof buffer, "%s;%s;1.300;%.4f;%.4f;%.3f;%s\r\n",
                                 record == Record::Reference ? "RF" : "MS", v.name.c_str(), v.a, v.b, v.c,
                                 v.code);
        text.append(buffer, static_cast<std::size_t>(size));
    });
    return text;
}

// The same records in the delivered columns: type 1-2, identifier 4-19, then the values in their columns.
std::string MakeColumnarBook(int lines) {
    using Record = SurveyRecords::Record;
    std::string text;
    text.reserve(static_cast<std::size_t>(lines) * 64);
    char buffer[160];
    SurveyRecords().Make(lines, [&](Record record, const SurveyRecords::Values& v) {
        int size = 0;
        if (record == Record::Point)
            size = std::snprintf(buffer, sizeof buffer, "PT %-16s %14.3f %14.3f %10.3f\r\n", v.name.c_str(),
                                 v.a, v.b, v.c);
        else if (record == Record::Station)
            size = std::snprintf(buffer, sizeof buffer, "ST %-16s %10.3f\r\n", v.name.c_str(), v.a);
        else
            size = std::snprintf(buffer, sizeof buffer, "%s %-16s %10.3f %12.4f %12.4f %12.3f %s\r\n",
                                 record == Record::Reference ? "RF" : "MS", v.name.c_str(), 1.3, v.a, v.b,
                                 v.c, v.code);
        text.append(buffer, static_cast<std::size_t>(size));
    });
    return text;
}

// The same records as a Quendal-Pc book, the codes of the side shots on lines of their own.
std::string MakeQuendalBook(int lines) {
    using Record = SurveyRecords::Record;
    std::string text = "QUENDAL-PC;1\r\n";
    text.reserve(static_cast<std::size_t>(lines) * 48);
    char buffer[160];
    SurveyRecords().Make(lines - 1, [&](Record record, const SurveyRecords::Values& v) {
        int size = 0;
        if (record == Record::Point)
            size = std::snprintf(buffer, sizeof buffer, "POINT;%s;%.3f;%.3f;%.3f;BORNE;XYZ\r\n",
                                 v.name.c_str(), v.a, v.b, v.c);
        else if (record == Record::Station)
            size = std::snprintf(buffer, sizeof buffer, "STATION;%s;%.3f\r\n", v.name.c_str(), v.a);
        else if (*v.code)
            size = std::snprintf(buffer, sizeof buffer, "CODE;%s;;%s\r\n", v.code, v.name.c_str());
        else
            size = std::snprintf(buffer, sizeof buffer, "%s;%s;1.3;%.5f;%.5f;%.4f\r\n",
                                 record == Record::Reference ? "REFERENCE" : "MESURE", v.name.c_str(), v.a,
                                 v.b, v.c);
        text.append(buffer, static_cast<std::size_t>(size));
    });
    return text;
}

} // namespace

std::string MakeFieldBook(FieldBookFormat format, int lines) {
    switch (format) {
    case FieldBookFormat::Geotronics:
        return GdmBook().Make(lines);
    case FieldBookFormat::NikonAtlas:
        return NikonRawBook(false).Make(lines);
    case FieldBookFormat::NikonKheops:
        return NikonDtmBook().Make(lines);
    case FieldBookFormat::NikonPsion:
        return NikonRawBook(true).Make(lines);
    case FieldBookFormat::Sokkia:
        return SdrBook().Make(lines);
    case FieldBookFormat::TopconGT7:
        return MakeTopconBook(lines);
    case FieldBookFormat::Wild:
        return GsiBook().Make(lines);
    case FieldBookFormat::Zeiss:
        return M5Book().Make(lines);
    case FieldBookFormat::Separateur:
        return MakeDelimitedBook(lines);
    case FieldBookFormat::Colonne:
        return MakeColumnarBook(lines);
    case FieldBookFormat::Quendal:
        return MakeQuendalBook(lines);
    }
    return {};
}

const char* BookExtension(FieldBookFormat format) {
    switch (format) {
    case FieldBookFormat::Geotronics:
        return "job";
    case FieldBookFormat::NikonAtlas:
    case FieldBookFormat::NikonPsion:
        return "raw";
    case FieldBookFormat::NikonKheops:
        return "nik";
    case FieldBookFormat::Sokkia:
        return "sdr";
    case FieldBookFormat::TopconGT7:
        return "gts7";
    case FieldBookFormat::Wild:
        return "gsi";
    case FieldBookFormat::Zeiss:
        return "m5";
    case FieldBookFormat::Separateur:
        return "csv";
    case FieldBookFormat::Colonne:
        return "txt";
    case FieldBookFormat::Quendal:
        return "qdl";
    }
    return "txt";
}

std::string BookLayout(FieldBookFormat format) {
    const char* common = "SeparateurDecimal=.\nLignesEntete=0\nUniteAngles=grades\nUniteDistances=metres\n"
                         "TypeStation=ST\nTypeReference=RF\nTypeMesure=MS\nTypePoint=PT\nTypeCode=CD\n"
                         "TypeCommentaire=CO\n";
    if (format == FieldBookFormat::Separateur)
        return std::string("[Parametrage]\nSeparateur=;\n") + common +
               "ChampsStation=TYPE,MATRICULE,HI,CODE\nChampsVisee=TYPE,MATRICULE,HP,AH,AV,DI,CODE\n"
               "ChampsPoint=TYPE,MATRICULE,X,Y,Z,CODE\n";
    if (format == FieldBookFormat::Colonne)
        return std::string("[Parametrage]\n") + common +
               "ChampsStation=TYPE:1-2,MATRICULE:4-19,HI:21-30,CODE:32-\n"
               "ChampsVisee=TYPE:1-2,MATRICULE:4-19,HP:21-30,AH:32-43,AV:45-56,DI:58-69,CODE:71-\n"
               "ChampsPoint=TYPE:1-2,MATRICULE:4-19,X:21-34,Y:36-49,Z:51-60,CODE:62-\n";
    return {};
}

} // namespace pyr::books
