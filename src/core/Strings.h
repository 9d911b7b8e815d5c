#pragma once

#include <cstdarg>
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

// Without the blanks (spaces, tabulations, line ends) at both ends.
std::string_view Trimmed(std::string_view text);
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
