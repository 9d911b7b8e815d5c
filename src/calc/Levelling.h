#pragma once

#include "core/Undefined.h"

#include <string>
#include <string_view>
#include <vector>

// Direct levelling: the staff readings of a GéoBase cut into set-ups of the level, the set-ups chained
// into runs (cheminements) from a benchmark of known height to a benchmark of known height, the height
// misclosure of each run measured against its tolerance and distributed, and the heights of the
// turning points and side points computed. Readings, distances and heights in metres.
//
// How the GéoBase is read, element after element:
// - a back reading (1004) starts a set-up of the level; the forward readings (1005) that follow it
//   belong to that set-up; the last of them is the set-up's forward reading, onto the next turning
//   point; those before it are side readings (points levelled from that set-up only);
// - a station (1001), a sighting (1002, 1003) or a traverse (1007) ends the levelling written before
//   it: the set-ups on either side of it are never chained. Comments, points, instruments and
//   codification commands are passed over, so that the benchmarks' heights may stand anywhere;
// - consecutive set-ups make a chain as long as each one's back point is the forward point of the
//   one before; a set-up whose back point is another point starts a new chain;
// - every turning point of known height (a point 1006 with its Z) ends a run and starts the next one:
//   each run is compensated on its own, between its two benchmarks, which may be the same point (a
//   closed loop). The parts of a chain before its first benchmark or after its last one are reported,
//   by name, and computed no further.
//
// In double station each step between two turning points is levelled twice, from two positions of
// the level: two consecutive set-ups between the same two points. Their two height differences must
// agree within a tolerance; the step takes their mean. A pair out of tolerance, or a step levelled
// once only, is reported by name and the run is still computed, but flagged.
namespace pyr {

class CCarnet;

// The reasons, in French, for what the computation cannot use or finds suspect. The %s are point
// identifiers, then numbers already formatted in metres.
inline constexpr const char* kLevellingNoBenchmarkAtEnd =
    "le cheminement parti de %s n'arrive sur aucun repère d'altitude connue";
inline constexpr const char* kLevellingNoBenchmarkAtStart =
    "le cheminement de %s à %s ne part d'aucun repère d'altitude connue";
inline constexpr const char* kLevellingNoBenchmark =
    "le cheminement de %s à %s ne passe par aucun repère d'altitude connue";
inline constexpr const char* kLevellingNoForwardReading =
    "la lecture arrière sur %s n'a pas de lecture avant";
inline constexpr const char* kLevellingNoBackReading = "la lecture avant sur %s n'a pas de lecture arrière";
inline constexpr const char* kLevellingPairOutOfTolerance =
    "les deux dénivelées de %s à %s (%s m et %s m) diffèrent de %s m, au-delà de la tolérance de %s m";
inline constexpr const char* kLevellingSingleReading =
    "la dénivelée de %s à %s n'est mesurée qu'une fois en double station";

enum class LevellingMethod {
    Simple,        // one set-up between two turning points
    DoubleStation, // two set-ups between the same two turning points, their mean used
};

// What "TypeTolerance" of the levelling options selects, for a closure tolerance T read from
// "FermAltimetr" (metres):
enum class LevellingToleranceMode {
    Fixed = 0,    // T, whatever the run
    PerKm = 1,    // T x sqrt(L), L the length of the run in km (back + forward distances): ordinary
                  // levelling's form, T being then the tolerance for one kilometre
    PerSetUp = 2, // T x sqrt(n), n the number of set-ups (of steps, in double station)
};

// What "TypeNivel" of the levelling options selects: how a run's misclosure is shared among its steps.
enum class LevellingDistribution {
    ByDistance = 0,         // in proportion to the sights' lengths: ordinary levelling on open ground
    BySetUp = 1,            // in equal shares per step: site levelling, where the sights are not measured
    ByHeightDifference = 2, // in proportion to |dh|: steep ground, where the errors grow with the climb
};

struct LevellingOptions {
    LevellingMethod method = LevellingMethod::Simple;
    // Asked for; a run whose steps lack a length, or whose lengths (or height differences) are all zero,
    // falls back on equal shares per step.
    LevellingDistribution distribution = LevellingDistribution::ByDistance;
    LevellingToleranceMode closureMode = LevellingToleranceMode::Fixed;
    double closureTolerance = 0.01; // metres (per sqrt(km) or per sqrt(set-up) as closureMode says)
    double pairTolerance = 0.01;    // double station: the largest gap between the two height differences
    // A run named by its two benchmarks: from `start` to the next `end` of its chain, the points of known
    // height between them are turning points like the others, their heights computed again (after a
    // reading was corrected, say, the heights written by an earlier computation no longer hold the run
    // in pieces). Empty: every point of known height is a benchmark.
    std::string start, end;

    // "TypeTolerance", "TypeNivel" and "FermAltimetr" of "Options_Nivellement"; the pair tolerance is
    // "TolAltitudes"
    // of "Options_Tolerances". The method is the caller's (it is the command's).
    static LevellingOptions FromOptions(std::string_view paramPath, LevellingMethod method);

    // The closure tolerance of a run of that length (metres, kUndefined when a distance is missing) and
    // that number of steps. Without a length, the per-kilometre form falls back on T alone.
    double ClosureTolerance(double lengthMetres, int stepCount) const;
};

// A forward reading of a set-up that is not its last one: a point levelled from that set-up only.
struct LevellingSideReading {
    std::string point;
    int element = -1;     // its index in the GéoBase
    double reading = 0.0; // staff reading
    double distance = kUndefined;
    double z = kUndefined;      // computed height: the instrument line minus the reading
    double knownZ = kUndefined; // its height in the GéoBase, when it is a known point (a check)
};

// One set-up of the level as the GéoBase holds it.
struct LevellingSetUp {
    std::string backPoint, forwardPoint;
    int backElement = -1, forwardElement = -1; // indices in the GéoBase
    double backReading = 0.0, forwardReading = 0.0;
    double backDistance = kUndefined, forwardDistance = kUndefined;
    std::vector<LevellingSideReading> sides;

    double HeightDifference() const { return backReading - forwardReading; } // height of forward - back
    // Back + forward distance; kUndefined when either is missing.
    double Length() const;
};

// The set-ups of a GéoBase, in runs of consecutive set-ups that nothing in the GéoBase separates (they
// may still hold several chains), and what could not be made into a set-up.
struct LevellingSetUps {
    std::vector<std::vector<LevellingSetUp>> blocks;
    std::vector<std::string> problems;
};
// Reads the set-ups of the levelling readings of a GéoBase (the rules at the head of this file).
LevellingSetUps ReadLevellingSetUps(const CCarnet& carnet);

// One step of a run, from a turning point to the next: one set-up, or the pair of double station.
struct LevellingStep {
    std::vector<LevellingSetUp> setUps; // one, or two in double station
    std::string from, to;
    double heightDifference = 0.0; // measured: back - forward, the mean of the pair in double station
    double length = kUndefined;    // back + forward distance (the mean of the pair); kUndefined if missing
    double pairGap = kUndefined;   // double station: first height difference minus the second
    bool pairOutOfTolerance = false;

    double correction = 0.0;                     // this step's share of -f
    double zFrom = kUndefined, zTo = kUndefined; // compensated heights of its two points
};

// A run between two benchmarks, computed.
struct LevellingRun {
    std::string start, end;
    bool closedLoop = false; // back on its starting benchmark
    double zStart = 0.0, zEnd = 0.0;
    std::vector<LevellingStep> steps;

    double length = kUndefined; // sum of the steps' lengths; kUndefined when one is missing
    LevellingDistribution distribution = LevellingDistribution::BySetUp; // the rule the run was shared by
    double misclosure = 0.0; // f = Z start + sum of height differences - Z end
    double tolerance = 0.0;
    bool inTolerance = true;           // |f| <= tolerance
    bool flagged = false;              // double station: a pair out of tolerance, or a step levelled once
    std::vector<std::string> warnings; // what flagged it, in French
};

struct LevellingResult {
    std::vector<LevellingRun> runs;
    std::vector<std::string> problems; // readings left out, runs that reach no benchmark
};

// Cuts the set-ups into runs between benchmarks (heights from the GéoBase's points) and computes them.
LevellingResult ComputeLevelling(const CCarnet& carnet, const LevellingOptions& options);
LevellingResult ComputeLevelling(const CCarnet& carnet, const LevellingSetUps& setUps,
                                 const LevellingOptions& options);

// Computes one run from its steps, given the heights of its two ends: misclosure, tolerance,
// distribution of -f in proportion to the cumulated step lengths (or to the number of steps when a
// length is missing or all are zero), compensated heights, side points. The side points of a set-up
// take the compensated height of its back point plus its back reading (its instrument line), minus
// their own reading: the set-up's correction is carried by its forward reading.
void CompensateLevellingRun(LevellingRun& run, const LevellingOptions& options);

} // namespace pyr
