// Expected values are exact by construction: quarter turns, and points placed on the axes and the
// diagonals of the grid.
#include "core/Angles.h"

#include <cmath>
#include <gtest/gtest.h>

using namespace pyr;

constexpr double kMgon = 1e-4; // 0.1 mgon, in grads

TEST(Angles, WrapIntoOneTurn) {
    EXPECT_EQ(WrapGrads(0.0), 0.0);
    EXPECT_EQ(WrapGrads(400.0), 0.0);
    EXPECT_EQ(WrapGrads(-100.0), 300.0);
    EXPECT_EQ(WrapGrads(850.0), 50.0);
    EXPECT_NEAR(WrapGrads(-1e-14), 0.0, 1e-12); // never 400 itself
    EXPECT_LT(WrapGrads(-1e-14), 400.0);
}

TEST(Angles, NearAndCentredBringWithinHalfATurn) {
    EXPECT_EQ(NearGrads(399.0, 1.0), -1.0);
    EXPECT_EQ(NearGrads(1.0, 399.0), 401.0);
    EXPECT_EQ(NearGrads(150.0, 100.0), 150.0);
    EXPECT_EQ(CentredGrads(399.5), -0.5); // a misclosure across the zero of the circle
    EXPECT_EQ(CentredGrads(-600.25), -200.25 + 400.0);
    EXPECT_EQ(CentredGrads(200.0), 200.0);
}

TEST(Angles, SinesAndCosinesOfQuarterTurnsAreExact) {
    EXPECT_EQ(CosGrads(100.0), 0.0);
    EXPECT_EQ(SinGrads(200.0), 0.0);
    EXPECT_EQ(CosGrads(300.0), 0.0);
    EXPECT_EQ(SinGrads(100.0), 1.0);
    EXPECT_EQ(CosGrads(200.0), -1.0);
    EXPECT_EQ(SinGrads(-100.0), -1.0);
    EXPECT_NEAR(SinGrads(50.0), std::sqrt(0.5), 1e-15);
    EXPECT_NEAR(CosGrads(350.0), std::sqrt(0.5), 1e-15);
}

TEST(Angles, BearingIsClockwiseFromNorthWithXEast) {
    EXPECT_NEAR(Bearing(0, 0, 0, 10), 0.0, kMgon);    // north
    EXPECT_NEAR(Bearing(0, 0, 10, 0), 100.0, kMgon);  // east
    EXPECT_NEAR(Bearing(0, 0, 0, -10), 200.0, kMgon); // south
    EXPECT_NEAR(Bearing(0, 0, -10, 0), 300.0, kMgon); // west
    EXPECT_NEAR(Bearing(651200, 6862300, 651210, 6862310), 50.0, kMgon);
    EXPECT_NEAR(Bearing(5, 5, 0, 10), 350.0, kMgon);
    EXPECT_EQ(Bearing(3, 4, 3, 4), 0.0);
}
