#include "geobase/GeoFile.h"

#include "core/Lines.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "geobase/Elements.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Kinds.h"

#include <charconv>
#include <cmath>
#include <cstdio>
#include <vector>

namespace pyr {

namespace {

constexpr char kSeparator = '\t';

bool NeedsEscape(char c) {
    return c == '\\' || c == '\t' || c == '\n' || c == '\r';
}

// Texts may hold anything: a backslash, a tabulation and the line ends are escaped. A GéoBase is UTF-8
// whatever a text brings (a field book read byte for byte, an instrument header cut in the middle of a
// letter): a text that is not valid UTF-8 is written as its Windows-1252 reading, the one the loader gives
// a file that is not UTF-8, so that the file reads back as it was written. At most three bytes are
// written for each byte of the text (a Windows-1252 letter in UTF-8; an escape takes two).
char* WriteEscaped(char* out, std::string_view text) {
    // Most texts are plain ASCII (identifiers, codes): copied as they are checked.
    size_t plain = 0;
    for (; plain < text.size(); ++plain) {
        const char c = text[plain];
        if (static_cast<unsigned char>(c) >= 0x80 || NeedsEscape(c)) break;
        out[plain] = c;
    }
    out += plain;
    text.remove_prefix(plain);
    if (text.empty()) return out;

    std::string converted;
    if (!IsValidUtf8(text)) {
        converted = Windows1252ToUtf8(text);
        text = converted;
    }
    for (char c : text) {
        switch (c) {
        case '\\':
            *out++ = '\\';
            *out++ = '\\';
            break;
        case '\t':
            *out++ = '\\';
            *out++ = 't';
            break;
        case '\n':
            *out++ = '\\';
            *out++ = 'n';
            break;
        case '\r':
            *out++ = '\\';
            *out++ = 'r';
            break;
        default:
            *out++ = c;
        }
    }
    return out;
}

std::string Unescaped(std::string_view field) {
    std::string text;
    text.reserve(field.size());
    for (size_t i = 0; i < field.size(); ++i) {
        char c = field[i];
        if (c == '\\' && i + 1 < field.size()) {
            char next = field[i + 1];
            if (next == '\\' || next == 't' || next == 'n' || next == 'r') {
                text += next == 't' ? '\t' : next == 'n' ? '\n' : next == 'r' ? '\r' : '\\';
                ++i;
                continue;
            }
        }
        text += c;
    }
    return text;
}

// The fields of one element, in the order of the layout, written at a cursor that has room for them
// (see LineBound).
class LineWriter {
public:
    explicit LineWriter(char* out) : m_out(out) {}
    char* End() const { return m_out; }
    void Kind(int kind) { m_out = std::to_chars(m_out, m_out + kIntegerRoom, kind).ptr; }
    void Text(std::string_view text) {
        *m_out++ = kSeparator;
        m_out = WriteEscaped(m_out, text);
    }
    void Number(double value) {
        *m_out++ = kSeparator;
        m_out = WriteShortest(m_out, value);
    }
    void Integer(long long value) {
        *m_out++ = kSeparator;
        m_out = std::to_chars(m_out, m_out + kIntegerRoom, value).ptr;
    }
    // The code and the parameters close most lines; empty ones at the end are left out.
    void CodeAndParameters(const CElement& element) {
        if (!element.par().empty()) {
            Text(element.sym());
            Text(element.par());
        } else if (!element.sym().empty()) {
            Text(element.sym());
        }
    }

    static constexpr size_t kIntegerRoom = 24;

private:
    char* m_out;
};

// Room enough for the fields of a line: a separator and three bytes a byte of each text, a separator and
// kShortestRoom for each number.
class LineBound {
public:
    void Text(std::string_view text) { m_bytes += 1 + 3 * text.size(); }
    void Numbers(size_t count) { m_bytes += count * (1 + kShortestRoom); }
    void Integer() { m_bytes += 1 + LineWriter::kIntegerRoom; }
    void Common(const CElement& element) {
        Text(element.mat());
        Text(element.sym());
        Text(element.par());
    }
    size_t Bytes() const { return m_bytes; }

private:
    size_t m_bytes = LineWriter::kIntegerRoom + 1; // the kind, and the end of the line
};

std::string_view InvariantFlag(const CPointGen& point) {
    if (point.invariantXY()) return point.invariantZ() ? "XYZ" : "XY";
    return point.invariantZ() ? "Z" : "-";
}

// The fields of a line, split at the tabulations, read in order.
class LineReader {
public:
    LineReader(std::string_view line, std::vector<std::string_view>& fields, std::string& error)
        : m_fields(fields), m_error(error) {
        m_fields.clear();
        // Fields are short: a plain loop over the bytes beats a search call for each.
        const char* start = line.data();
        const char* const end = start + line.size();
        for (const char* c = start; c != end; ++c) {
            if (*c == kSeparator) {
                m_fields.emplace_back(start, static_cast<size_t>(c - start));
                start = c + 1;
            }
        }
        m_fields.emplace_back(start, static_cast<size_t>(end - start));
    }

    size_t Count() const { return m_fields.size(); }
    size_t Position() const { return m_next; }
    bool Failed() const { return m_failed; }

    // Fields that must be there.
    bool Require(size_t count) {
        if (m_fields.size() >= m_next + count) return true;
        return Fail(Sprintf(msg::kMissingFields, static_cast<int>(m_fields.size()),
                            static_cast<int>(m_next + count)));
    }
    std::string Text() { return m_next < m_fields.size() ? Unescaped(m_fields[m_next++]) : std::string(); }
    std::string_view Raw() { return m_next < m_fields.size() ? m_fields[m_next++] : std::string_view(); }
    double Number() {
        std::string_view field = Raw();
        double value = 0;
        if (ReadDecimalQuick(field, value)) return value;
        auto [ptr, ec] = std::from_chars(field.data(), field.data() + field.size(), value);
        if (field.empty() || ec != std::errc() || ptr != field.data() + field.size() || !std::isfinite(value))
            Fail(Sprintf(msg::kBadNumber, std::string(field).c_str()));
        return value;
    }
    long long Integer() {
        std::string_view field = Raw();
        long long value = 0;
        if (!ParseInt(field, value)) Fail(Sprintf(msg::kBadNumber, std::string(field).c_str()));
        return value;
    }
    // Code and parameters, both optional.
    void CodeAndParameters(CElement& element) {
        element.setSym(Text());
        element.setPar(Text());
    }
    bool Fail(std::string why) {
        if (!m_failed) m_error = std::move(why);
        m_failed = true;
        return false;
    }

private:
    std::vector<std::string_view>& m_fields;
    size_t m_next = 1; // the kind code is read apart
    bool m_failed = false;
    std::string& m_error;
};

} // namespace

std::string GeoHeaderLine() {
    std::string line(kGeoHeader);
    line += kSeparator;
    line += std::to_string(kGeoFormatVersion);
    return line;
}

int GeoHeaderVersion(std::string_view line) {
    if (line.substr(0, kGeoHeader.size()) != kGeoHeader) return 0;
    line.remove_prefix(kGeoHeader.size());
    while (!line.empty() && (line.front() == kSeparator || line.front() == ' '))
        line.remove_prefix(1);
    long long version = 0;
    if (!ParseInt(line, version) || version < 1 || version > 1000000) return 0;
    return static_cast<int>(version);
}

bool IsBlankGeoLine(std::string_view line) {
    return line.find_first_not_of(" \t") == std::string_view::npos;
}

GeoFileCensus TakeGeoFileCensus(std::string_view text) {
    GeoFileCensus census;
    std::string error;
    if (text.substr(0, 3) == "\xEF\xBB\xBF") text.remove_prefix(3);
    ForEachLine(text, [&](std::string_view line, int) {
        if (census.header) return; // a GéoBase: nothing more to learn
        if (GeoHeaderVersion(line)) {
            census.header = true;
            return;
        }
        if (IsBlankGeoLine(line)) return;
        int kind = 0;
        census.Line(ParseElementLine(line, kind, error, false) != nullptr);
    });
    return census;
}

char* WriteElementLine(char* out, const CElement& element, int kind) {
    LineWriter w(out);
    w.Kind(kind);
    if (kind == kKindComment) {
        const auto& comment = static_cast<const CComment&>(element);
        if (!comment.text().empty()) w.Text(comment.text());
    } else if (kind == kKindStation) {
        const auto& station = static_cast<const CStation&>(element);
        w.Text(station.mat());
        w.Number(station.hi());
        w.Number(station.v0());
        w.CodeAndParameters(station);
    } else if (IsSightingKind(kind)) {
        const auto& sighting = static_cast<const CVisee&>(element);
        w.Text(sighting.mat());
        w.Number(sighting.hp());
        w.Number(sighting.ah());
        w.Number(sighting.av());
        w.Number(sighting.di());
        w.CodeAndParameters(sighting);
    } else if (IsLevellingKind(kind)) {
        const auto& reading = static_cast<const CLecture&>(element);
        w.Text(reading.mat());
        w.Number(reading.lm());
        w.Number(reading.dist());
        w.CodeAndParameters(reading);
    } else if (kind == kKindPoint) {
        const auto& point = static_cast<const CPointGen&>(element);
        w.Text(point.mat());
        w.Number(point.x());
        w.Number(point.y());
        w.Number(point.z());
        w.Text(InvariantFlag(point));
        w.CodeAndParameters(point);
    } else if (kind == kKindChemin) {
        const auto& traverse = static_cast<const CChemin&>(element);
        w.Text(traverse.mat());
        w.Integer(traverse.isClosed() ? 1 : 0);
        w.Integer(static_cast<long long>(traverse.stations().size()));
        for (const auto& station : traverse.stations())
            w.Text(station);
        w.CodeAndParameters(traverse);
    } else if (kind == kKindAppareil) {
        const auto& instrument = static_cast<const CAppareil&>(element);
        w.Text(instrument.mat());
        w.Number(instrument.collVerticale());
        w.Number(instrument.constPrisme());
        w.Number(instrument.sigmaAh());
        w.Number(instrument.sigmaAv());
        w.Number(instrument.sigmaDi());
        w.Number(instrument.sigmaPpm());
        w.CodeAndParameters(instrument);
    } else {
        // Codification commands: the word and its parameters first, then the identifier and the code.
        const auto& command = static_cast<const CCommande&>(element);
        w.Text(command.word());
        if (!command.par().empty() || !command.mat().empty() || !command.sym().empty()) w.Text(command.par());
        if (!command.mat().empty() || !command.sym().empty()) w.Text(command.mat());
        if (!command.sym().empty()) w.Text(command.sym());
    }
    return w.End();
}

size_t ElementLineBound(const CElement& element, int kind) {
    LineBound bound;
    if (kind == kKindComment) {
        bound.Text(static_cast<const CComment&>(element).text());
    } else if (kind == kKindStation) {
        bound.Common(element);
        bound.Numbers(2);
    } else if (IsSightingKind(kind)) {
        bound.Common(element);
        bound.Numbers(4);
    } else if (IsLevellingKind(kind)) {
        bound.Common(element);
        bound.Numbers(2);
    } else if (kind == kKindPoint) {
        bound.Common(element);
        bound.Numbers(3);
        bound.Text("XYZ");
    } else if (kind == kKindChemin) {
        const auto& traverse = static_cast<const CChemin&>(element);
        bound.Common(element);
        bound.Integer();
        bound.Integer();
        for (const auto& station : traverse.stations())
            bound.Text(station);
    } else if (kind == kKindAppareil) {
        bound.Common(element);
        bound.Numbers(6);
    } else {
        bound.Common(element);
        bound.Text(static_cast<const CCommande&>(element).word());
    }
    return bound.Bytes();
}

void AppendElementLine(std::string& out, const CElement& element, int kind) {
    const size_t size = out.size();
    out.resize(size + ElementLineBound(element, kind));
    out.resize(static_cast<size_t>(WriteElementLine(out.data() + size, element, kind) - out.data()));
}

std::string ElementLine(const CElement& element, int kind) {
    std::string line;
    AppendElementLine(line, element, kind);
    return line;
}

std::unique_ptr<CElement> ParseElementLine(std::string_view line, int& kind, std::string& error,
                                           bool lenient) {
    static std::vector<std::string_view> fields; // reused from line to line: one allocation per load
    LineReader r(line, fields, error);
    std::string_view kindField = line.substr(0, line.find(kSeparator));
    long long code = 0;
    if (kindField.empty()) {
        r.Fail(msg::kNoKind);
        return nullptr;
    }
    if (!ParseInt(kindField, code) || !IsKnownKind(static_cast<int>(code))) {
        r.Fail(Sprintf(msg::kUnknownKind, std::string(kindField).c_str()));
        return nullptr;
    }
    kind = static_cast<int>(code);

    std::unique_ptr<CElement> element;
    if (kind == kKindComment) {
        // The whole rest of the line is the comment, tabulations included.
        size_t tab = line.find(kSeparator);
        return std::make_unique<CComment>(tab == std::string_view::npos ? std::string()
                                                                        : Unescaped(line.substr(tab + 1)));
    } else if (kind == kKindStation) {
        if (!r.Require(3)) return nullptr;
        auto station = std::make_unique<CStation>(r.Text());
        station->setHI(r.Number());
        station->setV0(r.Number());
        r.CodeAndParameters(*station);
        element = std::move(station);
    } else if (IsSightingKind(kind)) {
        if (!r.Require(5)) return nullptr;
        std::string mat = r.Text();
        double hp = r.Number();
        double ah = r.Number();
        double av = r.Number();
        double di = r.Number();
        std::unique_ptr<CVisee> sighting;
        if (kind == kKindReference)
            sighting = std::make_unique<CReference>(std::move(mat), hp, ah, av, di);
        else
            sighting = std::make_unique<CMesure>(std::move(mat), hp, ah, av, di);
        r.CodeAndParameters(*sighting);
        element = std::move(sighting);
    } else if (IsLevellingKind(kind)) {
        if (!r.Require(3)) return nullptr;
        std::string mat = r.Text();
        double lm = r.Number();
        double dist = r.Number();
        std::unique_ptr<CLecture> reading;
        if (kind == kKindLectAR)
            reading = std::make_unique<CLectAR>(std::move(mat), lm, dist);
        else
            reading = std::make_unique<CLectAV>(std::move(mat), lm, dist);
        r.CodeAndParameters(*reading);
        element = std::move(reading);
    } else if (kind == kKindPoint) {
        if (!r.Require(5)) return nullptr;
        std::string mat = r.Text();
        double x = r.Number();
        double y = r.Number();
        double z = r.Number();
        auto point = std::make_unique<CPointGen>(std::move(mat), x, y, z);
        std::string_view flag = r.Raw();
        if (flag == "XY" || flag == "XYZ") point->setInvariantXY(true);
        if (flag == "Z" || flag == "XYZ") point->setInvariantZ(true);
        if (flag != "-" && flag != "XY" && flag != "Z" && flag != "XYZ")
            r.Fail(Sprintf(msg::kBadFlag, std::string(flag).c_str()));
        r.CodeAndParameters(*point);
        element = std::move(point);
    } else if (kind == kKindChemin) {
        if (!r.Require(3)) return nullptr;
        auto traverse = std::make_unique<CChemin>(r.Text());
        long long closed = r.Integer();
        if (closed != 0 && closed != 1) r.Fail(Sprintf(msg::kBadFlag, std::to_string(closed).c_str()));
        traverse->setClosed(closed == 1);
        long long count = r.Integer();
        if (r.Failed() || count < 0 || !r.Require(static_cast<size_t>(count))) {
            if (!r.Failed()) r.Fail(Sprintf(msg::kBadNumber, std::to_string(count).c_str()));
            return nullptr;
        }
        for (long long i = 0; i < count; ++i)
            traverse->add(r.Text());
        r.CodeAndParameters(*traverse);
        element = std::move(traverse);
    } else if (kind == kKindAppareil) {
        if (!r.Require(7)) return nullptr;
        auto instrument = std::make_unique<CAppareil>(r.Text());
        instrument->setCollVerticale(r.Number());
        instrument->setConstPrisme(r.Number());
        instrument->setSigmaAh(r.Number());
        instrument->setSigmaAv(r.Number());
        instrument->setSigmaDi(r.Number());
        instrument->setSigmaPpm(r.Number());
        r.CodeAndParameters(*instrument);
        element = std::move(instrument);
    } else {
        if (!r.Require(1)) return nullptr;
        auto command = std::make_unique<CCommande>(r.Text());
        command->setPar(r.Text());
        command->setMat(r.Text());
        command->setSym(r.Text());
        element = std::move(command);
    }
    if (r.Failed()) return nullptr;
    if (!lenient && r.Position() < r.Count()) {
        r.Fail(Sprintf(msg::kExtraFields, static_cast<int>(r.Count()), static_cast<int>(r.Position())));
        return nullptr;
    }
    return element;
}

} // namespace pyr
