#include "calc/CalculV0Listing.h"

#include "calc/CalculV0Texts.h"
#include "calc/ListingTables.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <string>
#include <vector>

namespace pyr {

namespace {

using Row = ListingRow;

// The station and each reference point once, X and Y in the surveyor's order.
void WriteSupportPoints(CDlgCfgListing& listing, const V0Result& result) {
    const bool swap = CPointGen::SwapXY();
    auto row = [&](const char* role, const std::string& mat, double x, double y, double z) {
        return Row{role, mat, listing.FormatCoor(swap ? y : x), listing.FormatCoor(swap ? x : y),
                   listing.FormatAlti(z)};
    };
    std::vector<Row> rows{{"", v0::kListMatricule, swap ? "Y" : "X", swap ? "X" : "Y", "Z"}};
    const StationPlace& station = result.station;
    rows.push_back(row(v0::kListStationRole, station.name, station.x, station.y, station.z));
    std::vector<std::string> listed;
    for (const V0Reference& ref : result.references) {
        if (std::find(listed.begin(), listed.end(), ref.mat) != listed.end()) continue;
        listed.push_back(ref.mat);
        rows.push_back(row(v0::kListReferenceRole, ref.mat, ref.x, ref.y, ref.z));
    }
    listing.rtfWriteTabTitle(v0::kListSupportTitle);
    DrawTable(listing, rows, true, 2);
}

void WriteReferences(CDlgCfgListing& listing, const V0Result& result) {
    std::vector<Row> rows{Row(std::begin(v0::kListColumns), std::end(v0::kListColumns))};
    for (const V0Reference& ref : result.references)
        rows.push_back({ref.mat, listing.FormatAngl(ref.bearing, -1, true), listing.FormatDist(ref.distance),
                        listing.FormatAngl(ref.ah, -1, true), listing.FormatAngl(ref.partialV0, -1, true),
                        listing.FormatAngl(ref.residual)});
    listing.rtfWriteTabTitle(
        Sprintf(v0::kListCalculationTitle, listing.FormatAngl(result.tolerance).c_str()));
    DrawTable(listing, rows, true, 1);
}

} // namespace

void WriteV0Result(CDlgCfgListing& listing, const V0Result& result) {
    const StationPlace& station = result.station;
    DrawFrame(listing, {Sprintf(v0::kListStation, station.name.c_str(), station.reprise)}, true);
    Blank(listing);
    WriteSupportPoints(listing, result);
    Blank(listing);

    const std::string previous = listing.FormatAngl(station.v0, -1, true);
    const std::string v0 = listing.FormatAngl(result.v0, -1, true);
    DrawFrame(listing,
              {result.byHand ? Sprintf(v0::kListFixedV0, v0.c_str())
                             : Sprintf(v0::kListPreviousV0, previous.c_str())},
              false);
    Blank(listing);
    if (!result.byHand) {
        WriteReferences(listing, result);
        Blank(listing);
    }

    Row summary{Sprintf(v0::kListSummary, v0::kListBefore, previous.c_str())};
    if (!result.byHand)
        summary.push_back(Sprintf(v0::kListSummary,
                                  result.weighted ? v0::kListAfterWeighted : v0::kListAfterUnweighted,
                                  v0.c_str()));
    DrawFrame(listing, summary, false);
    Blank(listing);

    DrawFrame(listing, {v0::kListRemarks}, true);
    if (result.remarks.empty()) listing.WriteLine("%s\n", v0::kRemarkNone);
    for (const std::string& remark : result.remarks)
        listing.WriteLine("%s\n", remark.c_str());
}

void WriteV0Tolerances(CDlgCfgListing& listing, const Tolerances& tolerances, bool weighted, bool forced) {
    for (const std::string& line : tolerances.Describe(kHeightTermsV0))
        listing.WriteLine("%s\n", line.c_str());
    listing.WriteLine(v0::kListOptions, weighted ? "oui" : "non", forced ? "oui" : "non");
    listing.WriteLine("\n");
}

} // namespace pyr
