#pragma once

#include <string>
#include <string_view>

// The records of a Trimble GDM (Geodimeter) label file, and the text of one record a line in which the
// reader keeps them between its two passes.
//
// A record is one "label=value" of the field book: the label a number (2 a station, 5 a point, 7 an
// angle ...), the value a number or a text. The first pass cleans each line (blanks and the transmission's
// control characters at both ends) and keeps the record with the number of the line it came from,
// "<line> <label>=<value>"; the second pass reads those records back and assembles the blocks.
namespace pyr::gdm {

// The labels that open a block.
inline constexpr int kLabelStation = 2;
inline constexpr int kLabelPoint = 5;

struct Record {
    int label = -1;
    std::string_view value;
};

enum class RecordShape {
    Blank,       // nothing but blanks and control characters: skipped without a word
    Whole,       // a label and its value
    Incomplete,  // a label without its value ("7=", or "7" alone): the record ends early
    Unrecognised // no label: the line is no record
};

// Splits one line of the field book.
RecordShape SplitRecord(std::string_view line, Record& record);

// Whether a label's value is a text that may be empty (an information, a code, a header line).
bool IsTextLabel(int label);

// Appends "<line> <label>=<value>" and the end of the line.
void AppendRecordLine(std::string& out, int number, const Record& record);
// Reads back a line written by AppendRecordLine; false for anything else.
bool ReadRecordLine(std::string_view line, int& number, Record& record);

} // namespace pyr::gdm
