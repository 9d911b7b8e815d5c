#pragma once

// The texts of the export of a GéoBase to a file: its dialog, its overwrite question, its settings keys.
// Those with %s or %d are printf formats.
namespace pyr::exp {

// ---- Settings, section "ExportationPoints" of the parameter file
inline constexpr const char* kSection = "ExportationPoints";
inline constexpr const char* kKeyDernierFormat = "DernierFormat";
inline constexpr const char* kKeyParametresSeparateur = "ParametresSeparateur";
inline constexpr const char* kKeyParametresColonne = "ParametresColonne";
inline constexpr const char* kKeyParametresLeica = "ParametresLeica"; // read, never written back
inline constexpr const char* kKeyParametresSokkia = "ParametresSokkia";
inline constexpr const char* kKeyParametresDxf = "ParametresDxf";
inline constexpr const char* kKeyVisualiserFichier = "VisualiserFichier";
inline constexpr const char* kKeyEcrirePoints = "EcrirePoints";
inline constexpr const char* kKeyEcrireCarnet = "EcrireCarnet";

// The settings files delivered in the installation's Config folder, offered until the person names others.
inline constexpr const char* kDefaultSeparateur = "Param_Export.sep";
inline constexpr const char* kDefaultColonne = "Param_Export.col";
inline constexpr const char* kDefaultLeica = "Export_Leica.ini";
inline constexpr const char* kDefaultGdm = "Export_Gdm.ini";
inline constexpr const char* kDefaultSokkia = "Export_Sokkia.ini";
inline constexpr const char* kDefaultDxf = "Export_Dxf.ini";

// ---- The dialog
inline constexpr const char* kCaption = "Exportation de points";
inline constexpr const char* kLabelOutput = "&Fichier à créer :";
inline constexpr const char* kLabelSource = "GéoBase à e&xporter :";
inline constexpr const char* kLabelFormat = "F&ormat :";
inline constexpr const char* kLabelParamFile = "Paramètres du for&mat :";
inline constexpr const char* kWritePoints = "Écrire les &points";
inline constexpr const char* kWriteCarnet = "Écrire les observations du &carnet";
inline constexpr const char* kGroupElements = "Eléments à exporter";
inline constexpr const char* kOnlySelectedElements = "&Uniquement les éléments sélectionnés";
inline constexpr const char* kAllElements = "Tous les éléments de la &GéoBase courante";
inline constexpr const char* kGroupPoints = "Points à exporter";
inline constexpr const char* kOnlySelectedPoints = "&Uniquement les points sélectionnés";
inline constexpr const char* kAllPoints = "Tous les points de la &GéoBase courante";
inline constexpr const char* kRange = "&Du matricule :";
inline constexpr const char* kRangeTo = "&au matricule :";
inline constexpr const char* kViewFile = "&Visualiser le fichier après l'exportation";

// ---- OK
inline constexpr const char* kMsgNothingToExport = "Il n'y a rien à exporter !";
inline constexpr const char* kMsgNoOutput = "Indiquez le nom du fichier à créer !";
inline constexpr const char* kMsgNoSource = "Indiquez la GéoBase à exporter !";
inline constexpr const char* kMsgBadRange = "Plage de matricules incorrecte : %s !";
inline constexpr const char* kMsgNotAGeoBase =
    "Le fichier <%s> n'est pas une GéoBase : il ne peut pas être complété.";
inline constexpr const char* kMsgExported = "Exportation des points terminée : <%s>.";
inline constexpr const char* kMsgElementsExported =
    "Exportation terminée : %d élément(s) écrit(s) dans <%s>.";

// ---- The overwrite dialog
inline constexpr const char* kOverwriteCaption = "Fichier existant";
inline constexpr const char* kOverwriteExists = "Le fichier de points à créer existe déjà !";
inline constexpr const char* kOverwriteLine1 = "Vous pouvez remplacer le fichier existant ou le conserver";
inline constexpr const char* kOverwriteLine2 = "en le complètant avec les nouveaux points exportés.";
inline constexpr const char* kOverwriteDxfLine1 = "Vous pouvez remplacer le fichier ou en choisir";
inline constexpr const char* kOverwriteDxfLine2 = "un autre en appuyant sur Annuler.";
inline constexpr const char* kReplace = "Remplacer";
inline constexpr const char* kComplete = "Compléter";
inline constexpr const char* kCancel = "Annuler";
// At a terminal, the three buttons become the answers of a question.
inline constexpr const char* kOverwriteAnswers =
    "Oui : remplacer, Non : compléter, Annuler : ne rien exporter.";
inline constexpr const char* kOverwriteDxfAnswers = "Oui : remplacer, Non : ne rien exporter.";

// ---- File choices
inline constexpr const char* kChooseOutput = "Enregistrer le fichier de points sous";
inline constexpr const char* kFilterGeoBase = "GéoBases PYRALIS (*.geo)|*.geo||";
inline constexpr const char* kFilterSokkia = "SOKKIA (*.sdr)|*.sdr||";
inline constexpr const char* kFilterDxf = "Dxf v12 (*.dxf)|*.dxf||";
inline constexpr const char* kFilterPoints =
    "Fichiers de points (*.xyz)|*.xyz|Fichiers textes (*.txt)|*.txt|Tous les fichiers (*.*)|*.*||";
inline constexpr const char* kChooseSource = "Sélectionnez la GéoBase à traiter";
inline constexpr const char* kChooseParamFile = "Sélectionnez le fichier de paramètres du format";
inline constexpr const char* kFilterParamFile =
    "Fichiers de paramètres (*.ini;*.sep;*.col)|*.ini;*.sep;*.col|Tous les fichiers (*.*)|*.*||";

// ---- Command line
inline constexpr const char* kHelpOutput = "le fichier à créer (par défaut tiré du nom de la GéoBase)";
inline constexpr const char* kHelpFormat =
    "le format (0 GéoBase, 1 séparateur, 2 colonné, 3 Quendal-Pc, 4 Leica, 5 Trimble GDM, 6 Sokkia, 7 DXF)";
inline constexpr const char* kHelpAll = "tous les points (ou éléments) de la GéoBase";
inline constexpr const char* kHelpSelection =
    "uniquement les points (ou éléments) des matricules SEL (« 100-150, A1 »)";
inline constexpr const char* kHelpFrom = "du matricule A (plage de matricules)";
inline constexpr const char* kHelpTo = "au matricule B (plage de matricules)";
inline constexpr const char* kHelpParamFile = "le fichier de paramètres du format";
inline constexpr const char* kHelpPoints = "écrire les points (formats GéoBase et Quendal-Pc)";
inline constexpr const char* kHelpCarnet =
    "écrire les observations du carnet (formats GéoBase et Quendal-Pc)";
inline constexpr const char* kHelpReplace = "remplacer le fichier s'il existe";
inline constexpr const char* kHelpComplete = "compléter le fichier s'il existe";
inline constexpr const char* kHelpView = "visualiser le fichier après l'exportation";
inline constexpr const char* kHelpExport = "exporter des points de la GéoBase (options de l'exportation)";
inline constexpr const char* kBadFormat = "format « %s » inconnu : un nombre de 0 à 7";
inline constexpr const char* kBadSelection = "sélection « %s » incorrecte : %s";
inline constexpr const char* kBothModes = "--remplacer et --completer s'excluent";
inline constexpr const char* kNoCompleteDxf = "un fichier DXF ne peut pas être complété";

} // namespace pyr::exp
