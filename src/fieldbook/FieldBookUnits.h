#pragma once

#include "core/AngleUnits.h"

// The units in which field books write their lengths, and their conversion to the metres of a GéoBase;
// the angle units and their conversions to grads are core/AngleUnits.h, which this header brings in.
namespace pyr {

enum class DistanceUnit {
    Metres,
    Feet // the international foot, 0.3048 m
};

inline constexpr double kMetresPerFoot = 0.3048;

double ToMetres(double length, DistanceUnit unit);

// A sighting that the field book gives with its horizontal distance (m) rather than its slope distance:
// when `slope` is unknown, completes it and, where it can, the zenith angle (gr). By the zenith angle
// (slope = horizontal / sin V); without one, by the height difference from the tilting axis to the
// target (slope = hypot, V = atan2(horizontal, difference)); with neither, the sighting is taken as
// horizontal (100 gr) so that its distance is kept. A vertical sighting (sin V = 0) gets no distance, nor
// a sighting of no length an angle.
void SlopeFromHorizontal(double horizontal, double heightDifference, double& zenith, double& slope);

} // namespace pyr
