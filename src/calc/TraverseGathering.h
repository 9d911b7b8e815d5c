#pragma once

#include "calc/CalculV0.h"
#include "calc/SightingReduction.h"
#include "calc/Tolerances.h"
#include "calc/Traverse.h"

#include <string>
#include <vector>

// What a traverse of a GéoBase gives its computation: the stations it names, placed and oriented as the
// GéoBase knows them, and from their reduced sightings the readings to their neighbours, the horizontal
// distances and height differences of the legs (the mean of both directions when both were measured).
namespace pyr {

class CCarnet;
class CChemin;

struct TraverseGatherSettings {
    SightingReductionOptions reduction; // constants, face left, eccentric offsets, scale correction
    V0Settings v0;                      // the end stations oriented on their references by the V0 rules
    Tolerances tolerances;              // "TolDistances" and "TolAltitudes": a leg's two measures compared
    TraverseRule rule = TraverseRule::Compass;
};

// A leg whose two measures disagree beyond the tolerance: kept, its mean used, and said.
struct TraverseLegWarning {
    std::string from, to;
    double forward = kUndefined;  // the measure from `from`
    double backward = kUndefined; // the measure from `to`
    double tolerance = kUndefined;
    bool height = false; // a height difference, else a horizontal distance
};

struct GatheredTraverse {
    bool ok = false;
    std::string why; // the French reason when the traverse cannot be gathered
    TraverseInput input;
    std::vector<StationPlace> places; // each station occurrence, in the traverse's order
    V0Result startV0, endV0;          // the orientations of the ends on their references
    std::vector<TraverseLegWarning> warnings;
};

// Gathers the traverse: its kind follows what is known (linked when both ends are known and oriented,
// tied in position when the last one cannot be oriented, closed when the traverse says so, open when its
// last station is not known).
GatheredTraverse GatherTraverse(const CCarnet& carnet, const CChemin& traverse,
                                const TraverseGatherSettings& settings);

// The tolerance (grads) of the angular closure of a traverse shared among `angles` angles, from the
// precision of the instruments it was measured with: a direction of a station is good to
// t = 2.7 sigma of its instrument ("SigmaAh" of the GéoBase's instrument in use at the set-up), or to
// `direction` when the instrument gives no precision; an angle is the difference of two directions and
// the closure the sum of the angles, so T = sqrt(2 x angles x mean of t^2), t sqrt(2n) when every
// station has the same instrument.
double AngularClosureTolerance(const CCarnet& carnet, const GatheredTraverse& gathered, int angles,
                               double direction);

} // namespace pyr
