#pragma once

// Two rays in the plane, each leaving a known point along a bearing: the angle under which they meet and
// the point where they meet. Bearings in grads, clockwise from the +Y axis (X is the easting);
// coordinates in metres.
namespace pyr {

// Below this absolute sine of the angle between two bearings, the rays count as parallel: 1e-6 is an
// angle of 0.06 mgon, under which the point would move by more than a kilometre for a millimetre of
// error across the rays.
inline constexpr double kParallelRaysSine = 1e-6;

// The angle under which two bearings meet, folded into [0, 100] gr: 0 for parallel or opposite rays,
// 100 for perpendicular ones. The larger it is, the better a pair of sightings fixes a point.
double IntersectionAngle(double g1, double g2);

// The point where the line through (xa, ya) along the bearing g1 meets the line through (xb, yb) along
// g2. The point lies at the signed distance L = ((xb - xa) cos g2 - (yb - ya) sin g2) / sin(g1 - g2)
// from A along g1 (negative behind A). False, with x and y untouched, when |sin(g1 - g2)| is below
// kParallelRaysSine.
bool IntersectRays(double xa, double ya, double g1, double xb, double yb, double g2, double& x, double& y);

} // namespace pyr
