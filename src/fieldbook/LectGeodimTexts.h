#pragma once

// What the reader of Trimble GDM (Geodimeter) label files writes in the text window and in the header
// comments of a GéoBase, beside the texts it shares with the other readers (FieldBookTexts.h). Those with
// %d or %s are printf formats; the line number first.
namespace pyr::gdm::msg {

inline constexpr const char* kUnknownLabel =
    "Attention : ligne %d : label %d inconnu, ignoré dans tout le carnet.";
inline constexpr const char* kOutsideBlock =
    "Erreur ligne %d : mesure hors d'un bloc de station (2) ou de point (5) !";
inline constexpr const char* kBadUnits =
    "Attention : ligne %d : unités <%s> inconnues, unités du fichier de paramétrage gardées.";
inline constexpr const char* kTemporaryUnwritable =
    "Attention : fichier temporaire <%s> impossible à écrire, le carnet est lu en mémoire.";

// ---- Labels of the header comments (beside those of every reader, FieldBookTexts.h)
inline constexpr const char* kLabelInformation = "Information";
inline constexpr const char* kLabelData = "Données";
inline constexpr const char* kLabelTime = "Heure";
inline constexpr const char* kLabelOperator = "Opérateur";
inline constexpr const char* kLabelProject = "Projet";

} // namespace pyr::gdm::msg
