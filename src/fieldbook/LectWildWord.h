#pragma once

#include <array>
#include <cstddef>
#include <string_view>

// The words of a Wild / Leica GSI block. A line is one block: words, each followed by a blank, made of
// a word index (two digits, three for the levelling readings 330-339, 390-399 and 560-579), then what
// the instrument adds (positions 3 to 6: the block number in words 11 and 41; otherwise a reserved
// place, the automatic index, the input mode and the unit digit), a sign at position 7, and 8 data
// characters (GSI-8) or 16 (GSI-16, a line starting with '*'), right-justified and padded with zeros.
// The words are cut by their sign, so that a word whose header was shortened is read all the same, and
// by their width, so that a point id holding blanks stays whole.
namespace pyr::gsi {

struct Word {
    int index = 0;         // 11, 21, 331 ...
    std::string_view info; // the header after the index: block number, or reserved, index, mode, unit
    char unit = 0;         // the unit digit ('0' to '8') at position 6, 0 when the header holds none
    char sign = '+';
    std::string_view data; // the data characters as written, blanks and padding kept
    std::string_view text; // the whole word, for the messages
};

// More words than a block of any instrument holds; a line with more is not a block.
inline constexpr std::size_t kMaxWords = 40;

struct Block {
    bool gsi16 = false;
    std::array<Word, kMaxWords> words;
    std::size_t count = 0;

    const Word* begin() const { return words.data(); }
    const Word* end() const { return words.data() + count; }
};

// Cuts a line into its words. False when a word cannot be read (no word index, no sign where the
// header ends, too many words): `bad` then views what could not be read.
bool SplitBlock(std::string_view line, Block& block, std::string_view& bad);

} // namespace pyr::gsi
