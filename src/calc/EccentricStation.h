#pragma once

#include "core/Undefined.h"

#include <string>
#include <vector>

// The computation of an eccentric station: a set-up E beside a known point C that cannot be occupied (a
// church spire, a pylon, a boundary marker under a wall), from which C is sighted with a distance and
// known points (the "points d'appui") are sighted for the orientation. The orientation V0 depends on
// where E is, and E lies at the measured distance from C along the bearing that V0 gives to the sighting
// on C: the two are found together by a fixed-point iteration that starts from E = C. The altitude comes
// from the sighting on C when C has one, otherwise from the zenith angles on the reference points. Angles
// in grads, bearings clockwise from the +Y axis (X is the easting), lengths and coordinates in metres. A
// value that is not known, or that the geometry cannot give, is kUndefined: never NaN or infinity.
namespace pyr {

// One sighting from E on a reference point: inputs filled by the gathering, outputs by the computation.
// The sighting arrives turned to face left and reduced for eccentric offsets and instrument constants.
struct EccentricSighting {
    // Inputs.
    int index = -1;        // the sighting element in the GéoBase
    std::string reference; // the reference point's name
    double x = kUndefined; // the reference point, m
    double y = kUndefined;
    double z = kUndefined;
    double hp = kUndefined; // target height less the target's vertical offset, m
    double ah = kUndefined; // horizontal direction, gr
    double av = kUndefined; // zenith angle, gr (0 at the zenith, 100 level)
    double di = kUndefined; // slope distance, m (shown only)

    // Outputs, from the last place of E.
    double d = kUndefined;   // horizontal distance from E to the point, m: the sighting's weight in V0
    double g = kUndefined;   // bearing from E to the point, gr, in [0, 400)
    double v0 = kUndefined;  // the V0 this sighting alone gives, brought within 200 gr of the first one's
    double ev0 = kUndefined; // the mean V0 less this one, gr
    double zi = kUndefined;  // the altitude of E this sighting alone gives, m (C without altitude)
    double eav = kUndefined; // zenith residual, gr: the zenith angle computed from E's altitude less AV
};

// Flags of a computation, in EccentricResult::flags.
enum : int {
    kExcentComputed = 1, // E and V0 were computed
    // No reference sighting on a point with X and Y, no distance to C, or C without X and Y.
    kExcentIncomplete = 8,
    // E and V0 did not settle within kExcentMaxIterations passes, or E came onto every reference point,
    // from where none has a bearing.
    kExcentNoConvergence = 0x400,
};

// The fixed point is reached when a pass moves E by less than this in X and in Y (m) ...
inline constexpr double kExcentConvergence = 1e-8;
// ... within this many passes.
inline constexpr int kExcentMaxIterations = 1000;

// One eccentric station and its computation.
struct EccentricResult {
    int stationIndex = -1;  // the station element
    std::string station;    // the station's name: the point that receives X, Y and Z
    int reprise = 1;        // its occurrence, "%s (%d)"
    double hi = kUndefined; // its instrument height with its vertical offset, m
    std::vector<EccentricSighting> sightings;

    // The sighting on the centre C, turned to face left.
    std::string centre;      // C's name
    double hpC = kUndefined; // target height on C, m
    double ahC = kUndefined; // horizontal direction, gr
    double avC = kUndefined; // zenith angle, gr
    double diC = kUndefined; // slope distance with the instrument's distance constant, m (shown only)
    double dhC = kUndefined; // horizontal distance E-C, corrected for scale by the gathering, m
    double xC = kUndefined;  // C, m
    double yC = kUndefined;
    double zC = kUndefined;

    // Planimetry.
    double x = kUndefined; // E, m
    double y = kUndefined;
    double v0 = kUndefined; // E's orientation, gr, in [0, 400)
    int iterations = 0;     // passes of the fixed point

    // Altimetry.
    double z = kUndefined;    // E's altitude, m
    int altitudes = 0;        // reference sightings that gave an altitude (none when C has one)
    double z0 = kUndefined;   // mean of their altitudes, m
    double emqZ = kUndefined; // the figure of the listing's "EMQ (cm)", two altitudes or more; see the source

    int flags = 0;
    std::string status; // the French text of a failure of the planimetry, "" otherwise
};

// Computes the eccentric station: E and V0 when `plani`, Z when `alti`. The outputs of the result and of
// its sightings are reset first, and those of a part switched off stay undefined. With C's altitude, Z
// comes from the sighting on C and needs only dhC, so it is computed even with the planimetry off or
// failed; without it, Z comes from the reference points and needs E's place. Returns result.flags.
int ComputeEccentricStation(EccentricResult& result, bool plani, bool alti);

} // namespace pyr
