#include "calc/TraverseListing.h"

#include "calc/ListingTables.h"
#include "calc/TraverseTexts.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <cmath>

namespace pyr {

namespace {

std::string Beyond(double misclosure, double tolerance) {
    return std::fabs(misclosure) > tolerance ? std::string("   ") + chem::kListOutOfTolerance : std::string();
}

} // namespace

std::string TraverseRatioText(const TraverseResult& result) {
    return result.Ratio() > 0.0 ? Sprintf(chem::kRatio, result.Ratio()) : std::string();
}

const char* TraverseKindText(TraverseKind kind) {
    switch (kind) {
    case TraverseKind::Linked:
        return chem::kKindLinked;
    case TraverseKind::Position:
        return chem::kKindPosition;
    case TraverseKind::Closed:
        return chem::kKindClosed;
    case TraverseKind::Open:
        break;
    }
    return chem::kKindOpen;
}

void WriteTraverseTolerances(CDlgCfgListing& listing, const TraverseTolerances& tolerances) {
    const std::string angular =
        tolerances.angularFromInstruments
            ? Sprintf(chem::kListAngularFromInstruments, listing.FormatAngl(tolerances.direction).c_str())
            : listing.FormatAngl(tolerances.angular) + " gr";
    listing.WriteLine(chem::kListTolerances, angular.c_str(),
                      listing.FormatDist(tolerances.planimetric).c_str(),
                      listing.FormatDist(tolerances.height).c_str());
    listing.WriteText("\n");
}

void WriteTraverse(CDlgCfgListing& listing, const TraverseReport& report) {
    const TraverseResult& r = report.result;
    const TraverseInput& input = report.gathered.input;
    const bool swap = CPointGen::SwapXY();
    if (!r.ok) { // named with its reason, and nothing else to list
        DrawFrame(listing, {Sprintf(chem::kLineNotComputed, report.name.c_str(), r.why.c_str())}, true);
        Blank(listing);
        return;
    }
    DrawFrame(listing, {Sprintf(chem::kListTraverse, report.name.c_str(), TraverseKindText(input.kind))},
              true);
    Blank(listing);

    if (IsKnown(r.angularMisclosure)) {
        listing.rtfWriteTabTitle(chem::kListAngularTitle);
        listing.WriteLine(chem::kListAngular, listing.FormatAngl(r.angularMisclosure).c_str(), r.angles,
                          listing.FormatAngl(report.tolerances.angular).c_str(),
                          listing.FormatAngl(-r.angularMisclosure / r.angles).c_str());
        listing.WriteText(Beyond(r.angularMisclosure, report.tolerances.angular) + "\n");
        Blank(listing);
    }

    ListingTable legs;
    legs.Clear(8);
    legs.AddRow(chem::kListLegColumns);
    const std::size_t count = r.stations.size();
    for (std::size_t k = 0; k < r.legs.size(); ++k) {
        const TraverseLegResult& leg = r.legs[k];
        legs.Add(r.stations[k].name);
        legs.Add(r.stations[(k + 1) % count].name);
        legs.Add(listing.FormatAngl(leg.bearing, -1, true));
        legs.Add(listing.FormatDist(leg.distance));
        legs.Add(listing.FormatCoor(swap ? leg.dy : leg.dx));
        legs.Add(listing.FormatCoor(swap ? leg.dx : leg.dy));
        legs.Add(listing.FormatDeni(swap ? leg.cy : leg.cx));
        legs.Add(listing.FormatDeni(swap ? leg.cx : leg.cy));
    }
    listing.rtfWriteTabTitle(chem::kListLegsTitle);
    DrawTable(listing, legs, true, 2);
    Blank(listing);

    if (input.kind == TraverseKind::Open) {
        listing.WriteLine("%s", chem::kListOpen);
        listing.WriteText("\n");
    } else {
        listing.WriteLine(chem::kListPlanimetric, listing.FormatDeni(swap ? r.fy : r.fx).c_str(),
                          listing.FormatDeni(swap ? r.fx : r.fy).c_str(), listing.FormatDist(r.f).c_str(),
                          TraverseRatioText(r).c_str(),
                          listing.FormatDist(report.tolerances.planimetric).c_str());
        listing.WriteText(Beyond(r.f, report.tolerances.planimetric) + "\n");
    }
    Blank(listing);

    ListingTable stations;
    stations.Clear(5);
    stations.AddRow(chem::kListStationColumns);
    for (const TraverseStationResult& station : r.stations) {
        stations.Add(station.name);
        stations.Add(listing.FormatCoor(swap ? station.y : station.x));
        stations.Add(listing.FormatCoor(swap ? station.x : station.y));
        stations.Add(IsKnown(station.z) ? listing.FormatAlti(station.z) : std::string());
        stations.Add(IsKnown(station.v0) ? listing.FormatAngl(station.v0, -1, true) : std::string());
    }
    listing.rtfWriteTabTitle(chem::kListStationsTitle);
    DrawTable(listing, stations, true, 1);
    Blank(listing);

    if (IsKnown(r.stations.front().z)) {
        ListingTable heights;
        heights.Clear(4);
        heights.AddRow(chem::kListHeightColumns);
        for (std::size_t k = 0; k < r.legs.size(); ++k) {
            heights.Add(r.stations[k].name);
            heights.Add(r.stations[(k + 1) % count].name);
            heights.Add(listing.FormatDeni(r.legs[k].dz));
            heights.Add(listing.FormatDeni(r.legs[k].cz));
        }
        listing.rtfWriteTabTitle(chem::kListHeightsTitle);
        DrawTable(listing, heights, true, 2);
        if (IsKnown(r.fz)) {
            listing.WriteLine(chem::kListHeight, listing.FormatDeni(r.fz).c_str(),
                              listing.FormatDist(report.tolerances.height).c_str());
            listing.WriteText(Beyond(r.fz, report.tolerances.height) + "\n");
        }
        Blank(listing);
    }
}

} // namespace pyr
