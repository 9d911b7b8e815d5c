#pragma once

#include "calc/EccentricStation.h"

namespace pyr {

class CDlgCfgListing;
struct Tolerances;

// The block of one eccentric station in its listing, after the common heading: the framed title
// "Calcul de la station S, reprise 2"; the centre and the reference points with their coordinates; the
// orientation from each reference (under the tolerance on the V0 when there is one to check against) and
// the final V0; the sighting on the centre and the place it gives; the altitude, from the centre or from
// the references, under the station's instrument height; last, the results together. The parts switched
// off are left out, a planimetry that failed says why. X and Y in the surveyor's order; an unknown value
// is "-".
void WriteEccentricResult(CDlgCfgListing& listing, const EccentricResult& result,
                          const Tolerances& tolerances);

} // namespace pyr
