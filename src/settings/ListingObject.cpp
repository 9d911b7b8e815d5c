#include "settings/ListingObject.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "settings/CalcOptions.h"

#include <algorithm>
#include <cstdarg>
#include <filesystem>

namespace pyr {

namespace {

// Lines of a plain-text page's footer, with the page count: a separator and the page number.
constexpr int kFooterLines = 2;
constexpr std::string_view kHeaderName = "PYRALIS Calculs Topo";

} // namespace

CDlgCfgListing::CDlgCfgListing(ui::FrontEnd& parent) : m_frontEnd(parent) {}

CDlgCfgListing::~CDlgCfgListing() = default;

void CDlgCfgListing::SetFormat(int format) {
    m_format = std::clamp(format, 0, 2);
}
void CDlgCfgListing::SetPageLength(int lines) {
    m_pageLength = std::clamp(lines, kMinPageLength, kMaxPageLength);
}
void CDlgCfgListing::SetPageWidth(int characters) {
    m_pageWidth = std::clamp(characters, kMinPageWidth, kMaxPageWidth);
}

// The defaults and limits are those of the options table, which the listings page edits.
void CDlgCfgListing::ReadLastParameters(std::string_view paramPath) {
    m_format = ReadOptionInt(paramPath, kSectionListingLayout, kKeyListingFormat);
    m_pageLength = ReadOptionInt(paramPath, kSectionListingLayout, kKeyPageLength);
    m_pageWidth = ReadOptionInt(paramPath, kSectionListingLayout, kKeyPageWidth);
}

// --- Output ------------------------------------------------------------------------------------------

std::string CDlgCfgListing::GetListingName(const std::string& geobasePath, const std::string& extension) {
    return ReplaceExtension(geobasePath, extension);
}

bool CDlgCfgListing::OpenListing(const std::string& path, std::string_view mode) {
    if (m_writer) CloseListing(m_fileName, false);
    const bool append = !IsRichText() && !mode.empty() && mode[0] == 'a';
    m_fileName = path;
    m_error = 0;
    auto writer = std::make_unique<SafeFileWriter>(path, append ? SafeFileWriter::Start::CopyOfFile
                                                                : SafeFileWriter::Start::Empty);
    if (writer->Error() != 0) {
        m_error = writer->Error();
        return false;
    }
    m_writer = std::move(writer);
    m_buffer.clear();
    m_documentStarted = false;
    m_output = ListingOutput::File;
    m_inPage = false;
    m_page = 0;
    m_lineCount = 0;
    m_pending.clear();
    m_lineOpen = false;
    return true;
}

void CDlgCfgListing::InitOutput(ListingOutput target) {
    m_output = target;
    m_inPage = false;
    m_page = 0;
    m_lineCount = 0;
}

bool CDlgCfgListing::CloseListing(const std::string& path, bool view) {
    if (!m_writer) return false;
    if (m_lineOpen) EndLine();
    if (IsRichText() && m_documentStarted) Raw("}\n");
    Flush();
    const bool written = m_writer->Commit();
    if (!written) m_error = m_writer->Error();
    m_writer.reset();
    if (view && written) ViewListing(path);
    return written;
}

std::string CDlgCfgListing::FailureText() const {
    return FileWriteFailure(m_fileName, m_error);
}

void CDlgCfgListing::ViewListing(const std::string& path) {
    m_frontEnd.ShowFile(path);
}

void CDlgCfgListing::Raw(std::string_view bytes) {
    if (m_output != ListingOutput::File || !m_writer) return;
    if (IsRichText() && !m_documentStarted) rtfInit();
    m_buffer += bytes;
    if (m_buffer.size() >= kBufferBytes) Flush();
}

void CDlgCfgListing::Flush() {
    if (m_writer && !m_buffer.empty()) m_writer->Write(m_buffer);
    m_buffer.clear();
}

// --- Lines and pages -----------------------------------------------------------------------------------

int CDlgCfgListing::Emit(std::string_view text, bool mayBreak) {
    int ended = 0;
    std::size_t begin = 0;
    while (begin < text.size()) {
        std::size_t end = text.find('\n', begin);
        if (!m_lineOpen) {
            if (mayBreak) BreakPageIfFull();
            m_lineOpen = true;
        }
        m_pending.append(text.substr(begin, std::min(end, text.size()) - begin));
        if (end == std::string_view::npos) break;
        EndLine();
        ++ended;
        begin = end + 1;
    }
    return ended;
}

void CDlgCfgListing::EndLine() {
    if (IsRichText()) {
        Raw("\\pard\\plain\\f0\\fs20 " + RtfEscape(m_pending) + "\\par\n");
    } else {
        m_pending += '\n';
        Raw(m_pending);
        m_pending.pop_back();
    }
    if (m_output == ListingOutput::TextWindow || m_echo) m_frontEnd.TextLine(m_pending);
    ++m_lineCount;
    m_pending.clear();
    m_lineOpen = false;
}

void CDlgCfgListing::BreakPageIfFull() {
    if (!m_pageCount || !m_inPage || IsRichText() || m_lineCount < m_pageLength - kFooterLines) return;
    WriteFooter();
    WriteHeader(m_page + 1);
    WriteDescriptor();
}

void CDlgCfgListing::WriteHeader(int page) {
    if (m_lineOpen) EndLine();
    if (IsRichText()) {
        if (m_page > 0) Raw("\\page\n");
        m_page = page;
        m_lineCount = 0;
        m_inPage = true;
        return;
    }
    m_page = page;
    m_lineCount = 0;
    m_inPage = true;
    // The program's name on the left, the listing's file name on the right when the line has room.
    std::string line(kHeaderName);
    const std::string name = std::filesystem::path(m_fileName).filename().string();
    const std::size_t room = static_cast<std::size_t>(m_pageWidth) - Utf8Length(line);
    if (!name.empty() && Utf8Length(name) + 1 < room)
        line += std::string(room - Utf8Length(name), ' ') + name;
    Emit(line + "\n" + SepLine(1) + "\n\n", false);
}

void CDlgCfgListing::WriteFooter() {
    if (m_lineOpen) EndLine();
    m_inPage = false;
    if (IsRichText()) return; // the document's footer numbers its pages
    if (!m_pageCount) {
        Emit(SepLine(1) + "\n", false);
        return;
    }
    std::string padding(static_cast<std::size_t>(std::max(0, m_pageLength - kFooterLines - m_lineCount)),
                        '\n');
    std::string number = CenterString("Page " + std::to_string(m_page));
    number.erase(number.find_last_not_of(' ') + 1);
    Emit(padding + SepLine(1) + "\n" + number + "\n", false);
}

// --- Text ----------------------------------------------------------------------------------------------

int CDlgCfgListing::WriteLine(const char* format, ...) {
    std::va_list args;
    va_start(args, format);
    std::string text = VSprintf(format, args);
    va_end(args);
    return Emit(text);
}

int CDlgCfgListing::WriteText(std::string_view text) {
    return Emit(text);
}

std::string CDlgCfgListing::SepLine(int index) const {
    const Sep& sep = m_sep[index];
    return std::string(static_cast<std::size_t>(sep.width < 0 ? m_pageWidth : sep.width), sep.c);
}

void CDlgCfgListing::SetTitleLine(std::string_view text, char frame) {
    m_title = text;
    m_titleFrame = frame;
}

std::string CDlgCfgListing::GetTitleLine() const {
    const std::string frame(1, m_titleFrame);
    const int inner = m_pageWidth - 2;
    if (static_cast<int>(Utf8Length(m_title)) + 2 > inner) return frame + " " + m_title + " " + frame;
    return frame + CenterString(m_title, inner) + frame;
}

int CDlgCfgListing::WriteTitle() {
    if (IsRichText()) {
        rtfWriteLstTitle(m_title);
        return 1;
    }
    return Emit(SepLine(0) + "\n" + GetTitleLine() + "\n" + SepLine(0) + "\n");
}

std::string CDlgCfgListing::CenterString(std::string_view text, int width) const {
    if (width < 0) width = m_pageWidth;
    const int length = static_cast<int>(Utf8Length(text));
    if (length >= width) return std::string(text);
    const int left = (width - length) / 2;
    return std::string(static_cast<std::size_t>(left), ' ') + std::string(text) +
           std::string(static_cast<std::size_t>(width - length - left), ' ');
}

int CDlgCfgListing::WriteDescriptor() {
    if (m_descriptor.empty()) return 0;
    std::string text = m_descriptor;
    if (text.back() != '\n') text += '\n';
    return Emit(text, false);
}

} // namespace pyr
