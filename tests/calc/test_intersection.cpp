// The computation of a point by intersection, against points and sightings built from exact coordinates
// (ExactReadings.h) and against independent computations in plain Python whose inputs and results are
// written beside the tests.
#include "ExactReadings.h"
#include "calc/Intersection.h"
#include "calc/IntersectionTexts.h"
#include "calc/Rays.h"

#include <string>
#include <tuple>
#include <vector>

namespace pyr::test {
namespace {

void ExpectAllFinite(const InterResult& r) {
    ExpectFinite({r.angle, r.x0, r.y0, r.x, r.y, r.emqX, r.emqY, r.sigma0, r.z0, r.z, r.emqZ});
    for (const InterSighting& s : r.sightings)
        ExpectFinite({s.dh, s.v, s.e, s.vz, s.ez, s.zi});
}

const Place kP{1234.567, 5678.901, 112.345};
// Five stations around P; S2 reads P at 0.0004 gr and S3 at 399.9997 gr, either side of the zero.
const KnownStation kStations[] = {
    {"S1", 1000.0, 5000.0, 100.0, 1.55, 123.4567},
    {"S2", 1500.0, 5200.0, 120.3, 1.62, BearingTo(1500.0, 5200.0, kP.x, kP.y) - 0.0004},
    {"S3", 1800.0, 6000.0, 95.2, 1.48, BearingTo(1800.0, 6000.0, kP.x, kP.y) + 0.0003},
    {"S4", 900.0, 6100.0, 130.0, 1.70, 250.0},
    {"S5", 1300.0, 5900.0, 110.0, 1.50, 0.0123},
};

InterResult Job(int stations, double hp = 0.0) {
    InterResult result;
    result.mat = "P";
    for (int i = 0; i < stations; ++i)
        result.sightings.push_back(SightP(kStations[i], kP, hp));
    return result;
}

TEST(Rays, MeetAtTheConstructedPointAndFoldTheirAngle) {
    // A (100, 200) and B (400, 150) both see P (250, 500); L is AP = √(150² + 300²) = 335.4102 m.
    const double g1 = BearingTo(100.0, 200.0, 250.0, 500.0), g2 = BearingTo(400.0, 150.0, 250.0, 500.0);
    double x = 0.0, y = 0.0;
    ASSERT_TRUE(IntersectRays(100.0, 200.0, g1, 400.0, 150.0, g2, x, y));
    EXPECT_NEAR(x, 250.0, kTenthMm);
    EXPECT_NEAR(y, 500.0, kTenthMm);
    // The lines, not the half-lines: A looking away from P still meets B's ray at P, behind A.
    ASSERT_TRUE(IntersectRays(100.0, 200.0, g1 + 200.0, 400.0, 150.0, g2, x, y));
    EXPECT_NEAR(x, 250.0, kTenthMm);
    EXPECT_NEAR(y, 500.0, kTenthMm);
    // Parallel and opposite rays: no point, x and y untouched.
    x = y = 7.0;
    EXPECT_FALSE(IntersectRays(0.0, 0.0, 50.0, 10.0, 0.0, 50.0, x, y));
    EXPECT_FALSE(IntersectRays(0.0, 0.0, 50.0, 10.0, 0.0, 250.0, x, y));
    EXPECT_FALSE(IntersectRays(0.0, 0.0, 50.0, 10.0, 0.0, 50.00001, x, y)); // 0.01 mgon: sine 1.6e-7
    EXPECT_EQ(x, 7.0);
    EXPECT_EQ(y, 7.0);

    // Folded to [0, 200]: across the zero, beyond 200, opposite, past 400, equal.
    // clang-format off
    for (auto [a, b, angle] : {std::tuple{10.0, 110.0, 100.0}, {110.0, 10.0, 100.0}, {10.0, 390.0, 20.0},
             {50.0, 180.0, 70.0}, {30.0, 230.0, 0.0}, {399.0, 401.0, 2.0}, {120.0, 120.0, 0.0}}) // clang-format on
        EXPECT_DOUBLE_EQ(IntersectionAngle(a, b), angle) << a << " " << b;
}

// On 0 m targets, on 1.3 m ones, one of them 2 m high.
TEST(IntersectionPlanimetry, ExactSightingsGiveThePointBackFromTwoThreeAndFiveStations) {
    ASSERT_NEAR(Job(3).sightings[1].ah, 0.0004, 1e-9);
    ASSERT_NEAR(Job(3).sightings[2].ah, 399.9997, 1e-9);
    for (int n : {2, 3, 5})
        for (double hp : {0.0, 1.3}) {
            SCOPED_TRACE(testing::Message() << n << " stations, targets " << hp);
            InterResult result = Job(n, hp);
            result.sightings[n - 1] = SightP(kStations[n - 1], kP, 2.0);
            EXPECT_EQ(ComputeIntersection(result, true, true), kInterComputed);
            EXPECT_EQ(result.status, "");
            EXPECT_NEAR(result.x0, kP.x, kTenthMm);
            EXPECT_NEAR(result.y0, kP.y, kTenthMm);
            EXPECT_NEAR(result.x, kP.x, kTenthMm);
            EXPECT_NEAR(result.y, kP.y, kTenthMm);
            EXPECT_EQ(result.altitudes, n);
            EXPECT_NEAR(result.z0, kP.z, kTenthMm);
            EXPECT_NEAR(result.z, kP.z, kTenthMm);
            EXPECT_TRUE(result.iterations >= 1 && result.iterations <= 2) << result.iterations;
            EXPECT_NEAR(result.emqZ, 0.0, kTenthMm);
            for (const InterSighting& s : result.sightings) {
                SCOPED_TRACE(s.station);
                EXPECT_NEAR(s.v, 0.0, kHundredthMgon);
                EXPECT_NEAR(s.e, 0.0, kTenthMm);
                EXPECT_NEAR(s.dh, std::hypot(kP.x - s.xs, kP.y - s.ys), kTenthMm);
                EXPECT_NEAR(s.zi, kP.z, kTenthMm);
                EXPECT_NEAR(s.vz, 0.0, kHundredthMgon);
                EXPECT_NEAR(s.ez, 0.0, kTenthMm);
            }
            // Two stations: no redundancy, no error.
            EXPECT_EQ(IsKnown(result.emqX) && IsKnown(result.emqY), n > 2);
            EXPECT_LT(n > 2 ? std::hypot(result.emqX, result.emqY) : 0.0, kTenthMm);
            ExpectAllFinite(result);
        }
    // Target heights ignored while the sightings were read on 1.3 m targets: the point comes out 1.3 m
    // too high, every sighting agreeing.
    InterResult ignored = Job(3, 1.3);
    for (InterSighting& s : ignored.sightings)
        s.hp = 0.0;
    ComputeIntersection(ignored, true, true);
    EXPECT_NEAR(ignored.z, kP.z + 1.3, kTenthMm);
}

// Stations S1 (1000, 5000) V0 123.4567, S2 (1500, 5200) V0 0.0123, S3 (1800, 6000) V0 387.6543 and
// S4 (900, 6100) V0 250 read P (1234.567, 5678.901) with AH rounded to 0.1 mgon and then put off by
// +1.2, -2.0, +1.5, -0.8 mgon: AH = 297.7229, 367.7661, 279.4678, 307.2576. Plain Python with math only
// (the pair search, the two-ray formula, the normal equations inverted by hand as a 2 x 2) gives:
//   pair S2-S3 at 99.3437 gr, X0 = 1234.544407, Y0 = 5678.905606,
//   X = 1234.5625440, Y = 5678.9045910,
//   v = -1.70, +1.79, -0.96, +0.92 mgon, e = -0.01922, +0.01537, -0.00984, +0.00780 m,
//   DH = 718.2834, 547.5460, 650.2475, 537.8229 m,
//   sigma0 = 0.0019845 gr, EMQ X = 0.0122796 m, EMQ Y = 0.0159887 m.
TEST(IntersectionPlanimetry, OneLeastSquaresStepOnPerturbedDirections) {
    InterResult result;
    const struct {
        const char* name;
        double x, y, v0, ah;
    } data[] = {{"S1", 1000.0, 5000.0, 123.4567, 297.7229},
                {"S2", 1500.0, 5200.0, 0.0123, 367.7661},
                {"S3", 1800.0, 6000.0, 387.6543, 279.4678},
                {"S4", 900.0, 6100.0, 250.0, 307.2576}};
    for (const auto& d : data) {
        InterSighting s;
        s.station = d.name, s.xs = d.x, s.ys = d.y, s.v0 = d.v0, s.ah = d.ah;
        result.sightings.push_back(s);
    }
    EXPECT_EQ(ComputeIntersection(result, true, true), kInterComputed);
    EXPECT_EQ(result.first, 1);
    EXPECT_EQ(result.second, 2);
    EXPECT_NEAR(result.angle, 99.3437, kHundredthMgon);
    EXPECT_NEAR(result.x0, 1234.544407, kHundredthMm);
    EXPECT_NEAR(result.y0, 5678.905606, kHundredthMm);
    EXPECT_NEAR(result.x, 1234.5625440, kHundredthMm);
    EXPECT_NEAR(result.y, 5678.9045910, kHundredthMm);
    const double v[] = {-0.00170, 0.00179, -0.00096, 0.00092}, e[] = {-0.01922, 0.01537, -0.00984, 0.00780};
    const double dh[] = {718.2834, 547.5460, 650.2475, 537.8229};
    for (std::size_t i = 0; i < 4; ++i) {
        EXPECT_NEAR(result.sightings[i].v, v[i], kHundredthMgon) << i;
        EXPECT_NEAR(result.sightings[i].e, e[i], kHundredthMm) << i;
        EXPECT_NEAR(result.sightings[i].dh, dh[i], kTenthMm) << i;
    }
    EXPECT_NEAR(result.sigma0, 0.0019845, 1e-7);
    EXPECT_NEAR(result.emqX, 0.0122796, kHundredthMm);
    EXPECT_NEAR(result.emqY, 0.0159887, kHundredthMm);
    // No zenith angles: no altitude.
    EXPECT_EQ(result.altitudes, 0);
    EXPECT_EQ(result.z, kUndefined);
    ExpectAllFinite(result);
}

// A sighting by bearing alone, V0 = 0: AH is the bearing.
InterSighting Ray(const char* station, double x, double y, double bearing) {
    InterSighting s;
    s.station = station, s.xs = x, s.ys = y, s.v0 = 0.0, s.ah = bearing;
    return s;
}

TEST(IntersectionPairChoice, WidestAngleFirstOnATieNeverParallelOrFromOneStation) {
    // P at the origin seen from A (0, -100) at 0 gr, B (-100, 0) at 100 gr and C (100, 0) at 300 gr:
    // A-B and A-C both meet at 100 gr, B-C are opposite. The first pair met keeps the tie.
    InterResult tie;
    tie.sightings = {Ray("A", 0.0, -100.0, 0.0), Ray("B", -100.0, 0.0, 100.0), Ray("C", 100.0, 0.0, 300.0)};
    EXPECT_EQ(ComputeIntersection(tie, true, false), kInterComputed);
    EXPECT_EQ(tie.first, 0);
    EXPECT_EQ(tie.second, 1);
    EXPECT_DOUBLE_EQ(tie.angle, 100.0);
    EXPECT_NEAR(tie.x, 0.0, kTenthMm);
    EXPECT_NEAR(tie.y, 0.0, kTenthMm);

    // Two sightings from one station make no pair, however wide their angle: A's rays at 0 and 100 gr
    // cross at 100 gr, B's ray at 360 gr meets them at 40 and 60 gr; the pair is A's second ray with B.
    InterResult sameStation;
    sameStation.sightings = {Ray("A", 0.0, -100.0, 0.0), Ray("A", 0.0, -100.0, 100.0),
                             Ray("B", 100.0, -100.0, 360.0)};
    ComputeIntersection(sameStation, true, false);
    EXPECT_EQ(sameStation.first, 1);
    EXPECT_EQ(sameStation.second, 2);
    EXPECT_NEAR(sameStation.angle, 60.0, kHundredthMgon);

    // Parallel or opposite rays from two stations, a pair 0.01 mgon apart that wins but cannot be cut,
    // and every sighting from one station: no pair, no point.
    const std::vector<std::vector<InterSighting>> noPair = {
        {Ray("A", 0.0, -100.0, 0.0), Ray("D", 0.0, -200.0, 0.0)},
        {Ray("A", 0.0, -100.0, 0.0), Ray("D", 0.0, -200.0, 200.0)},
        {Ray("A", 0.0, -100.0, 0.0), Ray("D", 50.0, -200.0, 0.00001)},
        {Ray("A", 0.0, 0.0, 10.0), Ray("A", 0.0, 0.0, 150.0), Ray("A", 0.0, 0.0, 320.0)}};
    for (const auto& sightings : noPair) {
        SCOPED_TRACE(sightings.back().ah);
        InterResult result;
        result.sightings = sightings;
        EXPECT_EQ(ComputeIntersection(result, true, true), kInterParallel);
        EXPECT_EQ(result.status, "Visées toutes confondues : Calcul impossible !");
        EXPECT_EQ(result.x, kUndefined);
        EXPECT_EQ(result.x0, kUndefined);
        ExpectAllFinite(result);
    }

    // Fewer than two sightings that can be used: none, one, or a second one without its station's V0.
    InterResult none;
    EXPECT_EQ(ComputeIntersection(none, true, true), kInterTooFew);
    EXPECT_EQ(none.status, "Une seule visée : Calcul impossible !");
    InterResult withoutV0;
    withoutV0.sightings = {Ray("A", 0.0, -100.0, 0.0), Ray("B", -100.0, 0.0, 100.0)};
    withoutV0.sightings[1].v0 = kUndefined;
    EXPECT_EQ(ComputeIntersection(withoutV0, true, false), kInterTooFew);
    EXPECT_EQ(withoutV0.status, inters::kMsgOneSighting);
    EXPECT_EQ(withoutV0.first, -1);
}

TEST(IntersectionPlanimetry, RaysUnderFiveGradsAreFlaggedButComputedAndRaysMeetingBehindShowHalfATurn) {
    // A (0, 0) looks due north at P (0, 1000); B lies 1000 m from P on the bearing 200 + g from P,
    // so that its ray meets A's under g.
    for (double g : {4.0, 4.999, 5.001, 6.0}) {
        const double b = (200.0 + g) / kGonPerRadian;
        const double xb = 1000.0 * std::sin(b), yb = 1000.0 + 1000.0 * std::cos(b);
        InterResult result;
        result.sightings = {Ray("A", 0.0, 0.0, 0.0), Ray("B", xb, yb, BearingTo(xb, yb, 0.0, 1000.0))};
        const int expected = g < 5.0 ? kInterComputed | kInterTooClose : kInterComputed;
        EXPECT_EQ(ComputeIntersection(result, true, false), expected) << g;
        EXPECT_NEAR(result.angle, g, kHundredthMgon);
        EXPECT_NEAR(result.x, 0.0, kTenthMm) << g;
        EXPECT_NEAR(result.y, 1000.0, kTenthMm) << g;
    }
    // A (0, 0) looks south, B (100, 100) west: the lines meet at (0, 100), behind A, half a turn off.
    InterResult result;
    result.sightings = {Ray("A", 0.0, 0.0, 200.0), Ray("B", 100.0, 100.0, 300.0)};
    EXPECT_EQ(ComputeIntersection(result, true, false), kInterComputed);
    EXPECT_NEAR(result.x, 0.0, kTenthMm);
    EXPECT_NEAR(result.y, 100.0, kTenthMm);
    EXPECT_NEAR(std::fabs(result.sightings[0].v), 200.0, kHundredthMgon);
    EXPECT_NEAR(result.sightings[1].v, 0.0, kHundredthMgon);
}

TEST(IntersectionAltimetry, OneSightingGivesTheAltitudeFromTheComputedOrTheMeasuredDistance) {
    // Planimetry from S1 and S2, only S1 read a zenith angle: Z from the distance to the computed point.
    InterResult result = Job(2, 1.3);
    result.sightings[1].av = kUndefined;
    result.sightings[0].dh = 1.0; // the measured distance gives way to the computed one
    EXPECT_EQ(ComputeIntersection(result, true, true), kInterComputed);
    EXPECT_EQ(result.altitudes, 1);
    EXPECT_NEAR(result.z, kP.z, kTenthMm);
    EXPECT_EQ(result.z0, result.z);
    EXPECT_EQ(result.emqZ, kUndefined); // one altitude: no freedom
    EXPECT_EQ(result.iterations, 0);
    EXPECT_NEAR(result.sightings[0].zi, kP.z, kTenthMm);
    EXPECT_EQ(result.sightings[1].zi, kUndefined);
    EXPECT_EQ(result.sightings[0].vz, kUndefined);
    ExpectAllFinite(result);

    // Planimetry off, or failed for want of a second sighting: the measured distance is used.
    for (bool plani : {false, true}) {
        InterResult alone = Job(1, 1.3);
        EXPECT_EQ(ComputeIntersection(alone, plani, true), plani ? kInterTooFew : 0);
        EXPECT_EQ(alone.status, plani ? inters::kMsgOneSighting : "");
        EXPECT_EQ(alone.x, kUndefined);
        EXPECT_NEAR(alone.z, kP.z, kTenthMm) << plani;
        EXPECT_EQ(alone.altitudes, 1);
    }
    // A station without planimetry but with a height and a measured distance.
    InterResult heightOnly = Job(1);
    heightOnly.sightings[0].xs = heightOnly.sightings[0].ys = heightOnly.sightings[0].v0 = kUndefined;
    ComputeIntersection(heightOnly, true, true);
    EXPECT_NEAR(heightOnly.z, kP.z, kTenthMm);
}

// Planimetry off; measured DH 718.2834, 547.546, 650.2475 m from S1 (Z 100, HI 1.55, HP 1.3),
// S2 (Z 120.3, HI 1.62, HP 1.3), S3 (Z 95.2, HI 1.48, HP 2.0) on a point at Z 112.345, the exact zenith
// angles rounded to 0.1 mgon then put off by +2.5, -3.0, +1.1 mgon: AV = 98.9336, 100.9613, 98.2748.
// Plain Python, minimising the sum of the squared zenith residuals by golden section (not Gauss-Newton):
//   Zi = 112.31701, 112.37112, 112.33343, Z0 = 112.34052, Z = 112.3457260,
//   vz = -0.002544, +0.002951, -0.001202 gr, ez = +0.02870, -0.02538, +0.01228 m, EMQ Z = 0.0163943 m.
TEST(IntersectionAltimetry, PerturbedZenithAnglesFitTheIndependentMinimum) {
    InterResult result;
    const struct {
        double zs, hi, hp, dh, av;
    } data[] = {{100.0, 1.55, 1.3, 718.2834, 98.9336},
                {120.3, 1.62, 1.3, 547.546, 100.9613},
                {95.2, 1.48, 2.0, 650.2475, 98.2748}};
    for (const auto& d : data) {
        InterSighting s;
        s.station = "S", s.zs = d.zs, s.hi = d.hi, s.hp = d.hp, s.dh = d.dh, s.av = d.av;
        result.sightings.push_back(s);
    }
    EXPECT_EQ(ComputeIntersection(result, false, true), 0);
    EXPECT_EQ(result.altitudes, 3);
    EXPECT_NEAR(result.z0, 112.34052, kHundredthMm);
    EXPECT_NEAR(result.z, 112.3457260, kHundredthMm);
    EXPECT_LT(result.iterations, kInterMaxIterations);
    const double zi[] = {112.31701, 112.37112, 112.33343}, vz[] = {-0.002544, 0.002951, -0.001202};
    const double ez[] = {0.02870, -0.02538, 0.01228};
    for (std::size_t i = 0; i < 3; ++i) {
        EXPECT_NEAR(result.sightings[i].zi, zi[i], kHundredthMm) << i;
        EXPECT_NEAR(result.sightings[i].vz, vz[i], 1e-6) << i;
        EXPECT_NEAR(result.sightings[i].ez, ez[i], kHundredthMm) << i;
    }
    EXPECT_NEAR(result.emqZ, 0.0163943, kHundredthMm);
    EXPECT_EQ(result.x, kUndefined);
    EXPECT_EQ(result.flags, 0);
}

// Two sightings that disagree wildly at close range: from a station at Z 0 (HI and HP 0), zenith 180 gr
// at 1 m and 30 gr at 3 m. Gauss-Newton oscillates and needs 32 steps to settle at Z = -0.7152034;
// an independent iteration in plain Python gives, after 10 steps from Z0 = 1.4050743, Z = -0.7049864.
TEST(IntersectionAltimetry, GaussNewtonStopsAfterTenSteps) {
    InterResult result;
    for (auto [dh, av] : {std::pair{1.0, 180.0}, std::pair{3.0, 30.0}}) {
        InterSighting s;
        s.station = "S", s.zs = 0.0, s.hi = 0.0, s.hp = 0.0, s.dh = dh, s.av = av;
        result.sightings.push_back(s);
    }
    ComputeIntersection(result, true, true);
    EXPECT_EQ(result.iterations, kInterMaxIterations);
    EXPECT_NEAR(result.z0, 1.4050743, kTenthMm);
    EXPECT_NEAR(result.z, -0.7049864, kTenthMm);
    EXPECT_TRUE(IsKnown(result.emqZ));
    ExpectAllFinite(result);
}

TEST(IntersectionDegenerate, StationOnTheApproximatePointAndSingularNormals) {
    // A (0, 0) looks north, B (100, 0) looks west twice, through A: the approximate point is A itself,
    // where A's direction has no derivative; B's two rows are equal, so the normal matrix is singular.
    // The approximate point stands, without errors.
    InterResult result;
    result.sightings = {Ray("A", 0.0, 0.0, 0.0), Ray("B", 100.0, 0.0, 300.0), Ray("B", 100.0, 0.0, 300.0)};
    for (InterSighting& s : result.sightings)
        s.zs = 50.0, s.hi = 1.5, s.hp = 1.5, s.av = 99.0;
    EXPECT_EQ(ComputeIntersection(result, true, true), kInterComputed);
    EXPECT_NEAR(result.x, 0.0, kTenthMm);
    EXPECT_NEAR(result.y, 0.0, kTenthMm);
    EXPECT_EQ(result.emqX, kUndefined);
    EXPECT_EQ(result.emqY, kUndefined);
    EXPECT_EQ(result.sigma0, kUndefined);
    EXPECT_EQ(result.sightings[0].dh, 0.0);
    EXPECT_EQ(result.sightings[0].v, kUndefined);  // no direction from a station to itself
    EXPECT_EQ(result.sightings[0].zi, kUndefined); // no height difference over no distance
    EXPECT_EQ(result.altitudes, 2);
    ExpectAllFinite(result);
}

TEST(IntersectionDegenerate, VerticalOrMissingZenithAnglesGiveNoAltitude) {
    InterResult result = Job(5, 1.3);
    result.sightings[0].av = 0.0;   // at the zenith
    result.sightings[1].av = 200.0; // at the nadir
    result.sightings[2].av = kUndefined;
    result.sightings[3].zs = kUndefined; // a station without altitude
    ComputeIntersection(result, true, true);
    EXPECT_EQ(result.altitudes, 1);
    for (int i : {0, 1, 2, 3})
        EXPECT_EQ(result.sightings[i].zi, kUndefined) << i;
    EXPECT_NEAR(result.z, kP.z, kTenthMm);
    EXPECT_EQ(result.emqZ, kUndefined);
    ExpectAllFinite(result);

    // None left, or no distance measured without planimetry: no altitude at all.
    result.sightings[4].av = 100.0 + 200.0; // face right, folded to level: still an altitude
    ComputeIntersection(result, false, true);
    EXPECT_EQ(result.altitudes, 1);
    result.sightings[4].dh = kUndefined;
    ComputeIntersection(result, false, true);
    EXPECT_EQ(result.altitudes, 0);
    EXPECT_EQ(result.z, kUndefined);
    EXPECT_EQ(result.z0, kUndefined);
    ExpectAllFinite(result);
}

TEST(IntersectionDegenerate, APartSwitchedOffLeavesItsResultsUndefined) {
    InterResult result = Job(3, 1.3);
    ComputeIntersection(result, true, true);
    ASSERT_TRUE(IsKnown(result.z) && IsKnown(result.x) && IsKnown(result.emqZ) && IsKnown(result.emqX));

    // Computed again without altimetry, then without planimetry: the earlier values are gone.
    EXPECT_EQ(ComputeIntersection(result, true, false), kInterComputed);
    EXPECT_TRUE(IsKnown(result.x) && result.altitudes == 0);
    for (double value : {result.z0, result.z, result.emqZ, result.sightings[0].zi, result.sightings[1].vz,
                         result.sightings[2].ez})
        EXPECT_EQ(value, kUndefined);
    EXPECT_EQ(ComputeIntersection(result, false, true), 0);
    EXPECT_NEAR(result.z, kP.z, kTenthMm);
    for (double value : {result.x0, result.y0, result.x, result.y, result.emqX, result.emqY, result.angle,
                         result.sightings[0].v, result.sightings[2].e})
        EXPECT_EQ(value, kUndefined);
    EXPECT_EQ(result.first, -1);
}

} // namespace
} // namespace pyr::test
