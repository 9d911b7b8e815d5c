#pragma once

#include "calc/TraverseGathering.h"

#include <string>

// The listing of a polygonal traverse: its kind, its angular closure, each leg with its compensated
// bearing, distance, coordinate differences and corrections, its planimetric closure with the ratio 1/n,
// the compensated stations, then the heights and their closure.
namespace pyr {

class CDlgCfgListing;

// The tolerances of the three closures: angular in grads, planimetric and height in metres.
struct TraverseTolerances {
    double angular = 0.01;
    double planimetric = 0.01;
    double height = 0.01;
    // Normal or precise tolerances: the angular one of each traverse comes from its instruments'
    // precision (AngularClosureTolerance), `direction` (grads) standing for an instrument without one;
    // custom tolerances: "FermAngulaire" as it stands.
    bool angularFromInstruments = false;
    double direction = 0.0;
};

struct TraverseReport {
    const std::string& name;
    const GatheredTraverse& gathered;
    const TraverseResult& result;
    const TraverseTolerances& tolerances;
};

// The kind of a traverse in words.
const char* TraverseKindText(TraverseKind kind);
// " (1/12345)": the traverse's length over its planimetric misclosure; "" without a misclosure.
std::string TraverseRatioText(const TraverseResult& result);
void WriteTraverse(CDlgCfgListing& listing, const TraverseReport& report);
void WriteTraverseTolerances(CDlgCfgListing& listing, const TraverseTolerances& tolerances);

} // namespace pyr
