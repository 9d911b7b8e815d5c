#include "calc/IntersectionListing.h"

#include "calc/IntersectionTexts.h"
#include "calc/ListingTables.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <cmath>
#include <iterator>
#include <string>
#include <vector>

namespace pyr {

std::string Milligrads(double grads) {
    if (IsUndefined(grads)) return "-";
    return FormatFixed(std::round(grads * 1e4) / 10.0 + 0.0, 1);
}

namespace {

// The station and its occurrence under the heading "Station       R".
std::string StationCell(const InterSighting& s) {
    if (s.reprise <= 0) return s.station;
    return Sprintf("%-13s %d", s.station.c_str(), s.reprise);
}

void WritePlanimetry(CDlgCfgListing& listing, const InterResult& result) {
    listing.rtfWriteTabTitle(inters::kListPlanimetry);
    if (!(result.flags & kInterComputed)) {
        listing.WriteLine("%s\n", result.status.c_str());
        return;
    }
    std::vector<ListingRow> rows{
        ListingRow(std::begin(inters::kListPlanimetryColumns), std::end(inters::kListPlanimetryColumns))};
    for (const InterSighting& s : result.sightings) {
        if (!UsableInPlanimetry(s)) continue;
        rows.push_back({StationCell(s), s.reference, listing.FormatAngl(s.v0, -1, true),
                        listing.FormatAngl(s.ah, -1, true), listing.FormatAngl(SightedBearing(s), -1, true),
                        listing.FormatDist(s.dh), Milligrads(s.v), listing.FormatDist(s.e)});
    }
    DrawTable(listing, rows, true, 2);
    if (result.flags & kInterTooClose) {
        Blank(listing);
        listing.WriteLine("%s\n", inters::kMsgTooClose);
    }
    Blank(listing);

    const bool swap = CPointGen::SwapXY();
    auto row = [&](const char* label, double x, double y, bool error) {
        const double first = swap ? y : x, second = swap ? x : y;
        if (error) return ListingRow{label, listing.FormatDist(first), listing.FormatDist(second)};
        return ListingRow{label, listing.FormatCoor(first), listing.FormatCoor(second)};
    };
    DrawTable(listing,
              {{"", swap ? "Y" : "X", swap ? "X" : "Y"},
               row(inters::kListApproximatePoint, result.x0, result.y0, false),
               row(inters::kListComputedPoint, result.x, result.y, false),
               row(inters::kListEmq, result.emqX, result.emqY, true)},
              true, 1);
}

void WriteAltimetry(CDlgCfgListing& listing, const InterResult& result) {
    listing.rtfWriteTabTitle(inters::kListAltimetry);
    std::vector<ListingRow> rows{
        ListingRow(std::begin(inters::kListAltimetryColumns), std::end(inters::kListAltimetryColumns))};
    for (const InterSighting& s : result.sightings) {
        if (IsUndefined(s.zi)) continue;
        rows.push_back({StationCell(s), s.reference, listing.FormatAlti(s.hi), listing.FormatAlti(s.hp),
                        listing.FormatAngl(s.av), listing.FormatDist(s.dh), listing.FormatAlti(s.zi),
                        Milligrads(s.vz), listing.FormatAlti(s.ez)});
    }
    DrawTable(listing, rows, true, 2);
    Blank(listing);
    DrawTable(listing,
              {{inters::kListApproximateZ, listing.FormatAlti(result.z0)},
               {inters::kListComputedZ, listing.FormatAlti(result.z)},
               {inters::kListEmq, listing.FormatAlti(result.emqZ)}},
              false, 1);
}

} // namespace

void WriteIntersectionResult(CDlgCfgListing& listing, const InterResult& result) {
    DrawFrame(listing, {Sprintf(inters::kListTitle, result.mat.c_str())}, true);
    Blank(listing);
    // A planimetry switched off leaves no flag; one that was tried says how it ended.
    if (result.flags & (kInterComputed | kInterTooFew | kInterParallel)) {
        WritePlanimetry(listing, result);
        Blank(listing);
    }
    if (result.altitudes > 0) {
        WriteAltimetry(listing, result);
        Blank(listing);
    }
}

} // namespace pyr
