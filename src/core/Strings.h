#pragma once

#include <cstdarg>
#include <cstdint>
#include <cstring>
#include <functional>
#include <initializer_list>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace pyr {

// printf into a string, for the program's messages (their formats are given as they stand), always with
// the C locale's decimal point.
std::string Sprintf(const char* format, ...) __attribute__((format(printf, 1, 2)));
std::string VSprintf(const char* format, std::va_list args) __attribute__((format(printf, 1, 0)));

// Without the blanks (spaces, tabulations, line ends) at both ends. Inline: the readers trim every field of
// a million lines.
inline std::string_view Trimmed(std::string_view text) {
    const auto blank = [](char c) { return c == ' ' || (c >= '\t' && c <= '\r'); };
    while (!text.empty() && blank(text.front()))
        text.remove_prefix(1);
    while (!text.empty() && blank(text.back()))
        text.remove_suffix(1);
    return text;
}

// Where the first of `controls` (characters below a blank, as the end of a transmission) stands in
// `text`, or npos: in one pass, where find_first_of would search the set for every character.
inline std::size_t FindControl(std::string_view text, std::string_view controls) {
    constexpr std::uint64_t kOnes = 0x0101010101010101u;
    std::size_t i = 0;
    const auto isControl = [&](char c) {
        return static_cast<unsigned char>(c) < ' ' && controls.find(c) != std::string_view::npos;
    };
    // Eight bytes at a time past those that hold no character below a blank.
    for (std::uint64_t word; i + 8 <= text.size(); i += 8) {
        std::memcpy(&word, text.data() + i, 8);
        if (((word - ' ' * kOnes) & ~word & 0x80 * kOnes) != 0)
            for (std::size_t j = i; j < i + 8; ++j)
                if (isControl(text[j])) return j;
    }
    for (; i < text.size(); ++i)
        if (isControl(text[i])) return i;
    return std::string_view::npos;
}
// Without the blanks and control characters at both ends: those of a line end and of a transmission
// (STX, ETX, EOT, Ctrl-Z, DEL) that a download leaves around a record.
std::string_view TrimmedOfControls(std::string_view text);

// Names compared as Windows compares file names, keys and command words: ASCII letters without regard
// to case, every other byte as it is.
bool EqualIgnoringCase(std::string_view a, std::string_view b);

// Whether `word` is one of `words`, compared as EqualIgnoringCase does.
bool IsAnyOf(std::string_view word, const std::vector<std::string>& words);
bool IsAnyOf(std::string_view word, std::initializer_list<std::string_view> words);

// A set of names that is searched with a string_view, without making a string of it.
struct TextHash {
    using is_transparent = void;
    std::size_t operator()(std::string_view text) const { return std::hash<std::string_view>{}(text); }
};
using TextSet = std::unordered_set<std::string, TextHash, std::equal_to<>>;

} // namespace pyr
