#pragma once

#include "fieldbook/TableCode.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

// The text of a code table (".cod"), one line a setting or a code:
//
//   ; a comment line (also '#')
//   Séparateur = A...Z
//   ARB   Sym_Cir_Dia   ARBRE        ; arbre, diamètre de la couronne
//   ^code ^command word ^complement  ^description
//
// The complement (symbol, layer name, text ...) is given to the command in front of what the surveyor
// types after the code. Comments, blank lines and the lines that cannot be read are kept as they stand,
// so that writing the table back loses nothing.
namespace pyr {

struct CodeTableLine {
    enum class Kind { Text, Separator, Code };
    Kind kind = Kind::Text;
    std::string text;                    // a Text line as it stood
    std::string code;                    // a Code line: the field code,
    std::string_view command;            // the command word, spelt as the program spells it,
    std::vector<std::string> complement; // the words the table adds to the command's parameters
    std::string description;             // and the words after ';', for the person reading the table
};

struct CodeTableContent {
    std::string separator = kSeparatorUpper;
    std::vector<CodeTableLine> lines;
    // The Code line of each code, by CodeKey.
    std::unordered_map<std::string, std::size_t> codes;
    bool crlf = false; // the lines ended with CR LF
};

// Why a line cannot be read, with its number counted from 1.
using CodeTableReport = std::function<void(int line, const std::string& reason)>;

// Reads the text of a table (UTF-8). A line that cannot be read is reported and kept as text; a code
// already defined keeps its first definition.
CodeTableContent ParseCodeTable(std::string_view text, const CodeTableReport& report);

// The text of the table: its lines in their order, the codes in aligned columns, the separator line
// where it stood (first, after the opening comments, when there was none).
std::string FormatCodeTable(const CodeTableContent& table);

} // namespace pyr
