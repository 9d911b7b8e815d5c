#include "calc/LevellingListing.h"

#include "calc/LevellingTexts.h"
#include "calc/ListingTables.h"
#include "core/Strings.h"
#include "settings/ListingObject.h"

#include <cmath>

namespace pyr {

namespace {

// Staff readings, sight lengths and height differences to the tenth of a millimetre.
constexpr int kDecimals = 4;

std::string Reading(const CDlgCfgListing& listing, double value) {
    return IsKnown(value) ? listing.FormatDist(value, kDecimals) : std::string();
}

std::string Height(const CDlgCfgListing& listing, double value) {
    return IsKnown(value) ? listing.FormatAlti(value) : std::string();
}

std::string Difference(const CDlgCfgListing& listing, double value) {
    return IsKnown(value) ? listing.FormatDeni(value, kDecimals) : std::string();
}

void WriteSetUps(CDlgCfgListing& listing, const LevellingRun& run, bool pairs) {
    ListingTable table;
    if (pairs) {
        table.Clear(std::size(niv::kListPairColumns));
        table.AddRow(niv::kListPairColumns);
    } else {
        table.Clear(std::size(niv::kListSetUpColumns));
        table.AddRow(niv::kListSetUpColumns);
    }
    for (const LevellingStep& step : run.steps) {
        for (std::size_t k = 0; k < step.setUps.size(); ++k) {
            const LevellingSetUp& setUp = step.setUps[k];
            const bool last = k + 1 == step.setUps.size();
            table.Add(setUp.backPoint);
            table.Add(setUp.forwardPoint);
            table.Add(Reading(listing, setUp.backReading));
            table.Add(Reading(listing, setUp.forwardReading));
            table.Add(Reading(listing, setUp.backDistance));
            table.Add(Reading(listing, setUp.forwardDistance));
            table.Add(Difference(listing, setUp.HeightDifference()));
            if (pairs) {
                // The pair's mean and gap stand on its second line, beside its compensated height.
                const bool paired = last && step.setUps.size() == 2;
                table.Add(last ? Difference(listing, step.heightDifference) : std::string());
                table.Add(paired ? Difference(listing, step.pairGap) +
                                       (step.pairOutOfTolerance ? niv::kListPairOut : "")
                                 : std::string());
            }
            table.Add(last ? Difference(listing, step.correction) : std::string());
            table.Add(last ? Height(listing, step.zTo) : std::string());
        }
    }
    listing.rtfWriteTabTitle(niv::kListSetUpsTitle);
    DrawTable(listing, table, true, 2);
    Blank(listing);
}

void WriteSides(CDlgCfgListing& listing, const LevellingRun& run) {
    ListingTable table;
    table.Clear(std::size(niv::kListSideColumns));
    table.AddRow(niv::kListSideColumns);
    bool any = false;
    for (const LevellingStep& step : run.steps)
        for (const LevellingSetUp& setUp : step.setUps)
            for (const LevellingSideReading& side : setUp.sides) {
                any = true;
                table.Add(setUp.backPoint);
                table.Add(side.point);
                table.Add(Reading(listing, side.reading));
                table.Add(Reading(listing, side.distance));
                table.Add(Height(listing, side.z));
                table.Add(Height(listing, side.knownZ));
                table.Add(IsKnown(side.knownZ) && IsKnown(side.z) ? Difference(listing, side.z - side.knownZ)
                                                                  : std::string());
            }
    if (!any) return;
    listing.rtfWriteTabTitle(niv::kListSidesTitle);
    DrawTable(listing, table, true, 2);
    Blank(listing);
}

} // namespace

void WriteLevellingRun(CDlgCfgListing& listing, const LevellingRun& run, const LevellingOptions& options) {
    const bool pairs = options.method == LevellingMethod::DoubleStation;
    DrawFrame(listing,
              {Sprintf(pairs ? niv::kListRunDouble : niv::kListRunSimple, run.start.c_str(), run.end.c_str(),
                       run.closedLoop ? niv::kClosedMark : "")},
              true);
    Blank(listing);
    listing.WriteLine(niv::kListBenchmarks, run.start.c_str(), listing.FormatAlti(run.zStart).c_str(),
                      run.end.c_str(), listing.FormatAlti(run.zEnd).c_str());
    listing.WriteText("\n");
    Blank(listing);

    WriteSetUps(listing, run, pairs);
    WriteSides(listing, run);

    const std::string length = IsKnown(run.length)
                                   ? Sprintf(niv::kListLength, listing.FormatDist(run.length).c_str())
                                   : std::string(niv::kListNoLength);
    listing.WriteLine(niv::kListClosure, Difference(listing, run.misclosure).c_str(), length.c_str(),
                      static_cast<int>(run.steps.size()), Reading(listing, run.tolerance).c_str());
    listing.WriteText(run.inTolerance ? "\n" : std::string("   ") + niv::kListOutOfTolerance + "\n");
    listing.WriteLine("%s", run.distribution == LevellingDistribution::ByDistance ? niv::kListByDistance
                            : run.distribution == LevellingDistribution::ByHeightDifference
                                ? niv::kListByHeightDifference
                                : niv::kListBySetUp);
    listing.WriteText("\n");
    Blank(listing);

    if (!run.warnings.empty()) {
        listing.rtfWriteTabTitle(niv::kListWarningsTitle);
        for (const std::string& warning : run.warnings) {
            listing.WriteLine("- %s", warning.c_str());
            listing.WriteText("\n");
        }
        Blank(listing);
    }
}

void WriteLevellingTolerances(CDlgCfgListing& listing, const LevellingOptions& options) {
    const char* format = niv::kListToleranceFixed;
    if (options.closureMode == LevellingToleranceMode::PerKm) format = niv::kListTolerancePerKm;
    if (options.closureMode == LevellingToleranceMode::PerSetUp) format = niv::kListTolerancePerSetUp;
    listing.WriteLine(format, Reading(listing, options.closureTolerance).c_str());
    listing.WriteText("\n");
    if (options.method == LevellingMethod::DoubleStation) {
        listing.WriteLine(niv::kListPairTolerance, Reading(listing, options.pairTolerance).c_str());
        listing.WriteText("\n");
    }
}

void WriteLevellingProblems(CDlgCfgListing& listing, const std::vector<std::string>& problems) {
    if (problems.empty()) return;
    listing.rtfWriteTabTitle(niv::kListWarningsTitle);
    for (const std::string& problem : problems) {
        listing.WriteLine("- %s", problem.c_str());
        listing.WriteText("\n");
    }
    Blank(listing);
}

} // namespace pyr
