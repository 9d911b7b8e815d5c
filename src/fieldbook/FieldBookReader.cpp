#include "fieldbook/FieldBookReader.h"

#include "core/FileLines.h"
#include "core/Files.h"
#include "core/Lines.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "core/Undefined.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/TableCode.h"
#include "geobase/Carnet.h"
#include "settings/CalcOptions.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <cerrno>
#include <cmath>

namespace pyr {

namespace {

// How often the clock is looked at, in lines, and how long a conversion runs before it shows where it is.
constexpr int kProgressStride = 8192;
constexpr auto kProgressDelay = std::chrono::seconds(1);

const ReadingChoices& NoChoices() {
    static const ReadingChoices none;
    return none;
}

} // namespace

std::unique_ptr<CAppareil> MakeInstrument(const InstrumentOptions& instrument) {
    auto element = std::make_unique<CAppareil>(instrument.name, instrument.verticalCollimation,
                                               instrument.prismConstant);
    element->setSigmaAh(instrument.sigmaAh);
    element->setSigmaAv(instrument.sigmaAv);
    element->setSigmaDi(instrument.sigmaDi);
    element->setSigmaPpm(instrument.sigmaPpm);
    return element;
}

CFieldBookReader::CFieldBookReader() = default;
CFieldBookReader::~CFieldBookReader() = default;

const ReadingChoices& CFieldBookReader::Choices() const {
    return m_choices ? *m_choices : NoChoices();
}

bool IsCutLastLine(std::string_view text, std::string_view line) {
    return !text.empty() && line.data() + line.size() == text.data() + text.size() && text.back() != '\n' &&
           text.back() != '\r' && !TrimmedOfControls(line).empty();
}

std::string CarnetOpenFailure(const std::string& path, int code) {
    return Sprintf(fb::kCarnetPathAndReason, fb::kMsgCannotOpenCarnet, path.c_str(),
                   SystemErrorText(code).c_str());
}

std::string CFieldBookReader::OpenFailure(const std::string& path, int code) const {
    return CarnetOpenFailure(path, code);
}

bool CFieldBookReader::Read(const std::string& path, CCarnet& result) {
    // The book is read by chunks, never whole: its lines become elements as they come.
    FileLines file;
    const int before = result.GetSize();
    bool read = file.Open(path);
    if (read) {
        m_path = path;
        // Started at the first line, so that a book found to be in Windows-1252 within its first
        // megabytes (where the accents of a header lie) says so before the creation is announced.
        bool started = false;
        read = file.ForEach(
            [&](const FileLines::Line& line) {
                if (!started) Start(result);
                started = true;
                ReadOne(line.text, line.number, line.unterminated && !TrimmedOfControls(line.text).empty(),
                        line.end, file.Size());
            },
            [&] {
                if (m_txt) m_txt->Print(fb::kReadAsWindows1252, m_path.c_str());
            });
        if (read && !started) Start(result);
        // A book that cannot be read to its end adds nothing.
        if (!read) {
            const int code = errno;
            m_result = nullptr;
            result.RemoveRange(before, result.GetSize());
            errno = code;
        } else {
            Finish(result);
        }
    }
    if (!read) {
        const int code = errno;
        ui::FrontEnd& frontEnd = m_parent ? *m_parent : ui::ApplicationFrontEnd();
        frontEnd.MessageBox(OpenFailure(path, code), ui::kCaption, ui::kIconWarning);
        return false;
    }
    return true;
}

void CFieldBookReader::ReadText(std::string_view bytes, CCarnet& result) {
    if (bytes.starts_with("\xEF\xBB\xBF")) bytes.remove_prefix(3);
    // Valid UTF-8 is read where it lies: a million-line field book is not copied once more.
    std::string converted;
    if (!IsValidUtf8(bytes)) {
        if (!m_path.empty() && m_txt) m_txt->Print(fb::kReadAsWindows1252, m_path.c_str());
        converted = Windows1252ToUtf8(bytes);
        bytes = converted;
    }
    Start(result);
    ForEachLine(bytes, [&](std::string_view line, int number) {
        ReadOne(line, number, IsCutLastLine(bytes, line),
                static_cast<std::size_t>(line.data() - bytes.data()) + line.size(), bytes.size());
    });
    Finish(result);
}

void CFieldBookReader::Start(CCarnet& result) {
    m_result = &result;
    if (m_announced) Print(fb::kCreating);
    m_start = m_lastProgress = std::chrono::steady_clock::now();
    BeginReading();
    if (Choices().writeInstrument) AddInstrument();
}

void CFieldBookReader::ReadOne(std::string_view line, int number, bool cut, std::uint64_t offset,
                               std::uint64_t size) {
    if (cut) LineError(fb::kCutLastLine, number);
    ReadLine(line, number);
    if (number % kProgressStride == 0) ShowProgress(number, offset, size);
}

void CFieldBookReader::Finish(CCarnet& result) {
    EndReading();
    if (m_announced && m_txt) m_txt->Print(fb::kFinished, result.GetSize());
    m_result = nullptr;
}

void CFieldBookReader::ShowProgress(int number, std::uint64_t offset, std::uint64_t size) {
    const auto now = std::chrono::steady_clock::now();
    if (!m_txt || now - m_start < kProgressDelay || now - m_lastProgress < kProgressDelay) return;
    m_lastProgress = now;
    const int percent = size ? static_cast<int>(offset * 100 / size) : 100;
    m_txt->Print(fb::kProgress, number, percent);
}

void CFieldBookReader::AddInstrument() {
    const auto& instruments = Choices().instruments;
    const InstrumentOptions* chosen = nullptr;
    for (const auto& instrument : instruments)
        if (instrument.name == Choices().instrumentName) chosen = &instrument;
    // The combo shows the first instrument when none has the name asked for.
    const InstrumentOptions standard{kStandardInstrument};
    if (!chosen) chosen = instruments.empty() ? &standard : &instruments.front();
    Result().Add(MakeInstrument(*chosen), kKindAppareil);
}

// ---- Reports ---------------------------------------------------------------------------------------------

bool CFieldBookReader::CheckLength(int number, std::string_view line, int expected) {
    const int length = static_cast<int>(Utf8Length(line));
    if (length == expected) return true;
    if (m_txt) m_txt->Print(fb::kBadLength, number, length, expected);
    return false;
}

void CFieldBookReader::LineUnrecognised(int number) {
    LineError(fb::kUnrecognised, number);
}

void CFieldBookReader::LineMissing(int number, std::string_view datum) {
    if (m_txt) m_txt->Print(fb::kMissingDatum, number, std::string(datum).c_str());
}

void CFieldBookReader::LineError(const char* format, int number) {
    if (m_txt) m_txt->PrintText(Sprintf(format, number));
}

void CFieldBookReader::LineUnknownStation(int number) {
    if (m_txt) m_txt->Print(fb::kUnknownStationOpened, number, fb::kUnknownStation);
}

void CFieldBookReader::Print(std::string_view text) {
    if (m_txt) m_txt->PrintText(text);
}

// ---- Elements --------------------------------------------------------------------------------------------

namespace {

// What a field book carries, without the binary noise of its conversions (a DMS reading turned into
// grads, a face-right reading brought back by 200 gr, feet into metres): angles to 0.01 µgr and lengths to
// the micrometre, finer than any instrument records, so that a value the book wrote comes back as written
// ("157.4134", not "157.41340000000002"). Dividing the rounded count by a power of ten that a double holds
// exactly gives the double nearest the decimal value, as reading its text would.
double Rounded(double value, double perUnit) {
    if (!IsKnown(value) || !std::isfinite(value) || std::fabs(value) * perUnit > 1e15) return value;
    return std::round(value * perUnit) / perUnit;
}
double Angle(double grads) {
    return Rounded(grads, 1e8);
}
double Length(double metres) {
    return Rounded(metres, 1e6);
}

} // namespace

CStation* CFieldBookReader::AddStation(std::string name, double hi, double v0, std::string code) {
    return Result().validStation(
        m_txt, std::make_unique<CStation>(std::move(name), Length(hi), Angle(v0), std::move(code)));
}

CReference* CFieldBookReader::AddReference(std::string point, double hp, double ah, double av, double di,
                                           std::string code) {
    return Result().validReference(m_txt,
                                   std::make_unique<CReference>(std::move(point), Length(hp), Angle(ah),
                                                                Angle(av), Length(di), std::move(code)));
}

CMesure* CFieldBookReader::AddMesure(std::string point, double hp, double ah, double av, double di,
                                     std::string code) {
    return Result().validMesure(m_txt, std::make_unique<CMesure>(std::move(point), Length(hp), Angle(ah),
                                                                 Angle(av), Length(di), std::move(code)));
}

CPointGen* CFieldBookReader::AddPoint(std::string name, double x, double y, double z, std::string code) {
    return Result().validPoint(m_txt, std::make_unique<CPointGen>(std::move(name), Length(x), Length(y),
                                                                  Length(z), std::move(code)));
}

void CFieldBookReader::AddHeaderComment(std::string_view label, std::string_view value) {
    Result().validComment(kHeaderLabelWidth, label, value);
}

void CFieldBookReader::AddComment(std::string text) {
    Result().Add(std::make_unique<CComment>(std::move(text)), kKindComment);
}

CElement* CFieldBookReader::AddCode(std::string_view code, std::string_view point) {
    code = Trimmed(code);
    if (code.empty()) return nullptr;
    // Named before it is added: renaming an element of the store would have it indexed again.
    if (Choices().interpret && m_table) {
        m_table->Make_str_cmd(code, m_words);
        int kind = 0;
        if (auto command = m_table->InterpreteTexte(m_words, kind)) {
            if (!point.empty()) command->setMat(std::string(point));
            const int index = Result().Add(std::move(command), kind);
            if (index >= 0) return Result().GetAt(index);
        }
    }
    const int index = Result().Add(
        std::make_unique<CCommande>(std::string(code), std::string(), std::string(point)), kKindCommand);
    return Result().GetAt(index);
}

void CFieldBookReader::SplitNameAndCode(std::string_view field, std::string& name, std::string& code) const {
    const std::size_t start =
        m_table ? std::min(CodePosition(field, m_table->Separator()), field.size()) : field.size();
    name = std::string(Trimmed(field.substr(0, start)));
    code = std::string(Trimmed(field.substr(start)));
}

} // namespace pyr
