#pragma once

#include <optional>
#include <span>
#include <string>
#include <string_view>

// The field-book formats that the reading commands convert into GéoBases, and the settings keys that a
// conversion reads and writes back.
namespace pyr {

enum class FieldBookFormat {
    Geotronics,
    NikonAtlas,
    NikonKheops,
    NikonPsion,
    Sokkia,
    TopconGT7,
    Wild,
    Zeiss,
    Separateur,
    Colonne,
    Quendal,
};

struct FieldBookFormatInfo {
    FieldBookFormat format;
    const char* menuEntry;      // "Carnet &Wild, Leica" (the '&' marks the shortcut letter)
    const char* name;           // "Wild": the caption suffix of the reading dialog
    const char* section;        // "Carnet.Wild", in the current parameter file
    const char* parameterFile;  // "Wild.ini" in the installation's Config folder; null for Quendal-Pc
    bool testHpNulle;           // whether the zero prism height test is offered
    bool preformatting;         // whether an external pre-formatting program may be named
    const char* noCodeTable;    // what is said when the editor holds no code table
    const char* command;        // the reading command's local name, "LecWild"
    const char* paramFilter;    // the file choice of the parameter file
    const char* paramExtension; // without its dot
};

// The eleven formats, in the order of the reading menu.
std::span<const FieldBookFormatInfo> FieldBookFormats();
const FieldBookFormatInfo& FormatInfo(FieldBookFormat format);
// The format a word names, without regard to case: its name ("Wild", "Nikon/Atlas", "Quendal-Pc"),
// its section without "Carnet." ("NikonAtlas", "Quendal") or its command ("LecWild", "LQuenda").
std::optional<FieldBookFormat> FindFieldBookFormat(std::string_view word);
// The words FindFieldBookFormat knows best, for a message: "Geotronics, Nikon/Atlas, ...".
std::string FieldBookFormatNames();

// ---- Keys of a format's section
inline constexpr const char* kKeyParametrage = "Parametrage";         // the instrument parameter file
inline constexpr const char* kKeyCarnet = "Carnet";                   // the last field book read
inline constexpr const char* kKeyInterpretation = "Interprétation";   // codes interpreted, 0 or 1
inline constexpr const char* kKeyAppareilTerrain = "AppareilTerrain"; // the field instrument's name
inline constexpr const char* kKeyEcrireAppareil = "EcrireAppareil";   // an instrument element first
inline constexpr const char* kKeyTestHpNulle = "TestHpNulle";         // read only, never written back
inline constexpr const char* kKeyPreformattage = "Preformattage";     // Wild: the pre-formatting program

// ---- Shared keys
inline constexpr const char* kSectionGeocodification = "Geocodification";
inline constexpr const char* kKeyTableDeCode = "TableDeCode";
// The registry settings: the last file written by any program of the suite.
inline constexpr const char* kRegistrySettings = "HKEY_CURRENT_USER";
inline constexpr const char* kSectionPyralis = "Pyralis";
inline constexpr const char* kKeyDernierFichier = "DernierFichier";
// Where the parameter file of the delimited and columnar formats is also kept, for the point loading.
inline constexpr const char* kSectionChargementDeSemis = "ChargementDeSemis";
inline constexpr const char* kKeyParametresColonne = "ParametresColonne";
inline constexpr const char* kKeyParametresSeparateur = "ParametresSeparateur";

// The installation's configuration file of that name: "%sConfig\%s" with the installation folder
// (ending with a separator).
std::string InstallationConfigFile(std::string_view installDir, std::string_view fileName);

// "%s%s%s.<extension>": the field book's drive, folder and name with another extension, beside it.
std::string BesideCarnet(std::string_view carnet, std::string_view extension);

// The temporary file a conversion writes beside the field book and deletes: "%s%s%s.tmp", or, when that
// name is the field book itself or a file already there (the surveyor's own), the same with ".tmp" added
// until the name is free, so that no file of the surveyor's is written over or deleted.
std::string TemporaryBesideCarnet(std::string_view carnet);

} // namespace pyr
