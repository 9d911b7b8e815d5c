#pragma once

// What the reader of Trimble GDM (Geodimeter) label files writes in the text window and in the header
// comments of a GéoBase, beside the texts it shares with the other readers (FieldBookTexts.h and the
// names of the data in LectWildTexts.h). Those with %d or %s are printf formats; the line number first.
namespace pyr::gdm::msg {

inline constexpr const char* kUnknownLabel =
    "Attention : ligne %d : label %d inconnu, ignoré dans tout le carnet.";
inline constexpr const char* kOutsideBlock =
    "Erreur ligne %d : mesure hors d'un bloc de station (2) ou de point (5) !";
inline constexpr const char* kBadUnits =
    "Attention : ligne %d : unités <%s> inconnues, unités du fichier de paramétrage gardées.";
inline constexpr const char* kTemporaryUnwritable =
    "Attention : fichier temporaire <%s> impossible à écrire, le carnet est lu en mémoire.";

// ---- Labels of the header comments
inline constexpr const char* kLabelFile = "Fichier";
inline constexpr const char* kLabelInformation = "Information";
inline constexpr const char* kLabelData = "Données";
inline constexpr const char* kLabelUnits = "Unités";
inline constexpr const char* kLabelPpm = "Correction atmosphérique";
inline constexpr const char* kLabelScale = "Facteur d'échelle";
inline constexpr const char* kLabelJob = "Chantier";
inline constexpr const char* kLabelDate = "Date";
inline constexpr const char* kLabelTime = "Heure";
inline constexpr const char* kLabelOperator = "Opérateur";
inline constexpr const char* kLabelProject = "Projet";
inline constexpr const char* kLabelInstrument = "Appareil";
inline constexpr const char* kLabelTemperature = "Température";

} // namespace pyr::gdm::msg
