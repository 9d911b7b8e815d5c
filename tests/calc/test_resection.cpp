// The computation of a station by resection, against a station and known points built from exact
// coordinates with plain plane trigonometry (std::atan2), not the program's helpers: a perfect instrument
// reads the sightings, so the station comes back exactly. With directions put off by a few mgon, the
// station is compared with an independent least-squares solution: Gauss-Newton on the plain direction
// equations with derivatives by central differences, iterated until it no longer moves.
#include "calc/Resection.h"
#include "calc/ResectionTexts.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <gtest/gtest.h>
#include <initializer_list>
#include <set>
#include <tuple>
#include <vector>

namespace pyr::test {
namespace {

constexpr double kTenthMm = 1e-4;
constexpr double kHundredthMm = 1e-5;
constexpr double kHundredthMgon = 1e-5;
constexpr double kGonPerRadian = 200.0 / 3.14159265358979323846;
// Curvature and refraction: the line of sight bends down by 0.84 / 12 768 000 m per square metre.
constexpr double kCurvature = 0.84 / 12768000.0;

struct Pt {
    double x, y, z;
};
// The station to find, in Lambert-sized coordinates; its V0 a little past the zero, so that the
// orientations each sighting gives straddle 0 / 400 once the directions are put off.
constexpr Pt kSt{1652345.678, 8176543.21, 150.0};
constexpr double kHi = 1.55;
constexpr double kV0 = 0.0005;
constexpr Pt Near(double dx, double dy, double z) {
    return {kSt.x + dx, kSt.y + dy, z};
}
const Pt kPoints[] = {Near(450.0, 620.0, 162.3),  Near(710.0, -120.0, 141.2), Near(-180.0, -610.0, 170.8),
                      Near(-610.0, 210.0, 155.5), Near(100.0, 850.0, 149.0),  Near(600.0, -500.0, 158.7)};

double BearingTo(double xa, double ya, double xb, double yb) {
    return std::fmod(std::atan2(xb - xa, yb - ya) * kGonPerRadian + 400.0, 400.0);
}
// An angle difference within [-200, 200].
double Gap(double grads) {
    return std::remainder(grads, 400.0);
}

// The sighting of `p` from the station at `st`, on a target 1.3 m high, put off by `dAh` and `dAv` gr.
StationSighting Sight(const Pt& p, double dAh = 0.0, double dAv = 0.0, const Pt& st = kSt) {
    const double d = std::hypot(p.x - st.x, p.y - st.y);
    const double rise = p.z + 1.3 - st.z - kHi - kCurvature * d * d;
    StationSighting s;
    s.x = p.x, s.y = p.y, s.z = p.z, s.hp = 1.3, s.dh = d;
    s.ah = std::fmod(BearingTo(st.x, st.y, p.x, p.y) - kV0 + dAh + 400.0, 400.0);
    s.av = std::atan2(d, rise) * kGonPerRadian + dAv;
    return s;
}
StationResult Job(std::initializer_list<StationSighting> sightings) {
    StationResult result;
    result.hi = kHi;
    result.sightings = sightings;
    return result;
}

void ExpectAllFinite(const StationResult& r) {
    for (double value :
         {r.x0, r.y0, r.v0Approx, r.x, r.y, r.v0, r.emqX, r.emqY, r.emqV0, r.sigma0, r.z0, r.z, r.emqZ})
        EXPECT_TRUE(std::isfinite(value)) << value;
    for (const StationSighting& s : r.sightings)
        for (double value : {s.dh, s.v0, s.v, s.e, s.vz, s.ez, s.zi})
            EXPECT_TRUE(std::isfinite(value)) << value;
}
std::set<int> Used(const StationResult& r) {
    std::set<int> used;
    for (std::size_t i = 0; i < r.sightings.size(); ++i)
        if (r.sightings[i].used) used.insert(static_cast<int>(i));
    return used;
}

// Gauss-Newton on `residuals` (computed less observed, a function of the unknowns) with derivatives by
// central differences and the normal equations inverted by Gauss-Jordan, from `start` until a step moves
// no unknown by more than 1e-10. Gives the unknowns, their root-mean-square errors
// sqrt(diag (JtJ)^-1) x sigma0 with sigma0 = sqrt(sum r² / (n - unknowns)), and the residuals.
using Vec = std::vector<double>;
struct Fit {
    Vec u, emq, r;
};
Fit LeastSquares(const std::function<Vec(const Vec&)>& residuals, Vec u) {
    const std::size_t m = u.size();
    std::vector<Vec> inverse;
    for (int iteration = 0; iteration < 20; ++iteration) {
        const Vec r = residuals(u);
        std::vector<Vec> j(m);
        for (std::size_t c = 0; c < m; ++c) {
            Vec plus = u, minus = u;
            plus[c] += 1e-3, minus[c] -= 1e-3;
            const Vec rp = residuals(plus), rm = residuals(minus);
            for (std::size_t i = 0; i < r.size(); ++i)
                j[c].push_back((rp[i] - rm[i]) / 2e-3);
        }
        // [JtJ | I] reduced to [I | (JtJ)^-1].
        std::vector<Vec> n(m, Vec(2 * m, 0.0));
        Vec jtr(m, 0.0);
        for (std::size_t a = 0; a < m; ++a) {
            for (std::size_t b = 0; b < m; ++b)
                for (std::size_t i = 0; i < r.size(); ++i)
                    n[a][b] += j[a][i] * j[b][i];
            for (std::size_t i = 0; i < r.size(); ++i)
                jtr[a] += j[a][i] * r[i];
            n[a][m + a] = 1.0;
        }
        for (std::size_t a = 0; a < m; ++a) {
            const double pivot = n[a][a];
            for (double& value : n[a])
                value /= pivot;
            for (std::size_t b = 0; b < m; ++b)
                if (b != a)
                    for (std::size_t c = 2 * m; c-- > 0;)
                        n[b][c] -= n[b][a] * n[a][c];
        }
        inverse = n;
        double largest = 0.0;
        for (std::size_t a = 0; a < m; ++a) {
            double step = 0.0;
            for (std::size_t b = 0; b < m; ++b)
                step += n[a][m + b] * jtr[b];
            u[a] -= step;
            largest = std::max(largest, std::fabs(step));
        }
        if (largest < 1e-10) break;
    }
    const Vec r = residuals(u);
    double squares = 0.0;
    for (double value : r)
        squares += value * value;
    const double sigma0 = std::sqrt(squares / static_cast<double>(r.size() - m));
    Vec emq;
    for (std::size_t a = 0; a < m; ++a)
        emq.push_back(std::sqrt(inverse[a][m + a]) * sigma0);
    return {u, emq, r};
}

TEST(ResectionPlanimetry, ExactSightingsGiveTheStationBackAmongThreeFourAndSixPoints) {
    for (std::size_t n : {3u, 4u, 6u}) {
        SCOPED_TRACE(n);
        StationResult result;
        result.hi = kHi;
        for (std::size_t i = 0; i < n; ++i)
            result.sightings.push_back(Sight(kPoints[i]));
        result.sightings[0].dh = 1.0; // the measured distance gives way to the one from the station
        EXPECT_EQ(ComputeResection(result, true, true), kStationComputed);
        EXPECT_EQ(result.status, "");
        EXPECT_NEAR(result.x0, kSt.x, kTenthMm);
        EXPECT_NEAR(result.y0, kSt.y, kTenthMm);
        EXPECT_NEAR(result.x, kSt.x, kTenthMm);
        EXPECT_NEAR(result.y, kSt.y, kTenthMm);
        EXPECT_NEAR(Gap(result.v0 - kV0), 0.0, kHundredthMgon);
        EXPECT_NEAR(result.z, kSt.z, kTenthMm);
        EXPECT_EQ(result.altitudes, static_cast<int>(n));
        EXPECT_EQ(Used(result).size(), 3u);
        for (const StationSighting& s : result.sightings) {
            EXPECT_NEAR(s.v, 0.0, kHundredthMgon);
            EXPECT_NEAR(s.vz, 0.0, kHundredthMgon);
            EXPECT_NEAR(s.zi, kSt.z, kTenthMm);
            EXPECT_NEAR(s.dh, std::hypot(s.x - kSt.x, s.y - kSt.y), kTenthMm);
        }
        // Three sightings: no redundancy in planimetry, no error.
        EXPECT_EQ(IsKnown(result.emqX) && IsKnown(result.emqY) && IsKnown(result.emqV0), n > 3);
        EXPECT_LT(n > 3 ? std::hypot(result.emqX, result.emqY) : 0.0, kTenthMm);
        EXPECT_NEAR(result.emqZ, 0.0, kTenthMm);
        ExpectAllFinite(result);
    }
}

TEST(ResectionPlanimetry, PerturbedSightingsAgreeWithAnIndependentLeastSquaresSolution) {
    const double dAh[] = {0.0021, -0.0014, 0.0030, -0.0026, 0.0008, -0.0019};
    const double dAv[] = {0.0015, -0.0022, 0.0009, -0.0011, 0.0024, -0.0006};
    StationResult result;
    result.hi = kHi;
    for (int i = 0; i < 6; ++i)
        result.sightings.push_back(Sight(kPoints[i], dAh[i], dAv[i]));
    ASSERT_EQ(ComputeResection(result, true, true), kStationComputed);
    // The orientations of single sightings straddle the zero and still average near it.
    EXPECT_NEAR(Gap(result.v0Approx - kV0), 0.0, 0.003);

    const auto& sightings = result.sightings;
    const Fit plani = LeastSquares(
        [&](const Vec& u) {
            Vec r(6);
            for (int i = 0; i < 6; ++i)
                r[i] = Gap(BearingTo(u[0], u[1], sightings[i].x, sightings[i].y) - u[2] - sightings[i].ah);
            return r;
        },
        Vec{kSt.x, kSt.y, kV0});
    EXPECT_NEAR(result.x, plani.u[0], kTenthMm);
    EXPECT_NEAR(result.y, plani.u[1], kTenthMm);
    EXPECT_NEAR(Gap(result.v0 - plani.u[2]), 0.0, kHundredthMgon);
    EXPECT_NEAR(result.emqX, plani.emq[0], kHundredthMm);
    EXPECT_NEAR(result.emqY, plani.emq[1], kHundredthMm);
    EXPECT_NEAR(result.emqV0, plani.emq[2], kHundredthMgon);
    for (int i = 0; i < 6; ++i)
        EXPECT_NEAR(sightings[i].v, plani.r[i], kHundredthMgon) << i;

    // The altitude: the zenith angles the station at Z would read from the computed place.
    const Fit alti = LeastSquares(
        [&](const Vec& u) {
            Vec r(6);
            for (int i = 0; i < 6; ++i) {
                const StationSighting& s = sightings[i];
                const double d = std::hypot(s.x - plani.u[0], s.y - plani.u[1]);
                r[i] = std::atan2(d, s.z + s.hp - u[0] - kHi - kCurvature * d * d) * kGonPerRadian - s.av;
            }
            return r;
        },
        Vec{kSt.z});
    EXPECT_NEAR(result.z, alti.u[0], kTenthMm);
    EXPECT_NEAR(result.emqZ, alti.emq[0], kHundredthMm);
    EXPECT_GT(std::fabs(result.z - result.z0), 1e-4); // the step did move the mean
    for (int i = 0; i < 6; ++i)
        EXPECT_NEAR(sightings[i].vz, alti.r[i], kHundredthMgon) << i;
    ExpectAllFinite(result);
}

TEST(ResectionTriples, LaterTripleWinsATieAndHalfTurnsAreSkipped) {
    // The same point read twice: the triples (0, 1, 2) and (0, 1, 3) have the very same p² + q², and the
    // later one places the station. The two readings of one point make no triple with a third one.
    StationResult tie = Job({Sight(kPoints[0]), Sight(kPoints[1]), Sight(kPoints[2]), Sight(kPoints[2])});
    EXPECT_EQ(ComputeResection(tie, true, false), kStationComputed);
    EXPECT_EQ(Used(tie), (std::set<int>{0, 1, 3}));
    EXPECT_NEAR(tie.x, kSt.x, kTenthMm);

    // A and B on a line through the station, read exactly 200 gr apart: the triples holding both are
    // skipped, the station comes from the others.
    const Pt a = Near(300.0, 400.0, 150.0), b = Near(-150.0, -200.0, 150.0);
    StationResult half = Job({Sight(a), Sight(b), Sight(kPoints[1]), Sight(kPoints[3])});
    half.sightings[1].ah = std::fmod(half.sightings[0].ah + 200.0, 400.0);
    EXPECT_EQ(ComputeResection(half, true, false), kStationComputed);
    EXPECT_EQ(Used(half), (std::set<int>{1, 2, 3}));
    EXPECT_NEAR(half.x, kSt.x, kTenthMm);
    EXPECT_NEAR(half.y, kSt.y, kTenthMm);

    // The station due east of A (GA = 100 gr, q = 0 exactly), B due north, C due south: the rays of B
    // and C are one line, the other two pairs place the station at the origin.
    StationResult east;
    for (const auto& [x, y, ah] : {std::tuple{-100.0, 0.0, 300.0}, {0.0, 100.0, 0.0}, {0.0, -100.0, 200.0}}) {
        StationSighting s;
        s.x = x, s.y = y, s.ah = ah;
        east.sightings.push_back(s);
    }
    EXPECT_EQ(ComputeResection(east, true, true), kStationComputed);
    EXPECT_NEAR(east.x, 0.0, kTenthMm);
    EXPECT_NEAR(east.y, 0.0, kTenthMm);
    EXPECT_NEAR(Gap(east.v0), 0.0, kHundredthMgon);
    ExpectAllFinite(east);
}

TEST(ResectionTriples, TooFewAlignedOrCocyclicSightingsLeaveTheStationUnplaced) {
    StationSighting withoutAh = Sight(kPoints[2]), onStation = Sight(kPoints[2]);
    withoutAh.ah = kUndefined;
    onStation.onStation = true;
    // Points along the bearing g from the station at the distance d.
    auto along = [](double g, double d) {
        return Sight(Near(d * std::sin(g / kGonPerRadian), d * std::cos(g / kGonPerRadian), 151.0));
    };
    // Points on the circle of radius 500 m centred 300 m east of the station, which lies on it too.
    auto onCircle = [](double a) {
        return Sight(Near(300.0 + 500.0 * std::sin(a), -400.0 + 500.0 * std::cos(a), 151.0));
    };
    const struct {
        std::vector<StationSighting> sightings;
        int flag;
        const char* status;
    } cases[] = {
        {{Sight(kPoints[0]), Sight(kPoints[1])}, kStationTooFew, resec::kMsgTooFew},
        {{Sight(kPoints[0]), Sight(kPoints[1]), withoutAh}, kStationTooFew, resec::kMsgTooFew},
        {{Sight(kPoints[0]), Sight(kPoints[1]), onStation}, kStationTooFew, resec::kMsgTooFew},
        // All on one line through the station, either side of it.
        {{along(50.0, 100.0), along(250.0, 200.0), along(50.0, 300.0)}, kStationAligned, resec::kMsgAligned},
        // The first triple, nearly on a line (directions 199.8 and 200.1 gr apart), has the largest
        // p² + q² of all (6.3e11 against 5.0e10, 3.3e11 and 1.8e9, plain Python) but no pair of rays
        // crossing under |sin| > 0.01; the good triples after it never reach its value.
        {{along(210.2, 400.0), along(10.0, 300.0), along(10.3, 500.0), along(60.0, 100.0)},
         kStationAligned,
         resec::kMsgAligned},
        {{onCircle(0.3), onCircle(2.0), onCircle(4.1)}, kStationCocyclic, resec::kMsgCocyclic},
        {{onCircle(0.3), onCircle(2.0), onCircle(4.1), onCircle(5.2)}, kStationCocyclic, resec::kMsgCocyclic},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.sightings.size());
        StationResult result;
        result.hi = kHi;
        result.sightings = c.sightings;
        EXPECT_EQ(ComputeResection(result, true, true), c.flag);
        EXPECT_EQ(result.status, c.status);
        EXPECT_EQ(result.x0, kUndefined);
        EXPECT_EQ(result.x, kUndefined);
        EXPECT_EQ(result.v0, kUndefined);
        EXPECT_TRUE(Used(result).empty());
        // The altitude from the measured distances stands.
        EXPECT_NEAR(result.z, kSt.z, kTenthMm);
        ExpectAllFinite(result);
    }
    // A fourth point off the circle places the station.
    StationResult off = Job({onCircle(0.3), onCircle(2.0), onCircle(4.1), Sight(kPoints[4])});
    EXPECT_EQ(ComputeResection(off, true, false), kStationComputed);
    EXPECT_NEAR(off.x, kSt.x, kTenthMm);
}

TEST(AdjustStation, OneStepOverBothKindsOfSightingsMovesTheApproximatePlaceToTheStation) {
    // Two stations already placed and oriented sighted the station (intersection sightings, on a 1.8 m
    // target), beside three resection sightings.
    const Pt s1 = Near(-300.0, -700.0, 120.0), s2 = Near(800.0, 300.0, 130.0);
    auto from = [](const Pt& s, double v0s, double dAh) {
        StationSighting sighting;
        sighting.onStation = true;
        sighting.x = s.x, sighting.y = s.y, sighting.z = s.z, sighting.v0s = v0s, sighting.hp = 1.8;
        sighting.ah = std::fmod(BearingTo(s.x, s.y, kSt.x, kSt.y) - v0s + dAh + 400.0, 400.0);
        return sighting;
    };
    for (double noise : {0.0, 1.0}) {
        SCOPED_TRACE(noise);
        StationResult result = Job({Sight(kPoints[0], 0.0021 * noise), Sight(kPoints[2], -0.0014 * noise),
                                    Sight(kPoints[3], 0.0030 * noise), from(s1, 312.3456, -0.0026 * noise),
                                    from(s2, 7.891, 0.0018 * noise)});
        // The approximate place 5 cm and 3 cm off, its orientation 2 mgon off.
        result.x0 = kSt.x + 0.05, result.y0 = kSt.y - 0.03, result.v0Approx = kV0 - 0.002;
        AdjustStation(result);
        const auto& sightings = result.sightings;
        const Fit fit = LeastSquares(
            [&](const Vec& u) {
                Vec r(5);
                for (int i = 0; i < 5; ++i) {
                    const StationSighting& s = sightings[i];
                    r[i] = s.onStation ? Gap(BearingTo(s.x, s.y, u[0], u[1]) - s.v0s - s.ah)
                                       : Gap(BearingTo(u[0], u[1], s.x, s.y) - u[2] - s.ah);
                }
                return r;
            },
            Vec{kSt.x, kSt.y, kV0});
        EXPECT_NEAR(result.x, fit.u[0], kTenthMm);
        EXPECT_NEAR(result.y, fit.u[1], kTenthMm);
        EXPECT_NEAR(Gap(result.v0 - fit.u[2]), 0.0, kHundredthMgon);
        EXPECT_NEAR(result.emqX, fit.emq[0], kHundredthMm);
        EXPECT_NEAR(result.emqY, fit.emq[1], kHundredthMm);
        EXPECT_NEAR(result.emqV0, fit.emq[2], kHundredthMgon);
        for (int i = 0; i < 5; ++i) {
            EXPECT_NEAR(sightings[i].v, fit.r[i], kHundredthMgon) << i;
            EXPECT_NEAR(sightings[i].dh, std::hypot(sightings[i].x - fit.u[0], sightings[i].y - fit.u[1]),
                        kTenthMm);
        }
        ExpectAllFinite(result);
    }

    // Three sightings, one of them on a known point at the approximate place itself: no row, no
    // direction, a zero distance; too few rows for a step, the approximate values stand.
    StationResult three = Job({Sight(kPoints[0]), Sight(kPoints[1]), Sight(kPoints[2]), Sight(kSt)});
    three.x0 = kSt.x, three.y0 = kSt.y, three.v0Approx = kV0;
    AdjustStation(three);
    EXPECT_EQ(three.x, three.x0);
    EXPECT_EQ(three.v0, three.v0Approx);
    EXPECT_EQ(three.emqX, kUndefined);
    EXPECT_EQ(three.sightings[3].dh, 0.0);
    EXPECT_EQ(three.sightings[3].v, kUndefined);
    ExpectAllFinite(three);
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

    // One altitude: no step, no error. No instrument height: no altitude at all.
    result.sightings[5].av = kUndefined;
    ComputeResection(result, false, true);
    EXPECT_EQ(result.altitudes, 1);
    EXPECT_EQ(result.z, result.z0);
    EXPECT_EQ(result.emqZ, kUndefined);
    result.hi = kUndefined;
    ComputeResection(result, false, true);
    EXPECT_EQ(result.altitudes, 0);
    EXPECT_EQ(result.z, kUndefined);
    ExpectAllFinite(result);
}

} // namespace
} // namespace pyr::test
