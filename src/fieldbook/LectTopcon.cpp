#include "fieldbook/LectTopcon.h"

#include "core/AngleUnits.h"
#include "core/Angles.h"
#include "core/Files.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectTopconTexts.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "ui/PyrTxtWnd.h"

#include <cmath>
#include <filesystem>

namespace pyr {

namespace {

using topcon::Keyword;
namespace text = topcon::msg;

// Beyond this a number is no measurement nor coordinate a field book holds: a wrong number, as are the
// infinities and NaN that a number reader would otherwise let through.
constexpr double kLargestValue = 1e9;

char UpperInitial(std::string_view field) {
    const char c = field.empty() ? '\0' : field.front();
    return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
}

const char* AngleUnitName(AngleUnit unit) {
    switch (unit) {
    case AngleUnit::Grads:
        return fb::kGrads;
    case AngleUnit::Dms:
        return text::kDms;
    case AngleUnit::Degrees:
        return fb::kDegrees;
    case AngleUnit::Mils:
        return text::kMils;
    }
    return fb::kGrads;
}

} // namespace

std::unique_ptr<CFieldBookReader> MakeTopconReader() {
    return std::make_unique<CLectTopcon>();
}

std::string CLectTopcon::OpenFailure(const std::string& path, int code) const {
    return Sprintf(fb::kInParentheses, Sprintf(fb::kMsgCannotOpenCarnetForReading, path.c_str()).c_str(),
                   SystemErrorText(code).c_str());
}

// ---- Settings and state ----------------------------------------------------------------------------------

void CLectTopcon::ReadSettings() {
    m_settings = ReadInstrumentSettings(Driver());
}

void CLectTopcon::BeginReading() {
    ReadSettings();
    m_started = m_lineSeen = false;
    m_software.clear();
    m_stationPending = false;
    m_stationName.clear();
    m_stationCode.clear();
    m_stationHi = kUndefined;
    m_station = nullptr;
    m_firstSighting = false;
    m_backsight.clear();
    m_sighting = SightingKind::None;
    m_target.clear();
    m_targetCode.clear();
    m_targetHeight = kUndefined;
    m_owner = PositionOwner::None;
    m_ownerName.clear();
    m_lastMeasured.clear();
}

void CLectTopcon::EndReading() {
    if (m_stationPending) FlushStation();
    if (m_sighting != SightingKind::None) ReportPendingSighting();
}

// ---- A line ----------------------------------------------------------------------------------------------

void CLectTopcon::ReadLine(std::string_view line, int number) {
    const std::string_view clean = TrimmedOfControls(line);
    if (clean.empty()) return;
    topcon::SplitRecord(clean, m_record);
    const Keyword kind = m_record.kind;

    // The first line of a field book names the program that wrote it ("TopSURV v6.04(OnBoard)"). It is
    // written, after the name of the file, once a record of the format shows that the file is one: a file
    // of another kind gives nothing.
    const bool firstLine = !m_lineSeen;
    m_lineSeen = true;
    if (kind == Keyword::Unknown && firstLine) {
        m_software.assign(clean);
        return;
    }
    if (kind != Keyword::Unknown && !m_started) {
        m_started = true;
        if (!Path().empty())
            AddHeaderComment(fb::kLabelFile, std::filesystem::path(Path()).filename().string());
        if (!m_software.empty()) AddHeaderComment(fb::kLabelSoftware, m_software);
    }
    // A station waits only for its coordinates, a sighting only for its observation (a note between
    // them is allowed), an XYZ line belongs only to the line just before it.
    if (kind != Keyword::Position && m_stationPending) FlushStation();
    const bool observation =
        kind == Keyword::AnglesOnly || kind == Keyword::SlopeDistance || kind == Keyword::Horizontal;
    if (!observation && kind != Keyword::Note && m_sighting != SightingKind::None) ReportPendingSighting();
    const PositionOwner owner = m_owner;
    m_owner = PositionOwner::None;

    switch (kind) {
    case Keyword::Job:
        return Header(fb::kLabelJob, m_record);
    case Keyword::Date:
        return Header(fb::kLabelDate, m_record, " ");
    case Keyword::Name:
        return Header(text::kLabelName, m_record);
    case Keyword::Instrument:
        return Header(fb::kLabelInstrument, m_record);
    case Keyword::Scale:
        return Header(fb::kLabelScale, m_record);
    case Keyword::Atmosphere:
        return Header(fb::kLabelAtmosphere, m_record);
    case Keyword::Temperature:
        return Header(text::kLabelTemperature, m_record);
    case Keyword::Control:
        return Header(text::kLabelControl, m_record);
    case Keyword::Units:
        return ReadUnits(number);
    case Keyword::Station:
        return ReadStation(number);
    case Keyword::Position:
        m_owner = owner;
        return ReadPosition(number);
    case Keyword::Backsight:
        return ReadBacksight(number);
    case Keyword::BackSighting:
        return ReadSighting(SightingKind::Back, number);
    case Keyword::ForeSighting:
    case Keyword::SideSighting:
        return ReadSighting(SightingKind::Fore, number);
    case Keyword::AnglesOnly:
    case Keyword::SlopeDistance:
    case Keyword::Horizontal:
        return ReadObservation(number);
    case Keyword::Note:
        if (!m_record.values.empty()) AddComment(std::string(m_record.values));
        return;
    case Keyword::Offset:
        return ReadOffset(number);
    case Keyword::Unknown:
        break;
    }
    LineUnrecognised(number);
}

void CLectTopcon::Header(const char* label, const topcon::Record& record, const char* separator) {
    m_text.clear();
    for (std::size_t i = 0; i < record.count; ++i) {
        if (record.fields[i].empty()) continue;
        if (!m_text.empty()) m_text += separator;
        m_text += record.fields[i];
    }
    if (!m_text.empty()) AddHeaderComment(label, m_text);
}

// UNITS M|F,D|G: the lengths in metres or feet, the angles in ddd.mmss or grads. An empty field keeps
// the unit in force.
void CLectTopcon::ReadUnits(int number) {
    const char lengths = UpperInitial(m_record.Field(0));
    const char angles = UpperInitial(m_record.Field(1));
    const bool known = (lengths == '\0' || lengths == 'M' || lengths == 'F') &&
                       (angles == '\0' || angles == 'D' || angles == 'G');
    if (!known) {
        if (TextWindow()) TextWindow()->Print(text::kBadUnits, number, std::string(m_record.values).c_str());
        return;
    }
    if (lengths != '\0') m_settings.distances = lengths == 'F' ? DistanceUnit::Feet : DistanceUnit::Metres;
    if (angles != '\0') m_settings.angles = angles == 'D' ? AngleUnit::Dms : AngleUnit::Grads;
    AddHeaderComment(fb::kLabelUnits,
                     Sprintf("%s, %s", m_settings.distances == DistanceUnit::Feet ? fb::kFeet : fb::kMetres,
                             AngleUnitName(m_settings.angles)));
}

// ---- Numbers ---------------------------------------------------------------------------------------------

// An empty field is a missing value, kept undefined; ddd.mmss is read digit by digit into degrees, so
// that no rounding shifts a second.
bool CLectTopcon::ReadNumber(std::string_view value, double& read, bool dms, int number) const {
    read = kUndefined;
    if (value.empty()) return true;
    double parsed = 0.0;
    const bool ok = dms ? DmsTextToDegrees(value, parsed) : ParseDouble(value, parsed);
    if (!ok || !std::isfinite(parsed) || std::fabs(parsed) > kLargestValue) {
        if (TextWindow()) TextWindow()->Print(fb::kBadNumber, number, std::string(value).c_str());
        return false;
    }
    read = parsed;
    return true;
}

bool CLectTopcon::ReadAngle(std::string_view value, double& grads, int number) const {
    const bool dms = m_settings.angles == AngleUnit::Dms;
    if (!ReadNumber(value, grads, dms, number)) return false;
    // ReadNumber has already turned ddd.mmss into degrees.
    grads = ToGrads(grads, dms ? AngleUnit::Degrees : m_settings.angles);
    return true;
}

bool CLectTopcon::ReadLength(std::string_view value, double& metres, int number) const {
    if (!ReadNumber(value, metres, false, number)) return false;
    metres = ToMetres(metres, m_settings.distances);
    return true;
}

// ---- Stations and points ---------------------------------------------------------------------------------

// STN id,ih,code: the station is written once the next line says whether its coordinates follow.
void CLectTopcon::ReadStation(int number) {
    const std::string_view name = FormMatView(m_record.Field(0));
    if (name.empty()) return LineMissing(number, fb::kDatumStation);
    double hi = kUndefined;
    if (!ReadLength(m_record.Field(1), hi, number)) return;
    m_stationPending = true;
    m_stationName.assign(name);
    m_stationCode.assign(m_record.Field(2));
    m_stationHi = hi;
    m_stationLine = number;
    m_owner = PositionOwner::Station;
    m_ownerName.assign(name);
}

void CLectTopcon::FlushStation() {
    m_stationPending = false;
    AddCode(m_stationCode, m_stationName);
    m_station = AddStation(m_stationName, m_stationHi);
    if (!m_station) LineError(fb::kRefused, m_stationLine);
    m_firstSighting = true;
    m_backsight.clear();
}

bool CLectTopcon::OpenUnknownStation(int number) {
    m_station = AddStation(fb::kUnknownStation, kUndefined);
    if (!m_station) {
        LineError(fb::kRefused, number);
        return false;
    }
    LineUnknownStation(number);
    m_firstSighting = true;
    m_backsight.clear();
    return true;
}

// XYZ E,N,Z (N,E,Z with "OrdreCoordonnees=YX"): the station's point, the backsight's, or the point the
// instrument computed from the sighting just read.
void CLectTopcon::ReadPosition(int number) {
    const PositionOwner owner = m_owner;
    m_owner = PositionOwner::None;
    if (owner == PositionOwner::None) return LineError(text::kNoOwner, number);
    double first = kUndefined, second = kUndefined, elevation = kUndefined;
    if (!ReadLength(m_record.Field(0), first, number) || !ReadLength(m_record.Field(1), second, number) ||
        !ReadLength(m_record.Field(2), elevation, number))
        return;
    // A point may hold its planimetry, its altimetry or both, never half a planimetry.
    if (IsKnown(first) != IsKnown(second) || (IsUndefined(first) && IsUndefined(elevation)))
        return LineMissing(number, text::kDatumCoordinates);
    if (owner == PositionOwner::Measured && !m_settings.keepComputed) return;
    const bool swap = m_settings.order == CoordinateOrder::NorthEast;
    if (owner == PositionOwner::Station) {
        AddCode(m_stationCode, m_stationName);
        m_stationCode.clear();
    }
    if (!AddPoint(m_ownerName, swap ? second : first, swap ? first : second, elevation))
        LineError(fb::kRefused, number);
    if (owner == PositionOwner::Station) FlushStation();
}

// BKB id,bearing,reading: the backsight of the station, and the orientation set on it. The V0 is left to
// the orientation computation, which checks it against every reference; the comment keeps what the
// instrument was told.
void CLectTopcon::ReadBacksight(int number) {
    const std::string_view name = FormMatView(m_record.Field(0));
    if (name.empty()) return LineMissing(number, fb::kDatumPoint);
    double bearing = kUndefined, reading = kUndefined;
    if (!ReadAngle(m_record.Field(1), bearing, number) || !ReadAngle(m_record.Field(2), reading, number))
        return;
    m_backsight.assign(name);
    if (IsKnown(bearing) || IsKnown(reading)) {
        const auto shown = [](double grads) {
            return IsKnown(grads) ? FormatFixed(grads, 5) : std::string("?");
        };
        AddComment(
            Sprintf(text::kOrientation, m_backsight.c_str(), shown(bearing).c_str(), shown(reading).c_str()));
    }
    m_owner = PositionOwner::Backsight;
    m_ownerName.assign(name);
}

// ---- Sightings -------------------------------------------------------------------------------------------

// BS id[,th] or FS / SS id,th,code: written when its observation comes.
void CLectTopcon::ReadSighting(SightingKind kind, int number) {
    const std::string_view name = FormMatView(m_record.Field(0));
    if (name.empty()) return LineMissing(number, fb::kDatumPoint);
    double height = kUndefined;
    if (!ReadLength(m_record.Field(1), height, number)) return;
    m_sighting = kind;
    m_target.assign(name);
    m_targetCode.assign(m_record.Field(2));
    m_targetHeight = height;
    m_targetLine = number;
}

void CLectTopcon::ReportPendingSighting() {
    m_sighting = SightingKind::None;
    LineMissing(m_targetLine, Sprintf(text::kDatumObservation, m_target.c_str()));
}

bool CLectTopcon::IsReference() const {
    if (m_sighting == SightingKind::Back) return true;
    if (!m_backsight.empty() && m_target == m_backsight) return true;
    return m_settings.MarksReference(m_firstSighting, m_targetCode);
}

// HV ha,va; SD ha,va,sd; HD ha,hd,vd. A GéoBase sighting holds a zenith angle and a slope distance: a
// horizontal distance hd with the height difference vd from the tilting axis to the target gives the
// slope distance hypot(hd, vd) and the zenith angle atan2(hd, vd); without vd the sighting is taken as
// horizontal (100 gr), so that its horizontal distance is kept.
void CLectTopcon::ReadObservation(int number) {
    if (m_sighting == SightingKind::None) return LineError(text::kNoSighting, number);
    double ah = kUndefined, av = kUndefined, di = kUndefined;
    bool read = ReadAngle(m_record.Field(0), ah, number);
    if (read && m_record.kind == Keyword::Horizontal) {
        double hd = kUndefined, vd = kUndefined;
        read = ReadLength(m_record.Field(1), hd, number) && ReadLength(m_record.Field(2), vd, number);
        SlopeFromHorizontal(hd, vd, av, di);
    } else if (read) {
        read = ReadAngle(m_record.Field(1), av, number);
        if (read && m_record.kind == Keyword::SlopeDistance) read = ReadLength(m_record.Field(2), di, number);
    }
    if (read && IsUndefined(ah) && IsUndefined(av) && IsUndefined(di)) {
        LineMissing(number, text::kDatumMeasures);
        read = false;
    }
    if (!read) return ReportPendingSighting();
    if (!m_station && !OpenUnknownStation(m_targetLine)) {
        m_sighting = SightingKind::None;
        return;
    }
    const bool reference = IsReference();
    m_sighting = SightingKind::None;
    m_firstSighting = false;
    AddCode(m_targetCode, m_target);
    const bool kept = reference ? AddReference(m_target, m_targetHeight, ah, av, di) != nullptr
                                : AddMesure(m_target, m_targetHeight, ah, av, di) != nullptr;
    if (!kept) return LineError(fb::kRefused, number);
    m_owner = PositionOwner::Measured;
    m_ownerName = m_target;
    m_lastMeasured = m_target;
}

// OFFSET: the values of an offset shot, which move the point of the last sighting; said, not applied.
void CLectTopcon::ReadOffset(int number) {
    if (TextWindow())
        TextWindow()->Print(text::kOffsetIgnored, number, std::string(m_record.values).c_str(),
                            m_lastMeasured.empty() ? "?" : m_lastMeasured.c_str());
}

} // namespace pyr
