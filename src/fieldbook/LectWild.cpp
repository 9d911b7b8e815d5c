#include "fieldbook/LectWild.h"

#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectWildTexts.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "settings/ParamStore.h"
#include "ui/PyrTxtWnd.h"

#include <cmath>
#include <cstring>
#include <filesystem>
#include <limits>

namespace pyr {

namespace {

using gsi::WordText;
namespace wild = gsi::msg;

// Two instrument heights closer than half a millimetre are the same.
constexpr double kSameHeight = 0.0005;

// A line holding the end of a transmission (ETX, EOT) or of a file (Ctrl-Z) is skipped; the start of a
// transmission (STX) in front of a block is dropped.
constexpr std::string_view kEndControls{"\x03\x04\x1a", 3};
constexpr char kSTX = '\x02';

bool IsDigits(std::string_view text) {
    for (char c : text)
        if (c < '0' || c > '9') return false;
    return !text.empty();
}

// The last eight digits of a date word, "DDMMYYYY" (17) or "MMDDhhmm" (19), shown as a surveyor reads
// them; a date of six digits (DDMMYY, the zeros of the padding in front) is shown with its two-digit
// year, and another writing is kept as it stands.
std::string DateText(std::string_view data, bool withTime) {
    std::string_view digits = Trimmed(data);
    if (digits.size() >= 8) digits = digits.substr(digits.size() - 8);
    if (digits.size() != 8 || !IsDigits(digits)) return std::string(Trimmed(data));
    const char* d = digits.data();
    if (withTime) return Sprintf("%.2s/%.2s %.2s:%.2s", d + 2, d, d + 4, d + 6);
    if (digits.starts_with("00")) return Sprintf("%.2s/%.2s/%.2s", d + 2, d + 4, d + 6);
    return Sprintf("%.2s/%.2s/%.4s", d, d + 2, d + 4);
}

} // namespace

// ---- Settings and state ----------------------------------------------------------------------------------

void CLectWild::ReadSettings() {
    const CParamDriver* driver = Driver();
    m_settings = ReadInstrumentSettings(driver);
    m_units = {m_settings.angles, m_settings.distances};
    m_convention = driver ? driver->Stations() : StationConvention::Auto;
    m_stationCodes = driver ? driver->StationCodes() : std::vector<std::string>{"2", "21"};
}

void CLectWild::BeginReading() {
    ReadSettings();
    m_station = nullptr;
    m_firstSighting = false;
    m_heightWarned = false;
    m_reflector = kUndefined;
    m_pendingCode.clear();
    m_known.Clear();
    m_started = false;
    for (std::string* last : {&m_format, &m_serial, &m_type, &m_date, &m_dateTime, &m_ppm, &m_prism})
        last->clear();
    m_ppmShown = m_prismShown = std::numeric_limits<double>::quiet_NaN();
    m_wordWarned.reset();
    m_unitWarned.reset();
}

// ---- A line ----------------------------------------------------------------------------------------------

void CLectWild::ReadLine(std::string_view line, int number) {
    // Blank lines (several CRs in a row), comments and the transmission's control lines are skipped.
    std::size_t first = 0;
    while (first < line.size() && (line[first] == ' ' || line[first] == '\t' || line[first] == kSTX))
        ++first;
    line.remove_prefix(first);
    if (line.empty() || line.front() == '!') return;
    if (FindControl(line, kEndControls) != std::string_view::npos) return;

    std::string_view bad;
    if (!gsi::SplitBlock(line, m_block, bad)) {
        LineUnrecognised(number);
        if (TextWindow()) TextWindow()->Print(fb::kStringRead, std::string(bad).c_str());
        return;
    }
    const gsi::Word* badWord = nullptr;
    if (!gsi::ReadBlock(m_block, m_units, m_content, badWord)) {
        if (TextWindow()) TextWindow()->Print(fb::kBadNumber, number, std::string(badWord->text).c_str());
        return;
    }
    HeaderComments();
    Warnings(number);
    if (m_content.codeBlock)
        ReadCodeBlock(number);
    else
        ReadDataBlock(number);
}

void CLectWild::Header(std::string& last, const char* label, std::string_view value) {
    if (value.empty() || value == last) return;
    last.assign(value);
    AddHeaderComment(label, value);
}

// Nearly every sighting repeats the ppm and the prism constant: the same value is not written out again
// to be found the same text.
void CLectWild::Header(std::string& last, double& shown, const char* label, double value, const char* unit) {
    if (value == shown && std::signbit(value) == std::signbit(shown)) return;
    shown = value;
    Header(last, label, FormatShortest(value) + unit);
}

void CLectWild::HeaderComments() {
    const gsi::BlockContent& c = m_content;
    if (!m_started) {
        m_started = true;
        if (!Path().empty())
            AddHeaderComment(fb::kLabelFile, std::filesystem::path(Path()).filename().string());
    }
    Header(m_format, fb::kLabelFormat, m_block.gsi16 ? wild::kGsi16 : wild::kGsi8);
    if (!c.serial.empty()) Header(m_serial, fb::kLabelSerial, FormMatView(c.serial));
    if (!c.type.empty()) Header(m_type, fb::kLabelInstrument, FormMatView(c.type));
    if (!c.date.empty()) Header(m_date, fb::kLabelDate, DateText(c.date, false));
    // The time of each measurement is no header: only a block without observations gives one.
    if (!c.dateTime.empty() && !c.HasObservation())
        Header(m_dateTime, wild::kLabelDateTime, DateText(c.dateTime, true));
    if (IsKnown(c.ppm)) Header(m_ppm, m_ppmShown, fb::kLabelPpm, c.ppm, " ppm");
    if (IsKnown(c.ppmTotal)) Header(m_ppm, m_ppmShown, fb::kLabelPpm, c.ppmTotal, " ppm");
    if (IsKnown(c.prismMm)) Header(m_prism, m_prismShown, fb::kLabelPrism, c.prismMm, " mm");
    if (IsKnown(c.prismConstantMm))
        Header(m_prism, m_prismShown, fb::kLabelPrism, RoundToDecimals(c.prismConstantMm, 1), " mm");
}

void CLectWild::Warnings(int number) {
    CPyrTxtWnd* txt = TextWindow();
    for (std::size_t i = 0; i < m_content.unknownCount; ++i) {
        const int index = m_content.unknown[i];
        if (m_wordWarned[static_cast<std::size_t>(index)]) continue;
        m_wordWarned.set(static_cast<std::size_t>(index));
        if (txt) txt->Print(wild::kUnknownWord, number, index);
    }
    if (const gsi::Word* word = m_content.foreignUnit) {
        if (m_unitWarned[static_cast<std::size_t>(word->index)]) return;
        m_unitWarned.set(static_cast<std::size_t>(word->index));
        if (txt) txt->Print(wild::kForeignUnit, number, word->unit, word->index);
    }
}

// ---- Code blocks -----------------------------------------------------------------------------------------

void CLectWild::ReadCodeBlock(int number) {
    const gsi::BlockContent& c = m_content;
    const std::string_view code = FormMatView(c.code);
    if (m_convention != StationConvention::Words84 && IsAnyOf(code, m_stationCodes)) {
        const gsi::Word* name = c.Info(42);
        if (!name || WordText(*name).empty()) return LineMissing(number, fb::kDatumStation);
        double hi = kUndefined;
        if (const gsi::Word* height = c.Info(43)) {
            if (gsi::ReadLength(*height, m_units.distances, hi) == gsi::Value::Bad) {
                if (TextWindow())
                    TextWindow()->Print(fb::kBadNumber, number, std::string(height->text).c_str());
                return;
            }
        }
        OpenStation(WordText(*name), hi, number);
        return;
    }
    m_text.assign(code);
    for (std::size_t i = 0; i < c.infoCount; ++i) {
        const std::string_view text = WordText(*c.infos[i]);
        if (text.empty()) continue;
        m_text += ' ';
        m_text += text;
    }
    AddCode(m_text);
    m_pendingCode.assign(code);
}

// ---- Measurement blocks ----------------------------------------------------------------------------------

void CLectWild::ReadDataBlock(int number) {
    if (IsKnown(m_content.reflector)) m_reflector = m_content.reflector;
    // A staff reading goes with its distance (32), which is no sighting.
    if (m_content.readingCount > 0) return ReadStaff(number);
    if (m_content.HasObservation()) return ReadSighting(number);
    ReadPointOrStation(number);
}

void CLectWild::AddRemarks() {
    m_text.clear();
    for (std::size_t i = 0; i < m_content.remarkCount; ++i) {
        const std::string_view text = WordText(*m_content.remarks[i]);
        if (text.empty()) continue;
        if (!m_text.empty()) m_text += ' ';
        m_text += text;
    }
    AddCode(m_text);
}

void CLectWild::ReadPointOrStation(int number) {
    const gsi::BlockContent& c = m_content;
    const std::string_view name = FormMatView(c.point.empty() ? c.station : c.point);
    if (m_convention != StationConvention::CodeBlock41 && c.HasStationWords()) {
        if (name.empty()) return LineMissing(number, fb::kDatumStation);
        AddRemarks();
        OpenStation(name, c.instrument, number);
        return;
    }
    // A known point; under the convention of code blocks, a station's coordinates make one too.
    if (c.HasStationPosition() || c.HasTarget()) {
        if (name.empty()) return LineMissing(number, fb::kDatumPoint);
        AddRemarks();
        const bool station = c.HasStationPosition();
        if (AddPosition(name, station ? c.stationEast : c.east, station ? c.stationNorth : c.north,
                        station ? c.stationElevation : c.elevation, true, number))
            CheckInstrumentHeight(c.instrument, number);
        return;
    }
    AddRemarks();
    if (IsKnown(c.instrument)) return CheckInstrumentHeight(c.instrument, number);
    // Header information, constants, a reflector height, codes, words read but unused: nothing more to
    // do. A point id alone has nothing to make of it.
    const bool anything = !c.serial.empty() || !c.type.empty() || !c.date.empty() || !c.dateTime.empty() ||
                          IsKnown(c.ppm) || IsKnown(c.ppmTotal) || IsKnown(c.prismConstantMm) ||
                          IsKnown(c.reflector) || c.HasRemarks();
    if (!anything && !name.empty()) LineMissing(number, fb::kDatumContent);
}

void CLectWild::ReadSighting(int number) {
    const gsi::BlockContent& c = m_content;
    if (m_convention != StationConvention::CodeBlock41 && !c.station.empty()) {
        const std::string_view station = FormMatView(c.station);
        if (!m_station || station != m_station->mat()) {
            if (!OpenStation(station, c.instrument, number)) return;
        }
    }
    if (!m_station) {
        if (!OpenStation(fb::kUnknownStation, c.instrument, number)) return;
        LineUnknownStation(number);
    }
    const std::string_view point = FormMatView(c.point);
    if (point.empty()) return LineMissing(number, fb::kDatumPoint);
    CheckInstrumentHeight(c.instrument, number);

    double ah = c.hz, av = c.v, di = c.slope;
    SlopeFromHorizontal(c.horizontal, c.heightDifference, av, di);
    AddRemarks();
    const bool reference = IsReference(point);
    CVisee* sighting = reference
                           ? static_cast<CVisee*>(AddReference(std::string(point), m_reflector, ah, av, di))
                           : static_cast<CVisee*>(AddMesure(std::string(point), m_reflector, ah, av, di));
    m_firstSighting = false;
    m_pendingCode.clear();
    if (!sighting) return LineError(fb::kRefused, number);
    if (m_settings.keepComputed && c.HasTarget())
        AddPosition(point, c.east, c.north, c.elevation, false, number);
}

void CLectWild::ReadStaff(int number) {
    const gsi::BlockContent& c = m_content;
    std::string point(FormMatView(c.point));
    if (point.empty()) return LineMissing(number, fb::kDatumPoint);
    AddRemarks();
    for (std::size_t i = 0; i < c.readingCount; ++i) {
        const gsi::StaffReading& reading = c.readings[i];
        if (reading.index == 331 || reading.index == 335)
            Result().Add(std::make_unique<CLectAR>(point, reading.metres, c.horizontal), kKindLectAR);
        else
            Result().Add(std::make_unique<CLectAV>(point, reading.metres, c.horizontal), kKindLectAV);
    }
}

// ---- Stations and points ---------------------------------------------------------------------------------

bool CLectWild::OpenStation(std::string_view name, double hi, int number) {
    const gsi::BlockContent& c = m_content;
    if (name.empty()) {
        LineMissing(number, fb::kDatumStation);
        return false;
    }
    if (c.HasStationPosition() &&
        !AddPosition(name, c.stationEast, c.stationNorth, c.stationElevation, true, number))
        return false;
    CStation* station = AddStation(std::string(name), hi);
    if (!station) {
        LineError(fb::kRefused, number);
        return false;
    }
    m_station = station;
    m_firstSighting = true;
    m_heightWarned = false;
    return true;
}

// Coordinates in the order of their words (81 82 83, or 84 85 86): the first is the easting unless the
// settings say the northing comes first.
bool CLectWild::AddPosition(std::string_view name, double first, double second, double elevation, bool known,
                            int number) {
    if (IsKnown(first) != IsKnown(second)) {
        const bool northMissing = IsKnown(first) == (m_settings.order == CoordinateOrder::EastNorth);
        LineMissing(number, northMissing ? fb::kDatumNorth : fb::kDatumEast);
        return false;
    }
    const bool swap = m_settings.order == CoordinateOrder::NorthEast;
    CPointGen* point = AddPoint(std::string(name), swap ? second : first, swap ? first : second, elevation);
    if (!point) {
        LineError(fb::kRefused, number);
        return false;
    }
    if (known && point->hasXY()) m_known.Insert(point->mat());
    return true;
}

void CLectWild::CheckInstrumentHeight(double hi, int number) {
    if (IsUndefined(hi)) return;
    if (!m_station) return LineError(fb::kNoStationForHI, number);
    if (IsUndefined(m_station->hi())) {
        m_station->setHI(hi);
    } else if (std::fabs(hi - m_station->hi()) > kSameHeight && !m_heightWarned) {
        m_heightWarned = true;
        if (TextWindow())
            TextWindow()->Print(wild::kHeightDiffers, number, FormatFixed(hi, 3).c_str(),
                                m_station->mat().c_str(), FormatFixed(m_station->hi(), 3).c_str());
    }
}

// ---- References ------------------------------------------------------------------------------------------

bool CLectWild::IsReference(std::string_view point) const {
    if (m_known.Contains(point)) return true;
    // The code of a sighting is the code block before it, or one of the remarks of its own block.
    if (m_settings.MarksReference(m_firstSighting, m_pendingCode)) return true;
    for (std::size_t i = 0; i < m_content.remarkCount; ++i)
        if (m_settings.MarksReference(false, WordText(*m_content.remarks[i]))) return true;
    return false;
}

} // namespace pyr
