#include "fieldbook/LectNikon.h"

#include "core/AngleUnits.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectNikonTexts.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "ui/PyrTxtWnd.h"

#include <cmath>
#include <filesystem>

namespace pyr {

namespace {

namespace nik = nikon::msg;

// The start (STX) and end (ETX, EOT) of a transmission and the end-of-file mark (Ctrl-Z) that a
// download leaves around the records.
bool IsControl(char c) {
    return c == '\x02' || c == '\x03' || c == '\x04' || c == '\x1a';
}

bool IsDigits(std::string_view text) {
    for (char c : text)
        if (c < '0' || c > '9') return false;
    return !text.empty();
}

bool IsNumber(std::string_view text) {
    double value = 0.0;
    return ParseDouble(text, value);
}

bool ContainsIgnoringCase(std::string_view text, std::string_view part) {
    for (std::size_t i = 0; i + part.size() <= text.size(); ++i)
        if (EqualIgnoringCase(text.substr(i, part.size()), part)) return true;
    return false;
}

// The key of a declaration "Key: value": letters, blanks and dots only, so that the time of a text
// such as "Downloaded 08-Feb-2010 11:17:17" is not taken for one.
bool IsDeclarationKey(std::string_view key) {
    for (char c : key)
        if (!((c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == ' ' || c == '.')) return false;
    return !Trimmed(key).empty();
}

// The types of the coordinate records: uploaded, manually input, calculated, resection, and the
// coordinates that a program computed.
bool IsCoordinateType(std::string_view type) {
    return IsAnyOf(type, {"UP", "MP", "CC", "RE", "MC"});
}

// A sighting's point: its number, else its identifier.
std::string_view PointOf(std::string_view number, std::string_view id) {
    const std::string_view name = FormMatView(number);
    return name.empty() ? FormMatView(id) : name;
}

// The identifier of a DTM record and the instrument height written after it ("1002-1.63",
// "1001--1.455"): the first hyphen whose rest is a number. False when there is no height.
bool SplitHeight(std::string_view field, std::string_view& id, std::string_view& height) {
    for (std::size_t i = field.find('-', 1); i != std::string_view::npos; i = field.find('-', i + 1)) {
        if (IsNumber(field.substr(i + 1))) {
            id = Trimmed(field.substr(0, i));
            height = field.substr(i + 1);
            return true;
        }
    }
    id = field;
    return false;
}

} // namespace

std::unique_ptr<CFieldBookReader> MakeNikonReader() {
    return std::make_unique<CLectNikon>();
}

void CLectNikon::Split(std::string_view line, Fields& fields) {
    fields.count = 0;
    for (;;) {
        const std::size_t comma = line.find(',');
        if (fields.count < kMaxFields) fields.at[fields.count++] = Trimmed(line.substr(0, comma));
        if (comma == std::string_view::npos) return;
        line.remove_prefix(comma + 1);
    }
}

// ---- Settings and state ----------------------------------------------------------------------------------

void CLectNikon::ReadSettings() {
    m_settings = ReadInstrumentSettings(Driver());
    m_zeroAtZenith = true;
}

void CLectNikon::BeginReading() {
    ReadSettings();
    m_hasStation = false;
    m_station.clear();
    m_backsight.clear();
    m_onAzimuth = false;
    m_firstSighting = false;
    m_known.Clear();
    m_started = m_rawStarted = m_dtmStarted = false;
}

void CLectNikon::Started(const char* format) {
    if (!m_started) {
        m_started = true;
        if (!Path().empty())
            AddHeaderComment(fb::kLabelFile, std::filesystem::path(Path()).filename().string());
    }
    if (format) AddHeaderComment(fb::kLabelFormat, format);
}

// ---- A line ----------------------------------------------------------------------------------------------

void CLectNikon::ReadLine(std::string_view line, int number) {
    while (!line.empty() && IsControl(line.front()))
        line.remove_prefix(1);
    while (!line.empty() && IsControl(line.back()))
        line.remove_suffix(1);
    line = Trimmed(line);
    if (line.empty()) return;

    Split(line, m_fields);
    const std::string_view type = m_fields[0];
    // The instrument keeps a record that was measured again with a "*" in front: the later one counts.
    if (type.starts_with('*')) return;
    if (IsDigits(type)) return ReadDtm(number);
    const bool comment = EqualIgnoringCase(type, "CO"), coordinates = IsCoordinateType(type),
               station = EqualIgnoringCase(type, "ST"), bothFaces = IsAnyOf(type, {"F1", "F2"}),
               shot = IsAnyOf(type, {"SS", "CP", "SO"});
    // A line of another file says nothing of this one: the header waits for a record of the format.
    if (!comment && !coordinates && !station && !bothFaces && !shot) return LineUnrecognised(number);
    if (!m_rawStarted) {
        m_rawStarted = true;
        Started(nullptr);
    }
    if (comment) {
        const std::size_t comma = line.find(',');
        return ReadComment(comma == std::string_view::npos ? std::string_view() : line.substr(comma + 1),
                           number);
    }
    if (coordinates) return ReadCoordinates(number);
    if (station) return ReadStation(number);
    ReadShot(number, bothFaces);
}

// ---- Raw format V2.00: comments and declarations ---------------------------------------------------------

void CLectNikon::ReadComment(std::string_view text, int number) {
    text = Trimmed(text);
    if (text.empty()) return;
    if (ContainsIgnoringCase(text, "RAW data format")) return AddHeaderComment(fb::kLabelFormat, text);
    if (const std::size_t job = text.find("<JOB>"); job != std::string_view::npos) {
        AddHeaderComment(fb::kLabelJob, Trimmed(text.substr(0, job)));
        std::string_view created = Trimmed(text.substr(job + 5));
        if (created.starts_with("Created")) created = Trimmed(created.substr(7));
        if (!created.empty()) AddHeaderComment(nik::kLabelCreated, created);
        return;
    }
    if (text.starts_with("Downloaded "))
        return AddHeaderComment(nik::kLabelDownloaded, Trimmed(text.substr(11)));
    if (const std::size_t colon = text.find(':');
        colon != std::string_view::npos && IsDeclarationKey(text.substr(0, colon)) &&
        ReadDeclaration(Trimmed(text.substr(0, colon)), Trimmed(text.substr(colon + 1)), number))
        return;
    AddComment(std::string(text));
}

// A declaration of the header. The units, the vertical zero and the axis order hold from here on;
// what the reader does not know of is kept as a comment.
bool CLectNikon::ReadDeclaration(std::string_view key, std::string_view value, int number) {
    const auto unknown = [&] {
        if (TextWindow())
            TextWindow()->Print(nik::kUnknownSetting, number, std::string(value).c_str(),
                                std::string(key).c_str());
    };
    const char* label = nullptr;
    if (EqualIgnoringCase(key, "Dist Units")) {
        label = fb::kLabelDistances;
        if (ContainsIgnoringCase(value, "feet") || ContainsIgnoringCase(value, "ft"))
            m_settings.distances = DistanceUnit::Feet;
        else if (ContainsIgnoringCase(value, "met"))
            m_settings.distances = DistanceUnit::Metres;
        else
            unknown();
    } else if (EqualIgnoringCase(key, "Angle Units")) {
        label = fb::kLabelAngles;
        if (IsAnyOf(value, {"DDDMMSS", "DMS", "DDD.MMSS"}))
            m_settings.angles = AngleUnit::Dms;
        else if (IsAnyOf(value, {"Gons", "Gon", "Grads", "Grades"}))
            m_settings.angles = AngleUnit::Grads;
        else if (IsAnyOf(value, {"Dec.Degrees", "Dec. Degrees", "Degrees", "Decimal Degrees"}))
            m_settings.angles = AngleUnit::Degrees;
        else if (IsAnyOf(value, {"Mils", "Mil"}))
            m_settings.angles = AngleUnit::Mils;
        else
            unknown();
    } else if (EqualIgnoringCase(key, "Zero VA")) {
        label = nik::kLabelZeroVA;
        if (IsAnyOf(value, {"Zenith"}))
            m_zeroAtZenith = true;
        else if (IsAnyOf(value, {"Horizontal", "Horizon", "Level"}))
            m_zeroAtZenith = false;
        else
            unknown();
    } else if (EqualIgnoringCase(key, "Coord Order")) {
        label = nik::kLabelOrder;
        if (IsAnyOf(value, {"NEZ", "NE"}))
            m_settings.order = CoordinateOrder::NorthEast;
        else if (IsAnyOf(value, {"ENZ", "EN"}))
            m_settings.order = CoordinateOrder::EastNorth;
        else
            unknown();
    } else if (EqualIgnoringCase(key, "Zero azimuth")) {
        label = nik::kLabelZeroAzimuth;
    } else if (EqualIgnoringCase(key, "HA Raw data")) {
        label = nik::kLabelRawHA;
    } else if (EqualIgnoringCase(key, "Instrument")) {
        label = fb::kLabelInstrument;
    } else if (EqualIgnoringCase(key, "Software")) {
        label = fb::kLabelSoftware;
    } else if (EqualIgnoringCase(key, "Description")) {
        label = nik::kLabelDescription;
    } else if (EqualIgnoringCase(key, "Client")) {
        label = nik::kLabelClient;
    } else if (EqualIgnoringCase(key, "Comments")) {
        label = nik::kLabelComments;
    } else if (EqualIgnoringCase(key, "Tilt Correction")) {
        label = nik::kLabelTilt;
    } else {
        return false;
    }
    if (!value.empty()) AddHeaderComment(label, value);
    return true;
}

// ---- Raw format V2.00: points, stations, shots -----------------------------------------------------------

// type, point, [point id], first, second, elevation, code. The identifier's place is there when the
// record has seven fields, or six of which the third is no coordinate.
void CLectNikon::ReadCoordinates(int number) {
    const Fields& f = m_fields;
    const bool idPlace = f.count >= 7 || (f.count == 6 && !IsNumber(f[2]));
    const std::size_t first = idPlace ? 3 : 2;
    const std::string_view name = PointOf(f[1], idPlace ? f[2] : std::string_view());
    if (name.empty()) return LineMissing(number, fb::kDatumPoint);
    // The coordinates that the instrument computed are kept only when the settings ask for them.
    if (EqualIgnoringCase(f[0], "CC") && !m_settings.keepComputed) return;
    double a = kUndefined, b = kUndefined, z = kUndefined;
    if (!Length(f[first], m_settings.distances, a, number) ||
        !Length(f[first + 1], m_settings.distances, b, number) ||
        !Length(f[first + 2], m_settings.distances, z, number))
        return;
    AddPosition(name, a, b, z, f[first + 3], number);
}

// ST, station, [station id], backsight, [backsight id], instrument height, backsight azimuth, backsight
// horizontal reading; the identifiers' places are there when the record has eight fields or more.
void CLectNikon::ReadStation(int number) {
    const Fields& f = m_fields;
    const bool idPlaces = f.count >= 8;
    const std::string_view name = PointOf(f[1], idPlaces ? f[2] : std::string_view());
    const std::string_view backsight = idPlaces ? PointOf(f[3], f[4]) : PointOf(f[2], std::string_view());
    const std::size_t hiAt = idPlaces ? 5 : 3;
    double hi = kUndefined, azimuth = kUndefined, reading = kUndefined;
    if (!Length(f[hiAt], m_settings.distances, hi, number) ||
        !Angle(f[hiAt + 1], m_settings.angles, azimuth, number) ||
        !Angle(f[hiAt + 2], m_settings.angles, reading, number))
        return;
    // Set up on an azimuth alone, without a backsight point that a reference could name, the station keeps
    // the orientation that the instrument computed with: the bearing of its circle's zero.
    const bool onAzimuth = backsight.empty() && IsKnown(azimuth) && IsKnown(reading);
    if (!OpenStation(name, hi, number, onAzimuth ? WrapGrads(azimuth - reading) : kUndefined)) return;
    m_backsight.assign(backsight);
    m_onAzimuth = onAzimuth;
    // The orientation that the instrument was given is kept for the surveyor to see: the V0 itself is
    // computed from the reference sightings.
    if (backsight.empty() && IsUndefined(azimuth) && IsUndefined(reading)) return;
    std::string text = Sprintf(nik::kBacksightStation, m_station.c_str());
    const char* separator = "";
    const auto part = [&](const char* format, const std::string& value) {
        text += separator;
        text += Sprintf(format, value.c_str());
        separator = ",";
    };
    if (!backsight.empty()) part(nik::kBacksightPoint, m_backsight);
    if (IsKnown(azimuth)) part(nik::kBacksightBearing, FormatFixed(azimuth, 5));
    if (IsKnown(reading)) part(nik::kBacksightReading, FormatFixed(reading, 5));
    AddComment(std::move(text));
}

// F1/F2 (backsight) or SS/CP/SO: type, point, [point id], target height, slope distance, horizontal
// reading, vertical angle, time, code. The identifier's place is told by where the time (hh:mm:ss)
// stands, or else by the number of fields.
void CLectNikon::ReadShot(int number, bool backsight) {
    const Fields& f = m_fields;
    bool idPlace = f.count > (backsight ? 7u : 8u);
    if (f[6].find(':') != std::string_view::npos)
        idPlace = false;
    else if (f[7].find(':') != std::string_view::npos)
        idPlace = true;
    const std::size_t first = idPlace ? 3 : 2;
    std::string_view point = PointOf(f[1], idPlace ? f[2] : std::string_view());
    if (point.empty() && backsight) point = m_backsight;
    // The shot on the azimuth of a station oriented on it: its reading is the one the V0 was set with.
    if (point.empty() && backsight && m_onAzimuth) return;
    if (point.empty()) return LineMissing(number, fb::kDatumPoint);
    if (!StationInForce(number)) return;
    double hp = kUndefined, di = kUndefined, ah = kUndefined, av = kUndefined;
    if (!Length(f[first], m_settings.distances, hp, number) ||
        !Length(f[first + 1], m_settings.distances, di, number) ||
        !Angle(f[first + 2], m_settings.angles, ah, number) ||
        !Zenith(f[first + 3], m_settings.angles, m_zeroAtZenith, av, number))
        return;
    if (IsUndefined(di) && IsUndefined(ah) && IsUndefined(av))
        return LineMissing(number, nik::kDatumObservation);
    const std::string_view code = f[first + 5];
    AddSighting(point, backsight || IsReference(point, code), hp, ah, av, di, code, number);
}

// ---- DTM-series format -----------------------------------------------------------------------------------

// state, type, units, id[-instrument height], then for an observation (type 0) the slope distance, the
// horizontal reading, the zenith angle and the target height, for coordinates (types 1 to 3) X, Y, Z.
void CLectNikon::ReadDtm(int number) {
    const Fields& f = m_fields;
    long long type = -1;
    if (!ParseInt(f[1], type) || type < 0 || type > 3) {
        if (TextWindow()) TextWindow()->Print(nik::kBadType, number, std::string(f[1]).c_str());
        return;
    }
    if (!m_dtmStarted) {
        m_dtmStarted = true;
        Started(nik::kDtmFormat);
    }
    AngleUnit angles = m_settings.angles;
    DistanceUnit distances = m_settings.distances;
    const std::string_view units = f[2];
    if (!units.empty()) {
        const char d = units.size() == 2 ? units[0] : '?';
        const char a = units.size() == 2 ? units[1] : '?';
        if ((d != 'M' && d != 'F') || (a != 'D' && a != 'G' && a != 'M')) {
            if (TextWindow()) TextWindow()->Print(nik::kBadUnits, number, std::string(units).c_str());
            return;
        }
        distances = d == 'M' ? DistanceUnit::Metres : DistanceUnit::Feet;
        angles = a == 'D' ? AngleUnit::Dms : a == 'G' ? AngleUnit::Grads : AngleUnit::Mils;
    }
    std::string_view id, heightText;
    const bool station = SplitHeight(f[3], id, heightText);
    const std::string_view name = FormMatView(id);
    if (name.empty()) return LineMissing(number, station ? fb::kDatumStation : fb::kDatumPoint);
    double hi = kUndefined;
    if (station && !Length(heightText, distances, hi, number)) return;

    if (type == 0) {
        if (station) {
            OpenStation(name, hi, number);
            return;
        }
        if (!StationInForce(number)) return;
        double di = kUndefined, ah = kUndefined, av = kUndefined, hp = kUndefined;
        if (!Length(f[4], distances, di, number) || !Angle(f[5], angles, ah, number) ||
            !Zenith(f[6], angles, true, av, number) || !Length(f[7], distances, hp, number))
            return;
        if (IsUndefined(di) && IsUndefined(ah) && IsUndefined(av))
            return LineMissing(number, nik::kDatumObservation);
        AddSighting(name, IsReference(name, {}), hp, ah, av, di, {}, number);
        return;
    }
    double a = kUndefined, b = kUndefined, z = kUndefined;
    if (!Length(f[4], distances, a, number) || !Length(f[5], distances, b, number) ||
        !Length(f[6], distances, z, number))
        return;
    if (IsKnown(a) || IsKnown(b) || IsKnown(z)) {
        if (!AddPosition(name, a, b, z, {}, number)) return;
    } else if (!station) {
        return LineMissing(number, fb::kDatumCoordinates);
    }
    if (station) OpenStation(name, hi, number);
}

// ---- Shared ----------------------------------------------------------------------------------------------

bool CLectNikon::Length(std::string_view text, DistanceUnit unit, double& metres, int number) const {
    metres = kUndefined;
    if (text.empty()) return true;
    double value = 0.0;
    if (!ParseDouble(text, value) || !std::isfinite(value)) {
        if (TextWindow()) TextWindow()->Print(fb::kBadNumber, number, std::string(text).c_str());
        return false;
    }
    metres = ToMetres(value, unit);
    return true;
}

bool CLectNikon::Angle(std::string_view text, AngleUnit unit, double& grads, int number) const {
    grads = kUndefined;
    if (text.empty()) return true;
    // ddd.mmss read digit by digit: 123.4530 is 123° 45' 30", exactly.
    double value = 0.0;
    if (!AngleTextToGrads(text, unit, value) || !std::isfinite(value)) {
        if (TextWindow()) TextWindow()->Print(fb::kBadNumber, number, std::string(text).c_str());
        return false;
    }
    grads = value;
    return true;
}

// A vertical angle as a zenith angle: one read from the horizon (positive upwards) is 100 gr less it.
bool CLectNikon::Zenith(std::string_view text, AngleUnit unit, bool fromZenith, double& grads,
                        int number) const {
    if (!Angle(text, unit, grads, number)) return false;
    if (!fromZenith && IsKnown(grads)) grads = WrapGrads(100.0 - grads);
    return true;
}

// A sighting before any station goes to a station "INCONNUE" that the surveyor renames: nothing measured
// is lost.
bool CLectNikon::StationInForce(int number) {
    if (m_hasStation) return true;
    if (!OpenStation(fb::kUnknownStation, kUndefined, number)) return false;
    LineUnknownStation(number);
    return true;
}

bool CLectNikon::OpenStation(std::string_view name, double hi, int number, double v0) {
    if (name.empty()) {
        LineMissing(number, fb::kDatumStation);
        return false;
    }
    CStation* station = AddStation(std::string(name), hi, v0);
    if (!station) {
        LineError(fb::kRefused, number);
        return false;
    }
    m_hasStation = true;
    m_station = station->mat();
    m_backsight.clear();
    m_onAzimuth = false;
    m_firstSighting = true;
    return true;
}

// Coordinates in the declared order: the first is the easting unless the northing comes first. The
// code goes in front of the point.
bool CLectNikon::AddPosition(std::string_view name, double first, double second, double elevation,
                             std::string_view code, int number) {
    if (IsUndefined(first) && IsUndefined(second) && IsUndefined(elevation)) {
        LineMissing(number, fb::kDatumCoordinates);
        return false;
    }
    if (IsKnown(first) != IsKnown(second)) {
        const bool northMissing = IsKnown(first) == (m_settings.order == CoordinateOrder::EastNorth);
        LineMissing(number, northMissing ? fb::kDatumNorth : fb::kDatumEast);
        return false;
    }
    const bool swap = m_settings.order == CoordinateOrder::NorthEast;
    AddCode(code, name);
    CPointGen* point = AddPoint(std::string(name), swap ? second : first, swap ? first : second, elevation);
    if (!point) {
        LineError(fb::kRefused, number);
        return false;
    }
    if (point->hasXY()) m_known.Insert(point->mat());
    return true;
}

void CLectNikon::AddSighting(std::string_view point, bool reference, double hp, double ah, double av,
                             double di, std::string_view code, int number) {
    AddCode(code, point);
    CVisee* sighting = reference ? static_cast<CVisee*>(AddReference(std::string(point), hp, ah, av, di))
                                 : static_cast<CVisee*>(AddMesure(std::string(point), hp, ah, av, di));
    m_firstSighting = false;
    if (!sighting) LineError(fb::kRefused, number);
}

// A sighting that the field book does not mark as a backsight is a reference when its point was given
// with coordinates, or as the settings say (the first sighting of each station, or a code among
// "CodesReference").
bool CLectNikon::IsReference(std::string_view point, std::string_view code) const {
    if (m_known.Contains(point)) return true;
    return m_settings.MarksReference(m_firstSighting, code);
}

} // namespace pyr
