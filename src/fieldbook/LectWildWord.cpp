#include "fieldbook/LectWildWord.h"

namespace pyr::gsi {

namespace {

constexpr std::size_t kHeaderLength = 6; // index and information, before the sign
constexpr std::size_t kDataGsi8 = 8;
constexpr std::size_t kDataGsi16 = 16;

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}
bool IsBlank(char c) {
    return c == ' ' || c == '\t';
}
bool IsSign(char c) {
    return c == '+' || c == '-';
}

// Whether the first three digits of a header are one of the three-digit word indices: the staff
// readings and differences of the levelling instruments. Words 11 and 41 carry a block number there.
bool IsThreeDigitIndex(int index) {
    return (index >= 330 && index <= 339) || (index >= 390 && index <= 399) || (index >= 560 && index <= 579);
}

// Reads the header (what stands before the sign) into the word; false when it is no header.
bool ReadHeader(std::string_view header, Word& word) {
    if (header.size() < 2 || !IsDigit(header[0]) || !IsDigit(header[1])) return false;
    for (char c : header)
        if (!IsDigit(c) && c != '.') return false;
    int index = (header[0] - '0') * 10 + (header[1] - '0');
    std::size_t length = 2;
    if (index != 11 && index != 41 && header.size() > 2 && IsDigit(header[2]) &&
        IsThreeDigitIndex(index * 10 + (header[2] - '0'))) {
        index = index * 10 + (header[2] - '0');
        length = 3;
    }
    word.index = index;
    word.info = header.substr(length);
    // The unit digit stands at position 6; a shortened header ends with it when it gives one.
    word.unit = 0;
    if (!word.info.empty() && IsDigit(header.back()) && index != 11 && index != 41) word.unit = header.back();
    return true;
}

// Whether a word begins at `position`: a header of two to six digits and dots, then its sign.
bool StartsWord(std::string_view line, std::size_t position) {
    std::size_t sign = position;
    while (sign < line.size() && sign - position <= kHeaderLength &&
           (IsDigit(line[sign]) || line[sign] == '.'))
        ++sign;
    return sign - position >= 2 && sign < line.size() && IsSign(line[sign]) && IsDigit(line[position]) &&
           IsDigit(line[position + 1]);
}

// The end of the data that starts at `start`: its full width when a blank or the end of the line
// follows (a point id may hold blanks). Otherwise (a shortened word, the last word of a line whose
// blanks were cut) the first blank that another word follows, or the end of the line.
std::size_t DataEnd(std::string_view line, std::size_t start, std::size_t width) {
    const std::size_t full = start + width;
    if (full <= line.size() && (full == line.size() || IsBlank(line[full]))) return full;
    for (std::size_t blank = start; blank < line.size(); ++blank) {
        if (!IsBlank(line[blank])) continue;
        std::size_t next = blank;
        while (next < line.size() && IsBlank(line[next]))
            ++next;
        if (next == line.size() || StartsWord(line, next)) return blank;
    }
    return line.size();
}

} // namespace

bool SplitBlock(std::string_view line, Block& block, std::string_view& bad) {
    block.count = 0;
    block.gsi16 = !line.empty() && line.front() == '*';
    const std::size_t width = block.gsi16 ? kDataGsi16 : kDataGsi8;
    std::size_t position = block.gsi16 ? 1 : 0;
    const std::size_t size = line.size();
    while (true) {
        while (position < size && IsBlank(line[position]))
            ++position;
        if (position >= size) {
            // A GSI-16 block that lost its star still has its 16-character words.
            if (block.count > 0 && block.words[0].data.size() == kDataGsi16) block.gsi16 = true;
            return true;
        }
        const std::size_t start = position;
        const auto readsAsHeader = [&](std::size_t sign) {
            return block.count < kMaxWords && sign < size && IsSign(line[sign]) &&
                   ReadHeader(line.substr(start, sign - start), block.words[block.count]);
        };
        // The sign stands at position 7, or earlier after a shortened header.
        std::size_t sign = start + kHeaderLength;
        if (!readsAsHeader(sign)) {
            sign = start;
            while (sign < size && sign - start <= kHeaderLength && !IsSign(line[sign]) &&
                   !IsBlank(line[sign]))
                ++sign;
            if (!readsAsHeader(sign)) {
                std::size_t end = start;
                while (end < size && !IsBlank(line[end]))
                    ++end;
                bad = line.substr(start, end - start);
                return false;
            }
        }
        Word& word = block.words[block.count];
        word.sign = line[sign];
        const std::size_t end = DataEnd(line, sign + 1, width);
        word.data = line.substr(sign + 1, end - sign - 1);
        word.text = line.substr(start, end - start);
        ++block.count;
        position = end;
    }
}

} // namespace pyr::gsi
