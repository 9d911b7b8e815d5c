// A traverse gathered from a GéoBase that a perfect instrument measured: the kind read from what is known,
// the legs measured both ways, and the stations placed back where they were.
#include "calc/TraverseGathering.h"
#include "calc/TraverseJob.h"
#include "core/Angles.h"
#include "geobase/Carnet.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr::test {
namespace {

constexpr double kTenthMm = 1e-4;

using namespace traverse_job;

// T1 sights T2 twice.
CCarnet Job(bool endKnown = true, double sigmaAh = 0.0) {
    TraverseJobOptions options;
    options.endKnown = endKnown;
    options.sigmaAh = sigmaAh;
    options.measuredTwice = true;
    return TraverseJob(options);
}

CChemin Chain(std::initializer_list<const char*> names) {
    CChemin chain("CH1");
    for (const char* name : names)
        chain.add(name);
    return chain;
}

TEST(TraverseGathering, ALinkedTraverseGivesItsStationsBackWhereTheyStand) {
    const CCarnet carnet = Job();
    const GatheredTraverse gathered = GatherTraverse(carnet, Chain({"A", "T1", "T2", "B"}), {});
    ASSERT_TRUE(gathered.ok) << gathered.why;
    EXPECT_EQ(gathered.input.kind, TraverseKind::Linked);
    EXPECT_TRUE(gathered.warnings.empty());
    EXPECT_NEAR(gathered.input.v00, 12.5, 1e-4);
    EXPECT_NEAR(gathered.input.v0n, 77.0, 1e-4);
    const TraverseResult result = ComputeTraverse(gathered.input);
    ASSERT_TRUE(result.ok) << result.why;
    EXPECT_NEAR(result.angularMisclosure, 0.0, 1e-4);
    EXPECT_NEAR(result.f, 0.0, kTenthMm);
    EXPECT_NEAR(result.fz, 0.0, kTenthMm);
    const Place expected[] = {kA, kT1, kT2, kB};
    for (int i = 0; i < 4; ++i) {
        SCOPED_TRACE(i);
        EXPECT_NEAR(result.stations[static_cast<std::size_t>(i)].x, expected[i].x, kTenthMm);
        EXPECT_NEAR(result.stations[static_cast<std::size_t>(i)].y, expected[i].y, kTenthMm);
        EXPECT_NEAR(result.stations[static_cast<std::size_t>(i)].z, expected[i].z, kTenthMm);
    }
    EXPECT_NEAR(result.stations[1].v0, 210.0, 1e-4);
    EXPECT_NEAR(CentredGrads(result.stations[2].v0 - 399.995), 0.0, 1e-4);
}

TEST(TraverseGathering, TheKindFollowsWhatIsKnownAndWhatIsMissingIsNamed) {
    // The last station not known: an open traverse, computed without control.
    const GatheredTraverse open = GatherTraverse(Job(false), Chain({"A", "T1", "T2", "B"}), {});
    ASSERT_TRUE(open.ok);
    EXPECT_EQ(open.input.kind, TraverseKind::Open);
    const TraverseResult result = ComputeTraverse(open.input);
    ASSERT_TRUE(result.ok) << result.why;
    EXPECT_NEAR(result.stations[3].x, kB.x, kTenthMm);

    EXPECT_EQ(GatherTraverse(Job(), Chain({"A", "T9", "B"}), {}).why,
              "la station <T9> n'est pas dans la GéoBase");
    EXPECT_EQ(GatherTraverse(Job(), Chain({"A", "T1(2)", "B"}), {}).why,
              "la station <T1(2)> n'est pas dans la GéoBase");
    // A station that does not sight its neighbour: the computation names it.
    const GatheredTraverse skipping = GatherTraverse(Job(), Chain({"A", "T2", "B"}), {});
    ASSERT_TRUE(skipping.ok);
    EXPECT_EQ(ComputeTraverse(skipping.input).why, "la station <A> ne vise pas la station suivante <T2>");
}

TEST(TraverseGathering, ALegWhoseTwoMeasuresDisagreeIsSaidAndItsMeanUsed) {
    CCarnet carnet = Job();
    // T1's sighting back to A, 5 cm too long.
    const int back = carnet.Find(kKindMesure, "A");
    carnet.As<CVisee>(back)->setDI(carnet.diAt(back) + 0.05);
    const GatheredTraverse gathered = GatherTraverse(carnet, Chain({"A", "T1", "T2", "B"}), {});
    ASSERT_TRUE(gathered.ok);
    ASSERT_EQ(gathered.warnings.size(), 1u);
    EXPECT_EQ(gathered.warnings[0].from, "A");
    EXPECT_EQ(gathered.warnings[0].to, "T1");
    EXPECT_FALSE(gathered.warnings[0].height);
    const double straight = std::hypot(kT1.x - kA.x, kT1.y - kA.y);
    EXPECT_NEAR(gathered.input.stations[0].distance, straight + 0.025, 2e-3);
}

// Each station's directions are good to 2.7 sigma of its instrument, or to the tolerance of one direction
// when the instrument gives no precision; the closure of n angles sums 2n directions.
TEST(TraverseGathering, TheAngularToleranceComesFromTheInstrumentsOfItsStations) {
    const CCarnet carnet = Job(true, 0.001);
    const GatheredTraverse gathered = GatherTraverse(carnet, Chain({"A", "T1", "T2", "B"}), {});
    ASSERT_TRUE(gathered.ok) << gathered.why;
    // A and T1: 0.0027 gr; T2 and B: 0.0043 gr; 4 angles.
    const double meanSquare = (2 * 0.0027 * 0.0027 + 2 * 0.0043 * 0.0043) / 4;
    EXPECT_NEAR(AngularClosureTolerance(carnet, gathered, 4, 0.0043), std::sqrt(8 * meanSquare), 1e-7);
    // No instrument at all: 0.0018 gr x sqrt(2 x 5) for precise work over 5 angles.
    const CCarnet bare = Job();
    const GatheredTraverse plain = GatherTraverse(bare, Chain({"A", "T1", "T2", "B"}), {});
    EXPECT_NEAR(AngularClosureTolerance(bare, plain, 5, 0.0018), 0.0018 * std::sqrt(10.0), 1e-7);
    EXPECT_EQ(AngularClosureTolerance(bare, plain, 0, 0.0018), 0.0);
}

} // namespace
} // namespace pyr::test
