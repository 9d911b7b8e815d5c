#include "settings/CalcOptions.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ParamStore.h"

#include <algorithm>
#include <array>
#include <cctype>

namespace pyr {

namespace {

using T = OptionType;

// Angles in grads, lengths in metres, the earth radius in kilometres. Switches run from 0 to 1.
constexpr std::array kSpecs = {
    // Calculations: the two bit sets are offered as check boxes by the page.
    OptionSpec{kSectionCalculations, "General", T::Integer, "7", 0, 7},
    OptionSpec{kSectionCalculations, "Cheminements", T::Integer, "32", 0, 127},
    OptionSpec{kSectionCalculations, "RayonHp0Check", T::Switch, "0", 0, 1},
    OptionSpec{kSectionCalculations, "ValeurDeHp0", T::Real, "0", -999999, 999999},
    OptionSpec{kSectionCalculations, "RayonV0Calcule", T::Switch, "0", 0, 1},
    OptionSpec{kSectionCalculations, "TrianguPtsRayon", T::Switch, "0", 0, 1},
    OptionSpec{kSectionCalculations, "IntersAvecHp", T::Switch, "1", 0, 1},

    // Corrections.
    OptionSpec{kSectionCorrections, "AlterLineaire", T::Real, "0", -100000, 100000},
    OptionSpec{kSectionCorrections, "CorrNivZero", T::Real, "0", -100000, 100000},
    OptionSpec{kSectionCorrections, "Projection", T::Text, "Aucune"},
    OptionSpec{kSectionCorrections, "CorrAuto", T::Switch, "0", 0, 1},
    OptionSpec{kSectionCorrections, "AbsiMoyenne", T::Real, "0", 0, 90000000},
    OptionSpec{kSectionCorrections, "OrdoMoyenne", T::Real, "0", 0, 90000000},
    OptionSpec{kSectionCorrections, "AltiMoyenne", T::Real, "0", -10000, 10000},
    OptionSpec{kSectionCorrections, "RayonTerre", T::Real, "6366", 6000, 7000}, // km

    // Editor: the decimals are kept as texts.
    OptionSpec{kSectionEditor, "General", T::Integer, "1", 0, 7},
    OptionSpec{kSectionEditor, "NombreDecimaleXY", T::Text, "4"},
    OptionSpec{kSectionEditor, "NombreDecimaleZ", T::Text, "3"},
    OptionSpec{kSectionEditor, "NombreDecimaleAng", T::Text, "5"},
    OptionSpec{kSectionEditor, "Reductions", T::Switch, "0", 0, 1},
    OptionSpec{kSectionEditor, "PointsDoubles", T::Switch, "0", 0, 1},
    OptionSpec{kSectionEditor, "TolerancePointDouble", T::Real, "0.05", 0, 100},
    OptionSpec{kSectionEditor, "CodePointDouble", T::Text, ""},

    // Database link.
    OptionSpec{kSectionDatabase, "NomBaseDonnées", T::Text, ""},
    OptionSpec{kSectionDatabase, "NomTableDonnées", T::Text, ""},
    OptionSpec{kSectionDatabase, "Tolérance", T::Text, "0.001"},
    OptionSpec{kSectionDatabase, "Distance3D", T::Switch, "1", 0, 1},
    OptionSpec{kSectionDatabase, "ConfirmerImport", T::Switch, "1", 0, 1},
    OptionSpec{kSectionDatabase, "ConfirmerExport", T::Switch, "1", 0, 1},
    OptionSpec{kSectionDatabase, "RendrePtsInvariants", T::Switch, "1", 0, 1},
    OptionSpec{kSectionDatabase, "AltitudeImportation", T::Switch, "1", 0, 1},
    OptionSpec{kSectionDatabase, "AltitudeExportation", T::Switch, "1", 0, 1},
    OptionSpec{kSectionDatabase, "Ident_Mat", T::Text, "NUMERO"},
    OptionSpec{kSectionDatabase, "Ident_X", T::Text, "X"},
    OptionSpec{kSectionDatabase, "Ident_Y", T::Text, "Y"},
    OptionSpec{kSectionDatabase, "Ident_Z", T::Text, "Z"},

    // Listings.
    OptionSpec{kSectionListings, "ChoixNomListing", T::Switch, "1", 0, 1},
    OptionSpec{kSectionListings, "ProduireJournal", T::Switch, "1", 0, 1},
    OptionSpec{kSectionListings, "EcrireTolérances", T::Switch, "1", 0, 1},
    OptionSpec{kSectionListings, "AffichePtsAppro", T::Switch, "1", 0, 1},
    OptionSpec{kSectionListings, "AfficherListing", T::Switch, "1", 0, 1},
    OptionSpec{kSectionListings, "CreationAnnulation", T::Switch, "1", 0, 1},
    OptionSpec{kSectionListings, "Inverser_XY", T::Switch, "0", 0, 1},
    OptionSpec{kSectionListings, "ControleV0Rayonne", T::Switch, "1", 0, 1},
    OptionSpec{kSectionListings, "RayonContenu", T::Text, "N,X,Y,Z,GI,DH"},

    // Levelling.
    OptionSpec{kSectionLevelling, "TypeTolerance", T::Integer, "0", 0, 2},
    OptionSpec{kSectionLevelling, "TypeNivel", T::Integer, "0", 0, 2},
    OptionSpec{kSectionLevelling, "FermAltimetr", T::Real, "0.01", 0, 100},

    // Tolerances.
    OptionSpec{kSectionTolerances, "TypeTolerance", T::Integer, "0", 0, 2},
    OptionSpec{kSectionTolerances, "TypeCanevas", T::Integer, "0", 0, 3},
    OptionSpec{kSectionTolerances, "TolAngles", T::Real, "0.01", 0, 400},
    OptionSpec{kSectionTolerances, "TolDistances", T::Real, "0.01", 0, 100},
    OptionSpec{kSectionTolerances, "TolAltitudes", T::Real, "0.01", 0, 100},
    OptionSpec{kSectionTolerances, "FermAngulaire", T::Real, "0.01", 0, 400},
    OptionSpec{kSectionTolerances, "FermPlanimetr", T::Real, "0.01", 0, 100},
    OptionSpec{kSectionTolerances, "FermAltimetr", T::Real, "0.01", 0, 100},
};

// The decimals of the store: a sane range, whatever the file holds.
constexpr int kMaxDecimals = 10;

int ReadIntOf(std::string_view paramPath, const OptionSpec& spec) {
    int value = 0;
    ReadParamInt(paramPath, spec.section, spec.key, LenientAtoi(spec.defaultValue),
                 static_cast<int>(spec.minimum), static_cast<int>(spec.maximum), value);
    return value;
}

double ReadRealOf(std::string_view paramPath, const OptionSpec& spec) {
    double value = 0;
    ReadParamDouble(paramPath, spec.section, spec.key, LenientAtof(spec.defaultValue), spec.minimum,
                    spec.maximum, value);
    return value;
}

std::string ReadTextOf(std::string_view paramPath, const OptionSpec& spec) {
    std::string value;
    ReadParamString(paramPath, spec.section, spec.key, spec.defaultValue, value);
    return value;
}

// A number of decimals kept as a text: its leading integer, within 0 to 10; a text that does not start
// with digits gives the default.
int ReadDecimals(std::string_view paramPath, std::string_view key) {
    const OptionSpec* spec = FindOptionSpec(kSectionEditor, key);
    const int byDefault = LenientAtoi(spec->defaultValue);
    const std::string stored = ReadTextOf(paramPath, *spec);
    const std::string_view text = Trimmed(stored);
    std::string_view digits = text;
    if (!digits.empty() && (digits.front() == '+' || digits.front() == '-')) digits.remove_prefix(1);
    if (digits.empty() || !std::isdigit(static_cast<unsigned char>(digits.front()))) return byDefault;
    return std::clamp(LenientAtoi(text), 0, kMaxDecimals);
}

} // namespace

std::span<const OptionSpec> CalcOptionSpecs() {
    return kSpecs;
}

// Sections and keys are told apart without regard to case, as the parameter files tell them.
const OptionSpec* FindOptionSpec(std::string_view section, std::string_view key) {
    for (const auto& spec : kSpecs)
        if (EqualIgnoringCase(spec.section, section) && EqualIgnoringCase(spec.key, key)) return &spec;
    return nullptr;
}

bool ReadOptionSwitch(std::string_view paramPath, std::string_view section, std::string_view key) {
    return ReadOptionInt(paramPath, section, key) != 0;
}

int ReadOptionInt(std::string_view paramPath, std::string_view section, std::string_view key) {
    const OptionSpec* spec = FindOptionSpec(section, key);
    if (!spec) return 0;
    switch (spec->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return ReadIntOf(paramPath, *spec);
    case OptionType::Real:
        return static_cast<int>(ReadRealOf(paramPath, *spec));
    case OptionType::Text:
        return LenientAtoi(ReadTextOf(paramPath, *spec));
    }
    return 0;
}

double ReadOptionReal(std::string_view paramPath, std::string_view section, std::string_view key) {
    const OptionSpec* spec = FindOptionSpec(section, key);
    if (!spec) return 0;
    switch (spec->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return ReadIntOf(paramPath, *spec);
    case OptionType::Real:
        return ReadRealOf(paramPath, *spec);
    case OptionType::Text: // "Tolérance" of the database link is a text holding a real
        return LenientAtof(ReadTextOf(paramPath, *spec));
    }
    return 0;
}

std::string ReadOptionText(std::string_view paramPath, std::string_view section, std::string_view key) {
    const OptionSpec* spec = FindOptionSpec(section, key);
    if (!spec) return {};
    switch (spec->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return Sprintf("%d", ReadIntOf(paramPath, *spec));
    case OptionType::Real:
        return FormatFixed(ReadRealOf(paramPath, *spec), 6);
    case OptionType::Text:
        return ReadTextOf(paramPath, *spec);
    }
    return {};
}

void ApplyStoreOptions(std::string_view paramPath) {
    SetStoreDecimals(ReadDecimals(paramPath, "NombreDecimaleXY"), ReadDecimals(paramPath, "NombreDecimaleZ"),
                     ReadDecimals(paramPath, "NombreDecimaleAng"));
    CPointGen::setSwapXY(ReadOptionSwitch(paramPath, kSectionListings, "Inverser_XY"));
}

} // namespace pyr
