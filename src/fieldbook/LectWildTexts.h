#pragma once

// What the reader of Wild / Leica GSI field books writes in the text window and in the header comments
// of a GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::gsi::msg {

// ---- Names of the data, for "Erreur ligne %d : donnée manquante pour %s !"
inline constexpr const char* kDatumPoint = "le matricule du point";
inline constexpr const char* kDatumStation = "le nom de la station";
inline constexpr const char* kDatumContent = "les observations ou les coordonnées du point";
inline constexpr const char* kDatumEast = "la coordonnée Est";
inline constexpr const char* kDatumNorth = "la coordonnée Nord";

// ---- Lines skipped
inline constexpr const char* kRefused = "Erreur ligne %d : donnée refusée par les contrôles de la GéoBase !";

// ---- Lines read, with something to say (each said once a field book)
inline constexpr const char* kUnknownWord =
    "Attention : ligne %d : mot %d inconnu, ignoré dans tout le carnet.";
inline constexpr const char* kForeignUnit =
    "Attention : ligne %d : unité « %c » impossible pour le mot %d, unité du fichier de paramétrage prise.";
inline constexpr const char* kHeightDiffers =
    "Attention : ligne %d : hauteur d'instrument %s différente de celle de la station <%s> (%s), "
    "celle de la station est gardée.";

// A field book that starts measuring without saying where the instrument stands (the polar output of
// many instruments): its first sightings go to a station of this name, which the surveyor renames.
inline constexpr const char* kUnknownStation = "INCONNUE";
inline constexpr const char* kUnknownStationOpened =
    "Attention : ligne %d : visées sans station, rattachées à la station <%s> (à renommer).";

// ---- Labels of the header comments
inline constexpr const char* kLabelFile = "Fichier";
inline constexpr const char* kLabelFormat = "Format";
inline constexpr const char* kLabelSerial = "Numéro de série";
inline constexpr const char* kLabelInstrument = "Appareil";
inline constexpr const char* kLabelDate = "Date";
inline constexpr const char* kLabelDateTime = "Date et heure";
inline constexpr const char* kLabelPpm = "Correction atmosphérique";
inline constexpr const char* kLabelPrism = "Constante de prisme";
inline constexpr const char* kGsi8 = "GSI-8";
inline constexpr const char* kGsi16 = "GSI-16";

} // namespace pyr::gsi::msg
