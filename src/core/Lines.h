#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace pyr {

// The first CR or LF of [p, end), or end. Eight bytes are looked at together: a line of a field book is
// tens of bytes without an end, and going byte by byte was the slowest part of cutting a big file.
inline const char* FindLineEnd(const char* p, const char* end) {
    constexpr std::uint64_t kOnes = 0x0101010101010101ULL;
    constexpr std::uint64_t kHighs = 0x8080808080808080ULL;
    while (end - p >= 8) {
        std::uint64_t word;
        std::memcpy(&word, p, 8);
        // A byte below 0x0E sets its high bit here (and no word without one does): CR and LF are among
        // them, and so are the tabulations, told apart byte by byte.
        if (((word - 0x0E * kOnes) & ~word & kHighs) != 0)
            for (int i = 0; i < 8; ++i)
                if (p[i] == '\n' || p[i] == '\r') return p + i;
        p += 8;
    }
    while (p < end && *p != '\n' && *p != '\r')
        ++p;
    return p;
}

// Calls f(line, number) for every line of the text, numbered from 1, without its end. LF, CRLF and a
// lone CR all end a line; a last line without an end is still a line, an empty text has none.
template <class F>
void ForEachLine(std::string_view text, F&& f) {
    int number = 0;
    const char* start = text.data();
    const char* const end = start + text.size();
    while (start < end) {
        const char* lineEnd = FindLineEnd(start, end);
        f(std::string_view(start, static_cast<std::size_t>(lineEnd - start)), ++number);
        if (lineEnd < end && *lineEnd == '\r' && lineEnd + 1 < end && lineEnd[1] == '\n') ++lineEnd;
        start = lineEnd + 1;
    }
}

} // namespace pyr
