#include "fieldbook/TableCodeWords.h"

#include "geobase/Kinds.h"

#include <unordered_map>

namespace pyr {

namespace {

constexpr bool IsBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\v' || c == '\f';
}

// In UTF-8 the letters of Latin-1 are 0xC3 followed by 0x80 to 0xBF: upper case up to 0x9E, lower case
// from 0x9F (ß), apart from × (0x97) and ÷ (0xB7). Œ, œ and Ÿ are 0xC5 0x92, 0x93 and 0xB8.
constexpr unsigned char kLatin1Lead = 0xC3;
constexpr unsigned char kLatinExtendedLead = 0xC5;

enum class LetterCase { None, Upper, Lower };

LetterCase CaseAt(std::string_view text, std::size_t index, std::size_t& length) {
    length = 1;
    const auto c = static_cast<unsigned char>(text[index]);
    if (c >= 'A' && c <= 'Z') return LetterCase::Upper;
    if (c >= 'a' && c <= 'z') return LetterCase::Lower;
    if (index + 1 >= text.size()) return LetterCase::None;
    const auto next = static_cast<unsigned char>(text[index + 1]);
    if (c == kLatin1Lead && next >= 0x80 && next <= 0xBF) {
        length = 2;
        if (next == 0x97 || next == 0xB7) return LetterCase::None;
        return next <= 0x9E ? LetterCase::Upper : LetterCase::Lower;
    }
    if (c == kLatinExtendedLead && (next == 0x92 || next == 0xB8)) {
        length = 2;
        return LetterCase::Upper;
    }
    if (c == kLatinExtendedLead && next == 0x93) {
        length = 2;
        return LetterCase::Lower;
    }
    return LetterCase::None;
}

// The letter without its accent for each upper-case letter of Latin-1 (0xC3 0x80 to 0x9E), '\0' for
// the letters that have no plain form (Æ, Ð, Þ) and for ×.
constexpr char kPlainLetters[] = "AAAAAA\0CEEEEIIII\0NOOOOO\0OUUUUY\0";

} // namespace

std::size_t SplitWords(std::string_view text, std::vector<std::string>& words) {
    std::size_t count = 0;
    std::size_t i = 0;
    const std::size_t size = text.size();
    for (;;) {
        while (i < size && IsBlank(text[i]))
            ++i;
        if (i >= size) break;
        std::size_t start = i;
        std::size_t end = 0;
        if (text[i] == '"') {
            start = i + 1;
            end = text.find('"', start);
            if (end == std::string_view::npos) end = size;
            i = end < size ? end + 1 : size;
        } else {
            while (i < size && !IsBlank(text[i]))
                ++i;
            end = i;
        }
        const std::string_view word = text.substr(start, end - start);
        if (count < words.size())
            words[count].assign(word);
        else
            words.emplace_back(word);
        ++count;
    }
    words.resize(count);
    return count;
}

std::size_t CommentStart(std::string_view line) {
    bool wordStart = true;
    for (std::size_t i = 0; i < line.size(); ++i) {
        const char c = line[i];
        if (IsBlank(c)) {
            wordStart = true;
        } else if (c == ';') {
            return i;
        } else if (wordStart && c == '"') {
            i = line.find('"', i + 1);
            if (i == std::string_view::npos) return i;
        } else {
            wordStart = false;
        }
    }
    return std::string_view::npos;
}

void AppendWord(std::string& line, std::string_view word) {
    if (!line.empty()) line += ' ';
    bool quoted = word.empty();
    for (char c : word)
        quoted = quoted || IsBlank(c) || c == ';';
    if (quoted) line += '"';
    line += word;
    if (quoted) line += '"';
}

std::string CodeKey(std::string_view code) {
    std::string key;
    key.reserve(code.size());
    for (std::size_t i = 0; i < code.size(); ++i) {
        const auto c = static_cast<unsigned char>(code[i]);
        const auto next = i + 1 < code.size() ? static_cast<unsigned char>(code[i + 1]) : 0;
        if (c >= 'a' && c <= 'z') {
            key += static_cast<char>(c - 'a' + 'A');
        } else if (c == kLatin1Lead && next >= 0xA0 && next <= 0xBE && next != 0xB7) {
            key += code[i];
            key += static_cast<char>(next - 0x20);
            ++i;
        } else if (c == kLatin1Lead && next == 0xBF) {
            key += "\xC5\xB8"; // ÿ
            ++i;
        } else if (c == kLatinExtendedLead && next == 0x93) {
            key += "\xC5\x92"; // œ
            ++i;
        } else {
            key += code[i];
        }
    }
    return key;
}

std::string CommandKey(std::string_view word) {
    const std::string upper = CodeKey(word);
    std::string key;
    key.reserve(upper.size());
    for (std::size_t i = 0; i < upper.size(); ++i) {
        const auto c = static_cast<unsigned char>(upper[i]);
        const auto next = i + 1 < upper.size() ? static_cast<unsigned char>(upper[i + 1]) : 0;
        if (c == kLatin1Lead && next >= 0x80 && next <= 0x9E && kPlainLetters[next - 0x80] != '\0') {
            key += kPlainLetters[next - 0x80];
            ++i;
        } else if (c == kLatinExtendedLead && next == 0x92) {
            key += "OE";
            ++i;
        } else if (c == kLatinExtendedLead && next == 0xB8) {
            key += 'Y';
            ++i;
        } else {
            key += upper[i];
        }
    }
    return key;
}

std::string_view InterpretedCommandWord(std::string_view word) {
    static const std::unordered_map<std::string, std::string_view> words = [] {
        std::unordered_map<std::string, std::string_view> all;
        for (std::string_view eccentric : {kExcentRad, kExcentTan, kExcentVer})
            all.emplace(CommandKey(eccentric), eccentric);
        for (int kind = kKindExcentrement + 1; kind <= kKindLastCommand; ++kind)
            all.emplace(CommandKey(CommandWord(kind)), CommandWord(kind));
        return all;
    }();
    const auto found = words.find(CommandKey(word));
    return found == words.end() ? std::string_view{} : found->second;
}

bool IsUpperCaseLetterAt(std::string_view text, std::size_t index, std::size_t& length) {
    return CaseAt(text, index, length) == LetterCase::Upper;
}

bool IsLowerCaseLetterAt(std::string_view text, std::size_t index, std::size_t& length) {
    return CaseAt(text, index, length) == LetterCase::Lower;
}

} // namespace pyr
