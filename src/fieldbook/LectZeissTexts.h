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

// ---- An M5 book whose header does not say where the point id and the code lie (the line of its first
// point line, then the columns of the point id and of the code in the 27-character information block)
inline constexpr const char* kPlacesFound =
    "Attention : ligne %d : places du matricule et du code non données par l'en-tête ; d'après les lignes "
    "de points, matricule lu en colonnes %d à %d et code en colonnes %d à %d du bloc d'information.";
inline constexpr const char* kPlacesUnexplained =
    "Attention : ligne %d : aucune disposition connue du bloc d'information n'explique les lignes de "
    "points ; matricule lu en colonnes %d à %d et code en colonnes %d à %d.";

// ---- Labels of the header comments (beside those of every reader, FieldBookTexts.h)
inline constexpr const char* kLabelVersion = "Version du logiciel";
inline constexpr const char* kLabelAxes = "Axes des coordonnées";
inline constexpr const char* kLabelOrientation = "Orientation (Om)";
inline constexpr const char* kLabelPressure = "Pression";

// The axes as the header comment says them, for the coordinate systems 1 (XY), 2 (YX) and 3 (NE) of the
// header word 05.
inline constexpr const char* kAxesXNorth = "X = nord, Y = est";
inline constexpr const char* kAxesXEast = "X = est, Y = nord";
inline constexpr const char* kAxesNorthEast = "N = nord, E = est";

} // namespace pyr::zeiss::msg
