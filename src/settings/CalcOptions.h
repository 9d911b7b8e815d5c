#pragma once

#include <span>
#include <string>
#include <string_view>

// The calculation options: every key of every section that the options sheet edits, with its type, its
// default and its limits, in one table. The sheet's pages and every computation read them through the
// functions below, so that a key has the same default and the same limits wherever it is read.
namespace pyr {

inline constexpr const char* kSectionInstruments = "Définitions_Des_Appareils";
inline constexpr const char* kSectionCalculations = "Options_Calculs";
inline constexpr const char* kSectionCorrections = "Options_Corrections";
inline constexpr const char* kSectionEditor = "Options_Editeur";
inline constexpr const char* kSectionDatabase = "Liaison_Base_de_Données";
inline constexpr const char* kSectionListings = "Options_Listings";
inline constexpr const char* kSectionLevelling = "Options_Nivellement";
inline constexpr const char* kSectionTolerances = "Options_Tolerances";

// The instrument always offered, whatever the file holds.
inline constexpr const char* kStandardInstrument = "Appareil Standard";

enum class OptionType {
    Switch,  // 0 or 1, written "%d"
    Integer, // written "%d"
    Real,    // written "%f"
    Text     // written as it is (some texts hold numbers: the editor's decimals)
};

struct OptionEntry {
    std::string_view section;
    std::string_view key;
    OptionType type;
    std::string_view defaultValue; // as the file would hold it: "1", "6366", "0.05", "N,X,Y,Z,GI,DH"
    double minimum = 0;            // limits of integers and reals; switches are 0 to 1; texts have none
    double maximum = 0;
};

// The keys of the fixed sections, section by section in the order of the pages (the numbered keys of
// the instruments are not in it: see OptionPages.h).
std::span<const OptionEntry> CalcOptionTable();
// The key of that section, or null.
const OptionEntry* FindOption(std::string_view section, std::string_view key);

// Reads with the table's default and limits, from the parameter path (a file or a registry root). An
// unknown section or key reads as 0 or "" (a caller's slip, caught by the tests).
bool ReadOptionSwitch(std::string_view paramPath, std::string_view section, std::string_view key);
int ReadOptionInt(std::string_view paramPath, std::string_view section, std::string_view key);
double ReadOptionReal(std::string_view paramPath, std::string_view section, std::string_view key);
std::string ReadOptionText(std::string_view paramPath, std::string_view section, std::string_view key);

// Sets the decimals settings of every element class from "NombreDecimaleXY", "NombreDecimaleZ",
// "NombreDecimaleAng", and the axis order of the points from "Inverser_XY".
void ApplyStoreOptions(std::string_view paramPath);

} // namespace pyr
