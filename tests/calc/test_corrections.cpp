// The corrections and the tolerances that every computation applies to its observations.
#include "TestSupport.h"
#include "calc/Corrections.h"
#include "calc/Tolerances.h"
#include "core/Angles.h"
#include "core/Undefined.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kMgon = 1e-4;    // 0.1 mgon
constexpr double kTenthMm = 1e-4; // 0.1 mm

TEST(FaceLeft, TurnsFaceRightIncludingBothBounds) {
    const struct {
        double ah, av;
        bool turned;
        double ahAfter, avAfter;
    } cases[] = {
        {50.0, 300.0, true, 250.0, 100.0},       {250.0, 300.0, true, 50.0, 100.0}, // wrapped
        {50.0, 200.0, true, 250.0, 200.0}, // 200 is face right: AH turns, AV stays
        {50.0, 400.0, true, 250.0, 0.0},         {kUndefined, 310.0, true, kUndefined, 90.0},
        {50.0, 199.9999, false, 50.0, 199.9999}, {50.0, 400.0001, false, 50.0, 400.0001},
    };
    for (const auto& c : cases) {
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

    // Unknown values stay unknown; without a zenith angle only the target height is reduced.
    a = kUndefined, z = 100.0, d = 50.0, t = kUndefined;
    ReduceEccentricSighting(a, z, d, t, 0.5, 0.5, 0.2, false);
    EXPECT_EQ(a, kUndefined);
    EXPECT_EQ(t, kUndefined);
    EXPECT_NEAR(d, std::hypot(50.5, 0.5), kTenthMm);
    a = 10.0, z = kUndefined, d = 50.0, t = 1.5;
    ReduceEccentricSighting(a, z, d, t, 0.5, 0.5, 0.2, true);
    EXPECT_EQ(a, 10.0);
    EXPECT_EQ(d, 50.0);
    EXPECT_NEAR(t, 1.3, 1e-12);
}

TEST(HorizontalDistance, ManualFormFromTheOptionsAutomaticFromTheHeight) {
    TempDir dir;
    const std::string ini = dir / "Pyralis.ini";
    WriteBytes(ini, "[Options_Corrections]\nAlterLineaire=-120\nCorrNivZero=-15\nCorrAuto=0\n"
                    "Projection=Aucune\nRayonTerre=6366\n");
    DistanceCorrection correction = DistanceCorrection::FromOptions(ini);
    DistanceCorrection unknown = correction; // the manual form needs no projection, the automatic one does
    unknown.projection = std::make_shared<const CProjection>("Inconnue", 6366.0);
    EXPECT_EQ(unknown.ProjectionError(), "");
    unknown.automatic = true;
    EXPECT_NE(unknown.ProjectionError(), "");
    double dh = 1000.0, none = 0.0, negative = kUndefined;
    for (double* d : {&dh, &none, &negative})
        CorrectHorizontalDistance(*d, kUndefined, kUndefined, kUndefined, correction);
    EXPECT_NEAR(dh, 1000.0 - 0.135, kTenthMm); // -120 - 15 mm a kilometre
    EXPECT_EQ(none, 0.0);
    EXPECT_EQ(negative, kUndefined);

    // Automatic, in local coordinates: no alteration, and the manual values ignored; at 1000 m over a
    // 6366 km earth a distance shrinks by R / (R + h). Without a height, no reduction.
    correction.automatic = true;
    dh = 1000.0;
    CorrectHorizontalDistance(dh, 100.0, 200.0, 1000.0, correction);
    EXPECT_NEAR(dh, 1000.0 * 6366000.0 / 6367000.0, kTenthMm);
    dh = 1000.0;
    CorrectHorizontalDistance(dh, 100.0, 200.0, kUndefined, correction);
    EXPECT_EQ(dh, 1000.0);
}

// Values worked by hand from the formulas of ordinary surveying work: 3 cm + 1 cm a kilometre for a
// distance; for a height difference over 1 km at z = 50 (sin² = cos² = 1/2) 0.01 sqrt(8 + 40 + 1 + 4),
// over 2 km at z = 300 (cos = 0) 0.01 sqrt(25 + 8 + 4), with the terms of the computed points.
TEST(Tolerances, TheModeOfTheOptionsChoosesTheFormulaOrTheCustomValues) {
    EXPECT_EQ(V0Tolerance(0, kV0ToleranceNormal), 0.0);
    EXPECT_NEAR(V0Tolerance(4, kV0ToleranceNormal), 0.0043 * std::sqrt(0.75), kMgon);
    TempDir dir;
    const std::string ini = dir / "Pyralis.ini";
    const struct {
        const char* file;
        double v0Of2, distanceAt250, heightAt1000, heightAt2000;
    } cases[] = {
        {"", 0.0043 / std::sqrt(2.0), 0.0325, 0.01 * std::sqrt(53.0), 0.01 * std::sqrt(37.0)},
        {"[Options_Tolerances]\nTypeTolerance=1\n", 0.0018 / std::sqrt(2.0), 0.0325, 0.01 * std::sqrt(53.0),
         0.01 * std::sqrt(37.0)},
        {"[Options_Tolerances]\nTypeTolerance=2\nTolAngles=0.005\nTolDistances=0.02\nTolAltitudes=0.03\n",
         0.005, 0.02, 0.03, 0.03},
        {"[Options_Tolerances]\nTypeTolerance=7\nTolAngles=0.005\n", 0.005, 0.01, 0.01, 0.01}, // clamped to 2
    };
    for (const auto& c : cases) {
        WriteBytes(ini, c.file);
        const Tolerances tolerances = Tolerances::FromOptions(ini);
        EXPECT_NEAR(tolerances.V0(2), c.v0Of2, kMgon) << c.file;
        EXPECT_NEAR(tolerances.Distance(250.0), c.distanceAt250, kTenthMm) << c.file;
        EXPECT_NEAR(tolerances.HeightDifference(1000.0, 50.0, kHeightTermsV0), c.heightAt1000, kTenthMm)
            << c.file;
        EXPECT_NEAR(tolerances.HeightDifference(2000.0, 300.0, kHeightTermsPoints), c.heightAt2000, kTenthMm)
            << c.file;
        // Given the sine and cosine of z, the same tolerance to the last bit, custom values included.
        double s = 0.0, cz = 0.0;
        SinCosGrads(123.4567, s, cz);
        EXPECT_EQ(tolerances.HeightDifference(1234.5, s, cz, kHeightTermsV0),
                  tolerances.HeightDifference(1234.5, 123.4567, kHeightTermsV0))
            << c.file;
    }
}

} // namespace
} // namespace pyr
