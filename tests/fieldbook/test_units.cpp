// Sightings given by their horizontal distance. Feet are brought to metres in every reader's tests, the
// angle units with the core.
#include "core/Undefined.h"
#include "fieldbook/FieldBookUnits.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {
constexpr double kMgon = 1e-4; // 0.1 mgon, in grads
} // namespace

// A 3-4-5 triangle: 4 m horizontally and 3 m up from the tilting axis is 5 m of slope, at a zenith angle
// of atan2(4, 3) = 53.13010235° = 59.0334470 gr; sin(59.0334470 gr) = 0.8, so 4 m at that angle is 5 m.
TEST(FieldBookUnits, SlopeDistanceAndZenithAngleFromAHorizontalDistance) {
    constexpr double kZenith345 = 53.13010235415598 * 400.0 / 360.0;
    constexpr double U = kUndefined;
    const struct {
        const char* what;
        double horizontal, heightDifference, zenith, slope; // given
        double zenithOut, slopeOut;                         // expected
    } cases[] = {
        {"height difference", 4.0, 3.0, U, U, kZenith345, 5.0},
        {"height difference down", 4.0, -3.0, U, U, 200.0 - kZenith345, 5.0},
        {"zenith angle", 4.0, U, kZenith345, U, kZenith345, 5.0},
        {"zenith angle wins over the difference", 4.0, 1.0, kZenith345, U, kZenith345, 5.0},
        {"horizontal sighting", 12.345, U, U, U, 100.0, 12.345},
        {"vertical sighting", 4.0, U, 0.0, U, 0.0, U},
        {"slope distance kept", 4.0, 3.0, U, 7.0, U, 7.0},
        {"no horizontal distance", U, 3.0, 90.0, U, 90.0, U},
        {"no length", 0.0, 0.0, U, U, U, 0.0},
    };
    for (const auto& c : cases) {
        double zenith = c.zenith, slope = c.slope;
        SlopeFromHorizontal(c.horizontal, c.heightDifference, zenith, slope);
        SCOPED_TRACE(c.what);
        if (c.zenithOut == U)
            EXPECT_EQ(zenith, U);
        else
            EXPECT_NEAR(zenith, c.zenithOut, kMgon);
        if (c.slopeOut == U)
            EXPECT_EQ(slope, U);
        else
            EXPECT_NEAR(slope, c.slopeOut, 1e-4);
    }
}
