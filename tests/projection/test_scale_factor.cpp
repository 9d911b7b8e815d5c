// The linear alteration of the projections and the reduction of distances to the level surface, against
// published values and hand computations.
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

#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kTenthPpm = 0.1;      // 0.1 mm a kilometre
constexpr double kHundredthPpm = 0.01; // the tolerance on hand-computed scales
constexpr double kTenthMm = 1e-4;
constexpr double kDegree = 3.14159265358979323846 / 180.0;

TEST(LinearAlteration, MatchesThePublishedScaleOfEachProjection) {
    struct Case {
        const char* projection;
        double x, y;
        double ppm;       // (k - 1) x 10^6
        const char* what; // where the place and its scale come from
    };
    const Case cases[] = {
        // Lambert-93: true scale on its standard parallels 44° and 49° (published definition), places
        // computed by hand from the published constants.
        {"Lambert 93", 700000.0, 6322333.1395, 0.0, "44°N on the central meridian 3°E"},
        {"Lambert 93", 700000.0, 6877786.7007, 0.0, "49°N on the central meridian"},
        {"Lambert 93", 1020687.5770, 6330457.4087, 0.0, "44°N, 7°E: the scale follows the parallel"},
        {"Lambert 93", 553672.0602, 6879639.9326, 0.0, "49°N, 1°E"},
        // Its origin (3°E, 46°30'N) = (700 000, 6 600 000); scale there by hand from the constants
        // k0 = 0.999051086 (the IGN rounds it to 0.99905103, within 0.06 ppm).
        {"Lambert 93", 700000.0, 6600000.0, -948.914, "the origin"},
        // Conic conformal zones: true scale on the standard parallels, by hand from the definition.
        {"CC42", 1700000.0, 1116705.2261, 0.0, "41°15'N"},
        {"CC42", 1700000.0, 1283305.6813, 0.0, "42°45'N"},
        {"CC46", 1700000.0, 5116646.7443, 0.0, "45°15'N"},
        {"CC46", 1700000.0, 5283364.2274, 0.0, "46°45'N"},
        {"CC50", 1700000.0, 9116588.3723, 0.0, "49°15'N"},
        {"CC50", 1700000.0, 9283422.4491, 0.0, "50°45'N"},
        // ... and at their origin (1 700 000, (zz - 41) x 1 000 000 + 200 000), k0 by hand.
        {"CC42", 1700000.0, 1200000.0, -85.3557, "the origin of CC42, 42°N"},
        {"CC46", 1700000.0, 5200000.0, -85.3960, "the origin of CC46, 46°N"},
        {"CC50", 1700000.0, 9200000.0, -85.4362, "the origin of CC50, 50°N"},
        // UTM: scale 0.9996 on the central meridian (false easting 500 000), whatever the latitude
        // (definition of the Universal Transverse Mercator grid).
        {"UTM 31N", 500000.0, 5000000.0, -400.0, "UTM 31N central meridian"},
        {"UTM 40S", 500000.0, 7650000.0, -400.0, "UTM 40S central meridian"},
        // NTF Lambert zones: scale on the origin parallel as the IGN defines each zone (Paris meridian).
        {"Lambert I", 600000.0, 1200000.0, -122.66, "Lambert I, k0 = 0.99987734"},
        {"Lambert II étendu", 600000.0, 2200000.0, -122.58, "Lambert II étendu, k0 = 0.99987742"},
        {"Lambert II Centre", 600000.0, 200000.0, -122.58, "Lambert II Centre, k0 = 0.99987742"},
        {"Lambert III", 600000.0, 3200000.0, -122.50, "Lambert III, k0 = 0.99987750"},
        {"Lambert IV", 234.358, 4185861.369, -55.29, "Lambert IV, k0 = 0.99994471"},
    };
    for (const Case& c : cases) {
        const CProjection projection(c.projection);
        ASSERT_TRUE(projection.IsValid()) << projection.Error();
        EXPECT_NEAR(projection.CalcLinearAlter(c.x, c.y), c.ppm, kHundredthPpm) << c.what;
    }
    // The value the IGN publishes for the origin of Lambert-93, k0 = 0.99905103.
    EXPECT_NEAR(CProjection("Lambert 93").CalcLinearAlter(700000.0, 6600000.0), -948.97, kTenthPpm);
}

TEST(LinearAlteration, EachPlaceGetsItsOwnScaleWhateverWasAskedBefore) {
    // The same places as above, asked in turn and again: the remembered place never answers for
    // another one.
    const CProjection lambert93("Lambert 93");
    const double origin = -948.914;
    for (int round = 0; round < 2; ++round) {
        EXPECT_NEAR(lambert93.CalcLinearAlter(700000.0, 6600000.0), origin, kHundredthPpm);
        EXPECT_NEAR(lambert93.CalcLinearAlter(700000.0, 6600000.0), origin, kHundredthPpm);
        EXPECT_NEAR(lambert93.CalcLinearAlter(700000.0, 6322333.1395), 0.0, kHundredthPpm);
        EXPECT_NEAR(lambert93.CalcEllipsReduc(700000.0, 6600000.0, 1000.0, 1), -156.7344, 1e-3);
    }
}

TEST(LinearAlteration, NoneWithoutAProjectionOrAPlace) {
    const CProjection none("Aucune");
    EXPECT_TRUE(none.IsValid());
    EXPECT_TRUE(none.IsNone());
    EXPECT_EQ(none.CalcLinearAlter(700000.0, 6600000.0), 0.0);

    const CProjection lambert93("Lambert 93");
    EXPECT_EQ(lambert93.CalcLinearAlter(kUndefined, 6600000.0), 0.0);
    EXPECT_EQ(lambert93.CalcLinearAlter(700000.0, kUndefined), 0.0);
    EXPECT_EQ(lambert93.CalcLinearAlter(NAN, 6600000.0), 0.0);
    EXPECT_EQ(lambert93.CalcLinearAlter(INFINITY, INFINITY), 0.0);
    // A place that PROJ cannot bring back to a latitude (UTM, thousands of kilometres off the grid).
    EXPECT_EQ(CProjection("UTM 31N").CalcLinearAlter(1e8, 5e6), 0.0);
}

TEST(LevelSurface, TheGaussianRadiusOfGRS80MatchesItsPublishedRadii) {
    // GRS80 (a = 6 378 137 m, 1/f = 298.257222101), published by Moritz, "Geodetic Reference System
    // 1980": semi-minor axis b = 6 356 752.3141 m, which is sqrt(rho N) at the equator; polar radius of
    // curvature c = 6 399 593.6259 m, sqrt(rho N) at the pole.
    const double a = 6378137.0, f = 1.0 / 298.257222101;
    EXPECT_NEAR(GaussianMeanRadius(a, f, 0.0), 6356752.3141, kTenthMm);
    EXPECT_NEAR(GaussianMeanRadius(a, f, 90.0 * kDegree), 6399593.6259, kTenthMm);
    EXPECT_NEAR(GaussianMeanRadius(a, f, -90.0 * kDegree), 6399593.6259, kTenthMm);
    // 46°30'N, by hand: a sqrt(1 - e2) / (1 - e2 sin2 phi).
    EXPECT_NEAR(GaussianMeanRadius(a, f, 46.5 * kDegree), 6379222.2851, kTenthMm);
    EXPECT_EQ(GaussianMeanRadius(6366000.0, 0.0, 0.7), 6366000.0); // a sphere
}

TEST(LevelSurface, ADistanceShrinksAboveTheSurfaceAndTheInverseBringsItBack) {
    struct Case {
        double height, radius;
        int direction;
        double ppm;
    };
    const Case cases[] = {
        {1000.0, 6366000.0, 1, -1000.0 / 6367000.0 * 1e6}, // 1 km up shrinks by R / (R + h): 157.06 mm/km
        {1000.0, 6366000.0, -1, 1000.0 / 6366000.0 * 1e6}, // (R + h) / R
        {-100.0, 6366000.0, 1, 100.0 / 6365900.0 * 1e6},   // below the surface the distance grows
        {0.0, 6366000.0, 1, 0.0},
        {-6366000.0, 6366000.0, 1, 0.0}, // the centre of the earth: no reduction rather than infinity
        {1000.0, 0.0, 1, 0.0},
    };
    for (const Case& c : cases)
        EXPECT_NEAR(LevelSurfaceReductionPpm(c.height, c.radius, c.direction), c.ppm, 1e-9)
            << c.height << " m, R " << c.radius << " m, direction " << c.direction;
    // The reduction and the opposite correction undo each other.
    const double down = LevelSurfaceReductionPpm(2500.0, 6379222.0, 1);
    const double up = LevelSurfaceReductionPpm(2500.0, 6379222.0, -1);
    EXPECT_NEAR((1.0 + down * 1e-6) * (1.0 + up * 1e-6), 1.0, 1e-15);
}

TEST(LevelSurface, TheRadiusIsTheEllipsoidsAtThePlaceOrElseTheOptionsOne) {
    struct Case {
        const char* projection;
        double x, y;
        double radius; // metres
        const char* what;
    };
    const Case cases[] = {
        {"Lambert 93", 700000.0, 6600000.0, 6379222.2851, "GRS80 at 46°30'N, by hand"},
        {"Lambert 93", 700000.0, 6322333.1395, 6377353.5561, "GRS80 at 44°N, by hand"},
        {"Lambert II étendu", 600000.0, 2200000.0, 6379579.3553,
         "Clarke 1880 IGN (a = 6 378 249.2, b = 6 356 515) at 46.8°N, by hand"},
        {"Lambert 93", kUndefined, 6600000.0, 6370000.0, "no place: the options' radius"},
        {"Aucune", 700000.0, 6600000.0, 6370000.0, "local coordinates: the options' radius"},
        {"Mercator", 700000.0, 6600000.0, 6370000.0, "an unknown projection: the options' radius"},
    };
    for (const Case& c : cases) {
        const CProjection projection(c.projection, 6370.0);
        EXPECT_NEAR(projection.CalcEllipsReduc(c.x, c.y, 1000.0, 1), -1000.0 / (c.radius + 1000.0) * 1e6,
                    1e-4)
            << c.what;
        EXPECT_NEAR(projection.CalcEllipsReduc(c.x, c.y, 1000.0, -1), 1000.0 / c.radius * 1e6, 1e-4)
            << c.what;
    }
    EXPECT_EQ(CProjection("Lambert 93").CalcEllipsReduc(700000.0, 6600000.0, kUndefined, 1), 0.0);
}

} // namespace
} // namespace pyr
