// Direct levelling: the set-ups read from a GéoBase, runs between benchmarks, misclosures distributed as
// a hand computation distributes them, double station, and runs that reach no benchmark.
#include "calc/Levelling.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <cmath>
#include <gtest/gtest.h>
#include <memory>
#include <utility>
#include <vector>

namespace pyr {
namespace {

constexpr double kHundredthMm = 1e-5;

// A GéoBase written as a field book is: benchmarks, back readings, forward readings.
struct FieldBook {
    CCarnet carnet;

    void Benchmark(const std::string& name, double z) {
        ASSERT_GE(carnet.Add(std::make_unique<CPointGen>(name, z), kKindPoint), 0);
    }
    void Back(const std::string& point, double reading, double distance = kUndefined) {
        ASSERT_GE(carnet.Add(std::make_unique<CLectAR>(point, reading, distance), kKindLectAR), 0);
    }
    void Forward(const std::string& point, double reading, double distance = kUndefined) {
        ASSERT_GE(carnet.Add(std::make_unique<CLectAV>(point, reading, distance), kKindLectAV), 0);
    }
    // A set-up from `from` to `to` whose true height difference is `dh`, the back staff read at 1.5 m.
    void SetUp(const std::string& from, const std::string& to, double dh, double distance = kUndefined) {
        Back(from, 1.5, distance);
        Forward(to, 1.5 - dh, distance);
    }
};

LevellingOptions Fixed(double tolerance, LevellingMethod method = LevellingMethod::Simple) {
    LevellingOptions options;
    options.method = method;
    options.closureMode = LevellingToleranceMode::Fixed;
    options.closureTolerance = tolerance;
    return options;
}

TEST(Levelling, ExactReadingsGiveTheHeightsBack) {
    // True heights: A 100.0000 and B 100.5432 known; T1 101.2345, T2 99.8765 and the side point S
    // 100.1111 to find. The readings are what a perfect level reads between them.
    FieldBook book;
    book.Benchmark("A", 100.0);
    book.Back("A", 1.4321, 35.0);
    book.Forward("T1", 1.4321 + 100.0 - 101.2345, 35.0);
    book.Back("T1", 0.5123, 28.0);
    book.Forward("S", 0.5123 + 101.2345 - 100.1111, 12.0);
    book.Forward("T2", 0.5123 + 101.2345 - 99.8765, 30.0);
    book.Back("T2", 2.2222, 40.0);
    book.Forward("B", 2.2222 + 99.8765 - 100.5432, 41.0);
    book.Benchmark("B", 100.5432);

    const LevellingResult result = ComputeLevelling(book.carnet, Fixed(0.01));
    EXPECT_TRUE(result.problems.empty());
    ASSERT_EQ(result.runs.size(), 1u);
    const LevellingRun& run = result.runs[0];
    EXPECT_EQ(run.start, "A");
    EXPECT_EQ(run.end, "B");
    EXPECT_FALSE(run.closedLoop);
    EXPECT_NEAR(run.misclosure, 0.0, 1e-9);
    EXPECT_TRUE(run.inTolerance);
    EXPECT_EQ(run.distribution, LevellingDistribution::ByDistance);
    EXPECT_DOUBLE_EQ(run.length, 70.0 + 58.0 + 81.0);
    ASSERT_EQ(run.steps.size(), 3u);
    EXPECT_NEAR(run.steps[0].zTo, 101.2345, kHundredthMm);
    EXPECT_NEAR(run.steps[1].zTo, 99.8765, kHundredthMm);
    EXPECT_NEAR(run.steps[2].zTo, 100.5432, kHundredthMm);
    // The side reading is not the set-up's forward reading: the last forward reading is.
    ASSERT_EQ(run.steps[1].setUps[0].sides.size(), 1u);
    EXPECT_EQ(run.steps[1].setUps[0].forwardPoint, "T2");
    EXPECT_NEAR(run.steps[1].setUps[0].sides[0].z, 100.1111, kHundredthMm);
}

// Three set-ups from A (100.000) to B (101.000):
//   A -> T1  back 1.500, forward 1.000, 30 m + 30 m   dh +0.500
//   T1 -> T2 back 1.200, forward 1.000, 15 m + 15 m   dh +0.200, side point S read 0.950
//   T2 -> B  back 1.400, forward 1.088, 30 m + 30 m   dh +0.312
// Sum of dh 1.012, f = 100 + 1.012 - 101 = +0.012 m, L = 150 m.
FieldBook MisclosedRun(bool withDistances) {
    FieldBook book;
    const double d = withDistances ? 30.0 : kUndefined;
    book.Benchmark("A", 100.0);
    book.Benchmark("B", 101.0);
    book.Back("A", 1.500, d);
    book.Forward("T1", 1.000, d);
    book.Back("T1", 1.200, 15.0);
    book.Forward("S", 0.950, 10.0);
    book.Forward("T2", 1.000, 15.0);
    book.Back("T2", 1.400, 30.0);
    book.Forward("B", 1.088, 30.0);
    return book;
}

TEST(Levelling, MisclosureSharedByCumulatedDistance) {
    // By distance, each point takes -f x (length behind it) / L:
    //   T1: -0.012 x 60/150 = -0.0048  ->  100.500 - 0.0048 = 100.4952
    //   T2: -0.012 x 90/150 = -0.0072  ->  100.700 - 0.0072 = 100.6928
    //   B : -0.012                     ->  101.012 - 0.0120 = 101.0000
    // S from T1's instrument line: 100.4952 + 1.200 - 0.950 = 100.7452.
    const FieldBook book = MisclosedRun(true);
    const LevellingResult result = ComputeLevelling(book.carnet, Fixed(0.01));
    ASSERT_EQ(result.runs.size(), 1u);
    const LevellingRun& run = result.runs[0];
    EXPECT_NEAR(run.misclosure, 0.012, 1e-9);
    EXPECT_EQ(run.distribution, LevellingDistribution::ByDistance);
    EXPECT_DOUBLE_EQ(run.length, 150.0);
    EXPECT_NEAR(run.steps[0].correction, -0.0048, 1e-9);
    EXPECT_NEAR(run.steps[1].correction, -0.0024, 1e-9);
    EXPECT_NEAR(run.steps[2].correction, -0.0048, 1e-9);
    EXPECT_NEAR(run.steps[0].zTo, 100.4952, kHundredthMm);
    EXPECT_NEAR(run.steps[1].zTo, 100.6928, kHundredthMm);
    EXPECT_DOUBLE_EQ(run.steps[2].zTo, 101.0);
    EXPECT_NEAR(run.steps[1].setUps[0].sides[0].z, 100.7452, kHundredthMm);

    // 12 mm against the three forms of the tolerance of 10 mm.
    EXPECT_FALSE(run.inTolerance); // fixed: 0.010
    LevellingOptions options = Fixed(0.01);
    options.closureMode = LevellingToleranceMode::PerKm; // 0.010 x sqrt(0.150) = 0.00387
    const LevellingRun perKm = ComputeLevelling(book.carnet, options).runs[0];
    EXPECT_NEAR(perKm.tolerance, 0.01 * std::sqrt(0.15), 1e-12);
    EXPECT_FALSE(perKm.inTolerance);
    options.closureMode = LevellingToleranceMode::PerSetUp; // 0.010 x sqrt(3) = 0.01732
    const LevellingRun perSetUp = ComputeLevelling(book.carnet, options).runs[0];
    EXPECT_NEAR(perSetUp.tolerance, 0.01 * std::sqrt(3.0), 1e-12);
    EXPECT_TRUE(perSetUp.inTolerance);
    // A misclosure of exactly the tolerance is within it.
    EXPECT_TRUE(ComputeLevelling(book.carnet, Fixed(0.012)).runs[0].inTolerance);
}

// The same run shared by the rule the surveyor chose, its sights measured or not:
//   by set-up, -0.004 each: T1 100.496, T2 100.692;
//   by height difference over 0.500 + 0.200 + 0.312 = 1.012 m of climb: T1 takes -0.012 x 0.5 / 1.012 =
//   -0.0059289 -> 100.4940711, T2 -0.012 x 0.7 / 1.012 = -0.0083004 -> 100.6916996.
TEST(Levelling, TheMisclosureIsSharedByTheRuleChosen) {
    const FieldBook book = MisclosedRun(true);
    LevellingOptions options = Fixed(0.02);
    options.distribution = LevellingDistribution::BySetUp;
    const LevellingRun bySetUp = ComputeLevelling(book.carnet, options).runs[0];
    EXPECT_EQ(bySetUp.distribution, LevellingDistribution::BySetUp);
    EXPECT_NEAR(bySetUp.steps[0].zTo, 100.496, kHundredthMm);
    EXPECT_NEAR(bySetUp.steps[1].zTo, 100.692, kHundredthMm);
    options.distribution = LevellingDistribution::ByHeightDifference;
    const LevellingRun byClimb = ComputeLevelling(book.carnet, options).runs[0];
    EXPECT_EQ(byClimb.distribution, LevellingDistribution::ByHeightDifference);
    EXPECT_NEAR(byClimb.steps[0].zTo, 100.4940711, kHundredthMm);
    EXPECT_NEAR(byClimb.steps[1].zTo, 100.6916996, kHundredthMm);
    EXPECT_DOUBLE_EQ(byClimb.steps[2].zTo, 101.0);
    // By distance without the sights' lengths: equal shares.
    options.distribution = LevellingDistribution::ByDistance;
    EXPECT_EQ(ComputeLevelling(MisclosedRun(false).carnet, options).runs[0].distribution,
              LevellingDistribution::BySetUp);
}

TEST(Levelling, MissingDistanceSharesByNumberOfSetUps) {
    // The first set-up has no distances: each set-up takes -0.012 / 3 = -0.004.
    //   T1: 100.500 - 0.004 = 100.496;  T2: 100.700 - 0.008 = 100.692;  B: 101.000.
    // The per-kilometre tolerance, without a length, is the fixed value.
    const FieldBook book = MisclosedRun(false);
    LevellingOptions options = Fixed(0.02);
    options.closureMode = LevellingToleranceMode::PerKm;
    const LevellingRun run = ComputeLevelling(book.carnet, options).runs[0];
    EXPECT_EQ(run.distribution, LevellingDistribution::BySetUp);
    EXPECT_FALSE(IsKnown(run.length));
    EXPECT_DOUBLE_EQ(run.tolerance, 0.02);
    EXPECT_NEAR(run.steps[0].zTo, 100.496, kHundredthMm);
    EXPECT_NEAR(run.steps[1].zTo, 100.692, kHundredthMm);
    EXPECT_DOUBLE_EQ(run.steps[2].zTo, 101.0);
    for (const LevellingStep& step : run.steps)
        EXPECT_NEAR(step.correction, -0.004, 1e-9);
}

TEST(Levelling, ClosedLoopBackOnItsBenchmark) {
    // A (50.000) -> T1 +0.800 -> T2 -0.300 -> A -0.497: f = +0.003, no distances: -0.001 a set-up.
    //   T1 50.799, T2 50.498, A 50.000.
    FieldBook book;
    book.Benchmark("A", 50.0);
    book.SetUp("A", "T1", 0.800);
    book.SetUp("T1", "T2", -0.300);
    book.SetUp("T2", "A", -0.497);
    const LevellingResult result = ComputeLevelling(book.carnet, Fixed(0.005));
    ASSERT_EQ(result.runs.size(), 1u);
    const LevellingRun& run = result.runs[0];
    EXPECT_TRUE(run.closedLoop);
    EXPECT_EQ(run.start, "A");
    EXPECT_EQ(run.end, "A");
    EXPECT_NEAR(run.misclosure, 0.003, 1e-9);
    EXPECT_TRUE(run.inTolerance);
    EXPECT_NEAR(run.steps[0].zTo, 50.799, kHundredthMm);
    EXPECT_NEAR(run.steps[1].zTo, 50.498, kHundredthMm);
    EXPECT_DOUBLE_EQ(run.steps[2].zTo, 50.0);
}

TEST(Levelling, DoubleStationPairOutOfToleranceIsNamedAndRunStillComputed) {
    // A (10.000) -> T1 -> B (10.500), each step read twice, every sight 20 m (steps of 40 m):
    //   A -> T1: +0.3000 and +0.3004 (gap 0.4 mm), mean +0.3002
    //   T1 -> B: +0.2000 and +0.2050 (gap 5.0 mm, out of 2 mm), mean +0.2025
    // f = 10 + 0.5027 - 10.5 = +0.0027, -0.00135 a step: T1 = 10.3002 - 0.00135 = 10.29885.
    FieldBook book;
    book.Benchmark("A", 10.0);
    book.Benchmark("B", 10.5);
    book.SetUp("A", "T1", 0.3000, 20.0);
    book.SetUp("A", "T1", 0.3004, 20.0);
    book.SetUp("T1", "B", 0.2000, 20.0);
    book.SetUp("T1", "B", 0.2050, 20.0);
    LevellingOptions options = Fixed(0.01, LevellingMethod::DoubleStation);
    options.pairTolerance = 0.002;
    const LevellingResult result = ComputeLevelling(book.carnet, options);
    EXPECT_TRUE(result.problems.empty());
    ASSERT_EQ(result.runs.size(), 1u);
    const LevellingRun& run = result.runs[0];
    ASSERT_EQ(run.steps.size(), 2u);
    EXPECT_EQ(run.steps[0].setUps.size(), 2u);
    EXPECT_FALSE(run.steps[0].pairOutOfTolerance);
    EXPECT_TRUE(run.steps[1].pairOutOfTolerance);
    EXPECT_NEAR(run.steps[1].heightDifference, 0.2025, 1e-9);
    EXPECT_DOUBLE_EQ(run.length, 80.0);
    EXPECT_NEAR(run.misclosure, 0.0027, 1e-9);
    EXPECT_NEAR(run.steps[0].zTo, 10.29885, kHundredthMm);
    EXPECT_TRUE(run.inTolerance);
    EXPECT_TRUE(run.flagged);
    ASSERT_EQ(run.warnings.size(), 1u);
    EXPECT_EQ(run.warnings[0], "les deux dénivelées de T1 à B (0.2000 m et 0.2050 m) diffèrent de 0.0050 m, "
                               "au-delà de la tolérance de 0.0020 m");

    // A step read once only is named too, and the run flagged; it counts as one step.
    FieldBook single;
    single.Benchmark("A", 10.0);
    single.Benchmark("B", 10.5);
    single.SetUp("A", "T1", 0.3000, 20.0);
    single.SetUp("A", "T1", 0.3000, 20.0);
    single.SetUp("T1", "B", 0.2000, 20.0);
    const LevellingRun once = ComputeLevelling(single.carnet, options).runs.at(0);
    EXPECT_TRUE(once.flagged);
    EXPECT_EQ(once.warnings, std::vector<std::string>{Sprintf(kLevellingSingleReading, "T1", "B")});
    EXPECT_NEAR(once.misclosure, 0.0, 1e-9);
}

TEST(Levelling, RunsBetweenBenchmarksAndWhatReachesNone) {
    FieldBook book;
    book.Benchmark("A", 100.0);
    book.Benchmark("M", 101.0);
    book.Benchmark("B", 102.0);
    book.Benchmark("Z", 200.0);
    // A known turning point ends one run and starts the next.
    book.SetUp("A", "T1", 0.5);
    book.SetUp("T1", "M", 0.5);
    book.SetUp("M", "B", 1.0);
    // Then a chain that leaves B and stops on an unknown point.
    book.SetUp("B", "T2", 0.3);
    book.SetUp("T2", "T3", 0.3);
    // A station ends the levelling: the set-up after it, though it starts on T3, is a new chain that
    // reaches Z from an unknown point.
    ASSERT_GE(book.carnet.Add(std::make_unique<CStation>("S1"), kKindStation), 0);
    book.SetUp("T3", "Z", 1.0);
    // A chain that touches no benchmark, a back reading without a forward one and a forward reading
    // without a back one.
    book.SetUp("P", "Q", 0.1);
    book.Back("R", 1.0);
    book.Back("Q", 1.0);
    ASSERT_GE(book.carnet.Add(std::make_unique<CStation>("S2"), kKindStation), 0);
    book.Forward("U", 1.0);

    const LevellingResult result = ComputeLevelling(book.carnet, Fixed(0.01));
    ASSERT_EQ(result.runs.size(), 2u);
    EXPECT_EQ(result.runs[0].start, "A");
    EXPECT_EQ(result.runs[0].end, "M");
    EXPECT_EQ(result.runs[0].steps.size(), 2u);
    EXPECT_EQ(result.runs[1].start, "M");
    EXPECT_EQ(result.runs[1].end, "B");
    EXPECT_EQ(result.problems, (std::vector<std::string>{
                                   "la lecture arrière sur R n'a pas de lecture avant",
                                   "la lecture arrière sur Q n'a pas de lecture avant",
                                   "la lecture avant sur U n'a pas de lecture arrière",
                                   "le cheminement parti de B n'arrive sur aucun repère d'altitude connue",
                                   "le cheminement de T3 à Z ne part d'aucun repère d'altitude connue",
                                   "le cheminement de P à Q ne passe par aucun repère d'altitude connue",
                               }));
}

// Published exercise: a level circuit of 30.500 km from BM1 (728.730 m) back to BM1, closed by the
// notes at 728.486 m, with the observed heights of the benchmarks set on the way at their distances
// from BM1 (askfilo.com, "Sample Problem 1: The known elevation of BM1 is 728.730 meters",
// https://askfilo.com/user-question-answers-smart-solutions/sample-problem-1-the-known-elevation-of-bm1-is-728-730-3338343738343531):
//   BM2  5.245 km 783.213 | BM3 11.271 km 891.764 | BM4 17.718 km 843.195
//   BM5 21.964 km 739.708 | BM6 25.247 km 702.956 | BM1 30.500 km 728.486
// Each section is written here as one set-up carrying its observed difference, half its length before
// and half after the level. f = 728.486 - 728.730 = -0.244 m; the correction is +0.244 x D / 30.5 =
// +0.008 m a kilometre:
//   BM2 +0.041960 -> 783.254960   BM3 +0.090168 -> 891.854168   BM4 +0.141744 -> 843.336744
//   BM5 +0.175712 -> 739.883712   BM6 +0.201976 -> 703.157976
TEST(Levelling, PublishedLevelCircuit) {
    const std::vector<std::pair<std::string, double>> observed{{"BM1", 728.730}, {"BM2", 783.213},
                                                               {"BM3", 891.764}, {"BM4", 843.195},
                                                               {"BM5", 739.708}, {"BM6", 702.956}};
    const std::vector<double> km{0.0, 5.245, 11.271, 17.718, 21.964, 25.247, 30.500};
    FieldBook book;
    book.Benchmark("BM1", 728.730);
    for (std::size_t i = 0; i < observed.size(); ++i) {
        const bool last = i + 1 == observed.size();
        const std::string& to = last ? observed[0].first : observed[i + 1].first;
        const double zTo = last ? 728.486 : observed[i + 1].second;
        const double half = (km[i + 1] - km[i]) * 500.0;
        book.Back(observed[i].first, 2.0 + zTo - observed[i].second, half);
        book.Forward(to, 2.0, half);
    }
    LevellingOptions options = Fixed(0.01);
    options.closureMode = LevellingToleranceMode::PerKm;
    const LevellingResult result = ComputeLevelling(book.carnet, options);
    ASSERT_EQ(result.runs.size(), 1u);
    const LevellingRun& run = result.runs[0];
    EXPECT_TRUE(run.closedLoop);
    EXPECT_NEAR(run.misclosure, -0.244, 1e-9);
    EXPECT_NEAR(run.length, 30500.0, 1e-6);
    EXPECT_FALSE(run.inTolerance); // 0.244 m against 0.010 x sqrt(30.5) = 0.055 m
    const double adjusted[] = {783.254960, 891.854168, 843.336744, 739.883712, 703.157976, 728.730};
    for (std::size_t i = 0; i < 6; ++i)
        EXPECT_NEAR(run.steps[i].zTo, adjusted[i], kHundredthMm) << i;
}

// Published field notes: a run of five set-ups with side readings from OBM 1 (29.23 m) to OBM 2 (29.66 m),
// without distances (Universiti Sains Malaysia, levelling lecture, "height of plane of collimation"
// example, https://civil.eng.usm.my/wamin/lecture1/FYPGeomatik/JS/Ukur%20Aras/JSSUAE1.htm):
//   BS 1.717 OBM1 | IS 1.432 A | FS 1.716, BS 2.918 B | IS 2.272 C | FS 0.953, BS 0.816 D
//   FS 3.005, BS 1.436 E | FS 1.391, BS 1.246 CP | IS 1.353 F | IS 1.462 G | FS 0.628 OBM2
// Its initial heights: B 29.231, D 31.196, E 29.007, CP 29.052, OBM2 29.670, so f = +0.010 m, and its
// adjustments -2 mm a set-up: B -2, D -4, E -6, CP -8. A side point is levelled from the instrument line
// of its set-up, drawn from the compensated back point: A 29.515 (29.23 + 1.717 - 1.432), C 29.231 - 0.002
// + 2.918 - 2.272 = 29.875, F and G 29.052 - 0.008 + 1.246 - 1.353 (1.462) = 28.937 (28.828). The notes
// give them their set-up's own adjustment too (A 29.513): that share is a convention, theirs not ours.
TEST(Levelling, PublishedFieldNotesWithSideReadings) {
    FieldBook book;
    book.Benchmark("OBM1", 29.23);
    book.Benchmark("OBM2", 29.66);
    book.Back("OBM1", 1.717);
    book.Forward("A", 1.432);
    book.Forward("B", 1.716);
    book.Back("B", 2.918);
    book.Forward("C", 2.272);
    book.Forward("D", 0.953);
    book.Back("D", 0.816);
    book.Forward("E", 3.005);
    book.Back("E", 1.436);
    book.Forward("CP", 1.391);
    book.Back("CP", 1.246);
    book.Forward("F", 1.353);
    book.Forward("G", 1.462);
    book.Forward("OBM2", 0.628);
    LevellingOptions options = Fixed(0.005);
    options.closureMode = LevellingToleranceMode::PerSetUp;
    const LevellingResult result = ComputeLevelling(book.carnet, options);
    ASSERT_EQ(result.runs.size(), 1u);
    const LevellingRun& run = result.runs[0];
    EXPECT_EQ(run.start, "OBM1");
    EXPECT_EQ(run.end, "OBM2");
    EXPECT_EQ(run.distribution, LevellingDistribution::BySetUp);
    EXPECT_NEAR(run.misclosure, 0.010, kHundredthMm);
    EXPECT_NEAR(run.tolerance, 0.005 * std::sqrt(5.0), 1e-9);
    EXPECT_TRUE(run.inTolerance);
    ASSERT_EQ(run.steps.size(), 5u);
    const double turning[] = {29.229, 31.192, 29.001, 29.044, 29.66};
    for (std::size_t i = 0; i < 5; ++i) {
        EXPECT_NEAR(run.steps[i].correction, -0.002, kHundredthMm) << i;
        EXPECT_NEAR(run.steps[i].zTo, turning[i], kHundredthMm) << run.steps[i].to;
    }
    const auto side = [&](std::size_t step, std::size_t rank) {
        return run.steps[step].setUps[0].sides[rank];
    };
    EXPECT_EQ(side(0, 0).point, "A");
    EXPECT_NEAR(side(0, 0).z, 29.515, kHundredthMm);
    EXPECT_NEAR(side(1, 0).z, 29.875, kHundredthMm);
    EXPECT_EQ(side(4, 1).point, "G");
    EXPECT_NEAR(side(4, 0).z, 28.937, kHundredthMm);
    EXPECT_NEAR(side(4, 1).z, 28.828, kHundredthMm);
}

} // namespace
} // namespace pyr
