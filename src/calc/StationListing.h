#pragma once

#include "calc/Resection.h"

namespace pyr {

class CDlgCfgListing;

// The block of one station in the listing of the resections or of the combined computations, after the
// common heading: the framed title "Calcul de la station S, reprise 2", then the parts that were
// computed. The planimetry: the table of the sightings with their bearings and residuals, the
// approximate and computed place and V0 and their errors (or why the station could not be computed). The
// altimetry, under the station's instrument height: the table of the sightings that gave an altitude, the
// mean and computed altitudes and the error. With `kinds` (the combined method) each line says whether
// the sighting was taken from the station ("-->") or on it ("<--"). X and Y in the surveyor's order; an
// unknown value is "-".
void WriteStationResult(CDlgCfgListing& listing, const StationResult& result, bool kinds);

} // namespace pyr
