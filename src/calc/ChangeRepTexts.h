#pragma once

// The words of the change of reference frame: the dialog's labels, its status and closing texts, the
// command line's help and refusals. Those with %s, %d or %f are printf formats.
namespace pyr::rep {

// ---- The dialog
inline constexpr const char* kCaption = "Changement de repère";
inline constexpr const char* kFrame1 = "Repère 1";
inline constexpr const char* kFrame2 = "Repère 2";
inline constexpr const char* kColumnX = "X";
inline constexpr const char* kColumnY = "Y";
inline constexpr const char* kFirstPoint = "Premier point :";
inline constexpr const char* kSecondPoint = "Second point :";
inline constexpr const char* kResults = "Résultats";
inline constexpr const char* kLabelRotation = "Rotation =";
inline constexpr const char* kUnitGrads = "gr";
inline constexpr const char* kLabelTranslationX = "Translation en X =";
inline constexpr const char* kLabelTranslationY = "Translation en Y =";
inline constexpr const char* kOptions = "Options";
inline constexpr const char* kLabelSelection = "&Sélection :";
inline constexpr const char* kNotANumber = "« %s » n'est pas un nombre !";

// The status of the distances between the two common points.
inline constexpr const char* kDistances = "Distance dans le repère 1 = %.4f m\nDistance dans le repère 2 = "
                                          "%.4f m\nDifférence des distances = %.4f m";
inline constexpr const char* kDistance1 = "Distance dans le repère 1 = %.4f m";
inline constexpr const char* kDistance2 = "Distance dans le repère 2 = %.4f m";
// The results as the dialog shows them.
inline constexpr const char* kRotationFormat = "%.5f";
inline constexpr const char* kTranslationFormat = "%.4f";

// The closing message.
inline constexpr const char* kDone = "%d Points ont été calculés\n%d Orientations de station modifiées";

// ---- The check boxes ('&' before the shortcut letter)
inline constexpr const char* kBoxChangeFrame = "&Changer le repère des points";
inline constexpr const char* kBoxModifyV0 = "Modifier les &V0 des stations";
inline constexpr const char* kBoxAllPoints = "&Tous les points";
inline constexpr const char* kBoxFixedPoints = "Déplacer aussi les points &fixes";
inline constexpr const char* kBoxProjection =
    "&Projeter les points sur la droite des deux points du repère 1";
inline constexpr const char* kBoxSwapYZ = "Inverser les coordonnées X et Z";
inline constexpr const char* kBoxKeepZ = "Conserver le &Z";

// ---- The command line
inline constexpr const char* kHelpAction =
    "change le repère des points de la GéoBase (et ses V0 avec --modif-v0 1), puis l'enregistre";
inline constexpr const char* kHelpFrame1 = "les deux points communs dans le repère de départ";
inline constexpr const char* kHelpFrame2 = "les deux mêmes points dans le repère d'arrivée";
inline constexpr const char* kHelpSelection = "les points (et stations) à changer de repère ; implique "
                                              "--tous-les-points 0";
inline constexpr const char* kHelpChangeFrame = "applique la rotation et la translation aux points";
inline constexpr const char* kHelpModifyV0 = "tourne les V0 connus des stations de la même rotation";
inline constexpr const char* kHelpAllPoints = "tous les points, sinon ceux de --selection";
inline constexpr const char* kHelpFixedPoints = "déplace aussi les points déclarés invariants";
inline constexpr const char* kHelpProjection =
    "projette d'abord les points sur la droite des deux points du repère 1";
inline constexpr const char* kHelpSwapYZ = "écrit l'altitude en Y (coupe le long de la droite)";
inline constexpr const char* kHelpKeepZ = "avec --inverser-yz 1, garde l'altitude en Z";
inline constexpr const char* kBadFrame = "--%s : « %s » n'est pas de la forme XA,YA,XB,YB (quatre nombres).";
inline constexpr const char* kFramesIncomplete =
    "Les deux points communs doivent être connus dans les deux repères : indiquez --repere1 XA,YA,XB,YB et "
    "--repere2 XA,YA,XB,YB.";

} // namespace pyr::rep
