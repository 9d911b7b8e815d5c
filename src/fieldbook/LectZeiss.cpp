#include "fieldbook/LectZeiss.h"

#include "core/AngleUnits.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectZeissPlaces.h"
#include "fieldbook/LectZeissTexts.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <filesystem>
#include <utility>

namespace pyr {

namespace {

namespace text = zeiss::msg;
using zeiss::Layout;

constexpr double kRightAngle = 100.0; // gr
constexpr double kNadir = 200.0;      // gr

// The end of a transmission (ETX, EOT) or of a file (Ctrl-Z) ends the data of its line; the start of a
// transmission (STX) in front of a line is dropped.
constexpr std::string_view kEndControls{"\x03\x04\x1a", 3};
constexpr char kSTX = '\x02';

// The marker that the code field of a point line holds for the instrument's station.
constexpr std::string_view kStationMarker = "S";

// The point lines of an M5 book without the places of its fields in a header that are looked at before
// those places are chosen: enough for a few codes and pieces of information to show where they lie.
constexpr int kPointLinesForPlaces = 50;

enum class Unit { None, Metres, Feet, Grads, Degrees, Dms, Mils, Percent, Unknown };

Unit UnitOf(std::string_view unit) {
    if (unit.empty()) return Unit::None;
    struct Name {
        std::string_view word; // its length known when compiled: compared to every value of a line
        Unit unit;
    };
    static constexpr Name kNames[] = {{"m", Unit::Metres},  {"ft", Unit::Feet},  {"gon", Unit::Grads},
                                      {"grd", Unit::Grads}, {"gr", Unit::Grads}, {"deg", Unit::Degrees},
                                      {"DMS", Unit::Dms},   {"mil", Unit::Mils}, {"%", Unit::Percent}};
    for (const Name& name : kNames)
        if (EqualIgnoringCase(unit, name.word)) return name.unit;
    return Unit::Unknown;
}

bool IsLength(Unit unit) {
    return unit == Unit::Metres || unit == Unit::Feet;
}

bool IsAngle(Unit unit) {
    return unit == Unit::Grads || unit == Unit::Degrees || unit == Unit::Dms || unit == Unit::Mils;
}

AngleUnit AngleUnitOf(Unit unit) {
    switch (unit) {
    case Unit::Degrees:
        return AngleUnit::Degrees;
    case Unit::Dms:
        return AngleUnit::Dms;
    case Unit::Mils:
        return AngleUnit::Mils;
    default:
        return AngleUnit::Grads;
    }
}

// What a value's type says it is.
enum class Kind {
    Slope,
    Horizontal,
    HeightDifference,
    Hz,
    Zenith,    // V1
    Elevation, // V2: from the horizon, up positive
    Nadir,     // V3: from the nadir
    Grade,     // V4: the slope of the sighting, in % (or an angle from the horizon)
    X,
    Y,
    Z,
    East,
    North,
    Reflector,
    Instrument,
    Orientation,
    Scale,
    Temperature,
    Pressure,
    HeaderWord,
    Unknown
};

Kind KindOf(std::string_view type) {
    struct Name {
        std::string_view word; // its length known when compiled: compared to every value of a line
        Kind kind;
    };
    static constexpr Name kNames[] = {{"SD", Kind::Slope},
                                      {"HD", Kind::Horizontal},
                                      {"h", Kind::HeightDifference},
                                      {"Hz", Kind::Hz},
                                      {"V1", Kind::Zenith},
                                      {"V2", Kind::Elevation},
                                      {"V3", Kind::Nadir},
                                      {"V4", Kind::Grade},
                                      {"X", Kind::X},
                                      {"x", Kind::X},
                                      {"Y", Kind::Y},
                                      {"y", Kind::Y},
                                      {"Z", Kind::Z},
                                      {"E", Kind::East},
                                      {"e", Kind::East},
                                      {"N", Kind::North},
                                      {"n", Kind::North},
                                      {"th", Kind::Reflector},
                                      {"ih", Kind::Instrument},
                                      {"Om", Kind::Orientation},
                                      {"m", Kind::Scale},
                                      {"T", Kind::Temperature},
                                      {"T_", Kind::Temperature},
                                      {"P", Kind::Pressure}};
    for (const Name& name : kNames)
        if (type == name.word) return name.kind;
    if (type.size() == 2 && std::isdigit(static_cast<unsigned char>(type[0])) &&
        std::isdigit(static_cast<unsigned char>(type[1])))
        return Kind::HeaderWord;
    return Kind::Unknown;
}

bool IsLengthKind(Kind kind) {
    return kind <= Kind::HeightDifference || (kind >= Kind::X && kind <= Kind::Instrument);
}

// Programs of the instrument that set up a station: their sightings orient it.
bool IsSetUpProgram(std::string_view words) {
    return words.find("STAT") != std::string_view::npos || words.starts_with("OR.") ||
           words.starts_with("ORIENT") || words.starts_with("RESECT");
}

// Texts that say something within a program without starting another one.
bool IsWithinProgram(std::string_view words) {
    for (const char* word : {"INPUT", "ADJUST", "COM-ON", "COM-OFF", "START", "END"})
        if (words.starts_with(word)) return true;
    return words.empty();
}

const char* LayoutName(Layout layout) {
    switch (layout) {
    case Layout::M5:
        return "M5";
    case Layout::R4:
        return "R4";
    case Layout::R5:
        return "R5";
    case Layout::Rec500:
        return "Rec 500";
    case Layout::Unknown:
        break;
    }
    return "";
}

std::string WithUnit(std::string_view number, std::string_view unit) {
    std::string shown(number);
    if (!unit.empty()) shown.append(" ").append(unit);
    return shown;
}

} // namespace

// ---- Settings and state ----------------------------------------------------------------------------------

void CLectZeiss::ReadSettings() {
    m_settings = ReadInstrumentSettings(Driver(), CoordinateOrder::NorthEast);
    // The instrument's X is its northing unless the settings say the easting comes first in X.
    m_xNorth = m_settings.order == CoordinateOrder::NorthEast;
}

void CLectZeiss::BeginReading() {
    ReadSettings();
    m_layout = Layout::Unknown;
    m_places = {};
    m_placesKnown = false;
    m_heldLines.clear();
    m_heldPoints = 0;
    m_station = nullptr;
    m_sighted = m_measured = m_settingUp = m_setUp = m_programStation = m_knownStation = false;
    m_hi = m_reflector = kUndefined;
    m_heightPending = false;
    m_held.clear();
    m_lineSighted.clear();
    m_sightedBefore.clear();
    m_typesSaid.clear();
    m_unitsSaid.clear();
    for (std::string* last : {&m_instrument, &m_serial, &m_version, &m_axes, &m_scale, &m_orientation,
                              &m_temperature, &m_pressure})
        last->clear();
    m_started = false;
}

// ---- A line ----------------------------------------------------------------------------------------------

void CLectZeiss::ReadLine(std::string_view line, int number) {
    if (!line.empty() && line.front() == kSTX) line.remove_prefix(1);
    line = line.substr(0, FindControl(line, kEndControls));
    if (HoldForPlaces(line, number)) return;
    ReadRecordLine(line, number);
}

void CLectZeiss::EndReading() {
    if (!m_heldLines.empty()) FindPlaces();
    WriteHeldSightings();
    SettleInstrumentHeight();
}

// An M5 book that does not say in its header where the point id and the code lie: its lines are held from
// its first point line until enough point lines are seen, or the book ends.
bool CLectZeiss::HoldForPlaces(std::string_view line, int number) {
    if (m_placesKnown) return false;
    const bool pointLine = zeiss::M5InfoOccupancy(line).has_value();
    if (m_heldLines.empty() && !pointLine) return false;
    m_heldLines.push_back({std::string(line), number});
    if (pointLine && ++m_heldPoints >= kPointLinesForPlaces) FindPlaces();
    return true;
}

// The layout that explains the most held point lines is kept, the surveyor told when it is not the
// default; then the held lines are read in their order.
void CLectZeiss::FindPlaces() {
    std::vector<std::string> occupancies;
    int firstPoint = 0;
    for (const HeldLine& held : m_heldLines)
        if (auto occupancy = zeiss::M5InfoOccupancy(held.text)) {
            if (firstPoint == 0) firstPoint = held.number;
            occupancies.push_back(std::move(*occupancy));
        }
    const zeiss::FoundPlaces found = zeiss::FindPlaces(occupancies);
    m_places = found.places;
    m_placesKnown = true;
    const zeiss::InfoPlaces usual;
    const bool moved = m_places.point != usual.point || m_places.code != usual.code;
    if (TextWindow() && (found.explained == 0 || moved))
        TextWindow()->Print(found.explained == 0 ? text::kPlacesUnexplained : text::kPlacesFound, firstPoint,
                            m_places.point, m_places.point + zeiss::kPointWidth - 1, m_places.code,
                            m_places.code + zeiss::kCodeWidth - 1);
    const std::vector<HeldLine> lines = std::exchange(m_heldLines, {});
    for (const HeldLine& held : lines)
        ReadRecordLine(held.text, held.number);
}

void CLectZeiss::ReadRecordLine(std::string_view line, int number) {
    const std::string_view words = Trimmed(line);
    if (words.empty() || words == "END") return;
    m_sightedBefore = std::exchange(m_lineSighted, {});
    if (!Split(line, number)) {
        LineUnrecognised(number);
        if (TextWindow()) TextWindow()->Print(fb::kStringRead, std::string(words).c_str());
        return;
    }
    Values values;
    if (!ReadValues(number, values)) return;
    if (m_record.errorFlag && TextWindow()) TextWindow()->Print(text::kFlaggedLine, number);
    if (m_record.text)
        ReadTextRecord(values);
    else
        ReadPoint(values, number);
}

bool CLectZeiss::Split(std::string_view line, int number) {
    Layout layout = zeiss::LayoutOf(line);
    if (layout == Layout::Unknown && (m_layout == Layout::Unknown || m_layout == Layout::Rec500))
        layout = Layout::Rec500;
    // A fixed-width line may carry blanks beyond its last column, not fewer columns.
    const int width = layout == Layout::M5       ? zeiss::kM5Width
                      : layout == Layout::Rec500 ? zeiss::kRec500Width
                                                 : 0;
    const auto Checked = [&](bool cut) {
        if (!cut || width == 0) return cut;
        // Counted in characters: an accented letter of a Windows-1252 field book is one column.
        const int length = static_cast<int>(Utf8Length(line));
        if (length == width) return true;
        const int filled = static_cast<int>(Utf8Length(line.substr(0, line.find_last_not_of(' ') + 1)));
        if (length < width || filled > width) CheckLength(number, line, width);
        return true;
    };
    bool cut = false;
    switch (layout) {
    case Layout::M5:
        cut = Checked(zeiss::SplitM5(line, m_places, m_record));
        break;
    case Layout::R4:
    case Layout::R5:
        cut = Checked(zeiss::SplitR4R5(line, layout == Layout::R5, m_record));
        break;
    case Layout::Rec500:
        cut = Checked(zeiss::SplitRec500(line, m_record));
        break;
    case Layout::Unknown:
        break;
    }
    if (!cut) return false;
    if (!m_started) {
        m_started = true;
        m_layout = layout;
        if (!Path().empty())
            AddHeaderComment(fb::kLabelFile, std::filesystem::path(Path()).filename().string());
        AddHeaderComment(fb::kLabelFormat, LayoutName(layout));
    }
    return true;
}

void CLectZeiss::WarnOnce(std::vector<std::string>& said, const char* format, std::string_view what,
                          int number) {
    if (IsAnyOf(what, said)) return;
    said.emplace_back(what);
    if (TextWindow()) TextWindow()->Print(format, number, said.back().c_str());
}

// Every value of the line into grads and metres. False, the line reported, when a number cannot be read.
bool CLectZeiss::ReadValues(int number, Values& values) {
    for (std::size_t i = 0; i < m_record.valueCount; ++i) {
        const zeiss::Value& value = m_record.values[i];
        const Kind kind = KindOf(value.type);
        if (kind == Kind::HeaderWord) {
            ReadHeaderWord(value.type, WithUnit(value.number, value.unit));
            continue;
        }
        if (kind == Kind::Unknown) {
            WarnOnce(m_typesSaid, text::kUnknownType, value.type, number);
            continue;
        }
        if (value.number.empty()) continue; // a type without its value: nothing measured
        switch (kind) {
        case Kind::Scale:
            Header(m_scale, fb::kLabelScale, WithUnit(value.number, value.unit));
            continue;
        case Kind::Temperature:
            Header(m_temperature, fb::kLabelTemperature, WithUnit(value.number, value.unit));
            continue;
        case Kind::Pressure:
            Header(m_pressure, text::kLabelPressure, WithUnit(value.number, value.unit));
            continue;
        default:
            break;
        }

        // A unit that does not fit the value (an angle in metres) is not trusted: the settings' one is taken.
        Unit unit = UnitOf(value.unit);
        const bool percent = unit == Unit::Percent && kind == Kind::Grade;
        const bool fits = IsLengthKind(kind) ? IsLength(unit) : IsAngle(unit);
        if (unit != Unit::None && !percent && !fits) {
            WarnOnce(m_unitsSaid, text::kUnknownUnit, value.unit, number);
            unit = Unit::None;
        }
        double read = 0.0;
        bool ok = false;
        if (IsLengthKind(kind)) {
            ok = ParseDouble(value.number, read);
            const DistanceUnit distances = unit == Unit::None   ? m_settings.distances
                                           : unit == Unit::Feet ? DistanceUnit::Feet
                                                                : DistanceUnit::Metres;
            read = ToMetres(read, distances);
        } else if (percent) {
            ok = ParseDouble(value.number, read);
            read = kRightAngle - RadiansToGrads(std::atan(read / 100.0));
        } else {
            const AngleUnit angles = unit == Unit::None ? m_settings.angles : AngleUnitOf(unit);
            ok = AngleTextToGrads(value.number, angles, read);
        }
        if (!ok || !std::isfinite(read)) {
            if (TextWindow()) TextWindow()->Print(fb::kBadNumber, number, std::string(value.number).c_str());
            return false;
        }
        switch (kind) {
        case Kind::Slope:
            values.slope = read;
            break;
        case Kind::Horizontal:
            values.horizontal = read;
            break;
        case Kind::HeightDifference:
            values.heightDifference = read;
            break;
        case Kind::Hz:
            values.hz = WrapGrads(read);
            break;
        case Kind::Zenith:
            values.zenith = WrapGrads(read);
            break;
        case Kind::Elevation:
            values.zenith = WrapGrads(kRightAngle - read);
            break;
        case Kind::Nadir:
            values.zenith = WrapGrads(kNadir - read);
            break;
        case Kind::Grade:
            values.zenith = WrapGrads(percent ? read : kRightAngle - read);
            break;
        case Kind::X:
            (m_xNorth ? values.north : values.east) = read;
            break;
        case Kind::Y:
            (m_xNorth ? values.east : values.north) = read;
            break;
        case Kind::Z:
            values.elevation = read;
            break;
        case Kind::East:
            values.east = read;
            break;
        case Kind::North:
            values.north = read;
            break;
        case Kind::Reflector:
            values.reflector = read;
            break;
        case Kind::Instrument:
            values.instrument = read;
            break;
        case Kind::Orientation:
            Header(m_orientation, text::kLabelOrientation, FormatShortest(RoundToDecimals(read, 5)) + " gr");
            break;
        default:
            break;
        }
    }
    if (IsKnown(values.reflector)) m_reflector = values.reflector;
    if (IsKnown(values.instrument)) m_hi = values.instrument;
    return true;
}

void CLectZeiss::Header(std::string& last, const char* label, std::string_view value) {
    if (value.empty() || value == last) return;
    last.assign(value);
    AddHeaderComment(label, value);
}

// The words of an instrument's header (between "START" and "END").
void CLectZeiss::ReadHeaderWord(std::string_view type, std::string_view value) {
    if (type == "01") return Header(m_instrument, fb::kLabelInstrument, value);
    if (type == "02") return Header(m_serial, fb::kLabelSerial, value);
    if (type == "03") return Header(m_version, text::kLabelVersion, value);
    const int number = LenientAtoi(value);
    if (type == "05") {
        // The coordinate system. Whatever the order of writing (word 06), the instrument writes the easting
        // first: in system 1 (XY) that is Y, so its X is the northing; in system 2 (YX) that is X, the
        // easting; system 3 names them N and E.
        if (number == 1) m_xNorth = true;
        if (number == 2) m_xNorth = false;
        if (number >= 1 && number <= 3)
            Header(m_axes, text::kLabelAxes,
                   number == 1   ? text::kAxesXNorth
                   : number == 2 ? text::kAxesXEast
                                 : text::kAxesNorthEast);
        return;
    }
    // The places of the information, the code and the point id in the information block.
    if (number < 1 || number > zeiss::kInfoWidth) return;
    if (type == "20") m_places.information = number;
    if (type == "21") m_places.code = number;
    if (type == "22") m_places.point = number;
    if (type == "20" || type == "21" || type == "22") m_placesKnown = true;
}

// ---- Texts -----------------------------------------------------------------------------------------------

void CLectZeiss::ReadTextRecord(const Values& values) {
    const std::string_view words = m_record.words;
    if (!IsWithinProgram(words)) {
        // Sightings of the set-up that no station line claimed stay before the next program.
        WriteHeldSightings();
        m_settingUp = false;
        m_setUp = IsSetUpProgram(words);
        m_programStation = false;
        m_knownStation = words.starts_with("KN STAT");
        AddComment(std::string(words));
    }
    if (IsKnown(values.instrument)) SetInstrumentHeight(values.instrument);
}

// ---- Points, stations and sightings ----------------------------------------------------------------------

void CLectZeiss::ReadPoint(const Values& values, int number) {
    if (m_record.point.empty()) {
        // A line of settings only (a Rec 500 line of m and Om) names no point.
        if (m_record.code.empty() && m_record.valueCount > 0 && !values.HasObservation() &&
            !values.HasPosition())
            return ReadTextRecord(values);
        return LineMissing(number, fb::kDatumPoint);
    }
    if (m_record.code == kStationMarker) return ReadStation(values, number);
    if (values.HasObservation()) return ReadSighting(values, number);
    if (values.HasPosition() && m_record.point == m_sightedBefore) return ReadComputed(values, number);
    if (values.HasPosition()) {
        AddPosition(m_record.point, values, true, number);
        return;
    }
    if (IsKnown(values.instrument)) return SetInstrumentHeight(values.instrument);
    if (IsUndefined(values.reflector)) LineMissing(number, fb::kDatumContent);
}

void CLectZeiss::ReadStation(const Values& values, int number) {
    const std::string_view name = FormMatView(m_record.point);
    // The lines of one set-up (its coordinates, then its height) name the same station.
    const bool same = m_station && m_settingUp && m_station->mat() == name;
    if (same)
        SettleInstrumentHeight();
    else if (!OpenStation(name, number))
        return;
    m_programStation = true;
    if (IsKnown(values.instrument)) {
        m_station->setHI(values.instrument);
        m_heightPending = false;
    }
    if (values.HasPosition()) AddPosition(name, values, false, number);
    WriteHeldSightings();
}

// A new station takes the last instrument height given, even one given before the previous station
// measured anything: that height was set for this one.
bool CLectZeiss::OpenStation(std::string_view name, int number) {
    CStation* station = AddStation(std::string(name), m_hi, m_knownStation ? 0.0 : kUndefined);
    if (!station) {
        LineError(fb::kRefused, number);
        return false;
    }
    m_station = station;
    m_sighted = m_measured = false;
    m_heightPending = false;
    m_settingUp = true;
    return true;
}

// An instrument height given after the station measured waits for the next station. Given before, it is
// the station's if a sighting comes next, the next station's if a station line comes first: the
// instrument asks for it at the start of the measurements as well as at the set-up of the next station.
void CLectZeiss::SetInstrumentHeight(double hi) {
    m_hi = hi;
    m_heightPending = m_station && !m_measured;
}

// The pending instrument height goes to the station in force.
void CLectZeiss::SettleInstrumentHeight() {
    if (m_heightPending && m_station) m_station->setHI(m_hi);
    m_heightPending = false;
}

bool CLectZeiss::IsReference(std::string_view code) const {
    if (m_setUp) return true;
    return m_settings.MarksReference(!m_sighted, code);
}

// A sighting of a set-up program read before the program's station line waits for it: the instrument
// writes the station once its backsights are measured.
void CLectZeiss::ReadSighting(const Values& values, int number) {
    Sighting sighting{
        std::string(m_record.point), std::string(m_record.code), PointCode(), values, m_reflector, number};
    m_lineSighted = sighting.point;
    if (m_setUp && !m_programStation) {
        m_held.push_back(std::move(sighting));
        return;
    }
    SettleInstrumentHeight();
    m_measured = true;
    m_settingUp = false;
    WriteSighting(sighting);
}

// The coordinates that the instrument computed for the sighting on the line before, written on a line of
// their own: the sighting's line holds three values only.
void CLectZeiss::ReadComputed(const Values& values, int number) {
    if (!m_held.empty() && m_held.back().point == m_sightedBefore) {
        Values& held = m_held.back().values;
        if (!held.HasPosition()) {
            held.east = values.east;
            held.north = values.north;
            held.elevation = values.elevation;
        }
        return;
    }
    if (m_settings.keepComputed) AddPosition(m_sightedBefore, values, false, number);
}

void CLectZeiss::WriteHeldSightings() {
    const std::vector<Sighting> held = std::exchange(m_held, {});
    for (const Sighting& sighting : held)
        WriteSighting(sighting);
}

void CLectZeiss::WriteSighting(const Sighting& sighting) {
    const int number = sighting.number;
    if (!m_station) {
        if (!OpenStation(fb::kUnknownStation, number)) return;
        LineUnknownStation(number);
    }
    const Values& values = sighting.values;
    double av = values.zenith, di = values.slope;
    SlopeFromHorizontal(values.horizontal, values.heightDifference, av, di);
    AddCode(sighting.label, sighting.point);
    const double hp = sighting.reflector;
    CVisee* added = IsReference(sighting.code)
                        ? static_cast<CVisee*>(AddReference(sighting.point, hp, values.hz, av, di))
                        : static_cast<CVisee*>(AddMesure(sighting.point, hp, values.hz, av, di));
    m_sighted = true;
    if (!added) return LineError(fb::kRefused, number);
    if (m_settings.keepComputed && IsKnown(values.east) && IsKnown(values.north))
        AddPosition(sighting.point, values, false, number);
}

// The code of the point line, followed by its information.
const std::string& CLectZeiss::PointCode() {
    m_text.assign(m_record.code);
    if (!m_record.information.empty()) m_text.append(m_text.empty() ? "" : " ").append(m_record.information);
    return m_text;
}

bool CLectZeiss::AddPosition(std::string_view name, const Values& values, bool keepCode, int number) {
    if (IsKnown(values.east) != IsKnown(values.north)) {
        LineMissing(number, IsKnown(values.east) ? fb::kDatumNorth : fb::kDatumEast);
        return false;
    }
    if (keepCode) AddCode(PointCode(), name);
    if (!AddPoint(std::string(name), values.east, values.north, values.elevation)) {
        LineError(fb::kRefused, number);
        return false;
    }
    return true;
}

std::unique_ptr<CFieldBookReader> MakeZeissReader() {
    return std::make_unique<CLectZeiss>();
}

} // namespace pyr
