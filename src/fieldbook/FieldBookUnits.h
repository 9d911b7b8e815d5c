#pragma once

#include <string_view>

// The units in which field books write their angles and lengths, and their conversion to the grads and
// metres of a GéoBase.
namespace pyr {

enum class AngleUnit {
    Grads,   // 400 to the circle
    Degrees, // decimal degrees, 360 to the circle
    Dms,     // sexagesimal degrees written ddd.mmss (12.3045 is 12° 30' 45")
    Mils     // 6400 to the circle
};

enum class DistanceUnit {
    Metres,
    Feet // the international foot, 0.3048 m
};

inline constexpr double kMetresPerFoot = 0.3048;

// Decimal degrees of an angle written ddd.mmss (a negative one keeps its sign); the seconds may carry
// decimals (12.304512 is 12° 30' 45.12").
double DmsToDegrees(double dms);
// The same from its text, digit by digit, so that no rounding of the binary value shifts a second:
// false when the text is no number.
bool DmsTextToDegrees(std::string_view text, double& degrees);

double ToGrads(double angle, AngleUnit unit);
double ToMetres(double length, DistanceUnit unit);

// A sighting that the field book gives with its horizontal distance (m) rather than its slope distance:
// when `slope` is unknown, completes it and, where it can, the zenith angle (gr). By the zenith angle
// (slope = horizontal / sin V); without one, by the height difference from the tilting axis to the
// target (slope = hypot, V = atan2(horizontal, difference)); with neither, the sighting is taken as
// horizontal (100 gr) so that its distance is kept. A vertical sighting (sin V = 0) gets no distance, nor
// a sighting of no length an angle.
void SlopeFromHorizontal(double horizontal, double heightDifference, double& zenith, double& slope);

} // namespace pyr
