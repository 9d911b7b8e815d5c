#pragma once

#include "calc/CalculV0.h"

namespace pyr {

class CDlgCfgListing;

// The block of one station in the listing of the V0 ("cv0" or "rtf"), after the common heading: the
// station, the coordinates of the points it rests on, its previous or fixed V0, the table of the partial
// V0 of its references with their deviations, the V0 before and after, and the remarks.
void WriteV0Result(CDlgCfgListing& listing, const V0Result& result);

// The tolerances and options of the computation, at the head of each station when the listing options
// ask for them.
void WriteV0Tolerances(CDlgCfgListing& listing, const Tolerances& tolerances, bool weighted, bool forced);

} // namespace pyr
