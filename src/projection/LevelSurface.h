#pragma once

// The reduction of a horizontal distance measured at some height to the level surface (the
// ellipsoid, or the sphere of the options for local coordinates).
namespace pyr {

// The Gaussian mean radius of curvature sqrt(rho N) of an ellipsoid at a latitude (radians), in
// metres: rho the radius of the meridian, N that of the prime vertical.
double GaussianMeanRadius(double semiMajorAxisMetre, double flattening, double latitudeRadian);

// The scale, in parts per million, that brings a distance measured at height `heightMetre` down to a
// surface of radius `radiusMetre` (direction 1: -Z / (R + Z) x 10^6, negative above the surface), or
// the opposite correction that brings a distance on the surface up to that height (direction -1:
// Z / R x 10^6). 0 when R or R + Z is not positive.
double LevelSurfaceReductionPpm(double heightMetre, double radiusMetre, int direction);

} // namespace pyr
