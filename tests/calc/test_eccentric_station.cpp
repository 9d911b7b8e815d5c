// The computation of an eccentric station, against stations and sightings built from exact coordinates
// (ExactReadings.h): the instrument stands at E, its horizontal circle reads 0 along the bearing V0, and
// C, the centre that cannot be occupied, lies a few metres away.
#include "ExactReadings.h"
#include "calc/EccentricStation.h"
#include "calc/EccentricTexts.h"
#include "calc/SessionTexts.h"

#include <array>
#include <string>
#include <utility>

namespace pyr::test {
namespace {

const Place kE{2345.678, 6789.012, 123.456};
constexpr double kHi = 1.55;
// Just under the zero, so that the references' V0 fall either side of it, on noisy directions.
constexpr double kV0 = 399.9995;
// Reference points 35 m, 480 m and 2 100 m from E (3-4-5 triangles), above and below the instrument.
const Place kRefs[] = {{kE.x + 21.0, kE.y - 28.0, 119.300},
                       {kE.x - 288.0, kE.y - 384.0, 140.200},
                       {kE.x + 1260.0, kE.y + 1680.0, 98.700}};
constexpr double kRefHp[] = {1.30, 1.80, 0.0};
constexpr double kRefDistances[] = {35.0, 480.0, 2100.0};

// What a perfect instrument over E reads; the line of sight bent by curvature and refraction on C,
// straight on the references, whose altitudes the computation takes without curvature term.
Reading Read(const Place& p, double hp, bool bent) {
    return test::Read(kE, kHi, kV0, p, hp, bent);
}

// The station with the centre C at `offset` from E and its three references; C has an altitude when
// `centreZ`. `noise` is added to the references' directions, gr.
EccentricResult Job(double offsetX, double offsetY, bool centreZ, std::array<double, 3> noise = {}) {
    EccentricResult result;
    result.station = "E";
    result.hi = kHi;
    const Place c{kE.x + offsetX, kE.y + offsetY, 131.789};
    const Reading onC = Read(c, 0.20, true);
    result.centre = "C";
    result.xC = c.x, result.yC = c.y, result.zC = centreZ ? c.z : kUndefined;
    result.hpC = 0.20, result.ahC = onC.ah, result.avC = onC.av, result.diC = onC.di, result.dhC = onC.dh;
    for (int i = 0; i < 3; ++i) {
        const Reading r = Read(kRefs[i], kRefHp[i], false);
        EccentricSighting s;
        s.reference = "R" + std::to_string(i + 1);
        s.x = kRefs[i].x, s.y = kRefs[i].y, s.z = kRefs[i].z, s.hp = kRefHp[i];
        s.ah = r.ah + noise[i], s.av = r.av, s.di = r.di;
        result.sightings.push_back(s);
    }
    return result;
}

void ExpectAllFinite(const EccentricResult& r) {
    ExpectFinite({r.x, r.y, r.v0, r.z, r.z0, r.emqZ});
    for (const EccentricSighting& s : r.sightings)
        ExpectFinite({s.d, s.g, s.v0, s.ev0, s.zi, s.eav});
}

TEST(EccentricStation, ExactSightingsGiveThePlaceOrientationAndAltitudeBack) {
    // C 2 m and 20 m from E; with C's altitude, Z comes from the sighting on C (curvature included).
    for (auto [dx, dy] : {std::pair{1.6, 1.2}, {-16.0, -12.0}})
        for (bool centreZ : {true, false}) {
            EccentricResult r = Job(dx, dy, centreZ);
            SCOPED_TRACE(testing::Message() << dx << " " << dy << " " << centreZ);
            EXPECT_EQ(ComputeEccentricStation(r, true, true), kExcentComputed);
            EXPECT_EQ(r.status, "");
            EXPECT_NEAR(r.x, kE.x, kTenthMm);
            EXPECT_NEAR(r.y, kE.y, kTenthMm);
            EXPECT_NEAR(Gap(r.v0 - kV0), 0.0, kHundredthMgon);
            EXPECT_TRUE(r.v0 >= 0.0 && r.iterations > 1 && r.iterations < 100) << r.v0 << " " << r.iterations;
            for (int i = 0; i < 3; ++i) {
                EXPECT_NEAR(r.sightings[i].d, kRefDistances[i], kTenthMm);
                EXPECT_NEAR(r.sightings[i].ev0, 0.0, kHundredthMgon);
            }
            // From C, to 0.01 mm: finer than the curvature term over 20 m, 0.026 mm.
            EXPECT_NEAR(r.z, kE.z, centreZ ? 1e-5 : kTenthMm);
            // Without C's altitude the three references give it, each exactly, with no spread.
            EXPECT_EQ(r.altitudes, centreZ ? 0 : 3);
            EXPECT_NEAR(r.emqZ, centreZ ? kUndefined : 0.0, 1e-6);
            ExpectAllFinite(r);
        }
}

TEST(EccentricStation, NoisyDirectionsAreAveragedByDistanceSoTheNearestWeighsLeast) {
    // On the references 35, 480 and 2 100 m away, gr; the second's V0 passes the zero, at 0.0005 gr.
    const std::array<double, 3> noise = {0.010, -0.001, 0.0005};
    EccentricResult r = Job(-16.0, -12.0, true, noise);
    ASSERT_EQ(ComputeEccentricStation(r, true, true), kExcentComputed);

    // At the place found: each reference's V0 from plain atan2, their mean weighted by the distances.
    double v0[3], weights = 0.0, weighted = 0.0;
    for (int i = 0; i < 3; ++i) {
        const EccentricSighting& s = r.sightings[i];
        const double d = std::hypot(s.x - r.x, s.y - r.y);
        v0[i] = Gap(std::atan2(s.x - r.x, s.y - r.y) * kGonPerRadian - s.ah - kV0);
        weights += d;
        weighted += d * v0[i];
    }
    EXPECT_NEAR(Gap(r.v0 - kV0), weighted / weights, kHundredthMgon);
    for (int i = 0; i < 3; ++i)
        EXPECT_NEAR(r.sightings[i].ev0, weighted / weights - v0[i], kHundredthMgon) << i;
    // And that place lies dhC from C, on the reverse of the bearing V0 + AH(C).
    const double g = (r.v0 + r.ahC) / kGonPerRadian;
    EXPECT_NEAR(r.x, r.xC - r.dhC * std::sin(g), kTenthMm);
    EXPECT_NEAR(r.y, r.yC - r.dhC * std::cos(g), kTenthMm);

    // Close to the mean of the noise weighted by the distances from the true E, -0.35 mgon (E moves by
    // 0.1 mm), far from the -3.2 mgon of a plain mean, which the 10 mgon on the nearest reference would pull.
    const double expected = -(noise[0] * 35.0 + noise[1] * 480.0 + noise[2] * 2100.0) / 2615.0;
    EXPECT_NEAR(Gap(r.v0 - kV0), expected, 2e-5);
}

TEST(EccentricStation, AltitudeFromReferencesWeightedBySensitivityOfZenithAngles) {
    // Only the first reference has an altitude: Z from it alone, no error figure.
    EccentricResult one = Job(1.6, 1.2, false);
    one.sightings[1].z = one.sightings[2].z = kUndefined;
    ASSERT_EQ(ComputeEccentricStation(one, true, true), kExcentComputed);
    EXPECT_EQ(one.altitudes, 1);
    EXPECT_NEAR(one.z, kE.z, kTenthMm);
    EXPECT_EQ(one.z0, one.z);
    EXPECT_EQ(one.emqZ, kUndefined);

    // Zenith angles off by 2, -1 and 3 mgon. Independently, with plain tan/atan in radians: each
    // Zi = Zpoint + HP - HI - D / tan z, Z their mean weighted by (sin²z / D)², each residual the angle
    // atan2(D, Zpoint + HP - Z - HI) less the reading, and the figure √(1/Σa²) √(Σ r² / 2), r in grads.
    EccentricResult r = Job(1.6, 1.2, false);
    const double errors[] = {0.002, -0.001, 0.003};
    for (int i = 0; i < 3; ++i)
        r.sightings[i].av += errors[i];
    ASSERT_EQ(ComputeEccentricStation(r, true, true), kExcentComputed);
    double zi[3], a[3], saa = 0.0, saz = 0.0;
    for (int i = 0; i < 3; ++i) {
        const double z = r.sightings[i].av / kGonPerRadian, d = kRefDistances[i];
        zi[i] = kRefs[i].z + kRefHp[i] - kHi - d / std::tan(z);
        a[i] = std::sin(z) * std::sin(z) / d;
        saa += a[i] * a[i];
        saz += a[i] * a[i] * zi[i];
    }
    const double z = saz / saa;
    double srr = 0.0;
    for (int i = 0; i < 3; ++i) {
        const double residual =
            std::atan2(kRefDistances[i], kRefs[i].z + kRefHp[i] - z - kHi) * kGonPerRadian -
            r.sightings[i].av;
        EXPECT_NEAR(r.sightings[i].zi, zi[i], kTenthMm) << i;
        EXPECT_NEAR(r.sightings[i].eav, residual, kHundredthMgon) << i;
        srr += residual * residual;
    }
    EXPECT_EQ(r.altitudes, 3);
    EXPECT_NEAR(r.z0, (zi[0] + zi[1] + zi[2]) / 3.0, kTenthMm);
    EXPECT_NEAR(r.z, z, kTenthMm);
    EXPECT_NEAR(r.emqZ, std::sqrt(1.0 / saa) * std::sqrt(srr / 2.0), 1e-6);
}

TEST(EccentricStation, ReferenceJustBeyondTheStationNeverSettles) {
    // E lies on the circle of radius dhC = 20 m around C. With the only reference about 1 m from E on the
    // side away from C (20.7 m from C), moving E along that circle turns the bearing to the reference some
    // fourteen times as much the other way: there is one place where E and its orientation agree, and each
    // pass throws E farther from it, to its other side.
    EccentricResult r = Job(-16.0, -12.0, true);
    const Place near{kE.x + 1.0, kE.y - 0.15, 0.0};
    r.sightings.resize(1);
    r.sightings[0].x = near.x, r.sightings[0].y = near.y;
    r.sightings[0].ah = Read(near, 0.0, false).ah;
    EXPECT_EQ(ComputeEccentricStation(r, true, true), kExcentNoConvergence);
    EXPECT_EQ(r.status, session::kMsgNotComputed);
    EXPECT_EQ(r.iterations, kExcentMaxIterations);
    EXPECT_EQ(r.x, kUndefined);
    EXPECT_EQ(r.v0, kUndefined);
    // The altitude from C needs only the distance to it.
    EXPECT_NEAR(r.z, kE.z, kTenthMm);
    ExpectAllFinite(r);
}

TEST(EccentricStation, MissingDataAndDegenerateGeometryFailOrLeaveUndefinedWithoutNaN) {
    // C has its altitude throughout: Z comes from the sighting on C whenever dhC and AV(C) allow it,
    // placed or not.
    struct Case {
        const char* what;
        void (*spoil)(EccentricResult&);
        int flags;
        bool altitude;
    };
    const Case cases[] = {
        {"no reference", [](EccentricResult& r) { r.sightings.clear(); }, kExcentIncomplete, true},
        {"no distance to C", [](EccentricResult& r) { r.dhC = 0.0; }, kExcentIncomplete, false},
        {"C without X", [](EccentricResult& r) { r.xC = kUndefined; }, kExcentIncomplete, true},
        // The only reference lies on C, where the first pass sets E up: no bearing, so no orientation.
        {"only reference on C",
         [](EccentricResult& r) {
             r.sightings.resize(1);
             r.sightings[0].x = r.xC, r.sightings[0].y = r.yC;
         },
         kExcentNoConvergence, true},
        // A reference point at C's place (another name for it) has no bearing in the first pass, from C,
        // and no weight; then it orients like the others.
        {"reference on C",
         [](EccentricResult& r) {
             r.sightings[0].x = r.xC, r.sightings[0].y = r.yC, r.sightings[0].ah = r.ahC;
         },
         kExcentComputed, true},
        // A vertical sighting on C gives no height difference from a horizontal distance.
        {"C at the zenith", [](EccentricResult& r) { r.avC = 0.0; }, kExcentComputed, false},
    };
    for (const Case& c : cases) {
        EccentricResult r = Job(1.6, 1.2, true);
        c.spoil(r);
        EXPECT_EQ(ComputeEccentricStation(r, true, true), c.flags) << c.what;
        EXPECT_EQ(r.status, c.flags == kExcentComputed ? "" : session::kMsgNotComputed) << c.what;
        EXPECT_NEAR(r.x, c.flags == kExcentComputed ? kE.x : kUndefined, kTenthMm) << c.what;
        EXPECT_NEAR(r.z, c.altitude ? kE.z : kUndefined, kTenthMm) << c.what;
        ExpectAllFinite(r);
    }
}

} // namespace
} // namespace pyr::test
