#include "IniFileStore.h"

#include "SettingsText.h"
#include "core/Files.h"
#include "core/Lines.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"

#include <cerrno>
#include <climits>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

// The library is used header-only, without its wide-character converters: texts stay UTF-8 bytes.
#define SI_NO_CONVERSION
#define SI_IMPLEMENTATION
#include <SimpleIni.h>

namespace pyr {

namespace {

#ifdef _WIN32
constexpr bool kNewFileCrlf = true;
#else
constexpr bool kNewFileCrlf = false;
#endif

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

// A stray line (neither section, key, comment nor blank) would be dropped by the library's reader. It
// is handed over as a comment carrying this mark, and the mark taken off again when the file is written.
constexpr std::string_view kStrayMark = ";\x01";

enum class LineKind { Blank, Comment, Section, Entry, Stray };

// The same reading of a line as the library's: blanks before the first character do not count, a
// section needs its closing bracket on the line, a key line needs a key before its "=".
LineKind Classify(std::string_view line) {
    const std::size_t first = line.find_first_not_of(" \t");
    if (first == std::string_view::npos) return LineKind::Blank;
    const char c = line[first];
    if (c == ';' || c == '#') return LineKind::Comment;
    if (c == '[')
        return line.find(']', first) != std::string_view::npos ? LineKind::Section : LineKind::Stray;
    const std::size_t equals = line.find('=', first);
    return equals != std::string_view::npos && equals != first ? LineKind::Entry : LineKind::Stray;
}

// UTF-8 back to Windows-1252, for a file that was read in that code page. The five holes of the code
// page come back from the C1 controls they were read as; what the code page cannot hold becomes '?'.
// A byte that does not start a valid UTF-8 sequence is kept as it is.
std::string Utf8ToWindows1252(std::string_view text) {
    static constexpr char16_t kHighHalf[32] = {
        0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
        0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
        0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178,
    };
    std::string out;
    out.reserve(text.size());
    const auto* p = reinterpret_cast<const std::uint8_t*>(text.data());
    const auto* end = p + text.size();
    while (p < end) {
        const std::uint8_t c = *p;
        int extra = c >= 0xF0 && c <= 0xF4 ? 3 : c >= 0xE0 && c <= 0xEF ? 2 : c >= 0xC2 && c <= 0xDF ? 1 : 0;
        if (c < 0x80 || extra == 0 || end - p <= extra) {
            out += static_cast<char>(c);
            ++p;
            continue;
        }
        char32_t cp = c & (0x3F >> extra);
        bool valid = true;
        for (int i = 1; i <= extra && valid; ++i) {
            valid = (p[i] & 0xC0) == 0x80;
            cp = (cp << 6) | (p[i] & 0x3F);
        }
        if (!valid) {
            out += static_cast<char>(c);
            ++p;
            continue;
        }
        p += extra + 1;
        if (cp >= 0xA0 && cp <= 0xFF) {
            out += static_cast<char>(cp);
            continue;
        }
        char replacement = '?';
        for (int i = 0; i < 32; ++i) {
            if (kHighHalf[i] == cp) {
                replacement = static_cast<char>(0x80 + i);
                break;
            }
        }
        out += replacement;
    }
    return out;
}

// Appends the lines of the library's output: stray lines get their text back, runs of blank lines
// become one (the library separates sections with two), and the text does not start with a blank line.
void AppendLibraryOutput(std::string& out, std::string_view output) {
    bool lastBlank = true;
    ForEachLine(output, [&](std::string_view line, int) {
        const bool blank = line.empty();
        if (blank && lastBlank) return;
        if (line.starts_with(kStrayMark)) line.remove_prefix(kStrayMark.size());
        out.append(line);
        out += '\n';
        lastBlank = blank;
    });
}

} // namespace

struct IniFile::Impl {
    Impl() : ini(/*isUtf8*/ false, /*multiKey*/ true, /*multiLine*/ false) {
        ini.SetSpaces(false);
        ini.SetQuotes(true);
    }

    // The library holds the file from its first line to its last section or key line. Of a file with
    // neither, every line is in `leading`, written back before anything added; the comment, blank and
    // stray lines after the last section or key line are in `trailing`, written back after everything.
    CSimpleIniA ini;
    std::string leading;
    std::string trailing;
    bool windows1252 = false;
    bool byteOrderMark = false;
    bool crlf = kNewFileCrlf;
};

IniFile::IniFile() : impl_(std::make_unique<Impl>()) {}
IniFile::~IniFile() = default;
IniFile::IniFile(IniFile&&) noexcept = default;
IniFile& IniFile::operator=(IniFile&&) noexcept = default;

int IniFile::Load(const std::string& path) {
    std::string bytes;
    if (!ReadWholeFile(path, bytes)) {
        const int code = errno != 0 ? errno : EIO;
        Parse({});
        return code;
    }
    Parse(bytes);
    return 0;
}

void IniFile::Parse(std::string_view bytes) {
    impl_ = std::make_unique<Impl>();
    Impl& d = *impl_;
    d.byteOrderMark = bytes.starts_with(kByteOrderMark);
    const std::string text = FileBytesToUtf8(bytes, &d.windows1252);
    if (text.find('\n') != std::string::npos || text.find('\r') != std::string::npos)
        d.crlf = text.find("\r\n") != std::string::npos;

    std::string head;
    std::string pendingMarked; // the lines since the last section or key line, strays marked
    std::string pendingRaw;    // the same lines as they are
    bool anyEntry = false;
    ForEachLine(text, [&](std::string_view line, int) {
        const LineKind kind = Classify(line);
        if (kind == LineKind::Section || kind == LineKind::Entry) {
            head += pendingMarked;
            head.append(line);
            head += '\n';
            pendingMarked.clear();
            pendingRaw.clear();
            anyEntry = true;
            return;
        }
        if (kind == LineKind::Stray) pendingMarked += kStrayMark;
        pendingMarked.append(line);
        pendingMarked += '\n';
        pendingRaw.append(line);
        pendingRaw += '\n';
    });
    if (anyEntry)
        d.trailing = std::move(pendingRaw);
    else
        d.leading = std::move(pendingRaw);
    d.ini.LoadData(head.data(), head.size());
}

bool IniFile::HasSection(std::string_view section) const {
    return impl_->ini.GetSection(std::string(section).c_str()) != nullptr;
}

bool IniFile::Get(std::string_view section, std::string_view key, std::string& value) const {
    const char* found = impl_->ini.GetValue(std::string(section).c_str(), std::string(key).c_str(), nullptr);
    if (!found) return false;
    value = found;
    return true;
}

void IniFile::Set(std::string_view section, std::string_view key, std::string_view value) {
    auto utf8 = [](std::string_view text) {
        return IsValidUtf8(text) ? std::string(text) : Windows1252ToUtf8(text);
    };
    const std::string sectionText = utf8(section);
    std::string keyText = utf8(key);
    // A key already there keeps its spelling; the library would give it the caller's.
    CSimpleIniA::TNamesDepend keys;
    if (impl_->ini.GetAllKeys(sectionText.c_str(), keys)) {
        for (const auto& entry : keys) {
            if (EqualIgnoringCase(entry.pItem, keyText)) {
                keyText = entry.pItem;
                break;
            }
        }
    }
    impl_->ini.SetValue(sectionText.c_str(), keyText.c_str(), utf8(value).c_str(), nullptr,
                        /*forceReplace*/ true);
}

std::string IniFile::Bytes() const {
    const Impl& d = *impl_;
    std::string output;
    d.ini.Save(output, /*addSignature*/ false);

    std::string text = d.leading;
    if (!text.empty() && !output.empty()) text += '\n';
    AppendLibraryOutput(text, output);
    text += d.trailing;

    if (d.crlf) {
        std::string withCr;
        withCr.reserve(text.size() + text.size() / 16);
        for (char c : text) {
            if (c == '\n') withCr += '\r';
            withCr += c;
        }
        text = std::move(withCr);
    }
    if (d.windows1252) text = Utf8ToWindows1252(text);
    if (d.byteOrderMark) text.insert(0, kByteOrderMark);
    return text;
}

int IniFile::Save(const std::string& path) const {
    return ReplaceFileContents(path, Bytes());
}

} // namespace pyr
