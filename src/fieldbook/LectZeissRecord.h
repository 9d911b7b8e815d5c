#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

// The lines of Trimble (Zeiss) field books cut into their fields, before any interpretation. Four
// layouts exist, told apart by the start of a line:
//  - M5: "For M5|Adr nnnnn|T2a <27-character information>|T3 <value 14> <unit 4>|T4 ...|T5 ...|e" in
//    119 columns (121 with CR LF); T2a is "PI1".."PI0" for a point, "TI" or "TO" for a text;
//  - R4: "For R4|<code and point>|<type value unit>|...|..." and R5, the same with "Adr nnnn|" after the
//    format; their fields are found by their separators;
//  - Rec 500: fixed columns, the address in 1-7, a text from column 9, the point id ending in column 27
//    and its code in 28-36, three blocks of a type (2 characters) and its value from columns 37, 52, 67.
// Every field is a view into the line; blanks around it are dropped.
namespace pyr::zeiss {

enum class Layout { Unknown, M5, R4, R5, Rec500 };

// The width of a line without its end: an M5 line, a Rec 500 line.
inline constexpr int kM5Width = 119;
inline constexpr int kRec500Width = 79;

// The information block of an M5 point line and its three fields: the point id (right-aligned), the code
// (right-aligned) and the information (left-aligned). The three fill 24 of the 27 columns; the surveyor
// may set the instrument to swap the point id and the code and to move the information.
inline constexpr int kInfoWidth = 27;
inline constexpr int kPointWidth = 12;
inline constexpr int kCodeWidth = 5;
inline constexpr int kInformationWidth = 7;

// The places, counted from 1 in the information block, of the information (I), the code (C) and the
// point id (P). An instrument's header gives them (words 20, 21, 22); without them, the reader finds them
// from the point lines (LectZeissPlaces.h). The default is the point id ending in column 19 followed by
// its code.
struct InfoPlaces {
    int information = 25;
    int code = 20;
    int point = 8;

    bool operator==(const InfoPlaces&) const = default;
};

struct Value {
    std::string_view type;   // "SD", "Hz", "V1", "X", "th" ... or a header word "01", "05"
    std::string_view number; // as written
    std::string_view unit;   // "m", "ft", "gon", "grd", "DMS", "deg", "mil", "%"; empty when not written
};

struct Record {
    Layout layout = Layout::Unknown;
    bool text = false;      // a text line (TI, TO, a Rec 500 text): `words` holds it
    bool end = false;       // the closing "END" line of a transfer
    bool errorFlag = false; // the instrument marked the line as wrong
    std::string_view words; // the text of a text line
    std::string_view point; // the point id of a point line
    std::string_view code;  // its code (a marker "S" for a station)
    std::string_view information;
    std::array<Value, 3> values{};
    std::size_t valueCount = 0; // the value blocks that hold something, in their order
};

// The layout of a line from its first characters; Unknown when it is none of those that announce
// themselves (a Rec 500 line does not).
Layout LayoutOf(std::string_view line);

// Cuts a line of the layout into `record`. False when the line is not one of that layout.
bool SplitM5(std::string_view line, const InfoPlaces& places, Record& record);
bool SplitR4R5(std::string_view line, bool withAddress, Record& record);
bool SplitRec500(std::string_view line, Record& record);

// What an M5 point line writes in its information block, a column a character: 'x' where something is
// written, a blank where nothing is; shorter than the block when the line is cut. Nothing when the line is
// not an M5 point line.
std::optional<std::string> M5InfoOccupancy(std::string_view line);

} // namespace pyr::zeiss
