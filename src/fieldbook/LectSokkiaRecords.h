#pragma once

#include <array>
#include <cstdint>
#include <string_view>

// The fixed-width records of the SDR field books, as text: which field lies where. SDR33 writes its
// point identifiers and its reals on 16 characters, SDR2x its identifiers on 4 and its reals on 10 (two
// reals may touch: only the positions separate them). A real is an optional '-', digits and an optional
// '.', padded with blanks; a field of blanks is a value the instrument did not record.
namespace pyr::sdr {

enum class Variant { Sdr2x, Sdr33 };

// What each field of a record holds, in its order from column 5.
enum class FieldKind : std::uint8_t {
    Id,   // a point identifier
    Real, // a number
    Text  // a description (16 characters) or a note (60): to the end of the line
};

// The layout of the records that carry fields (02, 03, 07, 08, 09, 13), by their two-digit type.
struct Layout {
    int count = 0;
    std::array<FieldKind, 6> kinds{};
    int textWidth = 0; // the width of the last field when it is a text
};
// The layout of a record type, or null for a type read otherwise (00, 01, 04, 05, 06, 10) or unknown.
const Layout* LayoutOf(std::string_view type);

// The length of a whole record of that layout in that variant (the last text field at its full width).
int RecordLength(const Layout& layout, Variant variant);

// Splits a record into its fields, each trimmed of its blanks (an empty view: nothing recorded). A line
// shorter than its record gives empty fields for what is missing; the last text runs to the end of the
// line.
struct Fields {
    std::array<std::string_view, 6> text{};
    std::string_view operator[](int i) const { return text[static_cast<std::size_t>(i)]; }
};
void SplitRecord(std::string_view line, const Layout& layout, Variant variant, Fields& fields);

// The field at columns [first, first + width) counted from 1 in characters, trimmed; empty beyond the
// line.
std::string_view Column(std::string_view line, int first, int width);

// The rest of the line from column `first` counted from 1 in characters (an accented letter of a
// Windows-1252 book is one column, never split), untrimmed; empty beyond the line.
std::string_view From(std::string_view line, int first);

// The variant of a record written without a header to say it: SDR2x always fills its 4-character
// identifier in columns 5 to 8, where SDR33 writes the blanks in front of its right-justified ones; and
// an SDR2x record is never longer than its layout.
Variant GuessVariant(std::string_view line, const Layout& layout);

// The checksum that closes a framed transfer: the sum of the data bytes modulo 65536. Whether the line
// ends were counted depends on the collector and on what the transfer made of them, so every usual
// counting is accepted: the bytes alone, with LF, or with CR LF after each line (the line of the STX
// counted or not); a Latin-1 text counts its letters as the single bytes they were.
class Checksum {
public:
    void Reset() { m_bytes = m_latin1 = m_lines = 0; }
    void AddLine(std::string_view line);
    bool Matches(unsigned value) const;

private:
    std::uint64_t m_bytes = 0;
    std::uint64_t m_latin1 = 0;
    std::uint64_t m_lines = 0;
};

} // namespace pyr::sdr
