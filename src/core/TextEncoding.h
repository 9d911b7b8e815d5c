#pragma once

#include <cstddef>
#include <string>
#include <string_view>

// Texts are UTF-8 in memory. Files written on Windows machines come in Windows-1252: a file that is
// not valid UTF-8 is taken as Windows-1252 and converted, so that its accents survive.
namespace pyr {

bool IsValidUtf8(std::string_view bytes);

// Where the first byte outside ASCII stands in `bytes`, or npos; looked for eight bytes at a time.
std::size_t FindNonAscii(std::string_view bytes);
inline bool IsAscii(std::string_view bytes) {
    return FindNonAscii(bytes) == std::string_view::npos;
}

std::string Windows1252ToUtf8(std::string_view bytes);

// UTF-8 text out of a file's bytes: a leading UTF-8 byte-order mark is dropped; bytes that are not
// valid UTF-8 are read as Windows-1252. `wasWindows1252`, when given, tells which reading was taken.
std::string FileBytesToUtf8(std::string_view bytes, bool* wasWindows1252 = nullptr);

// The number of characters of a UTF-8 text (not of its bytes).
std::size_t Utf8Length(std::string_view text);
// The text followed by blanks up to `width` characters, for columns of French words ("Référence").
std::string PadRight(std::string_view text, int width);

} // namespace pyr
