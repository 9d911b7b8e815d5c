#include "settings/CalcOptions.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"
#include "settings/ParamStore.h"

#include <algorithm>
#include <array>
#include <cctype>

namespace pyr {

namespace {

using T = OptionType;

// Angles in grads, lengths in metres, the earth radius in kilometres. Switches run from 0 to 1.
constexpr std::array kOptions = {
    // Calculations: the two bit sets are offered as check boxes by the page.
    OptionEntry{kSectionCalculations, "General", T::Integer, "7", 0, 7},
    OptionEntry{kSectionCalculations, "Cheminements", T::Integer, "32", 0, 127},
    OptionEntry{kSectionCalculations, "RayonHp0Check", T::Switch, "0", 0, 1},
    OptionEntry{kSectionCalculations, "ValeurDeHp0", T::Real, "0", -999999, 999999},
    OptionEntry{kSectionCalculations, "RayonV0Calcule", T::Switch, "0", 0, 1},
    OptionEntry{kSectionCalculations, "TrianguPtsRayon", T::Switch, "0", 0, 1},
    OptionEntry{kSectionCalculations, "IntersAvecHp", T::Switch, "1", 0, 1},
    // The station reduction folds a vertical eccentric offset into the zenith angle and the distance
    // (rather than into the target height).
    OptionEntry{kSectionCalculations, "ExcentVertDansAngles", T::Switch, "0", 0, 1},
    // The field instrument of a station that names none: its number in the list (0, the standard one).
    OptionEntry{kSectionCalculations, "AppareilParDefaut", T::Integer, "0", 0, 999},

    // Corrections.
    OptionEntry{kSectionCorrections, "AlterLineaire", T::Real, "0", -100000, 100000},
    OptionEntry{kSectionCorrections, "CorrNivZero", T::Real, "0", -100000, 100000},
    OptionEntry{kSectionCorrections, "Projection", T::Text, "Aucune"},
    OptionEntry{kSectionCorrections, "CorrAuto", T::Switch, "0", 0, 1},
    OptionEntry{kSectionCorrections, "AbsiMoyenne", T::Real, "0", 0, 90000000},
    OptionEntry{kSectionCorrections, "OrdoMoyenne", T::Real, "0", 0, 90000000},
    OptionEntry{kSectionCorrections, "AltiMoyenne", T::Real, "0", -10000, 10000},
    OptionEntry{kSectionCorrections, "RayonTerre", T::Real, "6366", 6000, 7000}, // km

    // Editor: the decimals are kept as texts.
    OptionEntry{kSectionEditor, "General", T::Integer, "1", 0, 7},
    OptionEntry{kSectionEditor, "NombreDecimaleXY", T::Text, "4"},
    OptionEntry{kSectionEditor, "NombreDecimaleZ", T::Text, "3"},
    OptionEntry{kSectionEditor, "NombreDecimaleAng", T::Text, "5"},
    OptionEntry{kSectionEditor, "Reductions", T::Switch, "0", 0, 1},
    OptionEntry{kSectionEditor, "PointsDoubles", T::Switch, "0", 0, 1},
    OptionEntry{kSectionEditor, "TolerancePointDouble", T::Real, "0.05", 0, 100},
    OptionEntry{kSectionEditor, "CodePointDouble", T::Text, ""},

    // Database link.
    OptionEntry{kSectionDatabase, "NomBaseDonnées", T::Text, ""},
    OptionEntry{kSectionDatabase, "NomTableDonnées", T::Text, ""},
    OptionEntry{kSectionDatabase, "Tolérance", T::Text, "0.001"},
    OptionEntry{kSectionDatabase, "Distance3D", T::Switch, "1", 0, 1},
    OptionEntry{kSectionDatabase, "ConfirmerImport", T::Switch, "1", 0, 1},
    OptionEntry{kSectionDatabase, "ConfirmerExport", T::Switch, "1", 0, 1},
    OptionEntry{kSectionDatabase, "RendrePtsInvariants", T::Switch, "1", 0, 1},
    OptionEntry{kSectionDatabase, "AltitudeImportation", T::Switch, "1", 0, 1},
    OptionEntry{kSectionDatabase, "AltitudeExportation", T::Switch, "1", 0, 1},
    OptionEntry{kSectionDatabase, "Ident_Mat", T::Text, "NUMERO"},
    OptionEntry{kSectionDatabase, "Ident_X", T::Text, "X"},
    OptionEntry{kSectionDatabase, "Ident_Y", T::Text, "Y"},
    OptionEntry{kSectionDatabase, "Ident_Z", T::Text, "Z"},

    // Listings.
    OptionEntry{kSectionListings, "ChoixNomListing", T::Switch, "1", 0, 1},
    OptionEntry{kSectionListings, "ProduireJournal", T::Switch, "1", 0, 1},
    OptionEntry{kSectionListings, "EcrireTolérances", T::Switch, "1", 0, 1},
    OptionEntry{kSectionListings, "AffichePtsAppro", T::Switch, "1", 0, 1},
    OptionEntry{kSectionListings, "AfficherListing", T::Switch, "1", 0, 1},
    OptionEntry{kSectionListings, "CreationAnnulation", T::Switch, "1", 0, 1},
    OptionEntry{kSectionListings, "Inverser_XY", T::Switch, "0", 0, 1},
    OptionEntry{kSectionListings, "ControleV0Rayonne", T::Switch, "1", 0, 1},
    OptionEntry{kSectionListings, "RayonContenu", T::Text, "N,X,Y,Z,GI,DH"},
    // The layout of every listing, which the listings page edits too: 0 rich text, 1 plain text in
    // numbered pages, 2 plain text in one run; the page's length in lines and width in characters.
    OptionEntry{kSectionListingLayout, kKeyListingFormat, T::Integer, "1", 0, 2},
    OptionEntry{kSectionListingLayout, kKeyPageLength, T::Integer, "70", kMinPageLength, kMaxPageLength},
    OptionEntry{kSectionListingLayout, kKeyPageWidth, T::Integer, "80", kMinPageWidth, kMaxPageWidth},

    // Levelling.
    OptionEntry{kSectionLevelling, "TypeTolerance", T::Integer, "0", 0, 2},
    OptionEntry{kSectionLevelling, "TypeNivel", T::Integer, "0", 0, 2},
    OptionEntry{kSectionLevelling, "FermAltimetr", T::Real, "0.01", 0, 100},

    // Tolerances.
    OptionEntry{kSectionTolerances, "TypeTolerance", T::Integer, "0", 0, 2},
    OptionEntry{kSectionTolerances, "TypeCanevas", T::Integer, "0", 0, 3},
    OptionEntry{kSectionTolerances, "TolAngles", T::Real, "0.01", 0, 400},
    OptionEntry{kSectionTolerances, "TolDistances", T::Real, "0.01", 0, 100},
    OptionEntry{kSectionTolerances, "TolAltitudes", T::Real, "0.01", 0, 100},
    OptionEntry{kSectionTolerances, "FermAngulaire", T::Real, "0.01", 0, 400},
    OptionEntry{kSectionTolerances, "FermPlanimetr", T::Real, "0.01", 0, 100},
    OptionEntry{kSectionTolerances, "FermAltimetr", T::Real, "0.01", 0, 100},
};

// The listing object starts with the defaults of the table, before it reads the file.
constexpr int IntegerDefault(std::string_view section, std::string_view key) {
    for (const auto& entry : kOptions)
        if (entry.section == section && entry.key == key) {
            int value = 0;
            for (char c : entry.defaultValue)
                value = value * 10 + (c - '0');
            return value;
        }
    return -1;
}
static_assert(IntegerDefault(kSectionListingLayout, kKeyListingFormat) == kDefaultListingFormat);
static_assert(IntegerDefault(kSectionListingLayout, kKeyPageLength) == kDefaultPageLength);
static_assert(IntegerDefault(kSectionListingLayout, kKeyPageWidth) == kDefaultPageWidth);

// The decimals of the store: a sane range, whatever the file holds.
constexpr int kMaxDecimals = 10;

int ReadIntOf(std::string_view paramPath, const OptionEntry& entry) {
    int value = 0;
    ReadParamInt(paramPath, entry.section, entry.key, LenientAtoi(entry.defaultValue),
                 static_cast<int>(entry.minimum), static_cast<int>(entry.maximum), value);
    return value;
}

double ReadRealOf(std::string_view paramPath, const OptionEntry& entry) {
    double value = 0;
    ReadParamDouble(paramPath, entry.section, entry.key, LenientAtof(entry.defaultValue), entry.minimum,
                    entry.maximum, value);
    return value;
}

std::string ReadTextOf(std::string_view paramPath, const OptionEntry& entry) {
    std::string value;
    ReadParamString(paramPath, entry.section, entry.key, entry.defaultValue, value);
    return value;
}

// A number of decimals kept as a text: its leading integer, within 0 to 10; a text that does not start
// with digits gives the default.
int ReadDecimals(std::string_view paramPath, std::string_view key) {
    const OptionEntry* entry = FindOption(kSectionEditor, key);
    const int byDefault = LenientAtoi(entry->defaultValue);
    const std::string stored = ReadTextOf(paramPath, *entry);
    const std::string_view text = Trimmed(stored);
    std::string_view digits = text;
    if (!digits.empty() && (digits.front() == '+' || digits.front() == '-')) digits.remove_prefix(1);
    if (digits.empty() || !std::isdigit(static_cast<unsigned char>(digits.front()))) return byDefault;
    return std::clamp(LenientAtoi(text), 0, kMaxDecimals);
}

} // namespace

std::span<const OptionEntry> CalcOptionTable() {
    return kOptions;
}

// Sections and keys are told apart without regard to case, as the parameter files tell them.
const OptionEntry* FindOption(std::string_view section, std::string_view key) {
    for (const auto& entry : kOptions)
        if (EqualIgnoringCase(entry.section, section) && EqualIgnoringCase(entry.key, key)) return &entry;
    return nullptr;
}

bool ReadOptionSwitch(std::string_view paramPath, std::string_view section, std::string_view key) {
    return ReadOptionInt(paramPath, section, key) != 0;
}

int ReadOptionInt(std::string_view paramPath, std::string_view section, std::string_view key) {
    const OptionEntry* entry = FindOption(section, key);
    if (!entry) return 0;
    switch (entry->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return ReadIntOf(paramPath, *entry);
    case OptionType::Real:
        return static_cast<int>(ReadRealOf(paramPath, *entry));
    case OptionType::Text:
        return LenientAtoi(ReadTextOf(paramPath, *entry));
    }
    return 0;
}

double ReadOptionReal(std::string_view paramPath, std::string_view section, std::string_view key) {
    const OptionEntry* entry = FindOption(section, key);
    if (!entry) return 0;
    switch (entry->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return ReadIntOf(paramPath, *entry);
    case OptionType::Real:
        return ReadRealOf(paramPath, *entry);
    case OptionType::Text: // "Tolérance" of the database link is a text holding a real
        return LenientAtof(ReadTextOf(paramPath, *entry));
    }
    return 0;
}

std::string ReadOptionText(std::string_view paramPath, std::string_view section, std::string_view key) {
    const OptionEntry* entry = FindOption(section, key);
    if (!entry) return {};
    switch (entry->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return Sprintf("%d", ReadIntOf(paramPath, *entry));
    case OptionType::Real:
        return FormatFixed(ReadRealOf(paramPath, *entry), 6);
    case OptionType::Text:
        return ReadTextOf(paramPath, *entry);
    }
    return {};
}

void ApplyStoreOptions(std::string_view paramPath) {
    SetStoreDecimals(ReadDecimals(paramPath, "NombreDecimaleXY"), ReadDecimals(paramPath, "NombreDecimaleZ"),
                     ReadDecimals(paramPath, "NombreDecimaleAng"));
    CPointGen::setSwapXY(ReadOptionSwitch(paramPath, kSectionListings, "Inverser_XY"));
}

} // namespace pyr
