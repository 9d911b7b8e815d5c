#pragma once

#include "calc/Radiation.h"

#include <string>
#include <string_view>
#include <vector>

// The listing of radiated points: station by station, its place and orientation, the points it radiated
// in the columns the surveyor chose, its checks of known points and the sightings that gave nothing; then
// the points determined from several stations with their mean and spread, and the stations not used.
namespace pyr {

class CDlgCfgListing;

struct RadiationReport {
    const std::vector<RadiatedStation>& stations;
    const RadiatedPoints& points;
    const std::vector<std::string>& columns; // tokens of "RayonContenu"
    bool checks;                             // "ControleV0Rayonne": the checks of known points listed
};

// The column tokens of "RayonContenu" that the listing knows (N, X, Y, Z, GI, DH, HP, AH, AV, DI, CS), in
// the surveyor's order, unknown ones left out; the default columns when none is known.
std::vector<std::string> RadiationColumns(std::string_view text);

void WriteRadiation(CDlgCfgListing& listing, const RadiationReport& report);
// The tolerances of multiple determinations and the options, at the head of the listing.
void WriteRadiationTolerances(CDlgCfgListing& listing, const RadiationSettings& settings, bool checks);

} // namespace pyr
