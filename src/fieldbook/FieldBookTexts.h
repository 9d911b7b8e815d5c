#pragma once

// The texts that the reading of field books shows in message boxes and writes in the text window. Those
// with %s or %d are printf formats.
namespace pyr::fb {

// ---- Message boxes of a conversion
inline constexpr const char* kMsgCannotOpenCarnet = "Impossible d'ouvrir le fichier carnet !";
// The field book named, and why the system could not open it.
inline constexpr const char* kCarnetPathAndReason = "%s\n(%s : %s)";
inline constexpr const char* kMsgCannotOpenCarnetForReading =
    "Impossible d'ouvrir le fichier carnet en lecture !\n(%s)";
inline constexpr const char* kMsgNoCodeTableLoaded = "Pas de table de codes actuellement chargée !!!";
inline constexpr const char* kMsgImpossibleCase = "Cas impossible en théorie !!!";
inline constexpr const char* kMsgZeroPrismHeight =
    "Certaines observations ont une hauteur de prisme à zéro !";
inline constexpr const char* kMsgPreformatMissing =
    "Impossible de trouver le programme de préformattage :\n%s";
inline constexpr const char* kMsgPreformatFailed = "Impossible de lancer le programme de préformattage :\n%s";
inline constexpr const char* kMsgReaderMissing =
    "La lecture des carnets %s n'est pas encore disponible dans cette version de PYRALIS Calculs Topo.";
inline constexpr const char* kMsgCodeTableUnreadable = "La table de codes <%s> ne peut pas être lue !";
inline constexpr const char* kMsgCannotWriteFile = "Impossible d'écrire le fichier <%s> !";
// A message, then on their own lines the GéoBase that could not be written and why.
inline constexpr const char* kGeoBaseAndReason = "%s\n<%s>\n(%s).";
inline constexpr const char* kGeoBaseKept = "\nLa GéoBase est restée telle qu'elle était.";
// A field book that gave no element: empty, cut at its start, or written in another format than the one of
// the command.
inline constexpr const char* kMsgNothingRead =
    "Carnet <%s> : aucun élément lu au format « %s » !\nLe carnet est vide ou n'est pas de ce format.";

// ---- The reading dialog
inline constexpr const char* kCaption = "Lecture du carnet";
inline constexpr const char* kMsgCarnetMissing = "Le fichier carnet indiqué n'existe pas !";
inline constexpr const char* kMsgParamFileMissing = "Le fichier de paramétrage indiqué n'existe pas !";
// A message followed by what it is about (the path of a file, the reason in words of a failure).
inline constexpr const char* kInParentheses = "%s\n(%s)";
inline constexpr const char* kAskCreateParamFile = "%s\nVoulez-vous en créer un nouveau ?";
inline constexpr const char* kAskCodeTable = "%s%s";
inline constexpr const char* kNoCodeTableNamed = "Aucune table de codes n'est indiquée.";
inline constexpr const char* kCodeTableMissing = "La table de codes indiquée n'existe pas.";
inline constexpr const char* kAskNoInterpretation = "\nVoulez-vous qu'aucune commande ne soit interprétée ?";
inline constexpr const char* kAskReplaceGeoBase = "%s\n%s";
inline constexpr const char* kGeoBaseExists = "La GéoBase indiquée existe déjà !";
inline constexpr const char* kReplaceIt = "Voulez-vous la remplacer ?";
inline constexpr const char* kMsgUnknownInstrument =
    "L'appareil « %s » n'est pas dans la liste des appareils des options.";

// File choices of the dialog: titles and filters.
inline constexpr const char* kChooseCarnet = "Sélectionnez le fichier carnet à traiter :";
inline constexpr const char* kCarnetFilter = "Tous les fichiers (*.*)|*.*||";
inline constexpr const char* kChooseGeoBase = "Nom de la GéoBase à créer :";
inline constexpr const char* kChooseParamFile = "Sélectionnez le fichier de paramétrage à utiliser :";
inline constexpr const char* kChooseCodeTable = "Nom de la table à utiliser :";

// ---- The parameter set of a format ("Parametrage")
inline constexpr const char* kMsgParamUnreadable =
    "Impossible de lire le fichier de paramétrage <%s> !\n(%s)";
inline constexpr const char* kMsgParamBadWord =
    "Fichier de paramétrage <%s> :\nvaleur « %s » incorrecte pour %s (valeurs possibles : %s) !";
inline constexpr const char* kMsgParamBadCount =
    "Fichier de paramétrage <%s> :\nvaleur « %s » incorrecte pour %s (un nombre entier de 0 à %d) !";
inline constexpr const char* kMsgParamBadText = "Fichier de paramétrage <%s> :\n%s incorrect : %s !";
inline constexpr const char* kWhyEmptySeparator = "le séparateur est vide";
inline constexpr const char* kWhyUnknownField = "champ inconnu « %s »";
inline constexpr const char* kWhyFieldTwice = "champ « %s » donné deux fois";
inline constexpr const char* kWhyFieldNotHere = "champ « %s » inattendu pour ce type d'enregistrement";
inline constexpr const char* kWhyNoColumns = "champ « %s » sans ses colonnes (%s:début-fin)";
inline constexpr const char* kWhyBadColumns = "colonnes incorrectes pour le champ « %s »";
inline constexpr const char* kWhyColumnsInDelimited =
    "colonnes données au champ « %s » d'un format séparateur";
inline constexpr const char* kWhyNoMatricule = "le champ MATRICULE manque";
inline constexpr const char* kWhyTypeEverywhere =
    "le champ TYPE doit figurer dans toutes les listes ou dans aucune";

// ---- The editor's reading menu
inline constexpr const char* kAskAppendToGeoBase =
    "La GéoBase courante n'est pas vide !\nVoulez-vous ajouter les nouvelles données à la fin de celle-ci "
    "?\n(Répondez par NON pour créer une nouvelle GéoBase.)";
inline constexpr const char* kMsgUnknownFormat = "Format de carnet inconnu : « %s » (formats : %s).";

// ---- The text window
inline constexpr const char* kCreating = "\nCréation de la GéoBase en cours ...";
inline constexpr const char* kFinished = " ... terminée : %d lignes écrites.";
inline constexpr const char* kProgress = "   ... %d lignes lues (%d %%)";
inline constexpr const char* kBadLength = "Attention : ligne %d de longueur incorrecte (%d / %d) !";
inline constexpr const char* kCutLastLine =
    "Attention : ligne %d sans fin de ligne, le carnet semble coupé ; elle est lue telle quelle !";
inline constexpr const char* kUnrecognised = "Erreur ligne %d : donnée non reconnue !";
inline constexpr const char* kMissingDatum = "Erreur ligne %d : donnée manquante pour %s !";
inline constexpr const char* kNoStationForHI =
    "Erreur ligne %d : pas de station pour cette hauteur d'instrument !";
inline constexpr const char* kIncompleteCommand = "Erreur ligne %d : la commande est incomplète !";
inline constexpr const char* kStringRead = " -> Chaîne lue = <%s>";
inline constexpr const char* kBadNumber = "Erreur ligne %d : valeur numérique incorrecte <%s> !";
inline constexpr const char* kExtraFields = "Attention : ligne %d : %d champ(s) en trop, ignoré(s).";
inline constexpr const char* kNewerQuendal = "Attention : ligne %d : carnet Quendal-Pc de version %d, plus "
                                             "récente que celle de ce programme (%d) ; il est lu quand même.";
inline constexpr const char* kReadAsWindows1252 = "Carnet <%s> : fichier lu en Windows-1252.";

// ---- Texts of every instrument reader
// Names of the data, for kMissingDatum.
inline constexpr const char* kDatumPoint = "le matricule du point";
inline constexpr const char* kDatumStation = "le nom de la station";
inline constexpr const char* kDatumContent = "les observations ou les coordonnées du point";
inline constexpr const char* kDatumCoordinates = "les coordonnées du point";
inline constexpr const char* kDatumEast = "la coordonnée Est";
inline constexpr const char* kDatumNorth = "la coordonnée Nord";

// Lines skipped.
inline constexpr const char* kRefused = "Erreur ligne %d : donnée refusée par les contrôles de la GéoBase !";

// A field book that starts measuring without saying where the instrument stands (the polar output of
// many instruments): its first sightings go to a station of this name, which the surveyor renames.
inline constexpr const char* kUnknownStation = "INCONNUE";
inline constexpr const char* kUnknownStationOpened =
    "Attention : ligne %d : visées sans station, rattachées à la station <%s> (à renommer).";

// Labels of the header comments of a GéoBase, and the units they name.
inline constexpr const char* kLabelFile = "Fichier";
inline constexpr const char* kLabelFormat = "Format";
inline constexpr const char* kLabelInstrument = "Appareil";
inline constexpr const char* kLabelSerial = "Numéro de série";
inline constexpr const char* kLabelSoftware = "Logiciel";
inline constexpr const char* kLabelJob = "Chantier";
inline constexpr const char* kLabelDate = "Date";
inline constexpr const char* kLabelUnits = "Unités";
inline constexpr const char* kLabelAngles = "Unité des angles";
inline constexpr const char* kLabelDistances = "Unité des distances";
inline constexpr const char* kLabelPpm = "Correction atmosphérique";
inline constexpr const char* kLabelAtmosphere = "Atmosphère";
inline constexpr const char* kLabelTemperature = "Température";
inline constexpr const char* kLabelPrism = "Constante de prisme";
inline constexpr const char* kLabelScale = "Facteur d'échelle";
inline constexpr const char* kMetres = "mètres";
inline constexpr const char* kFeet = "pieds";
inline constexpr const char* kGrads = "grades";
inline constexpr const char* kDegrees = "degrés décimaux";

} // namespace pyr::fb
