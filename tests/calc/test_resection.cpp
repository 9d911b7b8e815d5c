// The computation of a station by resection, against a station and known points built from exact
// coordinates (ExactReadings.h): a perfect instrument reads the sightings, so the station comes back
// exactly. Errors that a least-squares fit takes out entirely (with no component along the derivatives of
// the directions or of the zenith angles) leave the station where it was built: its residuals are then
// the errors negated, and its root-mean-square errors follow by hand.
#include "ExactReadings.h"
#include "calc/ResectionTexts.h"

#include <set>
#include <tuple>
#include <vector>

namespace pyr::test {
namespace {

constexpr double kRho = kGonPerRadian;
// The station to find, in Lambert-sized coordinates; its V0 just past the zero, so that put-off
// directions give orientations either side of 0 / 400.
constexpr Place kSt{1652345.678, 8176543.21, 150.0};
constexpr double kHi = 1.55, kHp = 1.3, kV0 = 0.0005;
constexpr Place Near(double dx, double dy, double z) {
    return {kSt.x + dx, kSt.y + dy, z};
}
const Place kPoints[] = {Near(450.0, 620.0, 162.3),  Near(710.0, -120.0, 141.2), Near(-180.0, -610.0, 170.8),
                         Near(-610.0, 210.0, 155.5), Near(100.0, 850.0, 149.0),  Near(600.0, -500.0, 158.7)};

// The sighting of `p` from the station, its AH and AV put off by dAh and dAv gr.
StationSighting Sight(const Place& p, double dAh = 0.0, double dAv = 0.0) {
    StationSighting s = SightPoint(kSt, kHi, kV0, p, kHp);
    s.ah = std::fmod(s.ah + dAh + 400.0, 400.0);
    s.av += dAv;
    return s;
}
StationResult Job(std::vector<StationSighting> sightings) {
    StationResult result;
    result.hi = kHi;
    result.sightings = std::move(sightings);
    return result;
}
std::set<int> Used(const StationResult& r) {
    std::set<int> used;
    for (std::size_t i = 0; i < r.sightings.size(); ++i)
        if (r.sightings[i].used) used.insert(static_cast<int>(i));
    return used;
}

TEST(ResectionPlanimetry, ExactSightingsGiveTheStationBackAmongThreeFourAndSixPoints) {
    for (std::size_t n : {3u, 4u, 6u}) {
        SCOPED_TRACE(n);
        StationResult result = Job({});
        for (std::size_t i = 0; i < n; ++i)
            result.sightings.push_back(Sight(kPoints[i]));
        result.sightings[0].dh = 1.0; // the measured distance gives way to the one from the station
        EXPECT_EQ(ComputeResection(result, true, true), kStationComputed);
        EXPECT_NEAR(result.x, kSt.x, kTenthMm);
        EXPECT_NEAR(result.y, kSt.y, kTenthMm);
        EXPECT_NEAR(Gap(result.v0 - kV0), 0.0, kHundredthMgon);
        EXPECT_NEAR(result.z, kSt.z, kTenthMm);
        EXPECT_EQ(Used(result).size(), 3u);
        for (const StationSighting& s : result.sightings) {
            EXPECT_NEAR(s.v, 0.0, kHundredthMgon);
            EXPECT_NEAR(s.vz, 0.0, kHundredthMgon);
            EXPECT_NEAR(s.dh, std::hypot(s.x - kSt.x, s.y - kSt.y), kTenthMm);
        }
        // Three sightings fix the place without redundancy: no error.
        EXPECT_EQ(IsKnown(result.emqX) && IsKnown(result.emqY) && IsKnown(result.emqV0), n > 3);
        EXPECT_LT(n > 3 ? std::hypot(result.emqX, result.emqY) : 0.0, kTenthMm);
        ExpectAllFinite(result);
    }
}

// Each point read in both faces, the two directions a milligrad apart, as a field book gives them before
// its station is reduced: two sightings on one point make no angle, and no triple is built on them.
// Taken as one, they would make a near-zero angle whose huge cotangent wins the triple search and puts
// the station on one of the points.
TEST(ResectionPlanimetry, PointsReadInBothFacesMakeNoTripleOfTheirOwn) {
    StationResult result = Job({});
    for (std::size_t i = 0; i < 3; ++i) {
        result.sightings.push_back(Sight(kPoints[i], -0.0005));
        result.sightings.push_back(Sight(kPoints[i], +0.0005));
    }
    EXPECT_EQ(ComputeResection(result, true, false), kStationComputed);
    EXPECT_NEAR(result.x, kSt.x, kTenthMm);
    EXPECT_NEAR(result.y, kSt.y, kTenthMm);
    EXPECT_NEAR(Gap(result.v0 - kV0), 0.0, kHundredthMgon);
    // The triple taken holds three different points.
    std::set<std::pair<double, double>> points;
    for (int i : Used(result))
        points.insert({result.sightings[i].x, result.sightings[i].y});
    EXPECT_EQ(points.size(), 3u);
}

TEST(ResectionPlanimetry, ErrorsTheFitTakesOutLeaveTheStationAndShowInItsResiduals) {
    // A cross: N and S at a = 300 m, E and W at b = 600 m, all level with the instrument (z = 100 gr).
    // Row i of the directions' design is (-dy, dx) rho / D² and -1: N (-rho/a, 0), E (0, rho/b),
    // S (rho/a, 0), W (0, -rho/b). AtA = diag(2 rho²/a², 2 rho²/b², 4), and (1, -1, 1, -1) is
    // orthogonal to every column: directions put off by (+2, -2, +2, -2) mgon move nothing, leave the
    // residuals v = -(put-off), sigma0 = sqrt(4 x 0.002² / (4 - 3)) = 0.004 gr, EMQ X = sigma0 a /
    // (rho sqrt 2), EMQ Y = sigma0 b / (rho sqrt 2), EMQ V0 = sigma0 / 2. The zenith angles' coefficients
    // are rho / D; errors (+2, -2, 0, -2) mgon weigh 2/300 - 2/600 - 2/600 = 0 against them, so the
    // station's altitude stays, though the plain mean of the altitudes moves; vz = -(put-off) and
    // EMQ Z = sqrt(12e-6 / 3) / (rho sqrt(2/a² + 2/b²)).
    const double a = 300.0, b = 600.0;
    auto level = [](double dx, double dy) {
        return Near(dx, dy, kSt.z + kHi - kHp + kCurvature * (dx * dx + dy * dy));
    };
    const double dAh[] = {0.002, -0.002, 0.002, -0.002}, dAv[] = {0.002, -0.002, 0.0, -0.002};
    StationResult result =
        Job({Sight(level(0.0, a), dAh[0], dAv[0]), Sight(level(b, 0.0), dAh[1], dAv[1]),
             Sight(level(0.0, -a), dAh[2], dAv[2]), Sight(level(-b, 0.0), dAh[3], dAv[3])});
    ASSERT_EQ(ComputeResection(result, true, true), kStationComputed);
    EXPECT_GT(std::hypot(result.x0 - kSt.x, result.y0 - kSt.y), 1e-3); // the first triple is off
    EXPECT_NEAR(Gap(result.v0Approx - kV0), 0.0, 0.002);
    EXPECT_NEAR(result.x, kSt.x, kTenthMm);
    EXPECT_NEAR(result.y, kSt.y, kTenthMm);
    EXPECT_NEAR(Gap(result.v0 - kV0), 0.0, kHundredthMgon);
    EXPECT_NEAR(result.sigma0, 0.004, kHundredthMgon);
    EXPECT_NEAR(result.emqX, 0.004 * a / (kRho * std::sqrt(2.0)), kHundredthMm);
    EXPECT_NEAR(result.emqY, 0.004 * b / (kRho * std::sqrt(2.0)), kHundredthMm);
    EXPECT_NEAR(result.emqV0, 0.002, kHundredthMgon);
    EXPECT_GT(std::fabs(result.z0 - kSt.z), 1e-3);
    EXPECT_NEAR(result.z, kSt.z, kTenthMm);
    EXPECT_NEAR(result.emqZ, std::sqrt(12e-6 / 3.0) / (kRho * std::sqrt(2.0 / (a * a) + 2.0 / (b * b))),
                kHundredthMm);
    for (int i = 0; i < 4; ++i) {
        EXPECT_NEAR(result.sightings[i].v, -dAh[i], kHundredthMgon) << i;
        EXPECT_NEAR(result.sightings[i].vz, -dAv[i], kHundredthMgon) << i;
    }
    ExpectAllFinite(result);
}

TEST(ResectionTriples, LaterTripleWinsATieHalfTurnsAreSkippedAndADueEastStationIsFound) {
    // The same point read twice: (0, 1, 2) and (0, 1, 3) have the very same p² + q², the later one wins.
    StationResult tie = Job({Sight(kPoints[0]), Sight(kPoints[1]), Sight(kPoints[2]), Sight(kPoints[2])});
    EXPECT_EQ(ComputeResection(tie, true, false), kStationComputed);
    EXPECT_EQ(Used(tie), (std::set<int>{0, 1, 3}));

    // A and B on a line through the station, read exactly 200 gr apart: the triples holding both are
    // skipped, the station comes from the others.
    StationResult half = Job({Sight(Near(300.0, 400.0, 150.0)), Sight(kPoints[1]),
                              Sight(Near(-150.0, -200.0, 150.0)), Sight(kPoints[3])});
    half.sightings[2].ah = std::fmod(half.sightings[0].ah + 200.0, 400.0);
    EXPECT_EQ(ComputeResection(half, true, false), kStationComputed);
    EXPECT_EQ(Used(half), (std::set<int>{1, 2, 3}));
    EXPECT_NEAR(half.x, kSt.x, kTenthMm);
    EXPECT_NEAR(half.y, kSt.y, kTenthMm);

    // The station at the origin, due east of A (GA = 300 gr: q = 0 exactly), B due north, C due south:
    // the rays of B and C make one line, the two other pairs cross at the station.
    StationResult east;
    for (const auto& [x, y, ah] : {std::tuple{-100.0, 0.0, 300.0}, {0.0, 100.0, 0.0}, {0.0, -100.0, 200.0}}) {
        east.sightings.emplace_back();
        east.sightings.back().x = x, east.sightings.back().y = y, east.sightings.back().ah = ah;
    }
    EXPECT_EQ(ComputeResection(east, true, true), kStationComputed);
    EXPECT_NEAR(east.x, 0.0, kTenthMm);
    EXPECT_NEAR(east.y, 0.0, kTenthMm);
    ExpectAllFinite(east);
}

TEST(ResectionTriples, TooFewAlignedOrCocyclicSightingsLeaveTheStationUnplaced) {
    StationSighting onStation = Sight(kPoints[2]);
    onStation.onStation = true;
    auto along = [](double g, double d) { // a point d metres from the station on the bearing g
        return Sight(Near(d * std::sin(g / kRho), d * std::cos(g / kRho), 151.0));
    };
    auto onCircle = [](double t) { // on the circle of 500 m centred at (300, -400) from the station
        return Sight(Near(300.0 + 500.0 * std::sin(t), -400.0 + 500.0 * std::cos(t), 151.0));
    };
    const struct {
        std::vector<StationSighting> sightings;
        int flag;
        const char* status;
    } cases[] = {
        {{Sight(kPoints[0]), Sight(kPoints[1]), onStation}, kStationTooFew, resec::kMsgTooFew},
        {{along(50.0, 100.0), along(250.0, 200.0), along(50.0, 300.0)}, kStationAligned, resec::kMsgAligned},
        // The first triple, nearly on a line (directions 199.8 and 200.1 gr apart), has the largest
        // p² + q² of all (6.3e11 against 5.0e10, 3.3e11 and 1.8e9, plain Python) but no pair of rays
        // crossing under |sin| > 0.01; the good triples after it never reach its value.
        {{along(210.2, 400.0), along(10.0, 300.0), along(10.3, 500.0), along(60.0, 100.0)},
         kStationAligned,
         resec::kMsgAligned},
        {{onCircle(0.3), onCircle(2.0), onCircle(4.1), onCircle(5.2)}, kStationCocyclic, resec::kMsgCocyclic},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.status);
        StationResult result = Job(c.sightings);
        EXPECT_EQ(ComputeResection(result, true, true), c.flag);
        EXPECT_EQ(result.status, c.status);
        EXPECT_EQ(result.x0, kUndefined);
        EXPECT_EQ(result.x, kUndefined);
        EXPECT_EQ(result.v0, kUndefined);
        EXPECT_TRUE(Used(result).empty());
        EXPECT_NEAR(result.z, kSt.z, kTenthMm); // from the measured distances
        ExpectAllFinite(result);
    }
}

TEST(AdjustStation, OneStepOverBothKindsOfSightingsBringsTheApproximatePlaceToTheStation) {
    // Two stations already placed and oriented sighted the station, beside three resection sightings.
    auto from = [](const Place& s, double v0s) {
        StationSighting sighting;
        sighting.onStation = true;
        sighting.x = s.x, sighting.y = s.y, sighting.v0s = v0s;
        sighting.ah = std::fmod(BearingTo(s.x, s.y, kSt.x, kSt.y) - v0s + 400.0, 400.0);
        return sighting;
    };
    const Place s1 = Near(-300.0, -700.0, 0.0), s2 = Near(800.0, 300.0, 0.0);
    StationResult result = Job({Sight(kPoints[0]), Sight(kPoints[2]), Sight(kPoints[3]), from(s1, 312.3456),
                                from(s2, 7.891), Sight(kSt)});
    // The approximate place 5 cm east and 3 cm south, 2 mgon off in orientation; a known point right
    // there has no direction from it, so no row in the step.
    result.x0 = kSt.x + 0.05, result.y0 = kSt.y - 0.03, result.v0Approx = kV0 - 0.002;
    result.sightings.back().x = result.x0, result.sightings.back().y = result.y0;
    AdjustStation(result);
    EXPECT_NEAR(result.x, kSt.x, kTenthMm);
    EXPECT_NEAR(result.y, kSt.y, kTenthMm);
    EXPECT_NEAR(Gap(result.v0 - kV0), 0.0, kHundredthMgon);
    EXPECT_NEAR(result.emqX, 0.0, kTenthMm);
    for (std::size_t i = 0; i < 5; ++i) {
        const StationSighting& s = result.sightings[i];
        EXPECT_NEAR(s.dh, std::hypot(s.x - kSt.x, s.y - kSt.y), kTenthMm) << i;
        EXPECT_NEAR(s.v, 0.0, kHundredthMgon) << i;
    }
    EXPECT_NEAR(result.sightings.back().dh, std::hypot(0.05, 0.03), kTenthMm);
    ExpectAllFinite(result);
}

TEST(ResectionAltimetry, MeasuredDistancesWithoutPlanimetryAndSightingsThatGiveNoAltitude) {
    StationResult result = Job({Sight(kPoints[0]), Sight(kPoints[1]), Sight(kPoints[2]), Sight(kPoints[3]),
                                Sight(kPoints[4]), Sight(kPoints[5])});
    result.sightings[0].z = kUndefined;
    result.sightings[1].av = kUndefined;
    result.sightings[2].av = 0.0; // at the zenith: no height difference over a horizontal distance
    result.sightings[3].dh = kUndefined;
    result.sightings[4].av = 400.0 - result.sightings[4].av; // face right, folded
    EXPECT_EQ(ComputeResection(result, false, true), 0);
    EXPECT_EQ(result.x, kUndefined);
    EXPECT_EQ(result.altitudes, 2);
    EXPECT_NEAR(result.z, kSt.z, kTenthMm);
    for (int i : {0, 1, 2, 3})
        EXPECT_EQ(result.sightings[i].zi, kUndefined) << i;
    ExpectAllFinite(result);

    // One altitude: no step, no error.
    result.sightings[5].av = kUndefined;
    ComputeResection(result, false, true);
    EXPECT_EQ(result.altitudes, 1);
    EXPECT_EQ(result.z, result.z0);
    EXPECT_EQ(result.emqZ, kUndefined);
    ExpectAllFinite(result);
}

} // namespace
} // namespace pyr::test
