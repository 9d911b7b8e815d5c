#include "TestSupport.h"
#include "calc/Corrections.h"
#include "core/Angles.h"
#include "core/Undefined.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kMgon = 1e-4; // 0.1 mgon
constexpr double kTenthMm = 1e-4;

TEST(FaceLeft, TurnsFaceRightIncludingBothBounds) {
    struct Case {
        double ah, av;
        bool turned;
        double ahAfter, avAfter;
    } cases[] = {
        {50.0, 300.0, true, 250.0, 100.0},
        {250.0, 300.0, true, 50.0, 100.0}, // wrapped into [0, 400)
        {50.0, 200.0, true, 250.0, 200.0}, // 200 counts as face right: AH turns, AV stays
        {50.0, 400.0, true, 250.0, 0.0},
        {kUndefined, 310.0, true, kUndefined, 90.0},
        {50.0, 199.9999, false, 50.0, 199.9999},
        {50.0, 400.0001, false, 50.0, 400.0001},
        {50.0, kUndefined, false, 50.0, kUndefined},
    };
    for (const Case& c : cases) {
        double ah = c.ah, av = c.av;
        EXPECT_EQ(ReduceToFaceLeft(ah, av), c.turned) << c.av;
        EXPECT_NEAR(ah, c.ahAfter, 1e-12) << c.av;
        EXPECT_NEAR(av, c.avAfter, 1e-12) << c.av;
    }
}

// The eccentric target seen from a station at the origin; the point lies ER beyond it along the line of
// sight, ET to the right of it and EV above it. The reduced sighting must be the sighting of that point.
TEST(EccentricSighting, AgreesWithThePlaneGeometryOfTheOffsetTarget) {
    const double ah = 37.5, av = 96.0, di = 142.0, hp = 1.6;
    const double er = 0.35, et = -0.42, ev = 0.25;

    const double h = di * SinGrads(av), v = di * CosGrads(av);
    const double sx = SinGrads(ah), sy = CosGrads(ah); // unit vector along the sight
    const double rx = sy, ry = -sx;                    // to its right (clockwise)
    const double px = h * sx + er * sx + et * rx, py = h * sy + er * sy + et * ry;
    const double ph = std::hypot(px, py);

    double a = ah, z = av, d = di, t = hp;
    ReduceEccentricSighting(a, z, d, t, er, et, ev, false);
    EXPECT_NEAR(a, Bearing(0, 0, px, py), kMgon);
    EXPECT_NEAR(d * SinGrads(z), ph, kTenthMm);
    EXPECT_NEAR(d * CosGrads(z), v, kTenthMm); // same height of the line of sight
    EXPECT_NEAR(t, hp - ev, 1e-12);            // the point stands EV higher: a shorter target

    // Folded into the angles, the sight reaches the point itself, and the target height stays.
    a = ah, z = av, d = di, t = hp;
    ReduceEccentricSighting(a, z, d, t, er, et, ev, true);
    EXPECT_NEAR(d * SinGrads(z), ph, kTenthMm);
    EXPECT_NEAR(d * CosGrads(z), v + ev, kTenthMm);
    EXPECT_EQ(t, hp);
}

TEST(EccentricSighting, LeavesWhatItCannotReduce) {
    double ah = kUndefined, av = 100.0, di = 50.0, hp = kUndefined;
    ReduceEccentricSighting(ah, av, di, hp, 0.5, 0.5, 0.2, false); // AH and HP unknown stay unknown
    EXPECT_EQ(ah, kUndefined);
    EXPECT_EQ(hp, kUndefined);
    EXPECT_NEAR(di, std::hypot(50.5, 0.5), kTenthMm);

    ah = 10.0, av = kUndefined, di = 50.0, hp = 1.5; // no zenith angle: only the height is reduced
    ReduceEccentricSighting(ah, av, di, hp, 0.5, 0.5, 0.2, true);
    EXPECT_EQ(ah, 10.0);
    EXPECT_EQ(di, 50.0);
    EXPECT_NEAR(hp, 1.3, 1e-12);
}

TEST(HorizontalDistance, ManualAndAutomaticScaleCorrections) {
    DistanceCorrection manual;
    manual.linearAlteration = -120.0; // mm/km
    manual.levelReduction = -15.0;
    double dh = 1000.0;
    CorrectHorizontalDistance(dh, kUndefined, kUndefined, kUndefined, manual);
    EXPECT_NEAR(dh, 1000.0 - 0.135, kTenthMm);

    double none = 0.0, negative = kUndefined;
    CorrectHorizontalDistance(none, 0, 0, 0, manual);
    CorrectHorizontalDistance(negative, 0, 0, 0, manual);
    EXPECT_EQ(none, 0.0);
    EXPECT_EQ(negative, kUndefined);

    // Local coordinates: no alteration; at 1000 m over a 6366 km earth a distance shrinks by
    // R / (R + h), 157.06 mm a kilometre.
    DistanceCorrection automatic;
    automatic.automatic = true;
    automatic.linearAlteration = 500.0; // ignored by the automatic form
    automatic.projection = std::make_shared<const CProjection>("Aucune", 6366.0);
    dh = 1000.0;
    CorrectHorizontalDistance(dh, 100.0, 200.0, 1000.0, automatic);
    EXPECT_NEAR(dh, 1000.0 * 6366000.0 / 6367000.0, kTenthMm);
    dh = 1000.0;
    CorrectHorizontalDistance(dh, 100.0, 200.0, kUndefined, automatic); // no height, no reduction
    EXPECT_EQ(dh, 1000.0);
}

TEST(HorizontalDistance, OptionsAreReadFromTheParameterFile) {
    TempDir dir;
    const std::string ini = dir / "Pyralis.ini";
    WriteBytes(ini, "[Options_Corrections]\nAlterLineaire=12.5\nCorrNivZero=-3\nCorrAuto=0\n"
                    "Projection=Aucune\nRayonTerre=5000\n");
    const DistanceCorrection read = DistanceCorrection::FromOptions(ini);
    EXPECT_FALSE(read.automatic);
    EXPECT_EQ(read.linearAlteration, 12.5);
    EXPECT_EQ(read.levelReduction, -3.0);
    ASSERT_TRUE(read.projection);
    EXPECT_TRUE(read.projection->IsNone());
    EXPECT_EQ(read.ProjectionError(), ""); // the manual form needs no projection
    // The radius is clamped to 6000 km: 1000 m up shrinks by 1000 / 6001000.
    EXPECT_NEAR(read.projection->CalcEllipsReduc(0, 0, 1000.0, 1), -1e9 / 6001000.0, 1e-9);
}

} // namespace
} // namespace pyr
