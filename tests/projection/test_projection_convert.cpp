// Conversion of coordinates between systems, against places computed by hand (the constants and the
// formulas are those given at the top of test_scale_factor.cpp).
#include "core/Undefined.h"
#include "projection/Projection.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kTenthMm = 1e-4;

TEST(ProjectionConvert, TheOriginOfEachConicZoneComesFromLambert93) {
    // (3°E, zz°N) in Lambert-93 by hand; in CCzz it is the zone's origin (1 700 000, (zz - 41) x 10^6
    // + 200 000).
    const double lambert93Northing[] = {6099938.5009, 6211183.7067, 6322333.1395, 6433418.9854, 6544473.8555,
                                        6655530.8603, 6766623.6900, 6877786.7007, 6989055.0074};
    const CProjection lambert93("Lambert 93");
    for (int zone = 42; zone <= 50; ++zone) {
        const CProjection conic("CC" + std::to_string(zone));
        double x = 700000.0, y = lambert93Northing[zone - 42];
        ASSERT_TRUE(lambert93.Convert(conic, x, y)) << zone;
        EXPECT_NEAR(x, 1700000.0, kTenthMm) << zone;
        EXPECT_NEAR(y, (zone - 41) * 1e6 + 200000.0, kTenthMm) << zone;
    }
}

TEST(ProjectionConvert, Lambert93ToCC46AndBackReturnsEveryPoint) {
    const CProjection lambert93("Lambert 93");
    const CProjection cc46(" cc46 ");
    // The origin of Lambert-93 (3°E, 46°30'N) is on the central meridian of CC46, by hand 55 574.0521 m
    // north of its origin.
    double x = 700000.0, y = 6600000.0;
    ASSERT_TRUE(lambert93.Convert(cc46, x, y));
    EXPECT_NEAR(x, 1700000.0, kTenthMm);
    EXPECT_NEAR(y, 5255574.0521, kTenthMm);

    const double places[][2] = {{700000.0, 6600000.0},
                                {843210.1234, 6521098.7654},
                                {652000.5, 6701234.25},
                                {1020687.5770, 6330457.4087}};
    for (const auto& place : places) {
        double px = place[0], py = place[1];
        ASSERT_TRUE(lambert93.Convert(cc46, px, py));
        EXPECT_GT(std::abs(py - place[1]), 1000.0); // it did move
        ASSERT_TRUE(cc46.Convert(lambert93, px, py));
        EXPECT_NEAR(px, place[0], kTenthMm);
        EXPECT_NEAR(py, place[1], kTenthMm);
    }
}

TEST(ProjectionConvert, SystemsOnOtherEllipsoidsAndMeridians) {
    // On the central meridian of UTM 31N (3°E, that of Lambert-93) the northing 5 000 000 is the
    // meridian arc from the equator times 0.9996: latitude 45.153477183° (WGS 84, arc integrated
    // numerically by hand), northing 6 450 464.5655 in Lambert-93 (published constants).
    double x = 500000.0, y = 5000000.0;
    ASSERT_TRUE(CProjection("UTM 31N").Convert(CProjection("Lambert 93"), x, y));
    EXPECT_NEAR(x, 700000.0, kTenthMm);
    EXPECT_NEAR(y, 6450464.5655, kTenthMm);

    // Lambert II étendu and Lambert II Centre are one projection, northings 2 000 000 m apart.
    x = 612345.678, y = 2123456.789;
    ASSERT_TRUE(CProjection("Lambert II étendu").Convert(CProjection("Lambert II Centre"), x, y));
    EXPECT_NEAR(x, 612345.678, kTenthMm);
    EXPECT_NEAR(y, 123456.789, kTenthMm);

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
    const CProjection lambert93("Lambert 93");
    struct Case {
        const char* from;
        const char* to;
        double x, y;
    };
    const Case cases[] = {
        {"Aucune", "Lambert 93", 1000.0, 2000.0},
        {"Lambert 93", "Aucune", 700000.0, 6600000.0},
        {"Lambert 93", "Mercator", 700000.0, 6600000.0},
        {"Lambert 93", "CC46", kUndefined, 6600000.0},
        {"Lambert 93", "CC46", 700000.0, NAN},
        {"UTM 31N", "Lambert 93", 1e8, 5e6}, // thousands of kilometres off the grid
    };
    for (const Case& c : cases) {
        double x = c.x, y = c.y;
        EXPECT_FALSE(CProjection(c.from).Convert(CProjection(c.to), x, y)) << c.from << " -> " << c.to;
        EXPECT_EQ(x, c.x);
        EXPECT_TRUE(y == c.y || (std::isnan(y) && std::isnan(c.y)));
    }
}

TEST(ProjectionConvert, AProjectionMovedKeepsItsSystem) {
    CProjection moved("Lambert 93");
    CProjection target(std::move(moved));
    double x = 700000.0, y = 6600000.0;
    EXPECT_TRUE(target.Convert(CProjection("CC46"), x, y));
    EXPECT_NEAR(target.CalcLinearAlter(700000.0, 6600000.0), -948.914, 0.01);
    EXPECT_EQ(target.Epsg(), 2154);
}

} // namespace
} // namespace pyr
