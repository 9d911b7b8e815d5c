#pragma once

#include "calc/Resection.h"
#include "core/Undefined.h"

// The computation of a station by the combined method ("recoupement"): the station's place, orientation
// and altitude from two kinds of sightings, those taken from the station on known points (resection)
// and those taken on the station from other stations already placed and oriented (intersection). Two
// resection sightings on A and B put the station on the circle through A and B that sees AB under the
// angle between their directions; one intersection sighting puts it on a line from its station; where
// the line meets the circle lies an approximate place. The adjustment of the resection then uses every
// sighting of both kinds. Angles in grads, bearings clockwise from the +Y axis (X is the easting),
// lengths and coordinates in metres. Never NaN or infinity in a result: unknown is kUndefined.
namespace pyr {

// Two approximate places closer than this (m) agree: they come from different sightings that fix the
// same station.
inline constexpr double kRecoupAgreement = 0.6;
// A place this close (m) to one of the circle's known points is that point itself, not a station.
inline constexpr double kRecoupNearKnown = 0.01;
// Below this angle (gr) between the line and the circle, the crossing is weak: the place is kept with a
// warning.
inline constexpr double kRecoupMinCrossing = 5.0;
// The line counts as tangent to the circle when its distance from the centre equals the radius within
// this (m): far below any measurement, above the rounding of coordinates of a few million metres.
inline constexpr double kTangentTolerance = 1e-8;

// Where a line meets a circle: none, one point (tangent) or two, in the order met going from the line's
// first point towards its second.
struct LineCircle {
    int count = 0;
    double x[2] = {kUndefined, kUndefined};
    double y[2] = {kUndefined, kUndefined};
};

// The line through (x1, y1) and (x2, y2) against the circle of centre (xc, yc) and radius r. Two equal
// points of the line or a radius not positive give no point.
LineCircle IntersectLineCircle(double x1, double y1, double x2, double y2, double xc, double yc, double r);

// Computes the station from its sightings of both kinds (StationSighting::onStation): the planimetry when
// `plani`, the altimetry when `alti`. It needs one intersection sighting and two resection sightings at
// least (kStationTooFew); the checks may leave no place (kStationFailed); a weak crossing of the chosen
// line and circle sets kStationWeakCrossing beside kStationComputed. The outputs of the result and of its
// sightings are reset first, and those of a part switched off stay undefined. With the planimetry off or
// failed, the altimetry works from the measured horizontal distances. The station's instrument height is
// result.hi. Returns result.flags.
int ComputeRecoupement(StationResult& result, bool plani, bool alti);

} // namespace pyr
