#include "fieldbook/LectGeodim.h"

#include "core/AngleUnits.h"
#include "core/Angles.h"
#include "core/Files.h"
#include "core/Lines.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectGeodimRecords.h"
#include "fieldbook/LectGeodimTexts.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "ui/PyrTxtWnd.h"

#include <cmath>
#include <cstdio>
#include <filesystem>

namespace pyr {

namespace {

// The labels of a GDM field book that the reader uses.
enum Label : int {
    kInformation = 0,
    kData = 1,
    kInstrumentHeight = 3,
    kCode = 4,
    kSignalHeight = 6,
    kHorizontal = 7,
    kVertical = 8,
    kSlopeDistance = 9,
    kHeightDifference = 10,
    kHorizontalDistance = 11,
    kHorizontalFaceII = 17,
    kVerticalFaceII = 18,
    kReferenceAngle = 21,
    kCompensator = 22,
    kUnits = 23,
    kHorizontalFaceI = 24,
    kVerticalFaceI = 25,
    kPpm = 30,
    kNorth = 37,
    kEast = 38,
    kElevation = 39,
    kDeltaNorth = 40,
    kDeltaEast = 41,
    kDeltaElevation = 42,
    kScaleFactor = 43,
    kJob = 50,
    kTemperature = 56,
    kReferenceObject = 62,
};

// Labels are numbers of at most four digits.
constexpr std::size_t kLabelCount = 10000;

constexpr double kHalfCircle = 200.0; // gr
constexpr double kFullCircle = 400.0; // gr

const char* HeaderLabel(int label) {
    static constexpr const char* kJobLabels[] = {
        fb::kLabelJob,           fb::kLabelDate,       gdm::msg::kLabelTime, gdm::msg::kLabelOperator,
        gdm::msg::kLabelProject, fb::kLabelInstrument, fb::kLabelTemperature};
    if (label == kInformation) return gdm::msg::kLabelInformation;
    if (label == kData) return gdm::msg::kLabelData;
    if (label >= kJob && label <= kTemperature) return kJobLabels[label - kJob];
    return nullptr;
}

// The unit digits of label 23: the first the angles, the second the distances (then the temperature and
// the pressure, which a GéoBase does not need).
bool UnitsFromDigits(std::string_view digits, AngleUnit& angles, DistanceUnit& distances) {
    if (digits.size() < 2) return false;
    static constexpr AngleUnit kAngles[] = {AngleUnit::Grads, AngleUnit::Degrees, AngleUnit::Dms,
                                            AngleUnit::Mils};
    const int angle = digits[0] - '1';
    const int distance = digits[1] - '1';
    if (angle < 0 || angle > 3 || distance < 0 || distance > 1) return false;
    for (char c : digits.substr(2))
        if (c < '0' || c > '9') return false;
    angles = kAngles[angle];
    distances = distance == 0 ? DistanceUnit::Metres : DistanceUnit::Feet;
    return true;
}

// Deletes the temporary copy of the records however the reading ends.
class TemporaryFile {
public:
    explicit TemporaryFile(std::string path) : m_path(std::move(path)) {}
    ~TemporaryFile() {
        std::error_code ignored;
        std::filesystem::remove(m_path, ignored);
    }
    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;

    bool Write(std::string_view text) const {
        std::FILE* file = std::fopen(m_path.c_str(), "wb");
        if (!file) return false;
        const bool written = std::fwrite(text.data(), 1, text.size(), file) == text.size();
        return std::fclose(file) == 0 && written;
    }

private:
    std::string m_path;
};

} // namespace

bool CLectGeodim::Block::HasObservation() const {
    for (double value :
         {ahGeneric, avGeneric, ahFaceI, avFaceI, ahFaceII, avFaceII, slope, horizontal, heightDifference})
        if (IsKnown(value)) return true;
    return false;
}

// ---- Settings and state ----------------------------------------------------------------------------------

void CLectGeodim::ReadSettings() {
    m_settings = ReadInstrumentSettings(Driver());
}

void CLectGeodim::BeginReading() {
    ReadSettings();
    m_records.clear();
    m_block = {};
    m_station = nullptr;
    m_orientedOn.clear();
    m_firstSighting = false;
    m_signalHeight = kUndefined;
    m_known.Clear();
    m_labelWarned.assign(kLabelCount, false);
    m_units.clear();
    m_ppm.clear();
    m_scale.clear();
}

// ---- First pass: the records, one a line -----------------------------------------------------------------

void CLectGeodim::ReadLine(std::string_view line, int number) {
    gdm::Record record;
    switch (gdm::SplitRecord(line, record)) {
    case gdm::RecordShape::Blank:
        return;
    case gdm::RecordShape::Whole:
        gdm::AppendRecordLine(m_records, number, record);
        return;
    case gdm::RecordShape::Incomplete:
        LineError(fb::kIncompleteCommand, number);
        // A block still starts there, so that what follows is not taken for the block before.
        if (record.label == gdm::kLabelStation || record.label == gdm::kLabelPoint)
            gdm::AppendRecordLine(m_records, number, {record.label, {}});
        break;
    case gdm::RecordShape::Unrecognised:
        LineUnrecognised(number);
        break;
    }
    if (TextWindow()) TextWindow()->Print(fb::kStringRead, std::string(line).c_str());
}

void CLectGeodim::EndReading() {
    std::string records = std::move(m_records);
    m_records = {};
    if (Path().empty()) return ReadRecords(records);
    const std::string temporary = TemporaryBesideCarnet(Path());

    TemporaryFile copy(temporary);
    std::string back;
    if (copy.Write(records) && ReadWholeFile(temporary, back)) {
        records = {};
        return ReadRecords(back);
    }
    if (TextWindow()) TextWindow()->Print(gdm::msg::kTemporaryUnwritable, temporary.c_str());
    ReadRecords(records);
}

// ---- Second pass: the blocks -----------------------------------------------------------------------------

void CLectGeodim::ReadRecords(std::string_view records) {
    // A book without one record of the format (another file) gives nothing, not even its name.
    if (!Path().empty() && !records.empty())
        AddHeaderComment(fb::kLabelFile, std::filesystem::path(Path()).filename().string());
    ForEachLine(records, [&](std::string_view line, int) {
        int number = 0;
        gdm::Record record;
        if (gdm::ReadRecordLine(line, number, record)) ReadRecord(number, record.label, record.value);
    });
    CloseBlock();
}

bool CLectGeodim::ReadAngle(int number, int label, std::string_view value, double& grads) {
    double angle = 0.0;
    const bool read = AngleTextToGrads(value, m_settings.angles, angle);
    if (!read || !std::isfinite(angle)) {
        if (TextWindow())
            TextWindow()->Print(
                fb::kBadNumber, number,
                Sprintf("%d=%.*s", label, static_cast<int>(value.size()), value.data()).c_str());
        return false;
    }
    grads = angle;
    return true;
}

bool CLectGeodim::ReadLength(int number, int label, std::string_view value, double& metres) {
    double length = 0.0;
    if (!ParseDouble(value, length) || !std::isfinite(length)) {
        if (TextWindow())
            TextWindow()->Print(
                fb::kBadNumber, number,
                Sprintf("%d=%.*s", label, static_cast<int>(value.size()), value.data()).c_str());
        return false;
    }
    metres = ToMetres(length, m_settings.distances);
    return true;
}

void CLectGeodim::ReadUnits(int number, std::string_view value) {
    if (!UnitsFromDigits(value, m_settings.angles, m_settings.distances)) {
        if (TextWindow()) TextWindow()->Print(gdm::msg::kBadUnits, number, std::string(value).c_str());
    }
    Header(m_units, fb::kLabelUnits, value);
}

void CLectGeodim::Header(std::string& last, const char* label, std::string_view value) {
    if (value.empty() || value == last) return;
    last.assign(value);
    AddHeaderComment(label, value);
}

void CLectGeodim::ReadRecord(int number, int label, std::string_view value) {
    Block& b = m_block;
    double* angle = nullptr;
    double* length = nullptr;
    switch (label) {
    case gdm::kLabelStation:
    case gdm::kLabelPoint:
        CloseBlock();
        b.label = label;
        b.number = number;
        b.name = value;
        return;
    case kHorizontal:
        angle = &b.ahGeneric;
        break;
    case kVertical:
        angle = &b.avGeneric;
        break;
    case kHorizontalFaceI:
        angle = &b.ahFaceI;
        break;
    case kVerticalFaceI:
        angle = &b.avFaceI;
        break;
    case kHorizontalFaceII:
        angle = &b.ahFaceII;
        break;
    case kVerticalFaceII:
        angle = &b.avFaceII;
        break;
    case kSlopeDistance:
        length = &b.slope;
        break;
    case kHorizontalDistance:
        length = &b.horizontal;
        break;
    case kHeightDifference:
        length = &b.heightDifference;
        break;
    // After label 62, a station block's coordinates are those of its orientation point.
    case kNorth:
        length = b.afterOrientation ? &b.orientationNorth : &b.north;
        break;
    case kEast:
        length = b.afterOrientation ? &b.orientationEast : &b.east;
        break;
    case kElevation:
        length = b.afterOrientation ? &b.orientationElevation : &b.elevation;
        break;
    case kInstrumentHeight: {
        double hi = kUndefined;
        if (!ReadLength(number, label, value, hi)) return;
        if (b.label == gdm::kLabelStation) {
            b.hi = hi;
        } else if (m_station) {
            m_station->setHI(hi); // measured again during the station: the last one counts
        } else {
            LineError(fb::kNoStationForHI, number);
        }
        return;
    }
    case kSignalHeight:
        ReadLength(number, label, value, m_signalHeight);
        return;
    case kCode:
        if (b.label < 0) {
            AddCode(value);
            return;
        }
        b.code = value;
        return;
    case kReferenceObject:
        if (b.label == gdm::kLabelStation) {
            b.orientedOn = value;
            b.afterOrientation = true;
        } else
            m_orientedOn.assign(FormMatView(value));
        return;
    case kUnits:
        ReadUnits(number, value);
        return;
    case kPpm:
        Header(m_ppm, fb::kLabelPpm, std::string(value) + " ppm");
        return;
    case kScaleFactor:
        Header(m_scale, fb::kLabelScale, value);
        return;
    case kReferenceAngle:
        if (b.label != gdm::kLabelStation) return;
        angle = &b.readingOnOrientation;
        break;
    case kCompensator:
    case kDeltaNorth:
    case kDeltaEast:
    case kDeltaElevation:
        return; // read by the instrument's own programs, nothing a GéoBase keeps
    default:
        if (const char* header = HeaderLabel(label)) {
            CloseBlock(); // written in its place, after the block it follows
            if (!value.empty()) AddHeaderComment(header, value);
            return;
        }
        if (!m_labelWarned[static_cast<std::size_t>(label)]) {
            m_labelWarned[static_cast<std::size_t>(label)] = true;
            if (TextWindow()) TextWindow()->Print(gdm::msg::kUnknownLabel, number, label);
        }
        return;
    }
    if (b.label < 0) return LineError(gdm::msg::kOutsideBlock, number);
    if (angle) ReadAngle(number, label, value, *angle);
    if (length) ReadLength(number, label, value, *length);
    // The instruments write a distance of 0 for a sighting on which none was measured (the orientation
    // point, an angle-only shot): no sighting has a length of zero.
    if ((label == kSlopeDistance || label == kHorizontalDistance) && *length == 0.0) *length = kUndefined;
}

// ---- Writing a block -------------------------------------------------------------------------------------

void CLectGeodim::CloseBlock() {
    if (m_block.label == gdm::kLabelStation) WriteStation();
    if (m_block.label == gdm::kLabelPoint) WritePoint();
    m_block = {};
}

void CLectGeodim::WriteStation() {
    const Block& b = m_block;
    const std::string_view name = FormMatView(b.name);
    if (name.empty()) return; // said in the first pass: the record ended early
    AddCode(b.code, name);
    WritePosition(true);
    WriteOrientationPoint();
    CStation* station = AddStation(std::string(name), b.hi);
    if (!station) return LineError(fb::kRefused, b.number);
    m_station = station;
    m_orientedOn.assign(FormMatView(b.orientedOn));
    m_firstSighting = true;
    // A backsight within the station's own block is a sighting of the point it is oriented on; without
    // a horizontal angle measured on it, the circle reading set on it (21) is its angle.
    Block& backsight = m_block;
    if (IsUndefined(backsight.ahGeneric) && IsUndefined(backsight.ahFaceI) && IsUndefined(backsight.ahFaceII))
        backsight.ahGeneric = backsight.readingOnOrientation;
    if (!backsight.HasObservation()) return;
    if (m_orientedOn.empty()) return LineMissing(b.number, fb::kDatumPoint);
    backsight.name = m_orientedOn;
    backsight.code = {};
    backsight.east = backsight.north = backsight.elevation = kUndefined;
    WritePoint();
}

// The coordinates a station block gives after label 62: its orientation point, known.
void CLectGeodim::WriteOrientationPoint() {
    Block& b = m_block;
    if (IsUndefined(b.orientationEast) && IsUndefined(b.orientationNorth) &&
        IsUndefined(b.orientationElevation))
        return;
    const std::string_view name = FormMatView(b.orientedOn);
    if (name.empty()) return LineMissing(b.number, fb::kDatumPoint);
    const Block station = b;
    b.name = b.orientedOn;
    b.east = b.orientationEast;
    b.north = b.orientationNorth;
    b.elevation = b.orientationElevation;
    WritePosition(true);
    b = station;
}

void CLectGeodim::WritePoint() {
    const Block& b = m_block;
    const std::string_view name = FormMatView(b.name);
    if (name.empty()) return;
    if (!b.HasObservation()) {
        AddCode(b.code, name);
        const bool located = IsKnown(b.east) || IsKnown(b.north) || IsKnown(b.elevation);
        if (!located) return LineMissing(b.number, fb::kDatumContent);
        WritePosition(true);
        return;
    }
    if (!m_station) {
        m_station = AddStation(fb::kUnknownStation);
        if (!m_station) return LineError(fb::kRefused, b.number);
        m_firstSighting = true;
        LineUnknownStation(b.number);
    }
    AddCode(b.code, name);

    // Face I from 24/25, or from 7/8 (which, beside both faces, hold their mean); face II from 17/18,
    // turned to face I: the circle has gone round half a turn and the zenith angle is read from the
    // other side.
    const double ahI = IsKnown(b.ahFaceI) ? b.ahFaceI : b.ahGeneric;
    const double avI = IsKnown(b.avFaceI) ? b.avFaceI : b.avGeneric;
    const bool faceII = IsKnown(b.ahFaceII) || IsKnown(b.avFaceII);
    const bool faceI = IsKnown(ahI) || IsKnown(avI) || !faceII;
    if (faceI) WriteSighting(ahI, avI, true);
    if (faceII) {
        const double ah = IsKnown(b.ahFaceII) ? WrapGrads(b.ahFaceII + kHalfCircle) : kUndefined;
        const double av = IsKnown(b.avFaceII) ? kFullCircle - b.avFaceII : kUndefined;
        // The distance is measured once: it goes with face I when there is one.
        WriteSighting(ah, av, !faceI);
    }
    m_firstSighting = false;
    if (m_settings.keepComputed) WritePosition(false);
}

void CLectGeodim::WriteSighting(double ah, double av, bool withDistances) {
    const Block& b = m_block;
    double di = withDistances ? b.slope : kUndefined;
    if (withDistances) SlopeFromHorizontal(b.horizontal, b.heightDifference, av, di);
    const std::string point(FormMatView(b.name));
    const bool reference = IsReference(point);
    const bool kept = reference ? AddReference(point, m_signalHeight, ah, av, di) != nullptr
                                : AddMesure(point, m_signalHeight, ah, av, di) != nullptr;
    if (!kept) LineError(fb::kRefused, b.number);
}

// The block's coordinates as a point of its name: 38 the easting (X), 37 the northing (Y), whatever the
// instrument calls them. Nothing to do without coordinates.
bool CLectGeodim::WritePosition(bool known) {
    const Block& b = m_block;
    if (IsUndefined(b.east) && IsUndefined(b.north) && IsUndefined(b.elevation)) return true;
    if (IsKnown(b.east) != IsKnown(b.north)) {
        LineMissing(b.number, IsKnown(b.east) ? fb::kDatumNorth : fb::kDatumEast);
        return false;
    }
    CPointGen* point = AddPoint(std::string(FormMatView(b.name)), b.east, b.north, b.elevation);
    if (!point) {
        LineError(fb::kRefused, b.number);
        return false;
    }
    if (known && point->hasXY()) m_known.Insert(point->mat());
    return true;
}

bool CLectGeodim::IsReference(std::string_view point) const {
    if (!m_orientedOn.empty() && point == m_orientedOn) return true;
    if (m_known.Contains(point)) return true;
    return m_settings.MarksReference(m_firstSighting, Trimmed(m_block.code));
}

std::unique_ptr<CFieldBookReader> MakeGeodimReader() {
    return std::make_unique<CLectGeodim>();
}

} // namespace pyr
