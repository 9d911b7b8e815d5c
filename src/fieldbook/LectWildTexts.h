#pragma once

// What the reader of Wild / Leica GSI field books writes in the text window and in the header comments
// of a GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::gsi::msg {

// ---- Lines read, with something to say (each said once a field book)
inline constexpr const char* kUnknownWord =
    "Attention : ligne %d : mot %d inconnu, ignoré dans tout le carnet.";
inline constexpr const char* kForeignUnit =
    "Attention : ligne %d : unité « %c » impossible pour le mot %d, unité du fichier de paramétrage prise.";
inline constexpr const char* kHeightDiffers =
    "Attention : ligne %d : hauteur d'instrument %s différente de celle de la station <%s> (%s), "
    "celle de la station est gardée.";

// ---- Labels of the header comments (beside those of every reader, FieldBookTexts.h)
inline constexpr const char* kLabelDateTime = "Date et heure";
inline constexpr const char* kGsi8 = "GSI-8";
inline constexpr const char* kGsi16 = "GSI-16";

} // namespace pyr::gsi::msg
