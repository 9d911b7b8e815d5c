#include "fieldbook/FieldBookFormats.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"

#include <array>
#include <filesystem>

namespace pyr {

namespace {

constexpr const char* kIniFilter = "Fichiers de paramètres (*.ini)|*.ini||";
constexpr const char* kSepFilter = "Fichiers de paramètres (*.sep)|*.sep||";
constexpr const char* kColFilter = "Fichiers de paramètres (*.col)|*.col||";
constexpr const char* kSectionPrefix = "Carnet.";

using F = FieldBookFormat;

// clang-format off
constexpr std::array<FieldBookFormatInfo, 11> kFormats{{
    {F::Geotronics, "Carnet Trimble &GDM", "Geotronics", "Carnet.Geotronics", "Geodim.ini", true, false,
     fb::kMsgNoCodeTableLoaded, "LGeodim", kIniFilter, "ini"},
    {F::NikonAtlas, "Carnet Nikon / &Atlas", "Nikon/Atlas", "Carnet.NikonAtlas", "NikAtlas.ini", true, false,
     fb::kMsgImpossibleCase, "LNikAtl", kIniFilter, "ini"},
    {F::NikonKheops, "Carnet Nikon / &Kheops", "Nikon/Kheops", "Carnet.NikonKheops", "NikKheops.ini", true,
     false, fb::kMsgImpossibleCase, "LNikKps", kIniFilter, "ini"},
    {F::NikonPsion, "Carnet Nikon / &Psion", "Nikon/Psion", "Carnet.NikonPsion", "NikPsion.ini", true, false,
     fb::kMsgImpossibleCase, "LNikPsi", kIniFilter, "ini"},
    {F::Sokkia, "Carnet &Sokkia", "Sokkia", "Carnet.Sokkia", "Sokkia.ini", true, false,
     fb::kMsgImpossibleCase, "LSokkia", kIniFilter, "ini"},
    {F::TopconGT7, "Carnet Topcon GT&7", "Topcon GT7", "Carnet.TopconGT7", "Topcon.ini", true, false,
     fb::kMsgImpossibleCase, "LTopcon", kIniFilter, "ini"},
    {F::Wild, "Carnet &Wild, Leica", "Wild", "Carnet.Wild", "Wild.ini", true, true,
     fb::kMsgNoCodeTableLoaded, "LecWild", kIniFilter, "ini"},
    {F::Zeiss, "Carnet Trimble (&Zeiss)", "Zeiss", "Carnet.Zeiss", "Zeiss.ini", true, false,
     fb::kMsgImpossibleCase, "LZeiss1", kIniFilter, "ini"},
    {F::Separateur, "Carnet Séparate&ur", "Séparateur", "Carnet.Séparateur", "Param_Export.sep", false, false,
     fb::kMsgImpossibleCase, "LSeparat", kSepFilter, "sep"},
    {F::Colonne, "Carnet Co&lonné", "Colonné", "Carnet.Colonné", "Param_Export.col", false, false,
     fb::kMsgImpossibleCase, "LColonne", kColFilter, "col"},
    {F::Quendal, "Carnet &Quendal-Pc", "Quendal-Pc", "Carnet.Quendal", nullptr, false, false,
     fb::kMsgImpossibleCase, "LQuenda", kIniFilter, "ini"},
}};
// clang-format on

} // namespace

std::span<const FieldBookFormatInfo> FieldBookFormats() {
    return kFormats;
}

const FieldBookFormatInfo& FormatInfo(FieldBookFormat format) {
    for (const auto& info : kFormats)
        if (info.format == format) return info;
    return kFormats.back();
}

std::optional<FieldBookFormat> FindFieldBookFormat(std::string_view word) {
    const std::string_view prefix(kSectionPrefix);
    for (const auto& info : kFormats) {
        const std::string_view section(info.section);
        if (EqualIgnoringCase(word, info.name) || EqualIgnoringCase(word, info.command) ||
            EqualIgnoringCase(word, section.substr(prefix.size())))
            return info.format;
    }
    return std::nullopt;
}

std::string FieldBookFormatNames() {
    const std::string_view prefix(kSectionPrefix);
    std::string names;
    for (const auto& info : kFormats) {
        if (!names.empty()) names += ", ";
        names += std::string_view(info.section).substr(prefix.size());
    }
    return names;
}

std::string InstallationConfigFile(std::string_view installDir, std::string_view fileName) {
    std::filesystem::path folder(installDir);
    return (folder / "Config" / fileName).string();
}

std::string BesideCarnet(std::string_view carnet, std::string_view extension) {
    return ReplaceExtension(std::string(carnet), std::string(extension));
}

std::string TemporaryBesideCarnet(std::string_view carnet) {
    std::string temporary = BesideCarnet(carnet, "tmp");
    while (temporary == carnet || FileExists(temporary))
        temporary += ".tmp";
    return temporary;
}

} // namespace pyr
