#include "core/Strings.h"

#include <clocale>
#include <cstdio>
#include <locale.h>

namespace pyr {

std::string Sprintf(const char* format, ...) {
    std::va_list args;
    va_start(args, format);
    std::string text = VSprintf(format, args);
    va_end(args);
    return text;
}

std::string VSprintf(const char* format, std::va_list args) {
    // The C locale for the length of the call, on this thread only: "%f" writes '.' whatever the
    // user's LC_NUMERIC, and the process's locale is left as it is.
    static const locale_t cLocale = newlocale(LC_ALL_MASK, "C", nullptr);
    const locale_t previous = cLocale ? uselocale(cLocale) : nullptr;
    std::va_list again;
    va_copy(again, args);
    // Most texts are a line: formed once on the stack, formed again only when longer.
    char line[256];
    const int size = std::vsnprintf(line, sizeof line, format, args);
    std::string text;
    if (size > 0 && static_cast<std::size_t>(size) < sizeof line) {
        text.assign(line, static_cast<std::size_t>(size));
    } else if (size > 0) {
        text.resize(static_cast<std::size_t>(size));
        std::vsnprintf(text.data(), text.size() + 1, format, again);
    }
    va_end(again);
    if (previous) uselocale(previous);
    return text;
}

std::string_view TrimmedOfControls(std::string_view text) {
    auto control = [](char c) { return static_cast<unsigned char>(c) <= ' ' || c == '\x7f'; };
    while (!text.empty() && control(text.front()))
        text.remove_prefix(1);
    while (!text.empty() && control(text.back()))
        text.remove_suffix(1);
    return text;
}

bool EqualIgnoringCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; };
    for (std::size_t i = 0; i < a.size(); ++i)
        if (lower(a[i]) != lower(b[i])) return false;
    return true;
}

namespace {
template <class Words>
bool AnyEqualIgnoringCase(std::string_view word, const Words& words) {
    for (const auto& candidate : words)
        if (EqualIgnoringCase(candidate, word)) return true;
    return false;
}
} // namespace

bool IsAnyOf(std::string_view word, const std::vector<std::string>& words) {
    return AnyEqualIgnoringCase(word, words);
}

bool IsAnyOf(std::string_view word, std::initializer_list<std::string_view> words) {
    return AnyEqualIgnoringCase(word, words);
}

} // namespace pyr
