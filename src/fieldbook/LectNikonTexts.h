#pragma once

// What the reader of Nikon field books writes in the text window and in the header comments of a
// GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::nikon::msg {

// ---- Names of the data, for "Erreur ligne %d : donnée manquante pour %s !"
inline constexpr const char* kDatumPoint = "le matricule du point";
inline constexpr const char* kDatumStation = "le nom de la station";
inline constexpr const char* kDatumObservation = "les observations du point";
inline constexpr const char* kDatumCoordinates = "les coordonnées du point";
inline constexpr const char* kDatumEast = "la coordonnée Est";
inline constexpr const char* kDatumNorth = "la coordonnée Nord";

// ---- Lines skipped
inline constexpr const char* kRefused = "Erreur ligne %d : donnée refusée par les contrôles de la GéoBase !";
inline constexpr const char* kNoStationForSighting = "Erreur ligne %d : pas de station pour cette visée !";
inline constexpr const char* kBadUnits =
    "Erreur ligne %d : unités « %s » inconnues (M ou F, puis D, G ou M) !";
inline constexpr const char* kBadType = "Erreur ligne %d : type d'enregistrement « %s » inconnu !";

// ---- Lines read, with something to say
inline constexpr const char* kUnknownSetting =
    "Attention : ligne %d : valeur « %s » inconnue pour « %s », réglage précédent gardé.";

// ---- Labels of the header comments
inline constexpr const char* kLabelFile = "Fichier";
inline constexpr const char* kLabelFormat = "Format";
inline constexpr const char* kLabelJob = "Chantier";
inline constexpr const char* kLabelCreated = "Création";
inline constexpr const char* kLabelDownloaded = "Transfert";
inline constexpr const char* kLabelInstrument = "Appareil";
inline constexpr const char* kLabelSoftware = "Logiciel";
inline constexpr const char* kLabelDescription = "Description";
inline constexpr const char* kLabelClient = "Client";
inline constexpr const char* kLabelComments = "Remarques";
inline constexpr const char* kLabelDistances = "Unité des distances";
inline constexpr const char* kLabelAngles = "Unité des angles";
inline constexpr const char* kLabelZeroAzimuth = "Zéro des azimuts";
inline constexpr const char* kLabelZeroVA = "Zéro vertical";
inline constexpr const char* kLabelOrder = "Ordre coordonnées";
inline constexpr const char* kLabelRawHA = "Lectures Hz";
inline constexpr const char* kLabelTilt = "Compensateur";
inline constexpr const char* kDtmFormat = "Nikon DTM (virgules)";

// The backsight a station declares, as a comment of its known parts: its point, the bearing and the
// horizontal reading of its direction, in grads.
inline constexpr const char* kBacksightStation = "Station <%s> :";
inline constexpr const char* kBacksightPoint = " référence <%s>";
inline constexpr const char* kBacksightBearing = " gisement %s gr";
inline constexpr const char* kBacksightReading = " lecture Hz %s gr";

} // namespace pyr::nikon::msg
