// The combined method against a station, its known points and the stations that sighted it, built from
// exact coordinates (ExactReadings.h). The circle through the station, A and B comes from the
// circumcentre formula; the angle between a line and that circle is asin(|u . n|), u the line's
// direction and n the unit radius where they cross.
#include "ExactReadings.h"
#include "calc/Recoupement.h"
#include "calc/RecoupementTexts.h"
#include "calc/SessionTexts.h"

namespace pyr::test {
namespace {

constexpr double kPiHere = 3.14159265358979323846;

struct Oriented {
    Place p;
    double v0, hi;
};
// The station to find, in Lambert-sized coordinates, with its instrument.
constexpr Place kSt{651234.567, 6862345.678, 112.345};
constexpr double kHi = 1.62, kV0 = 123.4567;
constexpr Place Near(double dx, double dy, double z) {
    return {kSt.x + dx, kSt.y + dy, z};
}
// Known points: A and B to the north, C south-west, D south-east, E 50 m away, 36 m above.
constexpr Place kA = Near(-100.0, 300.0, 130.21), kB = Near(150.0, 250.0, 95.37),
                kC = Near(-250.0, -80.0, 101.9), kD = Near(200.0, -150.0, 120.05),
                kE = Near(30.0, 40.0, 150.0);
// Stations that sighted the station. S1's line crosses the chord AB beyond the station: it meets the
// circle through A and B again on the arc that sees AB the other way round. S2's line meets that arc
// twice. A, set up as a station, sighted the station back: its line meets the circle at A itself.
constexpr Oriented kS1{Near(-10.0, -300.0, 98.76), 312.3456, 1.55},
    kS2{Near(300.0, 50.0, 125.43), 7.891, 1.48}, kFromA{kA, 150.0, 1.6};

StationSighting OnPoint(const Place& p, double hp = 1.3) {
    return SightPoint(kSt, kHi, kV0, p, hp);
}
// From `o` on the station, aimed at (x, y): the station itself unless told.
StationSighting FromStation(const Oriented& o, double hp = 1.8, double x = kSt.x, double y = kSt.y) {
    const Reading r = Read(o.p, o.hi, o.v0, kSt, hp);
    StationSighting s;
    s.onStation = true;
    s.x = o.p.x, s.y = o.p.y, s.z = o.p.z, s.v0s = o.v0, s.his = o.hi;
    s.hp = hp, s.ah = Read(o.p, o.hi, o.v0, {x, y, kSt.z}, hp).ah, s.av = r.av, s.dh = r.dh;
    return s;
}
StationResult Job(std::initializer_list<StationSighting> sightings) {
    StationResult r;
    r.hi = kHi;
    r.sightings = sightings;
    return r;
}

struct Circle {
    double x, y, r;
};
Circle CircleStAB() {
    const double bx = kA.x - kSt.x, by = kA.y - kSt.y, cx = kB.x - kSt.x, cy = kB.y - kSt.y;
    const double d = 2.0 * (bx * cy - by * cx);
    const double ux = (cy * (bx * bx + by * by) - by * (cx * cx + cy * cy)) / d;
    const double uy = (bx * (cx * cx + cy * cy) - cx * (bx * bx + by * by)) / d;
    return {kSt.x + ux, kSt.y + uy, std::hypot(ux, uy)};
}
// The angle, gr, between the line from `from` to (x, y) and the circle at (x, y).
double Crossing(const Place& from, double x, double y, const Circle& c = CircleStAB()) {
    const double lx = x - from.x, ly = y - from.y, l = std::hypot(lx, ly);
    return std::asin(std::fabs((lx * (x - c.x) + ly * (y - c.y)) / (l * c.r))) * kGonPerRadian;
}

TEST(Recoupement, LineMeetsCircle) {
    // Hand values about the circle of centre (10, 20) and radius 5 and the 3-4-5 circle about the
    // origin, moved to Lambert-sized coordinates; the points in the order met from the line's first point.
    constexpr double kX = 600000.0, kY = 6800000.0;
    struct Case {
        double x1, y1, x2, y2, xc, yc, r;
        int count;
        double px[2], py[2];
    } const cases[] = {
        {0, 20, 1, 20, 10, 20, 5, 2, {5, 15}, {20, 20}},      // through the centre
        {13, 30, 13, 29, 10, 20, 5, 2, {13, 13}, {24, 16}},   // 3 from the centre: half chord 4
        {-9, -2, -5, 0, 0, 0, 5, 2, {-5, 3}, {0, 4}},         // slanted, through (-5, 0) and (3, 4)
        {0, 25, 1, 25, 10, 20, 5, 1, {10, 0}, {25, 0}},       // tangent
        {0, 25.001, 1, 25.001, 10, 20, 5, 0, {0, 0}, {0, 0}}, // 1 mm outside
        {3, 3, 3, 3, 0, 0, 5, 0, {0, 0}, {0, 0}},             // no line
        {0, 0, 1, 0, 0, 0, 0, 0, {0, 0}, {0, 0}},             // no circle
    };
    for (const Case& c : cases) {
        const LineCircle cut =
            IntersectLineCircle(kX + c.x1, kY + c.y1, kX + c.x2, kY + c.y2, kX + c.xc, kY + c.yc, c.r);
        ASSERT_EQ(cut.count, c.count) << c.x1 << " " << c.y1;
        for (int k = 0; k < c.count; ++k) {
            EXPECT_NEAR(cut.x[k], kX + c.px[k], 1e-8) << c.x1 << " " << c.y1 << " #" << k;
            EXPECT_NEAR(cut.y[k], kY + c.py[k], 1e-8) << c.x1 << " " << c.y1 << " #" << k;
        }
    }
}

TEST(Recoupement, ExactSightingsGiveTheStation) {
    // Every line meets every circle at the station; the place that represents them is the one crossed
    // under the widest angle, here S1's line on the circle through A and B (99.2 gr; the others, from the
    // same formula, between 11.9 and 93.8 gr), or A's own line in the case without S1.
    struct Case {
        const char* what;
        StationResult job;
        Oriented line;
    } cases[] = {
        {"S1 A B", Job({FromStation(kS1), OnPoint(kA), OnPoint(kB)}), kS1},
        {"A S1 B C", Job({OnPoint(kA), FromStation(kS1), OnPoint(kB), OnPoint(kC)}), kS1},
        {"from A, A B", Job({FromStation(kFromA), OnPoint(kA), OnPoint(kB)}), kFromA},
        {"S2 A B S1", Job({FromStation(kS2), OnPoint(kA), OnPoint(kB), FromStation(kS1)}), kS1},
        {"A B C D S2 S1",
         Job({OnPoint(kA), OnPoint(kB), OnPoint(kC), OnPoint(kD), FromStation(kS2, 0.0), FromStation(kS1)}),
         kS1},
    };
    for (Case& c : cases) {
        StationResult& r = c.job;
        EXPECT_EQ(ComputeRecoupement(r, true, true), kStationComputed) << c.what << " " << r.status;
        EXPECT_NEAR(r.x, kSt.x, kTenthMm) << c.what;
        EXPECT_NEAR(r.y, kSt.y, kTenthMm) << c.what;
        EXPECT_NEAR(r.v0, kV0, kHundredthMgon) << c.what;
        EXPECT_NEAR(r.z, kSt.z, kTenthMm) << c.what;
        EXPECT_EQ(r.altitudes, static_cast<int>(r.sightings.size())) << c.what;
        EXPECT_NEAR(r.crossing, Crossing(c.line.p, kSt.x, kSt.y), kHundredthMgon) << c.what;
        int lines = 0, known = 0;
        for (const StationSighting& s : r.sightings)
            if (s.used) ++(s.onStation ? lines : known);
        EXPECT_TRUE(lines == 1 && known == 2) << c.what;
        ExpectAllFinite(r);
    }
}

TEST(Recoupement, AltitudeWeighsTheZenithAngles) {
    // A's zenith angle read 2 mgon too large puts A's altitude 1 cm off. One step on the zenith angles is
    // the mean of the altitudes weighted by sin⁴ z / DH², the inverse variance of DH / tan z for an error
    // of z: the steep short sighting on E (60 gr, 50 m) weighs 17 times as much as A's. The error follows
    // from the residuals at that mean, each angle changing by a = (200/pi) sin² z / DH for a metre.
    StationResult r = Job({FromStation(kS1), OnPoint(kA), OnPoint(kB), FromStation(kS2), OnPoint(kE, 0.0)});
    r.sightings[1].av += 0.002;
    ComputeRecoupement(r, true, true);
    ASSERT_EQ(r.altitudes, 5);
    double sw = 0.0, swz = 0.0, zi[5], a[5];
    for (int i = 0; i < 5; ++i) {
        const StationSighting& s = r.sightings[i];
        const double z = s.av / kGonPerRadian, sin2 = std::sin(z) * std::sin(z);
        const double rise = s.dh / std::tan(z) + kCurvature * s.dh * s.dh;
        zi[i] = s.onStation ? s.z + s.his - s.hp + rise : s.z + s.hp - kHi - rise;
        a[i] = kGonPerRadian * sin2 / s.dh;
        sw += a[i] * a[i];
        swz += a[i] * a[i] * zi[i];
    }
    EXPECT_NEAR(r.sightings[1].zi, zi[1], kHundredthMm);
    EXPECT_GT(zi[1] - kSt.z, 0.009);
    const double z = swz / sw;
    EXPECT_NEAR(r.z, z, kHundredthMm);
    double svv = 0.0;
    for (int i = 0; i < 5; ++i)
        svv += a[i] * a[i] * (z - zi[i]) * (z - zi[i]);
    EXPECT_NEAR(r.emqZ, std::sqrt(1.0 / sw) * std::sqrt(svv / 4.0), kHundredthMm);
}

TEST(Recoupement, ChoiceOfThePlace) {
    // S2 aims at Q on the circle through the station, A and B, a chord of 0.5 m or 0.7 m away (turned
    // about the centre by 2 asin(chord / 2R)): S2's and S1's lines meet that arc once each, at places
    // that agree or not; two that disagree leave none. Of two that agree, S1's crosses wider and stands.
    const Circle c = CircleStAB();
    for (const double chord : {0.5, 0.7}) {
        const double turn = std::atan2(kSt.x - c.x, kSt.y - c.y) + 2.0 * std::asin(0.5 * chord / c.r);
        const double qx = c.x + c.r * std::sin(turn), qy = c.y + c.r * std::cos(turn);
        StationResult r = Job({FromStation(kS2, 1.8, qx, qy), OnPoint(kA), OnPoint(kB), FromStation(kS1)});
        ComputeRecoupement(r, true, true);
        if (chord < kRecoupAgreement) {
            EXPECT_EQ(r.flags, kStationComputed) << r.status;
            ASSERT_GT(Crossing(kS1.p, kSt.x, kSt.y), Crossing(kS2.p, qx, qy));
            EXPECT_NEAR(r.x0, kSt.x, kTenthMm);
            EXPECT_NEAR(r.y0, kSt.y, kTenthMm);
        } else {
            EXPECT_EQ(r.flags, kStationFailed);
            EXPECT_EQ(r.status, session::kMsgNotComputed);
            EXPECT_EQ(r.x, kUndefined);
            EXPECT_NEAR(r.z, kSt.z, kTenthMm); // from the measured distances
        }
        ExpectAllFinite(r);
    }
    // A line through the station at phi from the circle's tangent meets it again 2R sin(phi) away, here
    // 0.4 m: the two places agree, both crossing under phi, about 0.15 gr, a weak crossing.
    const double phi = std::asin(0.2 / c.r), g = std::atan2(kSt.x - c.x, kSt.y - c.y) + kPiHere / 2.0 + phi;
    StationResult r = Job({FromStation({Near(-200.0 * std::sin(g), -200.0 * std::cos(g), 105.0), 50.0, 1.5}),
                           OnPoint(kA), OnPoint(kB)});
    EXPECT_EQ(ComputeRecoupement(r, true, true), kStationComputed | kStationWeakCrossing) << r.status;
    EXPECT_NEAR(r.crossing, phi * kGonPerRadian, kHundredthMgon);
    EXPECT_LT(std::hypot(r.x - kSt.x, r.y - kSt.y), 0.4 + kTenthMm);
}

TEST(Recoupement, TooFewOrDegenerateSightings) {
    StationSighting noDirection = OnPoint(kB), vertical = OnPoint(kA), noDistance = FromStation(kS2);
    noDirection.ah = kUndefined;
    vertical.av = 0.0; // a second sighting on A: no circle, and no altitude
    noDistance.dh = 0.0;
    struct Case {
        StationResult job;
        int flags;
    } cases[] = {
        {Job({}), kStationTooFew},
        {Job({OnPoint(kA), OnPoint(kB), OnPoint(kC)}), kStationTooFew},
        {Job({FromStation(kS1), FromStation(kS2), OnPoint(kA)}), kStationTooFew},
        {Job({FromStation(kS1), OnPoint(kA), noDirection}), kStationTooFew},
        {Job({FromStation(kS1), OnPoint(kA), vertical, noDistance}), kStationFailed},
    };
    for (Case& c : cases) {
        StationResult& r = c.job;
        EXPECT_EQ(ComputeRecoupement(r, true, true), c.flags) << r.sightings.size();
        EXPECT_EQ(r.status, c.flags == kStationTooFew ? recoup::kMsgTooFew : session::kMsgNotComputed);
        EXPECT_TRUE(r.x0 == kUndefined && r.x == kUndefined);
        // The altimetry goes on from the measured distances.
        EXPECT_TRUE(r.altitudes == 0 || std::fabs(r.z - kSt.z) < kTenthMm) << r.z;
        ExpectAllFinite(r);
    }
}

} // namespace
} // namespace pyr::test
