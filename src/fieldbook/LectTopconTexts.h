#pragma once

// What the reader of Topcon GTS-7 field books writes in the text window and in the header comments of a
// GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::topcon::msg {

// ---- Names of the data, for "Erreur ligne %d : donnée manquante pour %s !"
inline constexpr const char* kDatumObservation = "l'observation de la visée <%s>";
inline constexpr const char* kDatumMeasures = "les mesures de l'observation";
inline constexpr const char* kDatumCoordinates = "les coordonnées";

// ---- Lines skipped
inline constexpr const char* kNoSighting = "Erreur ligne %d : pas de visée pour cette observation !";
inline constexpr const char* kNoOwner = "Erreur ligne %d : pas de station ni de visée pour ces coordonnées !";
inline constexpr const char* kBadUnits =
    "Erreur ligne %d : unités « %s » inconnues (M ou F, puis D ou G), celles du fichier de paramétrage "
    "sont gardées !";
// An offset shot changes the point that the previous sighting measured: it is not applied, the surveyor
// corrects the sighting by hand.
inline constexpr const char* kOffsetIgnored =
    "Attention : ligne %d : excentrement (OFFSET %s) non appliqué, la visée <%s> est à corriger !";

// ---- Comments
// The orientation that the instrument was given on its backsight, angles in grads.
inline constexpr const char* kOrientation = "Orientation sur <%s> : gisement %s gr, lecture %s gr";

// ---- Labels of the header comments (beside those of every reader, FieldBookTexts.h)
inline constexpr const char* kLabelName = "Nom";
inline constexpr const char* kLabelTemperature = "Température, pression";
inline constexpr const char* kLabelControl = "Contrôle";
inline constexpr const char* kDms = "degrés (ddd.mmss)";
inline constexpr const char* kMils = "mils";

} // namespace pyr::topcon::msg
