// The reduction of one sighting for the computations. Expected values are worked by hand from the values
// written (the arithmetic is in each comment) or from the geometry the sighting was built from.
#include "calc/GeoLines.h"
#include "calc/SightingReduction.h"
#include "core/Angles.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kMgon = 1e-4;    // 0.1 mgon
constexpr double kTenthMm = 1e-4; // 0.1 mm

struct Reduced {
    Geo geo;
    int station = -1;

    ReducedSighting At(int sighting, const SightingReductionOptions& options = {}) const {
        return ReduceSighting(geo, StationPlaceAt(geo, station), sighting, options);
    }
};

TEST(SightingReduction, TheStationIsPlacedWithItsOwnVerticalOffsetAndItsSetUp) {
    Reduced r;
    r.geo.Pt("S1", 1000.0, 2000.0, 100.0).Sta("S1", 1.5, 12.5).Exc(kExcentVer, 0.12).Sta("S1", 1.6);
    r.station = r.geo.GetSize() - 1;
    const StationPlace second = StationPlaceAt(r.geo, r.station);
    EXPECT_EQ(second.Designation(), "S1(2)");
    EXPECT_NEAR(second.hi, 1.72, 1e-12); // 1.6 + 0.12
    EXPECT_FALSE(second.IsOriented());
    EXPECT_DOUBLE_EQ(second.z, 100.0);
    EXPECT_TRUE(StationPlaceAt(r.geo, 1).IsOriented());
}

// Collimation 0.002 gr and prism constant 0.03 m of the instrument in force; the options' default
// instrument when none is written. The second sighting, face right, reads 301.996 gr.
TEST(SightingReduction, InstrumentConstantsAreAddedOnlyWhenAskedAndBeforeTheFaceIsTurned) {
    Reduced r;
    r.geo.Pt("S1", 0.0, 0.0, 0.0).Inst("TS", 0.002, 0.03).Sta("S1", 1.5);
    r.station = 2;
    r.geo.Mes("A", 1.3, 50.0, 98.0, 150.0).Mes("A", 1.3, 250.0, 301.996, 150.0);
    SightingReductionOptions options;
    options.instrumentConstants = true;
    for (int i : {3, 4}) {
        const ReducedSighting s = r.At(i, options);
        SCOPED_TRACE(i);
        EXPECT_NEAR(s.av, 98.002, 1e-9); // 98 + 0.002; 400 − (301.996 + 0.002)
        EXPECT_NEAR(s.ah, 50.0, 1e-9);
        EXPECT_NEAR(s.di, 150.03, 1e-9);
        EXPECT_NEAR(s.dh, 149.956117227, kTenthMm); // 150.03 × sin(98.002 gr)
        EXPECT_EQ(s.faceRight, i == 4);
        // The sine and cosine carried are those of the zenith angle once corrected and turned.
        EXPECT_EQ(s.sinAv, SinGrads(s.av));
        EXPECT_EQ(s.cosAv, CosGrads(s.av));
    }
    EXPECT_NEAR(r.At(3).av, 98.0, 1e-12);
    EXPECT_NEAR(r.At(3).di, 150.0, 1e-12);

    Reduced plain; // no instrument element: the default instrument's constants
    plain.geo.Pt("S1", 0.0, 0.0, 0.0).Sta("S1", 1.5).Mes("A", 1.3, 50.0, 98.0, 150.0);
    plain.station = 1;
    options.defaultInstrument.verticalCollimation = -0.01;
    options.defaultInstrument.prismConstant = 0.0175;
    EXPECT_NEAR(plain.At(2, options).av, 97.99, 1e-9);
    EXPECT_NEAR(plain.At(2, options).di, 150.0175, 1e-9);
}

// P lies 0.40 m short of the target along its line of sight and 0.25 m to the right of it (offsets
// radial −0.40, tangential 0.25), 0.10 m below it: the reduced sighting aims at P, 50 m away.
TEST(SightingReduction, EccentricOffsetsBringTheSightingToThePointAndTheVerticalOneFollowsTargetHeights) {
    const double px = 30.0, py = 40.0; // 50 m from the station
    const double bearing = RadiansToGrads(std::atan2(px, py));
    const double along = std::sqrt(50.0 * 50.0 - 0.25 * 0.25); // to the foot of P on the target's line
    const double seen = bearing - RadiansToGrads(std::atan2(0.25, along));
    const double slope = along + 0.40; // horizontal sighting of the target
    Reduced r;
    r.geo.Pt("S1", 0.0, 0.0, 0.0).Sta("S1", 1.5);
    r.station = 1;
    r.geo.Exc(kExcentRad, -0.40).Exc(kExcentTan, 0.25).Exc(kExcentVer, 0.10);
    r.geo.Mes("P", 1.3, seen, 100.0, slope);
    const ReducedSighting withHeights = r.At(5);
    EXPECT_NEAR(withHeights.ah, bearing, kMgon);
    EXPECT_NEAR(withHeights.dh, 50.0, kTenthMm);
    EXPECT_NEAR(withHeights.hp, 1.2, 1e-12); // 1.3 − 0.10

    SightingReductionOptions noHeights;
    noHeights.targetHeights = false;
    const ReducedSighting without = r.At(5, noHeights);
    EXPECT_EQ(without.hp, 0.0);
    EXPECT_NEAR(without.dh, 50.0, kTenthMm); // the offsets still apply
}

TEST(SightingReduction, HorizontalDistancesAreScaledAndMissingOnesStayUnknown) {
    Reduced r;
    r.geo.Pt("S1", 0.0, 0.0, 0.0).Sta("S1", 1.5);
    r.station = 1;
    r.geo.Mes("A", 1.3, 10.0, 100.0, 200.0)
        .Mes("B", 1.3, 20.0, 100.0, 0.0)
        .Mes("C", 1.3, 30.0, kUndefined, 80.0);
    r.geo.Mes("D", 1.3, 40.0, 0.0, 12.0).Put(std::make_unique<CComment>("note"), kKindComment);
    SightingReductionOptions options;
    options.correction.linearAlteration = 100.0; // mm/km: 100 ppm
    EXPECT_NEAR(r.At(2, options).dh, 200.02, kTenthMm);
    for (int i : {3, 4, 5}) // no distance; no zenith angle; vertical
        EXPECT_EQ(r.At(i, options).dh, kUndefined) << i;
    EXPECT_EQ(r.At(6).index, -1); // a comment is no sighting

    // 100 / tan(99 gr) + 1.5 − 1.3 + 100² × 0.84 / 12 768 000 = 1.771583 m, worked with a calculator.
    EXPECT_NEAR(TrigonometricHeightDifference(100.0, 99.0, 1.5, 1.3), 1.7715834, 1e-6);
    EXPECT_NEAR(TrigonometricHeightDifference(1000.0, 100.0, 0.0, 0.0), 0.0657895, 1e-6);
}

} // namespace
} // namespace pyr
