#include "TextEncoding.h"

#include <bit>
#include <cstdint>
#include <cstring>

namespace pyr {

namespace {

// Code points of 0x80..0x9F in Windows-1252; the five holes of the code page map to the C1 controls
// of the same number, as Windows itself does, so that no byte is ever lost.
constexpr char16_t kHighHalf[32] = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178,
};

void AppendUtf8(std::string& out, char32_t cp) {
    if (cp < 0x80) {
        out += static_cast<char>(cp);
    } else if (cp < 0x800) {
        out += static_cast<char>(0xC0 | (cp >> 6));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    } else {
        out += static_cast<char>(0xE0 | (cp >> 12));
        out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    }
}

} // namespace

bool IsValidUtf8(std::string_view bytes) {
    const auto* p = reinterpret_cast<const std::uint8_t*>(bytes.data());
    const auto* end = p + bytes.size();
    while (p < end) {
        // Runs of ASCII, the bulk of every file, eight bytes at a time.
        while (end - p >= 8) {
            std::uint64_t word;
            std::memcpy(&word, p, sizeof word);
            if (word & 0x8080808080808080ULL) break;
            p += 8;
        }
        if (p == end) break;
        std::uint8_t c = *p;
        if (c < 0x80) {
            ++p;
            continue;
        }
        int extra;
        char32_t cp;
        if (c >= 0xC2 && c <= 0xDF) {
            extra = 1;
            cp = c & 0x1F;
        } else if (c >= 0xE0 && c <= 0xEF) {
            extra = 2;
            cp = c & 0x0F;
        } else if (c >= 0xF0 && c <= 0xF4) {
            extra = 3;
            cp = c & 0x07;
        } else {
            return false;
        }
        if (end - p <= extra) return false;
        for (int i = 1; i <= extra; ++i) {
            if ((p[i] & 0xC0) != 0x80) return false;
            cp = (cp << 6) | (p[i] & 0x3F);
        }
        // Overlong forms, surrogates and code points past U+10FFFF are not UTF-8.
        if ((extra == 2 && cp < 0x800) || (extra == 3 && (cp < 0x10000 || cp > 0x10FFFF)) ||
            (cp >= 0xD800 && cp <= 0xDFFF))
            return false;
        p += extra + 1;
    }
    return true;
}

std::string Windows1252ToUtf8(std::string_view bytes) {
    std::string out;
    out.reserve(bytes.size() + bytes.size() / 8);
    for (char ch : bytes) {
        auto c = static_cast<std::uint8_t>(ch);
        if (c < 0x80)
            out += ch;
        else if (c < 0xA0)
            AppendUtf8(out, kHighHalf[c - 0x80]);
        else
            AppendUtf8(out, c);
    }
    return out;
}

std::string FileBytesToUtf8(std::string_view bytes, bool* wasWindows1252) {
    if (bytes.substr(0, 3) == "\xEF\xBB\xBF") bytes.remove_prefix(3);
    bool ansi = !IsValidUtf8(bytes);
    if (wasWindows1252) *wasWindows1252 = ansi;
    return ansi ? Windows1252ToUtf8(bytes) : std::string(bytes);
}

std::size_t FindNonAscii(std::string_view bytes) {
    std::size_t i = 0;
    for (; i + 8 <= bytes.size(); i += 8) {
        std::uint64_t word;
        std::memcpy(&word, bytes.data() + i, 8);
        if ((word & 0x8080808080808080u) != 0) break;
    }
    for (; i < bytes.size(); ++i)
        if (static_cast<unsigned char>(bytes[i]) >= 0x80) return i;
    return std::string_view::npos;
}

std::size_t Utf8Length(std::string_view text) {
    // Every byte but the continuation bytes (10xxxxxx) starts a character; counted eight at a time, since
    // a listing measures millions of texts.
    std::size_t length = text.size(), i = 0;
    for (; i + 8 <= text.size(); i += 8) {
        std::uint64_t bytes = 0;
        std::memcpy(&bytes, text.data() + i, 8);
        // The high bit of each continuation byte, summed by one multiplication (a bit count is a call
        // into the runtime on processors that are not assumed to count bits).
        const std::uint64_t continuations = (bytes & ~(bytes << 1) & 0x8080808080808080u) >> 7;
        length -= static_cast<std::size_t>((continuations * 0x0101010101010101u) >> 56);
    }
    for (; i < text.size(); ++i)
        if ((static_cast<std::uint8_t>(text[i]) & 0xC0) == 0x80) --length;
    return length;
}

std::string PadRight(std::string_view text, int width) {
    std::string padded(text);
    std::size_t length = Utf8Length(text);
    if (width > 0 && length < static_cast<std::size_t>(width))
        padded.append(static_cast<std::size_t>(width) - length, ' ');
    return padded;
}

} // namespace pyr
