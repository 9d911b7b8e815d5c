#pragma once

// The words of the computation of points by intersection: the failures of a point's planimetry, the
// warning on a weak intersection and the titles, columns and labels of its listing. Those with %s are
// printf formats.
namespace pyr::inters {

// Failures of the planimetry, kept as the result's status.
inline constexpr const char* kMsgOneSighting = "Une seule visée : Calcul impossible !";
inline constexpr const char* kMsgAllConfounded = "Visées toutes confondues : Calcul impossible !";

// Shown as a message box when the best pair of rays meets under less than 5 gr.
inline constexpr const char* kMsgTooClose =
    "Attention, le résultat est probablement erroné\ncar les visées sont trop proches (< 5 gr).";

// The dialog.
inline constexpr const char* kSection = "Calcul Intersection";
inline constexpr const char* kCaption = "Calcul du point %s par intersection";
inline constexpr const char* kTooltip = "%s %s : %s";
inline constexpr const char* kLine = "%s  %s"; // the station's designation, the point sighted
inline constexpr const char* kMsgNoPoint =
    "La GéoBase <%s> n'a aucun point visé depuis une station orientée !";
inline constexpr const char* kMsgPointNotOffered =
    "Le point <%s> n'est visé depuis aucune station orientée et connue en coordonnées !";
inline constexpr const char* kMsgNoPointInSelection =
    "Aucun point calculable de la GéoBase n'est dans <%s> !";
inline constexpr const char* kMsgNoSightingKept = "Aucune visée du point <%s> ne vient des stations <%s> !";
inline constexpr const char* kMsgNoPointAsked = "Aucun point à calculer : indiquez --point ou --points.";
inline constexpr const char* kLabelX = "X =";
inline constexpr const char* kLabelY = "Y =";

// Lines of the text window: the result as the dialog shows it.
inline constexpr const char* kLinePoint = "Point %s : %s %s  %s %s  EMQ %s %s  EMQ %s %s";
inline constexpr const char* kLineAltitude = "Point %s : Z = %s  EMQ Z = %s (%d visée(s))";
inline constexpr const char* kLineSighting = "    %-14s v = %9s mgon  e = %8s m  vz = %9s mgon  ez = %8s m";
inline constexpr const char* kLineStatus = "Point %s : %s";

// The listing of a point.
inline constexpr const char* kListTitle = "Calcul du point %s";
inline constexpr const char* kListPlanimetry = "Calcul en planimétrie";
inline constexpr const char* kListAltimetry = "Calcul en altimétrie";
inline constexpr const char* kListPlanimetryColumns[] = {"Station       R", "Rep.", "V0",     "AH",
                                                         "Gisement",        "DH",   "V mgon", "El m"};
inline constexpr const char* kListAltimetryColumns[] = {
    "Station       R", "Rep.", "HI", "HP", "AV", "DH", "Z Pt", "Vz mgon", "Ez m"};
inline constexpr const char* kListApproximatePoint = "P approché :";
inline constexpr const char* kListComputedPoint = "P calculé  :";
inline constexpr const char* kListApproximateZ = "Z approché :";
inline constexpr const char* kListComputedZ = "Z calculé  :";
inline constexpr const char* kListEmq = "EMQ (m)    :";

} // namespace pyr::inters
