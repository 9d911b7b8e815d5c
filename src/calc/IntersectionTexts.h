#pragma once

// The words of the computation of points by intersection: the failures of a point's planimetry, the
// warning on a weak intersection and the titles and labels of its listing. Those with %s are printf
// formats.
namespace pyr::inters {

// Failures of the planimetry, kept as the result's status.
inline constexpr const char* kMsgOneSighting = "Une seule visée : Calcul impossible !";
inline constexpr const char* kMsgAllConfounded = "Visées toutes confondues : Calcul impossible !";

// Shown as a message box when the best pair of rays meets under less than 5 gr.
inline constexpr const char* kMsgTooClose =
    "Attention, le résultat est probablement erroné\ncar les visées sont trop proches (< 5 gr).";

} // namespace pyr::inters
