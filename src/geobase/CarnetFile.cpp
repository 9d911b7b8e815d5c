// Reading and writing GéoBase files. A GéoBase is never half written: it is written to a temporary
// file beside it, flushed to the disk, then renamed over the old one. The loader never drops a line.
#include "core/Files.h"
#include "core/Lines.h"
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
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace pyr {

namespace {

void Tell(ui::FrontEnd* parent, const std::string& text, int icon) {
    (parent ? *parent : ui::ApplicationFrontEnd()).MessageBox(text, ui::kCaption, icon);
}

bool IsBlankLine(std::string_view line) {
    return std::all_of(line.begin(), line.end(), [](char c) { return c == ' ' || c == '\t'; });
}

constexpr size_t kWriteChunk = 1 << 20;

} // namespace

int CCarnet::Load(CPyrTxtWnd* txt, const std::string& path, const std::string& configuration, int report,
                  ui::FrontEnd* parent) {
    RemoveAll();
    m_path = path;
    m_configuration = configuration;

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
    ForEachLine(text, [&](std::string_view line, int number) {
        if (int version = GeoHeaderVersion(line)) {
            if (number == 1 && version > kGeoFormatVersion) {
                lenient = true;
                if (txt) txt->Print(msg::kNewerVersion, path.c_str(), version, kGeoFormatVersion);
            }
            return; // a header line carries no element, wherever it stands
        }
        if (number == 1 && txt) txt->Print(msg::kNoHeader, path.c_str());
        if (IsBlankLine(line)) return;
        int kind = 0;
        if (auto element = ParseElementLine(line, kind, error, lenient)) {
            AddChecked(std::move(element), kind);
            return;
        }
        // Kept word for word, so that the next save writes it back.
        AddChecked(std::make_unique<CComment>(std::string(line)), kKindComment);
        if (txt) txt->Print(msg::kLineKept, number, error.c_str());
    });
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

int CCarnet::Save(const std::string& path, ui::FrontEnd* parent, bool report) {
    std::string temporary = ReplaceExtension(path, "tmp");
    if (temporary == path) temporary += ".tmp";
    std::FILE* file = path.empty() ? nullptr : std::fopen(temporary.c_str(), "wb");
    bool ok = file != nullptr;
    if (ok) {
        ok = Write(file, true) && std::fflush(file) == 0 && fsync(fileno(file)) == 0;
        // The new file keeps the access rights of the one it replaces.
        struct stat previous {};
        if (ok && stat(path.c_str(), &previous) == 0) fchmod(fileno(file), previous.st_mode & 07777);
        ok = (std::fclose(file) == 0) && ok;
        ok = ok && std::rename(temporary.c_str(), path.c_str()) == 0;
        if (!ok) std::remove(temporary.c_str());
    }
    if (!ok) {
        Tell(parent, Sprintf(msg::kSaveFailed, path.c_str()), ui::kIconWarning);
        return 0;
    }
    m_path = path;
    if (report) Tell(parent, Sprintf(msg::kSaved, path.c_str()), ui::kIconInformation);
    return 1;
}

int CCarnet::BackUp() {
    if (m_path.empty() || !FileExists(m_path)) return 1;
    std::error_code error;
    std::filesystem::copy_file(m_path, ReplaceExtension(m_path, "bak"),
                               std::filesystem::copy_options::overwrite_existing, error);
    if (error) {
        Tell(nullptr, Sprintf(msg::kBackUpFailed, m_path.c_str()), ui::kIconWarning);
        return 0;
    }
    return 1;
}

} // namespace pyr
