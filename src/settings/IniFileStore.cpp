#include "IniFileStore.h"

#include "ParamStore.h"
#include "SettingsMessages.h"
#include "SettingsText.h"
#include "core/Files.h"
#include "core/Lines.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <optional>
#include <set>
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
// A comment of the file that starts with the mark itself gets a second one, so that it keeps the first.
constexpr std::string_view kStrayMark = ";\x01";

bool StartsWithStrayMark(std::string_view line) {
    const std::size_t first = line.find_first_not_of(" \t");
    return first != std::string_view::npos && line.substr(first).starts_with(kStrayMark);
}

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

// The length of the well-formed UTF-8 character at `p` (overlong forms, surrogates and code points past
// U+10FFFF are not), its code point in `cp`; 0 when there is none.
std::size_t Utf8Sequence(const std::uint8_t* p, const std::uint8_t* end, char32_t& cp) {
    const std::uint8_t c = *p;
    const int extra = c >= 0xF0 && c <= 0xF4   ? 3
                      : c >= 0xE0 && c <= 0xEF ? 2
                      : c >= 0xC2 && c <= 0xDF ? 1
                                               : 0;
    if (c < 0x80) {
        cp = c;
        return 1;
    }
    if (extra == 0 || end - p <= extra) return 0;
    cp = c & (0x3F >> extra);
    for (int i = 1; i <= extra; ++i) {
        if ((p[i] & 0xC0) != 0x80) return 0;
        cp = (cp << 6) | (p[i] & 0x3F);
    }
    if ((extra == 2 && cp < 0x800) || (extra == 3 && (cp < 0x10000 || cp > 0x10FFFF)) ||
        (cp >= 0xD800 && cp <= 0xDFFF))
        return 0;
    return static_cast<std::size_t>(extra) + 1;
}

// Bytes that a line of the file cannot carry are kept as U+EF00 + byte, three bytes of UTF-8: EE, then
// BC to BF for the byte's two high bits, then 80 to BF for its six low ones.
constexpr char32_t kEscapeFirst = 0xEF00;
constexpr char32_t kEscapeLast = 0xEFFF;

void AppendEscapedByte(std::string& out, std::uint8_t byte) {
    out += static_cast<char>(0xEE);
    out += static_cast<char>(0xBC | (byte >> 6));
    out += static_cast<char>(0x80 | (byte & 0x3F));
}

// The text as the file keeps it: valid UTF-8 without control characters but tab, each byte that is not
// so escaped (a line end would cut the line, and a file of controls would no longer pass for text).
std::string EscapeForFile(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    const auto* p = reinterpret_cast<const std::uint8_t*>(text.data());
    const auto* end = p + text.size();
    while (p < end) {
        char32_t cp = 0;
        const std::size_t length = Utf8Sequence(p, end, cp);
        const bool control = (cp < 0x20 && cp != '\t') || cp == 0x7F;
        const bool escaped = length == 0 || control || (cp >= kEscapeFirst && cp <= kEscapeLast);
        if (!escaped) {
            out.append(reinterpret_cast<const char*>(p), length);
            p += length;
            continue;
        }
        for (const auto* last = p + std::max<std::size_t>(length, 1); p < last; ++p)
            AppendEscapedByte(out, *p);
    }
    return out;
}

// A section or key name as the file keeps it. Names are the program's own, and kept as they are: UTF-8,
// a name that is not being taken as Windows-1252.
std::string NameText(std::string_view name) {
    return IsValidUtf8(name) ? std::string(name) : Windows1252ToUtf8(name);
}

// The bytes that the file's text stands for.
std::string UnescapeFromFile(std::string_view text) {
    if (text.find('\xEE') == std::string_view::npos) return std::string(text);
    std::string out;
    out.reserve(text.size());
    for (std::size_t i = 0; i < text.size(); ++i) {
        const auto c = static_cast<std::uint8_t>(text[i]);
        if (c == 0xEE && i + 2 < text.size()) {
            const auto second = static_cast<std::uint8_t>(text[i + 1]);
            const auto third = static_cast<std::uint8_t>(text[i + 2]);
            if (second >= 0xBC && second <= 0xBF && (third & 0xC0) == 0x80) {
                out += static_cast<char>(((second & 0x03) << 6) | (third & 0x3F));
                i += 2;
                continue;
            }
        }
        out += static_cast<char>(c);
    }
    return out;
}

// UTF-8 back to Windows-1252, for a file that was read in that code page; nothing when the text holds a
// character the code page lacks. The five holes of the code page come back from the C1 controls they
// were read as.
std::optional<std::string> Utf8ToWindows1252(std::string_view text) {
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
        if (*p < 0x80) {
            out += static_cast<char>(*p++);
            continue;
        }
        char32_t cp = 0;
        const std::size_t length = Utf8Sequence(p, end, cp);
        if (length == 0) return std::nullopt;
        p += length;
        if (cp >= 0xA0 && cp <= 0xFF) {
            out += static_cast<char>(cp);
            continue;
        }
        const auto* found = std::find(std::begin(kHighHalf), std::end(kHighHalf), cp);
        if (found == std::end(kHighHalf)) return std::nullopt;
        out += static_cast<char>(0x80 + (found - std::begin(kHighHalf)));
    }
    return out;
}

// A value quoted twice ("\"C:\\a.geo\"" between quotes) loses one pair when read, and would lose the
// second when written back and read again: its first inner quote is escaped, so that it reads the same
// every time.
std::string KeepInnerQuotes(std::string_view line) {
    const std::size_t equals = line.find('=');
    std::string_view value = line.substr(equals + 1);
    const std::size_t first = value.find_first_not_of(" \t");
    if (first == std::string_view::npos) return std::string(line);
    value = value.substr(first, value.find_last_not_of(" \t") - first + 1);
    auto quoted = [](std::string_view text) {
        return text.size() >= 2 && text.front() == '"' && text.back() == '"';
    };
    if (!quoted(value) || !quoted(value.substr(1, value.size() - 2))) return std::string(line);
    std::string kept(line.substr(0, equals + 1));
    AppendEscapedByte(kept, '"');
    kept.append(value.substr(2, value.size() - 3));
    return kept;
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

    // The library holds the file from its first section or key line to its last. The lines before the
    // first are in `leading`, written back as they are before everything (the library would take a
    // comment there for the file's or for the first section's depending on the blank lines around it,
    // and write it back otherwise); of a file with no section or key, that is every line, and what is
    // added comes after a blank line. The comment, blank and stray lines after the last section or key
    // line are in `trailing`, written back after everything.
    CSimpleIniA ini;
    std::string leading;
    bool anyEntry = false;
    std::string trailing;
    bool windows1252 = false;
    bool byteOrderMark = false;
    bool crlf = kNewFileCrlf;
};

IniFile::IniFile() : impl_(std::make_unique<Impl>()) {}
IniFile::~IniFile() = default;
IniFile::IniFile(IniFile&&) noexcept = default;
IniFile& IniFile::operator=(IniFile&&) noexcept = default;

// Control characters that a hand-edited file may hold and still be text (see IsParamFileText): a count,
// not a rate, so that a file written from a text one, holding no more of them, is text too.
constexpr std::size_t kMostStrayControls = 8;

bool IsParamFileText(std::string_view bytes) {
    std::size_t controls = 0;
    for (const char c : bytes) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte == 0) return false;
        const bool textControl =
            byte == '\t' || byte == '\n' || byte == '\v' || byte == '\f' || byte == '\r' || byte == 0x1A;
        if ((byte < 0x20 && !textControl) || byte == 0x7F) ++controls;
    }
    return controls <= kMostStrayControls;
}

int IniFile::Load(const std::string& path) {
    std::string bytes;
    if (!ReadWholeFile(path, bytes)) {
        const int code = errno != 0 ? errno : EIO;
        Parse({});
        return code;
    }
    if (!IsParamFileText(bytes)) {
        Parse({});
        return kNotParamText;
    }
    Parse(bytes);
    return 0;
}

void IniFile::Parse(std::string_view bytes) {
    impl_ = std::make_unique<Impl>();
    Impl& d = *impl_;
    d.byteOrderMark = bytes.starts_with(kByteOrderMark);
    std::string text = FileBytesToUtf8(bytes, &d.windows1252);
    // No text holds a NUL, and the library would stop reading at the first: one stands for its escape.
    if (text.find('\0') != std::string::npos) {
        std::string escapedNul;
        AppendEscapedByte(escapedNul, 0);
        std::string withoutNul;
        for (const char c : text) {
            if (c == '\0')
                withoutNul += escapedNul;
            else
                withoutNul += c;
        }
        text = std::move(withoutNul);
    }
    if (text.find('\n') != std::string::npos || text.find('\r') != std::string::npos)
        d.crlf = text.find("\r\n") != std::string::npos;

    std::string head;
    std::string pendingMarked; // the lines since the last section or key line, strays marked
    std::string pendingRaw;    // the same lines as they are
    ForEachLine(text, [&](std::string_view line, int) {
        const LineKind kind = Classify(line);
        const bool entry = kind == LineKind::Section || kind == LineKind::Entry;
        if (!entry && !d.anyEntry) {
            d.leading.append(line);
            d.leading += '\n';
            return;
        }
        if (entry) {
            head += pendingMarked;
            if (kind == LineKind::Entry)
                head += KeepInnerQuotes(line);
            else
                head.append(line);
            head += '\n';
            pendingMarked.clear();
            pendingRaw.clear();
            d.anyEntry = true;
            return;
        }
        if (kind == LineKind::Stray || StartsWithStrayMark(line)) pendingMarked += kStrayMark;
        pendingMarked.append(line);
        pendingMarked += '\n';
        pendingRaw.append(line);
        pendingRaw += '\n';
    });
    d.trailing = std::move(pendingRaw);
    // The library takes a mark at the very start of what it is given for the file's own and drops it:
    // the file's mark is gone already, so these bytes open a key, and a line end before them keeps them.
    if (head.starts_with(kByteOrderMark)) head.insert(0, "\n");
    d.ini.LoadData(head.data(), head.size());
}

bool IniFile::HasSection(std::string_view section) const {
    return impl_->ini.GetSection(NameText(section).c_str()) != nullptr;
}

bool IniFile::Get(std::string_view section, std::string_view key, std::string& value) const {
    const char* found = impl_->ini.GetValue(NameText(section).c_str(), NameText(key).c_str(), nullptr);
    if (!found) return false;
    value = UnescapeFromFile(found);
    return true;
}

void IniFile::Set(std::string_view section, std::string_view key, std::string_view value) {
    const std::string sectionText = NameText(section);
    std::string keyText = NameText(key);
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
    // The library quotes a value with blanks around it, and takes a pair of quotes off any value it
    // reads: the first quote of a value that is itself quoted is escaped, so that it keeps both.
    std::string valueText = EscapeForFile(value);
    if (valueText.size() >= 2 && valueText.front() == '"' && valueText.back() == '"') {
        std::string escapedQuote;
        AppendEscapedByte(escapedQuote, '"');
        valueText.replace(0, 1, escapedQuote);
    }
    impl_->ini.SetValue(sectionText.c_str(), keyText.c_str(), valueText.c_str(), nullptr,
                        /*forceReplace*/ true);
}

std::vector<IniFile::Entry> IniFile::Entries() const {
    std::vector<Entry> entries;
    CSimpleIniA::TNamesDepend sections;
    impl_->ini.GetAllSections(sections);
    sections.sort(CSimpleIniA::Entry::LoadOrder());
    for (const auto& section : sections) {
        CSimpleIniA::TNamesDepend keys;
        impl_->ini.GetAllKeys(section.pItem, keys);
        keys.sort(CSimpleIniA::Entry::LoadOrder());
        for (const auto& key : keys) {
            CSimpleIniA::TNamesDepend values;
            impl_->ini.GetAllValues(section.pItem, key.pItem, values);
            values.sort(CSimpleIniA::Entry::LoadOrder());
            for (const auto& value : values)
                entries.push_back({section.pItem, key.pItem, UnescapeFromFile(value.pItem)});
        }
    }
    return entries;
}

std::string IniFile::Bytes() const {
    const Impl& d = *impl_;
    std::string output;
    d.ini.Save(output, /*addSignature*/ false);

    std::string text = d.leading;
    if (!d.anyEntry && !d.leading.empty() && !output.empty()) text += '\n';
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
    // Back in its code page, unless a character has no place there, or the bytes that made the file
    // not UTF-8 are gone (a value replaced): read as UTF-8, it would then change. UTF-8 keeps it all.
    if (d.windows1252) {
        auto inCodePage = Utf8ToWindows1252(text);
        if (inCodePage && (*inCodePage == text || !IsValidUtf8(*inCodePage))) text = std::move(*inCodePage);
    }
    // A file whose first key opens with the bytes of the mark (the blanks before them dropped) gets a mark
    // of its own: the next reading takes the first mark for the file's and keeps the key whole.
    if (d.byteOrderMark || text.starts_with(kByteOrderMark)) text.insert(0, kByteOrderMark);
    return text;
}

int IniFile::Save(const std::string& path) const {
    return ReplaceFileContents(path, Bytes());
}

// --- Parameter files that are not text ---------------------------------------------------------------

namespace {

// The files already said not to be text, for the life of the program: every command reads many values,
// and the person is told once. The host's one thread makes every call, so no lock.
std::set<std::string>& ToldUnreadable() {
    static std::set<std::string> told;
    return told;
}

// Renames `from` to `to` unless a file already holds that name (EEXIST then), in one step where the file
// system can.
int RenameWithoutReplacing(const std::string& from, const std::string& to) {
#ifdef RENAME_NOREPLACE
    if (renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE) == 0) return 0;
    if (errno != EINVAL && errno != ENOSYS && errno != ENOTSUP) return errno;
#endif
    struct stat info {};
    if (lstat(to.c_str(), &info) == 0) return EEXIST;
    return std::rename(from.c_str(), to.c_str()) == 0 ? 0 : errno;
}

} // namespace

std::string FreeAsideName(const std::string& path) {
    for (int number = 1;; ++number) {
        std::string name = path + ".illisible";
        if (number > 1) name += "." + std::to_string(number);
        struct stat info {};
        if (lstat(name.c_str(), &info) != 0) return name;
    }
}

int LoadParamFileToRead(IniFile& file, const std::string& path) {
    const int code = file.Load(path);
    if (code == kNotParamText && ToldUnreadable().insert(path).second)
        ShowParamMessage(nullptr, Sprintf(kMsgParamFileNotText, path.c_str()));
    return code;
}

int LoadParamFileToWrite(IniFile& file, const std::string& path) {
    const int code = file.Load(path);
    if (code != kNotParamText) return code;
    // Another program may take the free name between the look and the move: the next one is tried.
    for (int attempt = 0; attempt < 100; ++attempt) {
        const std::string aside = FreeAsideName(path);
        const int moved = RenameWithoutReplacing(path, aside);
        if (moved == EEXIST) continue;
        if (moved != 0) return moved;
        ToldUnreadable().erase(path);
        ShowParamMessage(nullptr, Sprintf(kMsgParamFileSetAside, path.c_str(), aside.c_str()));
        return ENOENT;
    }
    return EEXIST;
}

void ForgetUnreadableParamFiles() {
    ToldUnreadable().clear();
}

} // namespace pyr
