#pragma once

// What the reader of SDR field books writes in the text window and in the header comments of a
// GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::sdr::msg {

// ---- Names of the data, for "Erreur ligne %d : donnée manquante pour %s !"
inline constexpr const char* kDatumTarget = "le matricule du point visé";
inline constexpr const char* kDatumBacksight = "le point de référence";
inline constexpr const char* kDatumHeight = "la hauteur de prisme";
inline constexpr const char* kDatumObservations = "les observations";

// ---- Lines read, with something to say
inline constexpr const char* kStationOpened =
    "Attention : ligne %d : visées depuis <%s> sans enregistrement de station, station ouverte sans "
    "hauteur d'instrument.";
inline constexpr const char* kUnknownUnit =
    "Attention : ligne %d : code « %c » inconnu pour %s, valeur du fichier de paramétrage prise.";
inline constexpr const char* kWhatAngles = "l'unité des angles";
inline constexpr const char* kWhatDistances = "l'unité des distances";
inline constexpr const char* kWhatOrder = "l'ordre des coordonnées";
inline constexpr const char* kAzimuthKept =
    "Attention : ligne %d : visée MC sans référence orientée à la station <%s>, son gisement est gardé "
    "comme lecture horizontale.";
inline constexpr const char* kBadChecksum =
    "Attention : ligne %d : la somme de contrôle %s ne correspond pas aux données reçues ; vérifiez le "
    "transfert du carnet.";

// ---- Labels and values of the header comments (beside those of every reader, FieldBookTexts.h)
inline constexpr const char* kLabelVersion = "Version";
inline constexpr const char* kLabelOrder = "Ordre des coordonnées";
inline constexpr const char* kLabelVertical = "Angle vertical";
inline constexpr const char* kLabelCollimation = "Collimation";
inline constexpr const char* kLabelAzimuth = "Gisement de référence";
inline constexpr const char* kSdr2x = "SDR2x";
inline constexpr const char* kSdr33 = "SDR33";
inline constexpr const char* kMils = "millièmes (6400 au tour, code %c)";
inline constexpr const char* kNorthEast = "N-E-Z";
inline constexpr const char* kEastNorth = "E-N-Z";
inline constexpr const char* kZenith = "zénithal";
inline constexpr const char* kElevation = "site (zéro à l'horizon), converti en zénithal";
inline constexpr const char* kAzimuthValue = "%s -> %s : %s gr";

} // namespace pyr::sdr::msg
