#pragma once

#include <array>
#include <string>
#include <string_view>
#include <vector>

// The Quendal-Pc field book: a text file of records, one a line, whose fields are separated by ';'. The
// first field names the record. Written for surveyors in docs/quendal-pc.md; written by CDlgConfigQdl
// (ConfigQdl.h) and read by CQuendalReader (QuendalReader.h).
namespace pyr::qdl {

inline constexpr std::string_view kHeader = "QUENDAL-PC"; // "QUENDAL-PC;1", the first line
inline constexpr int kVersion = 1;
inline constexpr char kSeparator = ';';
inline constexpr char kQuote = '"';

// The records and the kinds of element they carry.
inline constexpr std::string_view kComment = "COMMENTAIRE";    // 1000: text
inline constexpr std::string_view kInstrument = "APPAREIL";    // 1008: name, constants, precisions
inline constexpr std::string_view kStation = "STATION";        // 1001: name, HI, V0, code
inline constexpr std::string_view kReference = "REFERENCE";    // 1002: point, HP, AH, AV, DI, code
inline constexpr std::string_view kMesure = "MESURE";          // 1003: point, HP, AH, AV, DI, code
inline constexpr std::string_view kPoint = "POINT";            // 1006: point, X, Y, Z, code, invariance
inline constexpr std::string_view kBackReading = "LECTURE_AR"; // 1004: point, reading, distance, code
inline constexpr std::string_view kForeReading = "LECTURE_AV"; // 1005: the same
inline constexpr std::string_view kTraverse = "CHEMINEMENT";   // 1007: name, closed (0/1), stations
inline constexpr std::string_view kCode = "CODE";              // 1009: field code, parameters, point, code
inline constexpr std::string_view kCommand = "COMMANDE";       // 1010-1065: word, parameters, point, code

// A point's invariance: "XY", "Z", "XYZ"; nothing (or "-") when none.
inline constexpr std::string_view kInvariantXY = "XY";
inline constexpr std::string_view kInvariantZ = "Z";
inline constexpr std::string_view kInvariantXYZ = "XYZ";

// The most fields a record holds, traverses aside (their stations run on: SplitAllFields reads them).
inline constexpr std::size_t kMaxFields = 10;

// The fields of a line, as views into it, or into `scratch` for those written in quotes with doubled
// quotes inside (the views stay valid while `scratch` is not touched). Unquoted fields are trimmed of
// their blanks. `count` is the number of fields of the line, which may exceed the fields kept.
struct Fields {
    std::array<std::string_view, kMaxFields> field{};
    std::size_t count = 0;
    bool quoted[kMaxFields] = {};
    std::string_view operator[](std::size_t i) const {
        return i < kMaxFields ? field[i] : std::string_view();
    }
};
void SplitFields(std::string_view line, Fields& fields, std::string& scratch);
// Every field of the line, however many.
std::vector<std::string> SplitAllFields(std::string_view line);

// Appends a field: in quotes when it holds the separator, a quote, or blanks at its ends.
void AppendField(std::string& out, std::string_view text);

} // namespace pyr::qdl
