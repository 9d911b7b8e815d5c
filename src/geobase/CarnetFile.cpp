// Reading and writing GéoBase files. A GéoBase is never half written (see core/SafeFile.h), never written
// over a file that is not a GéoBase or that its owner protected, and the loader never drops a line.
#include "core/Files.h"
#include "core/Lines.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <unistd.h>

namespace pyr {

namespace {

void Tell(ui::FrontEnd* parent, const std::string& text, int icon) {
    (parent ? *parent : ui::ApplicationFrontEnd()).MessageBox(text, ui::kCaption, icon);
}

// A failure of what the person asked for: the running command ends on a failure status.
void ReportFailure(ui::FrontEnd* parent, const std::string& text) {
    (parent ? *parent : ui::ApplicationFrontEnd()).ReportFailure(text);
}

// Whether a GéoBase header opens the file: the first few kilobytes tell it without reading a big file.
bool OpensWithHeader(const std::string& path) {
    const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return false;
    char buffer[4096];
    const ssize_t n = read(fd, buffer, sizeof buffer);
    close(fd);
    std::string_view head(buffer, n > 0 ? static_cast<size_t>(n) : 0);
    if (head.substr(0, 3) == "\xEF\xBB\xBF") head.remove_prefix(3);
    return GeoHeaderVersion(head.substr(0, head.find_first_of("\r\n"))) != 0;
}

constexpr size_t kWriteChunk = 1 << 20;

} // namespace

int CCarnet::Load(CPyrTxtWnd* txt, const std::string& path, const std::string& configuration, int report,
                  ui::FrontEnd* parent) {
    RemoveAll();
    m_path = path;
    m_configuration = configuration;

    m_knownPath.clear();
    m_knownForeign = false;

    std::string bytes;
    if (!ReadWholeFile(path, bytes)) {
        std::string why = SystemErrorText(errno);
        Tell(parent, Sprintf(msg::kCannotOpen, path.c_str(), why.c_str()), ui::kIconWarning);
        return 0;
    }
    std::string_view text(bytes);
    if (text.substr(0, 3) == "\xEF\xBB\xBF") text.remove_prefix(3);
    if (!IsValidUtf8(text)) {
        bytes = Windows1252ToUtf8(text);
        text = bytes;
        if (txt) txt->Print(msg::kReadAsWindows1252, path.c_str());
    }

    const size_t lineCount = static_cast<size_t>(std::count(text.begin(), text.end(), '\n')) + 1;
    m_elements.reserve(lineCount);
    m_kinds.reserve(lineCount);

    bool lenient = false;
    std::string error;
    GeoFileCensus census;
    ForEachLine(text, [&](std::string_view line, int number) {
        if (int version = GeoHeaderVersion(line)) {
            if (number == 1 && version > kGeoFormatVersion) {
                lenient = true;
                if (txt) txt->Print(msg::kNewerVersion, path.c_str(), version, kGeoFormatVersion);
            }
            census.header = true;
            return; // a header line carries no element, wherever it stands
        }
        if (number == 1 && txt) txt->Print(msg::kNoHeader, path.c_str());
        if (IsBlankGeoLine(line)) return;
        int kind = 0;
        auto element = ParseElementLine(line, kind, error, lenient);
        census.Line(element != nullptr);
        if (element) {
            AddChecked(std::move(element), kind);
            return;
        }
        // Kept word for word, so that the next save writes it back.
        AddChecked(std::make_unique<CComment>(std::string(line)), kKindComment);
        if (txt) txt->Print(msg::kLineKept, number, error.c_str());
    });
    m_knownPath = path;
    m_knownForeign = census.IsForeign();
    if (txt && m_knownForeign) txt->Print(msg::kOpenedForeign, path.c_str(), census.unreadable, census.lines);
    if (txt && IsReadOnlyFile(path)) txt->Print(msg::kOpenedReadOnly, path.c_str());
    if (report && txt) txt->Print(msg::kLoaded, path.c_str(), GetSize());
    return 1;
}

bool CCarnet::Write(std::FILE* file, bool withHeader) const {
    if (!file) return false;
    std::string buffer;
    // About 64 bytes a line: a small store does not need a whole chunk.
    buffer.reserve(std::min(kWriteChunk, 64 * m_elements.size()) + 4096);
    if (withHeader) {
        buffer += GeoHeaderLine();
        buffer += '\n';
    }
    for (size_t i = 0; i < m_elements.size(); ++i) {
        AppendElementLine(buffer, *m_elements[i], m_kinds[i]);
        buffer += '\n';
        if (buffer.size() >= kWriteChunk) {
            if (std::fwrite(buffer.data(), 1, buffer.size(), file) != buffer.size()) return false;
            buffer.clear();
        }
    }
    if (!buffer.empty() && std::fwrite(buffer.data(), 1, buffer.size(), file) != buffer.size()) return false;
    return std::ferror(file) == 0;
}

bool CCarnet::IsForeignFile(const std::string& path) const {
    if (!FileExists(path)) return false; // nothing there to lose
    if (path == m_knownPath) return m_knownForeign;
    if (OpensWithHeader(path)) return false;
    // Rare: a save under another name, over a file without a header at its top.
    std::string bytes;
    return ReadWholeFile(path, bytes) && TakeGeoFileCensus(bytes).IsForeign();
}

std::string CCarnet::SaveRefusal(const std::string& path) const {
    if (IsReadOnlyFile(path)) return msg::kRefusedReadOnly;
    if (IsForeignFile(path)) return msg::kRefusedForeign;
    return {};
}

int CCarnet::Save(const std::string& path, ui::FrontEnd* parent, bool report) {
    std::string failure = SaveRefusal(path);
    if (failure.empty()) {
        SafeFileWriter writer(path);
        errno = 0;
        const bool written = Write(writer.File(), true);
        int code = 0;
        if (!writer.File()) {
            code = writer.Error();
        } else if (!written) {
            code = errno != 0 ? errno : EIO;
            writer.Abandon();
        } else if (!writer.Commit()) {
            code = writer.Error();
        }
        if (code != 0)
            failure = Sprintf(msg::kSaveFailedReason, SystemErrorText(code).c_str()) +
                      (FileExists(path) ? msg::kLeftAsItWas : "");
    }
    if (!failure.empty()) {
        ReportFailure(parent, Sprintf(msg::kSaveFailed, path.c_str()) + failure);
        return 0;
    }
    m_path = path;
    m_knownPath = path; // a GéoBase now, written here
    m_knownForeign = false;
    if (report) Tell(parent, Sprintf(msg::kSaved, path.c_str()), ui::kIconInformation);
    return 1;
}

int CCarnet::BackUp(ui::FrontEnd* parent) {
    if (m_path.empty() || !FileExists(m_path)) return 1;
    if (const std::string refusal = SaveRefusal(m_path); !refusal.empty()) {
        ReportFailure(parent, Sprintf(msg::kSaveFailed, m_path.c_str()) + refusal);
        return 0;
    }
    const std::string backup = ReplaceExtension(m_path, "bak");
    if (const int code = CopyFileContents(m_path, backup)) {
        ReportFailure(parent, Sprintf(msg::kBackUpFailed, m_path.c_str(), backup.c_str(),
                                      SystemErrorText(code).c_str()));
        return 0;
    }
    return 1;
}

} // namespace pyr
