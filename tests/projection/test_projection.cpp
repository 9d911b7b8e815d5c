// The linear alteration of the projections, the reduction of distances to the level surface and the
// conversion of coordinates, against published values and hand computations.
//
// Hand computations of Lambert-93 places use the constants the IGN publishes for it (GRS80 ellipsoid,
// e = 0.0818191910428158): n = 0.7256077650532670, C = 11 754 255.4261 m, Xs = 700 000 m,
// Ys = 12 655 612.0499 m. At latitude phi and longitude lambda, with L the isometric latitude
// L = ln(tan(pi/4 + phi/2) ((1 - e sin phi) / (1 + e sin phi))^(e/2)):
//   R = C exp(-n L), X = Xs + R sin(n (lambda - 3°)), Y = Ys - R cos(n (lambda - 3°)),
//   k = n R / (N cos phi), N = a / sqrt(1 - e2 sin2 phi).
// The conic conformal zones CCzz are built the same way from their definition (origin latitude zz°,
// standard parallels zz° -/+ 0.75°, X0 = 1 700 000, Y0 = (zz - 41) x 1 000 000 + 200 000).
#include "core/Undefined.h"
#include "projection/LevelSurface.h"
#include "projection/Projection.h"

#include <gtest/gtest.h>
#include <tuple>

namespace pyr {
namespace {

constexpr double kTenthMm = 1e-4;
constexpr double kHundredthPpm = 0.01; // the tolerance on hand-computed scales
constexpr double kDegree = 3.14159265358979323846 / 180.0;

TEST(LinearAlteration, MatchesThePublishedScaleOfEachProjection) {
    // Scale as (k - 1) x 10^6, and where the place and its scale come from.
    for (const auto& [name, x, y, ppm, what] : {
             // Lambert-93: true scale on its standard parallels 44° and 49° (published definition), places
             // computed by hand from the published constants; at the origin k0 = 0.999051086 by hand.
             std::tuple{"Lambert 93", 700000.0, 6322333.1395, 0.0, "44°N on the central meridian 3°E"},
             {"Lambert 93", 1020687.5770, 6330457.4087, 0.0, "44°N, 7°E: the scale follows the parallel"},
             {"Lambert 93", 700000.0, 6600000.0, -948.914, "the origin (3°E, 46°30'N)"},
             // Conic conformal zones: true scale on the standard parallels, k0 at the origin, by hand.
             {"CC42", 1700000.0, 1116705.2261, 0.0, "41°15'N"},
             {"CC46", 1700000.0, 5200000.0, -85.3960, "the origin of CC46, 46°N"},
             // UTM: scale 0.9996 on the central meridian (false easting 500 000), whatever the latitude
             // (definition of the Universal Transverse Mercator grid).
             {"UTM 31N", 500000.0, 5000000.0, -400.0, "UTM 31N central meridian"},
             {"UTM 40S", 500000.0, 7650000.0, -400.0, "UTM 40S central meridian"},
             // NTF Lambert zones: scale on the origin parallel as the IGN defines each zone (Paris meridian).
             {"Lambert I", 600000.0, 1200000.0, -122.66, "Lambert I, k0 = 0.99987734"},
             {"Lambert IV", 234.358, 4185861.369, -55.29, "Lambert IV, k0 = 0.99994471"},
         })
        EXPECT_NEAR(CProjection(name).CalcLinearAlter(x, y), ppm, kHundredthPpm) << what;
    // The scale factor the IGN publishes for the origin of Lambert-93 (RGF93 / Lambert-93, EPSG:2154),
    // k0 = 0.99905103, within 0.1 mm a kilometre.
    EXPECT_NEAR(CProjection("Lambert 93").CalcLinearAlter(700000.0, 6600000.0), -948.97, 0.1);
}

TEST(LinearAlteration, EachPlaceGetsItsOwnScaleAndNoPlaceNone) {
    // Two places of one meridian asked in turn: the place remembered never answers for the other.
    const CProjection lambert93("Lambert 93");
    for (int round = 0; round < 2; ++round) {
        EXPECT_NEAR(lambert93.CalcLinearAlter(700000.0, 6600000.0), -948.914, kHundredthPpm);
        EXPECT_NEAR(lambert93.CalcLinearAlter(700000.0, 6322333.1395), 0.0, kHundredthPpm);
        // 1 000 m up on GRS80 at 46°30'N (radius below): -h / (R + h).
        EXPECT_NEAR(lambert93.CalcEllipsReduc(700000.0, 6600000.0, 1000.0, 1), -1e9 / 6380222.2851, 1e-4);
    }
    // Local coordinates, an unknown place, a place PROJ cannot bring back to a latitude.
    for (const auto& [name, x, y] : {std::tuple{"Aucune", 700000.0, 6600000.0},
                                     {"Lambert 93", kUndefined, 6600000.0},
                                     {"Lambert 93", 700000.0, kUndefined},
                                     {"UTM 31N", 1e8, 5e6}})
        EXPECT_EQ(CProjection(name).CalcLinearAlter(x, y), 0.0) << name << " " << x << " " << y;
}

TEST(LevelSurface, PublishedRadiiOfGRS80AndHeightsWithoutAReduction) {
    // GRS80 (a = 6 378 137 m, 1/f = 298.257222101), published by Moritz, "Geodetic Reference System
    // 1980": semi-minor axis b = 6 356 752.3141 m, which is sqrt(rho N) at the equator; polar radius of
    // curvature c = 6 399 593.6259 m, sqrt(rho N) at the pole.
    const double a = 6378137.0, f = 1.0 / 298.257222101;
    EXPECT_NEAR(GaussianMeanRadius(a, f, 0.0), 6356752.3141, kTenthMm);
    EXPECT_NEAR(GaussianMeanRadius(a, f, -90.0 * kDegree), 6399593.6259, kTenthMm);

    // At the centre of the earth, or on no sphere, no reduction rather than an infinity.
    EXPECT_EQ(LevelSurfaceReductionPpm(-6366000.0, 6366000.0, 1), 0.0);
    EXPECT_EQ(LevelSurfaceReductionPpm(1000.0, 0.0, 1), 0.0);
}

TEST(LevelSurface, TheRadiusIsTheEllipsoidsAtThePlaceOrElseTheOptionsOne) {
    // 1 000 m up, a measured distance shrinks by R / (R + h); the opposite correction is (R + h) / R.
    for (const auto& [name, x, y, radius, what] : {
             std::tuple{"Lambert 93", 700000.0, 6600000.0, 6379222.2851,
                        "GRS80 at 46°30'N, by hand: a sqrt(1 - e2) / (1 - e2 sin2 phi)"},
             {"Lambert II étendu", 600000.0, 2200000.0, 6379579.3553,
              "Clarke 1880 IGN (a = 6 378 249.2, b = 6 356 515) at 46.8°N, by hand"},
             {"Lambert 93", kUndefined, 6600000.0, 6370000.0, "no place: the options' radius"},
             {"Aucune", 700000.0, 6600000.0, 6370000.0, "local coordinates: the options' radius"},
             {"UTM 31N", 1e8, 5e6, 6370000.0, "a place off the grid: the options' radius"},
         }) {
        const CProjection projection(name, 6370.0);
        EXPECT_NEAR(projection.CalcEllipsReduc(x, y, 1000.0, 1), -1e9 / (radius + 1000.0), 1e-4) << what;
        EXPECT_NEAR(projection.CalcEllipsReduc(x, y, 1000.0, -1), 1e9 / radius, 1e-4) << what;
    }
    EXPECT_EQ(CProjection("Lambert 93").CalcEllipsReduc(700000.0, 6600000.0, kUndefined, 1), 0.0);
}

TEST(ProjectionConvert, Lambert93ToEachConicZoneAndBack) {
    // (3°E, zz°N) in Lambert-93 by hand; in CCzz it is the zone's origin (1 700 000, (zz - 41) x 10^6
    // + 200 000).
    const double lambert93Northing[] = {6099938.5009, 6211183.7067, 6322333.1395, 6433418.9854, 6544473.8555,
                                        6655530.8603, 6766623.6900, 6877786.7007, 6989055.0074};
    const CProjection lambert93("Lambert 93");
    for (int zone = 42; zone <= 50; ++zone) {
        double x = 700000.0, y = lambert93Northing[zone - 42];
        ASSERT_TRUE(lambert93.Convert(CProjection("CC" + std::to_string(zone)), x, y)) << zone;
        EXPECT_NEAR(x, 1700000.0, kTenthMm) << zone;
        EXPECT_NEAR(y, (zone - 41) * 1e6 + 200000.0, kTenthMm) << zone;
    }
    const CProjection cc46("CC46");
    double x = 843210.1234, y = 6521098.7654; // 143 km east of the central meridian
    ASSERT_TRUE(lambert93.Convert(cc46, x, y));
    ASSERT_TRUE(cc46.Convert(lambert93, x, y));
    EXPECT_NEAR(x, 843210.1234, kTenthMm);
    EXPECT_NEAR(y, 6521098.7654, kTenthMm);
}

TEST(ProjectionConvert, SystemsOnOtherEllipsoidsAndMeridians) {
    // On the central meridian of UTM 31N (3°E, that of Lambert-93) the northing 5 000 000 is the
    // meridian arc from the equator times 0.9996: latitude 45.153477183° (WGS 84, arc integrated
    // numerically by hand), northing 6 450 464.5655 in Lambert-93 (published constants).
    double x = 500000.0, y = 5000000.0;
    ASSERT_TRUE(CProjection("UTM 31N").Convert(CProjection("Lambert 93"), x, y));
    EXPECT_NEAR(x, 700000.0, kTenthMm);
    EXPECT_NEAR(y, 6450464.5655, kTenthMm);

    // NTF to RGF93 and back (through the IGN grid or, without it, the published Helmert shift).
    const CProjection lambert2e("Lambert II étendu"), lambert93("Lambert 93");
    x = 600000.0, y = 2200000.0;
    ASSERT_TRUE(lambert2e.Convert(lambert93, x, y));
    EXPECT_NEAR(x, 649399.0, 100.0); // about 49.4 km east and 4 433.5 km north of the NTF figures
    EXPECT_NEAR(y, 6633524.0, 100.0);
    ASSERT_TRUE(lambert93.Convert(lambert2e, x, y));
    EXPECT_NEAR(x, 600000.0, 1e-3);
    EXPECT_NEAR(y, 2200000.0, 1e-3);
}

TEST(ProjectionConvert, RefusedConversionsLeaveThePointAlone) {
    for (const auto& [from, to, x0, y0] : {std::tuple{"Aucune", "Lambert 93", 1000.0, 2000.0},
                                           {"Lambert 93", "Mercator", 700000.0, 6600000.0},
                                           {"Lambert 93", "CC46", kUndefined, 6600000.0},
                                           {"UTM 31N", "Lambert 93", 1e8, 5e6}}) { // far off the grid
        double x = x0, y = y0;
        EXPECT_FALSE(CProjection(from).Convert(CProjection(to), x, y)) << from << " -> " << to;
        EXPECT_EQ(x, x0);
        EXPECT_EQ(y, y0);
    }
}

} // namespace
} // namespace pyr
