#include "fieldbook/LectSokkia.h"

#include "core/AngleUnits.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectSokkiaTexts.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "ui/PyrTxtWnd.h"

#include <cmath>
#include <filesystem>

namespace pyr {

namespace {

namespace text = sdr::msg;

constexpr char kSTX = '\x02';
constexpr char kETX = '\x03';
constexpr std::string_view kUnchecked = "00000";
constexpr double kHorizonToZenith =
    100.0; // gr: a vertical angle from the horizon is 100 gr less a zenith one

// Columns of the header (00) and instrument (01) records, counted from 1.
constexpr int kVersionColumn = 5, kVersionWidth = 16;
constexpr int kDateColumn = 25, kDateWidth = 16;
constexpr std::size_t kAngleUnitIndex = 40, kDistanceUnitIndex = 41, kOrderIndex = 44;
constexpr int kModelColumn = 6, kModelWidth = 16, kSerialColumn = 22, kSerialWidth = 6;
constexpr int kEdmColumn = 28, kEdmSerialColumn = 44;
constexpr std::size_t kZeroVerticalIndex = 50;
constexpr int kConstantsColumn = 52;
constexpr int kJobWidth = 16;
constexpr int kFirstFieldColumn = 5; // after the type (columns 1-2) and the derivation code (3-4)

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

// The code letter at a column counted from 0 in characters, ' ' beyond the line; '?' for a letter that is
// no code (an accented one), which says it in the report of an unknown code.
char At(std::string_view line, std::size_t index) {
    const std::string_view letter = sdr::Column(line, static_cast<int>(index) + 1, 1);
    if (letter.empty()) return ' ';
    return letter.size() == 1 ? letter.front() : '?';
}

// A line without the blanks, the line-end and transfer controls (EOT, Ctrl-Z) behind its last datum.
std::string_view Content(std::string_view line) {
    std::size_t end = line.size();
    while (end > 0 && static_cast<unsigned char>(line[end - 1]) <= ' ')
        --end;
    return line.substr(0, end);
}

// The text of a record with its runs of blanks brought to one.
std::string Words(std::string_view text) {
    std::string words;
    for (char c : Trimmed(text)) {
        if (c == ' ' && !words.empty() && words.back() == ' ') continue;
        words += c;
    }
    return words;
}

// A date that says something: the transfer of some collectors blanks it into "00-000-00 00:00".
bool IsDate(std::string_view date) {
    for (char c : date)
        if (c != '0' && c != '-' && c != ':' && c != '/' && c != '.' && c != ' ') return true;
    return false;
}

} // namespace

std::unique_ptr<CFieldBookReader> MakeSokkiaReader() {
    return std::make_unique<CLectSokkia>();
}

// ---- Settings and state ----------------------------------------------------------------------------------

void CLectSokkia::ReadSettings() {
    m_zenith = true;
    m_variant = sdr::Variant::Sdr33;
    m_variantKnown = false;
    // Without a parameter set, what an SDR collector writes when nothing says otherwise.
    m_settings = ReadInstrumentSettings(Driver(), CoordinateOrder::NorthEast);
}

void CLectSokkia::BeginReading() {
    ReadSettings();
    m_station = nullptr;
    m_stationName.clear();
    m_firstSighting = false;
    m_azimuthWarned = false;
    m_backsight = {};
    m_targetHeight = kUndefined;
    m_lastSighted.clear();
    m_started = false;
    m_framed = false;
    m_checksum.Reset();
}

void CLectSokkia::EndReading() {
    CloseStation();
}

// ---- Lines and framing -----------------------------------------------------------------------------------

void CLectSokkia::ReadLine(std::string_view line, int number) {
    // STX opens a framed transfer; what follows it on its line, usually nothing, is data.
    if (!line.empty() && line.front() == kSTX) {
        m_framed = true;
        m_checksum.Reset();
        line.remove_prefix(1);
        if (line.empty()) return;
    }
    const std::size_t etx = line.find(kETX);
    const std::string_view data = line.substr(0, etx);
    if (m_framed && !data.empty()) m_checksum.AddLine(data);
    ReadRecord(data, number);
    if (etx == std::string_view::npos) return;
    if (m_framed) CheckFrame(line.substr(etx + 1), number);
    m_framed = false;
}

void CLectSokkia::CheckFrame(std::string_view checksum, int number) {
    checksum = Trimmed(Content(checksum));
    if (checksum.size() != kUnchecked.size() || checksum == kUnchecked) return;
    unsigned value = 0;
    for (char c : checksum) {
        if (!IsDigit(c)) return;
        value = value * 10 + static_cast<unsigned>(c - '0');
    }
    if (!m_checksum.Matches(value) && TextWindow())
        TextWindow()->Print(text::kBadChecksum, number, std::string(checksum).c_str());
}

void CLectSokkia::HeaderOnce() {
    if (m_started) return;
    m_started = true;
    if (!Path().empty()) AddHeaderComment(fb::kLabelFile, std::filesystem::path(Path()).filename().string());
}

void CLectSokkia::SetVariant(sdr::Variant variant) {
    m_variant = variant;
    m_variantKnown = true;
    AddHeaderComment(fb::kLabelFormat, variant == sdr::Variant::Sdr33 ? text::kSdr33 : text::kSdr2x);
}

void CLectSokkia::ReadRecord(std::string_view line, int number) {
    const std::string_view content = Content(line);
    if (content.empty()) return;
    if (content.size() < 2 || !IsDigit(content[0]) || !IsDigit(content[1])) return LineUnrecognised(number);
    const std::string_view type = content.substr(0, 2);
    if (type != "08" && type != "09" && type != "13") m_lastSighted.clear();
    const sdr::Layout* layout = sdr::LayoutOf(type);
    // A line of another file says nothing of this one: the header waits for a record of the format.
    if (!layout && type != "00" && type != "01" && type != "04" && type != "05" && type != "06" &&
        type != "10")
        return LineUnrecognised(number);
    HeaderOnce();
    const std::string_view derivation = content.substr(2, std::min<std::size_t>(2, content.size() - 2));

    if (layout) {
        if (!m_variantKnown && type != "03" && type != "13") SetVariant(sdr::GuessVariant(content, *layout));
        const int expected = sdr::RecordLength(*layout, m_variant);
        if (static_cast<int>(Utf8Length(content)) > expected) CheckLength(number, line, expected);
        sdr::SplitRecord(content, *layout, m_variant, m_fields);
        switch (type[1]) {
        case '2':
            return ReadStation(number);
        case '3':
            return type == "03" ? ReadTargetHeight(number) : ReadNote();
        case '7':
            return ReadBacksight(number);
        case '8':
            return ReadCoordinates(number);
        default:
            return ReadObservation(derivation, number);
        }
    }
    if (type == "00") return ReadHeader(content, number);
    if (type == "01") return ReadInstrument(content);
    if (type == "04" || type == "05" || type == "06") return ReadConstants(type, content);
    const std::string_view job = sdr::Column(content, kFirstFieldColumn, kJobWidth);
    if (!job.empty()) AddHeaderComment(fb::kLabelJob, job);
}

// ---- Header records --------------------------------------------------------------------------------------

void CLectSokkia::ReadHeader(std::string_view line, int number) {
    const std::string_view version = sdr::Column(line, kVersionColumn, kVersionWidth);
    if (!version.empty()) {
        AddHeaderComment(text::kLabelVersion, version);
        if (!m_variantKnown && version.starts_with("SDR2")) SetVariant(sdr::Variant::Sdr2x);
        if (!m_variantKnown && version.starts_with("SDR3")) SetVariant(sdr::Variant::Sdr33);
    }
    const std::string_view date = sdr::Column(line, kDateColumn, kDateWidth);
    if (IsDate(date)) AddHeaderComment(fb::kLabelDate, date);

    const auto unknown = [&](char code, const char* what) {
        if (code != ' ' && TextWindow()) TextWindow()->Print(text::kUnknownUnit, number, code, what);
    };
    const char angles = At(line, kAngleUnitIndex);
    switch (angles) {
    case '1':
        m_settings.angles = AngleUnit::Degrees;
        AddHeaderComment(fb::kLabelAngles, fb::kDegrees);
        break;
    case '2':
        m_settings.angles = AngleUnit::Grads;
        AddHeaderComment(fb::kLabelAngles, fb::kGrads);
        break;
    case '3': // mils are 3 on some collectors, 4 on others
    case '4':
        m_settings.angles = AngleUnit::Mils;
        AddHeaderComment(fb::kLabelAngles, Sprintf(text::kMils, angles));
        break;
    default:
        unknown(angles, text::kWhatAngles);
    }
    const char distances = At(line, kDistanceUnitIndex);
    if (distances == '1' || distances == '2') {
        m_settings.distances = distances == '1' ? DistanceUnit::Metres : DistanceUnit::Feet;
        AddHeaderComment(fb::kLabelDistances, distances == '1' ? fb::kMetres : fb::kFeet);
    } else {
        unknown(distances, text::kWhatDistances);
    }
    const char order = At(line, kOrderIndex);
    if (order == '1' || order == '2') {
        m_settings.order = order == '1' ? CoordinateOrder::NorthEast : CoordinateOrder::EastNorth;
        AddHeaderComment(text::kLabelOrder, order == '1' ? text::kNorthEast : text::kEastNorth);
    } else {
        unknown(order, text::kWhatOrder);
    }
}

void CLectSokkia::ReadInstrument(std::string_view line) {
    const std::string_view model = sdr::Column(line, kModelColumn, kModelWidth);
    const std::string_view edm = sdr::Column(line, kEdmColumn, kModelWidth);
    const std::string_view serial = sdr::Column(line, kSerialColumn, kSerialWidth);
    const std::string_view edmSerial = sdr::Column(line, kEdmSerialColumn, kSerialWidth);
    std::string models(model), serials(serial);
    if (!edm.empty() && edm != model) models += (models.empty() ? "" : " / ") + std::string(edm);
    if (!edmSerial.empty() && edmSerial != serial)
        serials += (serials.empty() ? "" : " / ") + std::string(edmSerial);
    if (!models.empty()) AddHeaderComment(fb::kLabelInstrument, models);
    if (!serials.empty()) AddHeaderComment(fb::kLabelSerial, serials);
    const char zero = At(line, kZeroVerticalIndex);
    if (zero == '1' || zero == '2') {
        m_zenith = zero == '1';
        AddHeaderComment(text::kLabelVertical, m_zenith ? text::kZenith : text::kElevation);
    }
    // Three constants follow; the prism constant is the last, kept as the instrument wrote it.
    const int width = m_variant == sdr::Variant::Sdr33 ? 16 : 10;
    const std::string_view prism = sdr::Column(line, kConstantsColumn + 2 * width, width);
    if (!prism.empty()) AddHeaderComment(fb::kLabelPrism, prism);
}

void CLectSokkia::ReadConstants(std::string_view type, std::string_view line) {
    const std::string values = Words(sdr::From(line, kFirstFieldColumn));
    if (values.empty()) return;
    const char* label = type == "04"   ? text::kLabelCollimation
                        : type == "05" ? fb::kLabelAtmosphere
                                       : fb::kLabelScale;
    AddHeaderComment(label, values);
}

// ---- Values ----------------------------------------------------------------------------------------------

bool CLectSokkia::Real(int field, double& value, int number) {
    const std::string_view written = m_fields[field];
    value = kUndefined;
    if (written.empty()) return true;
    if (ParseDouble(written, value) && std::isfinite(value)) return true;
    value = kUndefined;
    if (TextWindow()) TextWindow()->Print(fb::kBadNumber, number, std::string(written).c_str());
    return false;
}

bool CLectSokkia::Length(int field, double& metres, int number) {
    if (!Real(field, metres, number)) return false;
    if (IsKnown(metres)) metres = ToMetres(metres, m_settings.distances);
    return true;
}

bool CLectSokkia::Angle(int field, double& grads, int number) {
    if (!Real(field, grads, number)) return false;
    if (IsKnown(grads)) grads = ToGrads(grads, m_settings.angles);
    return true;
}

// Northing and easting in the order of the header (or of the settings), then the elevation: X is the
// easting and Y the northing whatever that order.
bool CLectSokkia::Position(int first, double& x, double& y, double& z, int number) {
    double a = kUndefined, b = kUndefined;
    if (!Length(first, a, number) || !Length(first + 1, b, number) || !Length(first + 2, z, number))
        return false;
    const bool northFirst = m_settings.order == CoordinateOrder::NorthEast;
    if (IsKnown(a) != IsKnown(b)) {
        LineMissing(number, IsKnown(a) == northFirst ? fb::kDatumEast : fb::kDatumNorth);
        return false;
    }
    x = northFirst ? b : a;
    y = northFirst ? a : b;
    return true;
}

// ---- Stations --------------------------------------------------------------------------------------------

bool CLectSokkia::OpenStation(std::string_view name, double hi, int number) {
    CStation* station = AddStation(std::string(name), hi);
    m_station = station;
    m_stationName = station ? std::string(name) : std::string();
    m_firstSighting = true;
    m_azimuthWarned = false;
    m_backsight = {};
    if (!station) LineError(fb::kRefused, number);
    return station != nullptr;
}

// The backsight of a station that no observation sighted: its circle reading is the reference.
void CLectSokkia::WriteBacksight() {
    if (m_station && !m_backsight.point.empty() && !m_backsight.sighted && IsKnown(m_backsight.hz))
        AddReference(m_backsight.point, kUndefined, m_backsight.hz, kUndefined, kUndefined);
    m_backsight = {};
}

void CLectSokkia::CloseStation() {
    WriteBacksight();
    m_station = nullptr;
    m_stationName.clear();
}

// The station of a backsight or an observation: the one in force, or a new one when the record names
// another.
bool CLectSokkia::StationFor(std::string_view from, int number) {
    const std::string_view name = FormMatView(from);
    if (name.empty() || (m_station && name == m_stationName)) {
        if (m_station) return true;
        // Nothing measured is lost: the sightings go to a station the surveyor renames.
        if (!OpenStation(fb::kUnknownStation, kUndefined, number)) return false;
        LineUnknownStation(number);
        return true;
    }
    CloseStation();
    if (TextWindow()) TextWindow()->Print(text::kStationOpened, number, std::string(name).c_str());
    return OpenStation(name, kUndefined, number);
}

void CLectSokkia::ReadStation(int number) {
    const std::string_view name = FormMatView(m_fields[0]);
    if (name.empty()) return LineMissing(number, fb::kDatumStation);
    double x = kUndefined, y = kUndefined, z = kUndefined, hi = kUndefined;
    if (!Position(1, x, y, z, number) || !Length(4, hi, number)) return;
    CloseStation();
    AddCode(m_fields[5], name);
    if ((IsKnown(x) || IsKnown(z)) && !AddPoint(std::string(name), x, y, z))
        return LineError(fb::kRefused, number);
    OpenStation(name, hi, number);
}

void CLectSokkia::ReadTargetHeight(int number) {
    double height = kUndefined;
    if (!Length(0, height, number)) return;
    if (IsUndefined(height)) return LineMissing(number, text::kDatumHeight);
    m_targetHeight = height;
}

void CLectSokkia::ReadBacksight(int number) {
    const std::string_view point = FormMatView(m_fields[1]);
    double azimuth = kUndefined, hz = kUndefined;
    if (!Angle(2, azimuth, number) || !Angle(3, hz, number)) return;
    if (point.empty()) return LineMissing(number, text::kDatumBacksight);
    if (!StationFor(m_fields[0], number)) return;
    WriteBacksight();
    m_backsight = {std::string(point), hz, azimuth, false};
    if (IsKnown(azimuth))
        AddHeaderComment(text::kLabelAzimuth,
                         Sprintf(text::kAzimuthValue, m_stationName.c_str(), m_backsight.point.c_str(),
                                 FormatFixed(azimuth, 5).c_str()));
}

// ---- Points and sightings --------------------------------------------------------------------------------

void CLectSokkia::ReadCoordinates(int number) {
    const std::string_view name = FormMatView(m_fields[0]);
    const bool computed = !name.empty() && name == m_lastSighted;
    m_lastSighted.clear();
    if (name.empty()) return LineMissing(number, fb::kDatumPoint);
    // The coordinates that the collector computed from the observation just before.
    if (computed && !m_settings.keepComputed) return;
    double x = kUndefined, y = kUndefined, z = kUndefined;
    if (!Position(1, x, y, z, number)) return;
    if (IsUndefined(x) && IsUndefined(z)) return LineMissing(number, fb::kDatumCoordinates);
    AddCode(m_fields[4], name);
    if (!AddPoint(std::string(name), x, y, z)) LineError(fb::kRefused, number);
}

bool CLectSokkia::IsReference(std::string_view point, std::string_view code) const {
    if (!m_backsight.point.empty() && point == m_backsight.point) return true;
    return m_settings.MarksReference(m_firstSighting, code);
}

void CLectSokkia::ReadObservation(std::string_view derivation, int number) {
    const std::string_view point = FormMatView(m_fields[1]);
    double di = kUndefined, av = kUndefined, ah = kUndefined;
    if (!Length(2, di, number) || !Angle(3, av, number) || !Angle(4, ah, number)) return;
    if (point.empty()) return LineMissing(number, text::kDatumTarget);
    if (IsUndefined(di) && IsUndefined(av) && IsUndefined(ah))
        return LineMissing(number, text::kDatumObservations);
    if (!StationFor(m_fields[0], number)) return;

    if (IsKnown(av) && !m_zenith) av = WrapGrads(kHorizonToZenith - av);
    // MC: the collector reduced the observation and wrote the azimuth of the point instead of the circle
    // reading. The backsight gives the circle back: reading = azimuth - (its azimuth - its reading).
    if (derivation == "MC" && IsKnown(ah)) {
        if (IsKnown(m_backsight.azimuth) && IsKnown(m_backsight.hz)) {
            ah = WrapGrads(ah - (m_backsight.azimuth - m_backsight.hz));
        } else if (!m_azimuthWarned) {
            m_azimuthWarned = true;
            if (TextWindow()) TextWindow()->Print(text::kAzimuthKept, number, m_stationName.c_str());
        }
    }
    const std::string_view code = m_fields[5];
    AddCode(code, point);
    const bool reference = IsReference(point, code);
    const bool added = reference ? AddReference(std::string(point), m_targetHeight, ah, av, di) != nullptr
                                 : AddMesure(std::string(point), m_targetHeight, ah, av, di) != nullptr;
    m_firstSighting = false;
    m_lastSighted.assign(point);
    if (!added) return LineError(fb::kRefused, number);
    if (reference && point == m_backsight.point) m_backsight.sighted = true;
}

void CLectSokkia::ReadNote() {
    if (!m_fields[0].empty()) AddComment(std::string(m_fields[0]));
}

} // namespace pyr
