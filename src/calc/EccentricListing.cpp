#include "calc/EccentricListing.h"

#include "calc/EccentricTexts.h"
#include "calc/ListingTables.h"
#include "calc/Tolerances.h"
#include "core/Angles.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <string>
#include <vector>

namespace pyr {

namespace {

// The centre, then each reference point once, X and Y in the surveyor's order.
void WriteSupportPoints(CDlgCfgListing& listing, const EccentricResult& result) {
    const bool swap = CPointGen::SwapXY();
    auto row = [&](const std::string& mat, double x, double y, double z, const char* role) {
        return ListingRow{mat, listing.FormatCoor(swap ? y : x), listing.FormatCoor(swap ? x : y),
                          listing.FormatAlti(z), role};
    };
    std::vector<ListingRow> rows{
        {excent::kListMatricule, swap ? "Y" : "X", swap ? "X" : "Y", "Z", excent::kListRole},
        row(result.centre, result.xC, result.yC, result.zC, excent::kListRoleCentre)};
    std::vector<std::string> listed{result.centre};
    for (const EccentricSighting& s : result.sightings) {
        if (std::find(listed.begin(), listed.end(), s.reference) != listed.end()) continue;
        listed.push_back(s.reference);
        rows.push_back(row(s.reference, s.x, s.y, s.z, excent::kListRoleReference));
    }
    listing.rtfWriteTabTitle(excent::kListSupport);
    DrawTable(listing, rows, true, 1);
}

// The V0 each reference gives from the station's final place, and its gap to the mean weighted by the
// distances. The tolerance is that of the mean of as many directions, when it is not nil (one reference
// in the ordinary tolerances has nothing to be checked against).
void WriteOrientation(CDlgCfgListing& listing, const EccentricResult& result, const Tolerances& tolerances) {
    std::vector<ListingRow> rows{
        {excent::kListStationEccentric, excent::kListReference, "Gis.", "DH", "V0", excent::kListResidualV0}};
    for (const EccentricSighting& s : result.sightings) {
        if (IsUndefined(s.v0)) continue;
        rows.push_back({result.station, s.reference, listing.FormatAngl(s.g, -1, true),
                        listing.FormatDist(s.d), listing.FormatAngl(s.v0, -1, true),
                        listing.FormatAngl(s.ev0)});
    }
    const double tolerance = tolerances.V0(static_cast<int>(rows.size()) - 1);
    listing.rtfWriteTabTitle(tolerance > 0.0
                                 ? Sprintf(excent::kListV0Tolerance, listing.FormatAngl(tolerance).c_str())
                                 : std::string(excent::kListV0));
    DrawTable(listing, rows, true, 2);
    Blank(listing);
    DrawFrame(listing,
              {Sprintf("%s : %s", excent::kListFinalV0, listing.FormatAngl(result.v0, -1, true).c_str())},
              false);
}

// The sighting on the centre, then the station put at its horizontal distance from C on the reverse of
// the bearing the final V0 gives that sighting.
void WritePlanimetry(CDlgCfgListing& listing, const EccentricResult& result) {
    listing.rtfWriteTabTitle(excent::kListPlanimetry);
    DrawTable(
        listing,
        {{excent::kListStationComputed, excent::kListCentre, "AH", "AV", "DI", "DH"},
         {result.station, result.centre, listing.FormatAngl(result.ahC, -1, true),
          listing.FormatAngl(result.avC), listing.FormatDist(result.diC), listing.FormatDist(result.dhC)}},
        true, 2);
    Blank(listing);
    const bool swap = CPointGen::SwapXY();
    const double fromCentre = IsKnown(result.v0) ? WrapGrads(result.v0 + result.ahC + 200.0) : kUndefined;
    DrawTable(
        listing,
        {{excent::kListStationComputed, excent::kListBearingCentreToStation, swap ? "Y" : "X",
          swap ? "X" : "Y"},
         {result.station, listing.FormatAngl(fromCentre, -1, true),
          listing.FormatCoor(swap ? result.y : result.x), listing.FormatCoor(swap ? result.x : result.y)}},
        true, 1);
}

// From the centre, one line; from the references, the altitude each gives and its zenith residual, then
// their mean, the adjusted altitude and its error.
void WriteAltimetry(CDlgCfgListing& listing, const EccentricResult& result) {
    listing.rtfWriteTabTitle(Sprintf(excent::kListAltimetry, listing.FormatAlti(result.hi).c_str()));
    std::vector<ListingRow> rows{
        {excent::kListReference, "HP", "AV", excent::kListAltitudeOfStation, excent::kListResidualAV}};
    const bool fromCentre = result.altitudes == 0;
    if (fromCentre) {
        rows.push_back({result.centre, listing.FormatAlti(result.hpC), listing.FormatAngl(result.avC),
                        listing.FormatAlti(result.z), "-"});
    } else {
        for (const EccentricSighting& s : result.sightings)
            if (IsKnown(s.zi))
                rows.push_back({s.reference, listing.FormatAlti(s.hp), listing.FormatAngl(s.av),
                                listing.FormatAlti(s.zi), listing.FormatAngl(s.eav)});
    }
    DrawTable(listing, rows, true, 1);
    Blank(listing);
    if (fromCentre)
        DrawTable(listing, {{excent::kListComputedZ, listing.FormatAlti(result.z)}}, false, 1);
    else
        DrawTable(listing,
                  {{excent::kListApproximateZ, listing.FormatAlti(result.z0)},
                   {excent::kListAdjustedZ, listing.FormatAlti(result.z)},
                   {excent::kListEmqZ, listing.FormatAlti(result.emqZ)}},
                  false, 1);
}

void WriteSummary(CDlgCfgListing& listing, const EccentricResult& result) {
    const bool swap = CPointGen::SwapXY();
    listing.rtfWriteTabTitle(excent::kListSummary);
    DrawTable(listing,
              {{excent::kListStation, swap ? "Y" : "X", swap ? "X" : "Y", "Z", "V0"},
               {result.station, listing.FormatCoor(swap ? result.y : result.x),
                listing.FormatCoor(swap ? result.x : result.y), listing.FormatAlti(result.z),
                listing.FormatAngl(result.v0, -1, true)}},
              true, 1);
}

} // namespace

void WriteEccentricResult(CDlgCfgListing& listing, const EccentricResult& result,
                          const Tolerances& tolerances) {
    DrawFrame(listing, {Sprintf(excent::kListTitle, result.station.c_str(), result.reprise)}, true);
    Blank(listing);
    WriteSupportPoints(listing, result);
    Blank(listing);
    // A planimetry switched off leaves no flag; one that was tried says how it ended.
    if (result.flags & kExcentComputed) {
        WriteOrientation(listing, result, tolerances);
        Blank(listing);
        WritePlanimetry(listing, result);
        Blank(listing);
    } else if (result.flags != 0) {
        listing.rtfWriteTabTitle(excent::kListPlanimetry);
        listing.WriteLine("%s\n", result.status.c_str());
        Blank(listing);
    }
    if (IsKnown(result.z)) {
        WriteAltimetry(listing, result);
        Blank(listing);
    }
    WriteSummary(listing, result);
    Blank(listing);
}

} // namespace pyr
