#pragma once

#include "core/Undefined.h"

#include <string>
#include <vector>

// The computation of a new point by intersection: sightings taken on the point from two or more stations
// whose coordinates and orientation V0 are known. In planimetry, the two rays that meet under the widest
// angle give an approximate point, which one least-squares step on all the directions then improves;
// in altimetry, each sighting with a zenith angle gives a height, which a Gauss-Newton fit of the zenith
// angles refines. Angles in grads, bearings clockwise from the +Y axis (X is the easting), lengths and
// coordinates in metres. A value that is not known, or that the geometry cannot give, is kUndefined:
// the records never hold NaN or infinity.
namespace pyr {

// One sighting of the point: inputs filled by the gathering, outputs by the computation. The sighting
// arrives turned to face left and reduced for eccentric offsets and instrument constants; its horizontal
// distance is corrected for scale.
struct InterSighting {
    // Inputs.
    int index = -1;         // the sighting element in the GéoBase
    std::string station;    // station name; two sightings from one station never make the pair
    int reprise = 0;        // the station's occurrence (reprise), shown by the listing; 0 when not given
    std::string reference;  // the sighted point's name as the list line shows it
    double xs = kUndefined; // the station point, m
    double ys = kUndefined;
    double zs = kUndefined;
    double v0 = kUndefined; // the station's orientation, gr
    double hi = kUndefined; // instrument height with the station's vertical offset, m
    double hp = kUndefined; // target height, m (0 when target heights are not used)
    double ah = kUndefined; // horizontal direction, gr
    double av = kUndefined; // zenith angle, gr (0 at the zenith, 100 level)
    double di = kUndefined; // slope distance, m
    // Horizontal distance, m: measured (corrected) on input; once the point's planimetry is computed,
    // the distance from the station to it, which is also the one the altimetry uses.
    double dh = kUndefined;

    // Outputs.
    double v = kUndefined;  // direction residual, gr: computed bearing less V0 + AH, within [-200, 200]
    double e = kUndefined;  // its linear value across the line of sight at the point, m
    double vz = kUndefined; // zenith residual, gr: computed zenith angle less the measured one
    double ez = kUndefined; // its linear value, m: (cos zc - cos AV) x DH
    double zi = kUndefined; // the altitude this sighting alone gives, m
};

// Flags of a computation, in InterResult::flags.
enum : int {
    kInterComputed = 1,     // the planimetry was computed
    kInterTooClose = 4,     // computed, but the best pair of rays meets under less than 5 gr
    kInterTooFew = 8,       // fewer than two sightings usable in planimetry
    kInterParallel = 0x100, // no pair of rays from two stations that meet
};

// Below this intersection angle (gr), the point is computed but probably wrong.
inline constexpr double kInterMinAngle = 5.0;
// The Gauss-Newton fit of the altitude stops when a step moves Z by no more than this (m), or after
// kInterMaxIterations steps.
inline constexpr double kInterAltitudeStep = 1e-6;
inline constexpr int kInterMaxIterations = 10;

// One point and its computation.
struct InterResult {
    std::string mat; // the point's name
    std::vector<InterSighting> sightings;

    // Planimetry.
    int first = -1, second = -1; // ranks in `sightings` of the pair of rays that gave the approximate point
    double angle = kUndefined;   // the angle under which they meet, gr, in (0, 100]
    double x0 = kUndefined;      // approximate point, m
    double y0 = kUndefined;
    double x = kUndefined; // computed point, m
    double y = kUndefined;
    double emqX = kUndefined; // its root-mean-square errors, m (three sightings or more)
    double emqY = kUndefined;
    double sigma0 = kUndefined; // root-mean-square direction residual, gr

    // Altimetry.
    int altitudes = 0;        // sightings that gave an altitude
    int iterations = 0;       // Gauss-Newton steps taken
    double z0 = kUndefined;   // mean of the sightings' altitudes, m
    double z = kUndefined;    // computed altitude, m
    double emqZ = kUndefined; // its root-mean-square error, m (two altitudes or more)

    int flags = 0;      // kInterComputed, kInterTooClose, kInterTooFew, kInterParallel
    std::string status; // the French text of a failure of the planimetry, "" otherwise
};

// The bearing of the line of sight, V0 + AH in [0, 400), when both are known.
double SightedBearing(const InterSighting& sighting);

// A sighting that takes part in the planimetry: its station's coordinates, the station's V0 and the
// horizontal direction are known.
bool UsableInPlanimetry(const InterSighting& sighting);

// Computes the point from its sightings: the planimetry when `plani`, the altimetry when `alti`. The
// outputs of the result and of its sightings are reset first, and those of a part switched off stay
// undefined. When the planimetry is off or fails, the altimetry works from the measured horizontal
// distances, so that a point seen with a distance from a single station still gets its Z. A computed
// planimetry replaces the sightings' dh by the distances to the point: the sightings are gathered
// afresh before each computation. Returns result.flags.
int ComputeIntersection(InterResult& result, bool plani, bool alti);

} // namespace pyr
