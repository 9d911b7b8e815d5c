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
