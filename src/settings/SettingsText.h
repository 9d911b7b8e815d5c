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

} // namespace pyr
