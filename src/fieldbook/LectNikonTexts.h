#pragma once

// What the reader of Nikon field books writes in the text window and in the header comments of a
// GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::nikon::msg {

// ---- Names of the data, for "Erreur ligne %d : donnée manquante pour %s !"
inline constexpr const char* kDatumObservation = "les observations du point";

// ---- Lines skipped
inline constexpr const char* kBadUnits =
    "Erreur ligne %d : unités « %s » inconnues (M ou F, puis D, G ou M) !";
inline constexpr const char* kBadType = "Erreur ligne %d : type d'enregistrement « %s » inconnu !";

// ---- Lines read, with something to say
inline constexpr const char* kUnknownSetting =
    "Attention : ligne %d : valeur « %s » inconnue pour « %s », réglage précédent gardé.";

// ---- Labels of the header comments (beside those of every reader, FieldBookTexts.h)
inline constexpr const char* kLabelCreated = "Création";
inline constexpr const char* kLabelDownloaded = "Transfert";
inline constexpr const char* kLabelDescription = "Description";
inline constexpr const char* kLabelClient = "Client";
inline constexpr const char* kLabelComments = "Remarques";
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
