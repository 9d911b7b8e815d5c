#pragma once

// The words of the computation of a station by the combined method (sightings taken from the station on
// known points, and on the station from other stations already placed and oriented): the failures of its
// planimetry and the warning on a weak crossing of the line and the circle.
namespace pyr::recoup {

// Failures of the planimetry, kept as the result's status. The first is spelled as the surveyors have
// always read it.
inline constexpr const char* kMsgTooFew = "1 visée d'intersection et 2 visées de relèvement minimun";

// Shown as a message box when the chosen line meets its circle under less than 5 gr; the result is kept.
inline constexpr const char* kMsgWeakCrossing =
    "Intersection défavorable entre la droite et le cercle (< 5 grades)";

} // namespace pyr::recoup
