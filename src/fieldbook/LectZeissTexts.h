#pragma once

// What the reader of Trimble (Zeiss) field books writes in the text window and in the header comments of
// a GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::zeiss::msg {

// ---- Lines read, with something to say (each type or unit said once a field book)
inline constexpr const char* kUnknownType =
    "Attention : ligne %d : type de valeur « %s » inconnu, ignoré dans tout le carnet.";
inline constexpr const char* kUnknownUnit =
    "Attention : ligne %d : unité « %s » inconnue ou impossible pour la valeur, unité du fichier de "
    "paramétrage prise.";
inline constexpr const char* kFlaggedLine =
    "Attention : ligne %d : ligne marquée en erreur par l'appareil, lue quand même.";

// ---- Labels of the header comments (beside those of every reader, FieldBookTexts.h)
inline constexpr const char* kLabelVersion = "Version du logiciel";
inline constexpr const char* kLabelAxes = "Axes des coordonnées";
inline constexpr const char* kLabelOrientation = "Orientation (Om)";
inline constexpr const char* kLabelPressure = "Pression";

// The axes as the header comment says them.
inline constexpr const char* kAxesXNorth = "X = nord, Y = est";
inline constexpr const char* kAxesXEast = "X = est, Y = nord";
inline constexpr const char* kAxesNorthEast = "N = nord, E = est";

} // namespace pyr::zeiss::msg
