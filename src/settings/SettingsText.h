#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace pyr {

// Cuts a text read into a fixed buffer of `bufferSize` bytes, its end of text included, as such a buffer
// would: to bufferSize - 1 bytes at most, moved back so as not to split a UTF-8 character.
inline void CutToValueBuffer(std::string& text, std::size_t bufferSize) {
    if (bufferSize == 0 || text.size() < bufferSize) return;
    std::size_t cut = bufferSize - 1;
    while (cut > 0 && (static_cast<unsigned char>(text[cut]) & 0xC0) == 0x80)
        --cut;
    text.resize(cut);
}

// Names of files, registry roots and keys compared as the system compares them: ASCII letters without
// regard to case, every other byte as it is.
inline bool EqualIgnoringCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; };
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (lower(a[i]) != lower(b[i])) return false;
    }
    return true;
}

} // namespace pyr
