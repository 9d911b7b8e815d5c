#pragma once

#include <cstddef>
#include <string_view>

namespace pyr {

// Calls f(line, number) for every line of the text, numbered from 1, without its end. LF, CRLF and a
// lone CR all end a line; a last line without an end is still a line, an empty text has none.
template <class F>
void ForEachLine(std::string_view text, F&& f) {
    int number = 0;
    std::size_t start = 0;
    const std::size_t size = text.size();
    while (start < size) {
        std::size_t end = start;
        while (end < size && text[end] != '\n' && text[end] != '\r')
            ++end;
        f(text.substr(start, end - start), ++number);
        if (end < size && text[end] == '\r' && end + 1 < size && text[end + 1] == '\n') ++end;
        start = end + 1;
    }
}

} // namespace pyr
