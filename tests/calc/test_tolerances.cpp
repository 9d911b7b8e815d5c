#include "TestSupport.h"
#include "calc/Tolerances.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kTenthMm = 1e-4;
constexpr double kMicrogon = 1e-6;

// Values worked by hand from the formulas of ordinary surveying work.
TEST(Tolerances, FormulasAgainstHandValues) {
    EXPECT_NEAR(DistanceTolerance(0.0), 0.030, kTenthMm);
    EXPECT_NEAR(DistanceTolerance(1000.0), 0.040, kTenthMm); // 3 cm + 1 cm a kilometre
    EXPECT_NEAR(DistanceTolerance(250.0), 0.0325, kTenthMm);

    EXPECT_EQ(V0Tolerance(0, kV0ToleranceNormal), 0.0);
    EXPECT_EQ(V0Tolerance(1, kV0ToleranceNormal), 0.0); // one reference: its own mean
    EXPECT_NEAR(V0Tolerance(2, kV0ToleranceNormal), 0.0043 / std::sqrt(2.0), kMicrogon);
    EXPECT_NEAR(V0Tolerance(4, kV0ToleranceNormal), 0.0043 * std::sqrt(0.75), kMicrogon);
    EXPECT_NEAR(V0Tolerance(2, kV0TolerancePrecise), 0.0018 / std::sqrt(2.0), kMicrogon);

    // 1 km horizontal (z = 100): 0.01 sqrt(16 + 1 / c2 + 4); at z = 50, sin² = cos² = 1/2.
    const struct {
        double distance, zenith;
        HeightToleranceTerms terms;
        double expected;
    } heights[] = {
        {1000.0, 100.0, kHeightTermsV0, 0.01 * std::sqrt(21.0)},
        {1000.0, 100.0, kHeightTermsPoints, 0.01 * std::sqrt(20.5)},
        {1000.0, 50.0, kHeightTermsV0, 0.01 * std::sqrt(8.0 + 40.0 + 1.0 + 4.0)},
        {0.0, 100.0, kHeightTermsV0, 0.01 * std::sqrt(13.0)},
        {2000.0, 300.0, kHeightTermsPoints, 0.01 * std::sqrt(25.0 + 8.0 + 4.0)},
    };
    for (const auto& h : heights)
        EXPECT_NEAR(HeightDifferenceTolerance(h.distance, h.zenith, h.terms), h.expected, 1e-9) << h.distance;
}

TEST(Tolerances, TheModeOfTheOptionsChoosesTheFormulaOrTheCustomValues) {
    TempDir dir;
    const std::string ini = dir / "Pyralis.ini";
    const struct {
        const char* file;
        double v0Of2, distanceAt1000, heightAt1000;
    } cases[] = {
        {"", 0.0043 / std::sqrt(2.0), 0.04, 0.01 * std::sqrt(21.0)},
        {"[Options_Tolerances]\nTypeTolerance=1\n", 0.0018 / std::sqrt(2.0), 0.04, 0.01 * std::sqrt(21.0)},
        {"[Options_Tolerances]\nTypeTolerance=2\nTolAngles=0.005\nTolDistances=0.02\nTolAltitudes=0.03\n",
         0.005, 0.02, 0.03},
        {"[Options_Tolerances]\nTypeTolerance=7\nTolAngles=0.005\n", 0.005, 0.01, 0.01}, // clamped to 2
    };
    for (const auto& c : cases) {
        WriteBytes(ini, c.file);
        const Tolerances tolerances = Tolerances::FromOptions(ini);
        EXPECT_NEAR(tolerances.V0(2), c.v0Of2, kMicrogon) << c.file;
        EXPECT_NEAR(tolerances.Distance(1000.0), c.distanceAt1000, kTenthMm) << c.file;
        EXPECT_NEAR(tolerances.HeightDifference(1000.0, 100.0, kHeightTermsV0), c.heightAt1000, kTenthMm)
            << c.file;
    }
}

} // namespace
} // namespace pyr
