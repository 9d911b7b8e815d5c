#pragma once

#include "calc/Levelling.h"

#include <string>
#include <vector>

// The listing of a levelling run: its two benchmarks, the table of its set-ups (back and forward points,
// readings and sight lengths, height difference, correction, compensated height; in double station the
// two height differences of each pair, their mean and their gap), the side points with the check of
// those already known, the misclosure with its tolerance, and what was found suspect.
namespace pyr {

class CDlgCfgListing;

void WriteLevellingRun(CDlgCfgListing& listing, const LevellingRun& run, const LevellingOptions& options);
// The closure tolerance as the options make it, and the pair tolerance in double station.
void WriteLevellingTolerances(CDlgCfgListing& listing, const LevellingOptions& options);
// What could not be made into a run: readings left out, parts reaching no benchmark.
void WriteLevellingProblems(CDlgCfgListing& listing, const std::vector<std::string>& problems);

} // namespace pyr
