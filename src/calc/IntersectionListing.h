#pragma once

#include "calc/Intersection.h"

#include <string>

namespace pyr {

class CDlgCfgListing;

// The block of one point in the listing of the intersections, after the common heading: the framed
// title, then the parts that were computed. The planimetry: the table of the sightings with their
// bearings and residuals, the approximate and computed points and their errors (or why the point could
// not be computed). The altimetry: the table of the sightings that gave an altitude, the mean and
// computed altitudes and the error. X and Y in the surveyor's order; an unknown value is "-".
void WriteIntersectionResult(CDlgCfgListing& listing, const InterResult& result);

// A residual in grads written in milligrads to a tenth, "-" when unknown; a rounded zero has no sign.
std::string Milligrads(double grads);

} // namespace pyr
