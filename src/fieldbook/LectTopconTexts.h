#pragma once

// What the reader of Topcon GTS-7 field books writes in the text window and in the header comments of a
// GéoBase. Those with %d or %s are printf formats; the line number comes first.
namespace pyr::topcon::msg {

// ---- Names of the data, for "Erreur ligne %d : donnée manquante pour %s !"
inline constexpr const char* kDatumStation = "le nom de la station";
inline constexpr const char* kDatumPoint = "le matricule du point";
inline constexpr const char* kDatumObservation = "l'observation de la visée <%s>";
inline constexpr const char* kDatumMeasures = "les mesures de l'observation";
inline constexpr const char* kDatumCoordinates = "les coordonnées";

// ---- Lines skipped
inline constexpr const char* kRefused = "Erreur ligne %d : donnée refusée par les contrôles de la GéoBase !";
inline constexpr const char* kNoSighting = "Erreur ligne %d : pas de visée pour cette observation !";
inline constexpr const char* kNoOwner = "Erreur ligne %d : pas de station ni de visée pour ces coordonnées !";
inline constexpr const char* kBadUnits =
    "Erreur ligne %d : unités « %s » inconnues (M ou F, puis D ou G), celles du fichier de paramétrage "
    "sont gardées !";
// An offset shot changes the point that the previous sighting measured: it is not applied, the surveyor
// corrects the sighting by hand.
inline constexpr const char* kOffsetIgnored =
    "Attention : ligne %d : excentrement (OFFSET %s) non appliqué, la visée <%s> est à corriger !";

// A field book that starts measuring without saying where the instrument stands: its first sightings go
// to a station of this name, which the surveyor renames.
inline constexpr const char* kUnknownStation = "INCONNUE";
inline constexpr const char* kUnknownStationOpened =
    "Attention : ligne %d : visées sans station, rattachées à la station <%s> (à renommer).";

// ---- Comments
// The orientation that the instrument was given on its backsight, angles in grads.
inline constexpr const char* kOrientation = "Orientation sur <%s> : gisement %s gr, lecture %s gr";

// ---- Labels of the header comments
inline constexpr const char* kLabelFile = "Fichier";
inline constexpr const char* kLabelSoftware = "Logiciel";
inline constexpr const char* kLabelJob = "Chantier";
inline constexpr const char* kLabelDate = "Date";
inline constexpr const char* kLabelName = "Nom";
inline constexpr const char* kLabelInstrument = "Appareil";
inline constexpr const char* kLabelUnits = "Unités";
inline constexpr const char* kLabelScale = "Facteur d'échelle";
inline constexpr const char* kLabelAtmosphere = "Atmosphère";
inline constexpr const char* kLabelTemperature = "Température, pression";
inline constexpr const char* kLabelControl = "Contrôle";
inline constexpr const char* kMetres = "mètres";
inline constexpr const char* kFeet = "pieds";
inline constexpr const char* kDms = "degrés (ddd.mmss)";
inline constexpr const char* kGrads = "grades";
inline constexpr const char* kDegrees = "degrés décimaux";
inline constexpr const char* kMils = "mils";

} // namespace pyr::topcon::msg
