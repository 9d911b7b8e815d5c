#pragma once

#include "core/Undefined.h"

#include <string>
#include <vector>

// The computation of a polygonal traverse (cheminement polygonal): a chain of stations, each sighting
// the one before it (back) and the one after it (forward), run from a known station to a known station
// (or back to the first one), its angular, planimetric and height misclosures measured and distributed.
// Angles are in grads, lengths in metres, X east and Y north; a bearing is counted clockwise from north.
namespace pyr {

// How a traverse is tied to what is known.
enum class TraverseKind {
    Linked,   // "encadré": known and oriented at both ends: angular, planimetric and height closures
    Position, // known at both ends, oriented at the start only: planimetric and height closures
    Closed,   // "fermé": back on its oriented starting station: every closure
    Open,     // "antenne": known and oriented at the start only: no closure, no control
};

// How the planimetric misclosure is shared among the legs.
enum class TraverseRule {
    Compass,   // in proportion to the leg lengths
    Component, // each component in proportion to the legs' differences of that component
};

// One station of the traverse, as its reduced sightings give it.
struct TraverseStation {
    std::string name;
    // The horizontal readings (grads) to the previous and the next station; the first station has no
    // back reading, the last no forward reading (kUndefined).
    double back = kUndefined;
    double forward = kUndefined;
    // The horizontal distance and the height difference to the next station (the mean of both
    // directions when both were measured); kUndefined on the last station, and for a height not measured.
    double distance = kUndefined;
    double dz = kUndefined;
};

struct TraverseInput {
    TraverseKind kind = TraverseKind::Linked;
    TraverseRule rule = TraverseRule::Compass;
    // Which closures are distributed; one that is not is still measured and reported.
    bool distributeAngular = true;
    bool distributePlanimetric = true;
    bool distributeHeight = true;
    std::vector<TraverseStation> stations; // in their order; a closed traverse does not repeat the first
    // The known ends: the first station's place and V0 (its orientation), the last station's place
    // and V0 (a linked traverse), its place only (Position). Z kUndefined: no height closure.
    double x0 = kUndefined, y0 = kUndefined, z0 = kUndefined, v00 = kUndefined;
    double xn = kUndefined, yn = kUndefined, zn = kUndefined, v0n = kUndefined;
};

struct TraverseLegResult {
    double bearing = 0.0; // compensated
    double distance = 0.0;
    double dx = 0.0, dy = 0.0; // from the compensated bearing, before the planimetric corrections
    double cx = 0.0, cy = 0.0; // the corrections of the planimetric closure
    double dz = kUndefined;    // measured
    double cz = 0.0;           // the correction of the height closure
};

struct TraverseStationResult {
    std::string name;
    double x = 0.0, y = 0.0, z = kUndefined;
    double v0 = 0.0;              // the compensated bearing of a leg minus its reading
    double angleCorrection = 0.0; // the part of the angular closure given to this station's angle
};

struct TraverseResult {
    bool ok = false;
    std::string why; // the French reason when it cannot be computed
    std::vector<TraverseStationResult> stations;
    std::vector<TraverseLegResult> legs;
    int angles = 0;                        // the angles the angular closure is shared among
    double angularMisclosure = kUndefined; // computed minus known, grads; kUndefined without one
    double fx = kUndefined, fy = kUndefined, f = kUndefined; // computed minus known, metres
    double fz = kUndefined;
    double length = 0.0; // the sum of the legs
    // 1/n: the length over the planimetric misclosure (0 without one, or for a misclosure of zero).
    double Ratio() const { return f > 0.0 && f != kUndefined ? length / f : 0.0; }
};

// Computes the traverse. The angular closure is shared equally among its angles (one at each station,
// the first and the last included, their orientation standing for the angle on their references); the
// planimetric one by `rule`; the height one in proportion to the leg lengths.
TraverseResult ComputeTraverse(const TraverseInput& input);

} // namespace pyr
