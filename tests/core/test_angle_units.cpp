// Angles in degrees, sexagesimal degrees and mils, to grads and back. Expected values by hand:
// 360° = 400 gr = 6400 mils, so 1° = 10/9 gr, 45° = 50 gr and 1 mil = 1/16 = 0.0625 gr; a sexagesimal
// angle ddd.mmss is ddd + mm/60 + ss/3600 degrees, so 12° 30' 45" = 12.5125° = 125.125 / 9 =
// 13.902777... gr.
#include "core/AngleUnits.h"
#include "core/Undefined.h"

#include <cmath>
#include <cstdio>
#include <gtest/gtest.h>
#include <string>

using namespace pyr;

namespace {
constexpr double kMgon = 1e-4;               // 0.1 mgon, in grads
constexpr double kArcSecond = 1e-7;          // well under a thousandth of a second, in degrees
constexpr double k12d30m45s = 125.125 / 9.0; // gr
} // namespace

TEST(AngleUnits, SexagesimalTextIsReadDigitByDigit) {
    // clang-format off
    const std::pair<const char*, double> cases[] = {
        {"12.3045", 12.0 + 30.0 / 60 + 45.0 / 3600}, {"0.0001", 1.0 / 3600}, {"-45.3", -45.5}, {"90", 90.0},
        {"359.5959", 359.0 + 59.0 / 60 + 59.0 / 3600}, {"12.30451", 12.0 + 30.0 / 60 + 45.1 / 3600},
        {"12.305", 12.0 + 30.0 / 60 + 50.0 / 3600}, {" +7.0030 ", 7.0 + 30.0 / 3600}};
    // clang-format on
    for (const auto& [text, expected] : cases) {
        double degrees = 0;
        ASSERT_TRUE(DmsTextToDegrees(text, degrees)) << text;
        EXPECT_NEAR(degrees, expected, kArcSecond) << text;
        EXPECT_NEAR(DmsToDegrees(std::stod(text)), expected, kArcSecond) << text;
    }
    for (const char* bad : {"12°30", "", "-", "abc", "1e5"}) {
        double ignored = 0;
        EXPECT_FALSE(DmsTextToDegrees(bad, ignored)) << bad;
    }
}

// 123.4530 is held as 123.45299999...: read from the binary value or from its text, every whole second
// of a degree gives the same degrees to the bit, those of its minutes and seconds.
TEST(AngleUnits, NoBinaryRoundingShiftsASecond) {
    for (int minutes = 0; minutes < 60; ++minutes) {
        for (int seconds = 0; seconds < 60; ++seconds) {
            char text[16];
            std::snprintf(text, sizeof text, "123.%02d%02d", minutes, seconds);
            const double expected = SexagesimalToDegrees(123.0, minutes, seconds);
            double fromText = 0;
            ASSERT_TRUE(DmsTextToDegrees(text, fromText));
            ASSERT_EQ(fromText, expected) << text;
            ASSERT_EQ(DmsToDegrees(std::stod(text)), expected) << text;
            ASSERT_EQ(DmsToDegrees(-std::stod(text)), -expected) << text;
        }
    }
}

TEST(AngleUnits, ConversionsGiveTheValuesComputedByHand) {
    EXPECT_EQ(DegreesToGrads(45.0), 50.0);
    EXPECT_EQ(GradsToDegrees(50.0), 45.0);
    EXPECT_EQ(DegreesToGrads(90.0), 100.0);
    EXPECT_EQ(DegreesToGrads(-180.0), -200.0);
    EXPECT_EQ(MilsToGrads(1.0), 0.0625);
    EXPECT_EQ(GradsToMils(100.0), 1600.0);
    EXPECT_EQ(ToGrads(123.4567, AngleUnit::Grads), 123.4567);
    EXPECT_NEAR(ToGrads(12.3045, AngleUnit::Dms), k12d30m45s, 1e-12);
    EXPECT_NEAR(ToGrads(180.3, AngleUnit::Dms), 200.5556, kMgon); // 180° 30' = 180.5°
    EXPECT_EQ(FromGrads(k12d30m45s, AngleUnit::Dms), 12.3045);    // the nearest double to the text
    EXPECT_EQ(FromGrads(50.0, AngleUnit::Dms), 45.0); // the other units come back through the round trips
}

// The undefined value is a marker, not an angle: no unit changes it, written out it reads back as itself.
TEST(AngleUnits, TheUndefinedValueStaysUndefined) {
    for (AngleUnit unit : {AngleUnit::Grads, AngleUnit::Degrees, AngleUnit::Dms, AngleUnit::Mils}) {
        EXPECT_EQ(ToGrads(kUndefined, unit), kUndefined);
        EXPECT_EQ(FromGrads(kUndefined, unit), kUndefined);
        double grads = 0;
        ASSERT_TRUE(AngleTextToGrads("-999999", unit, grads));
        EXPECT_EQ(grads, kUndefined);
    }
}

TEST(AngleUnits, AngleTextInEveryUnit) {
    const struct {
        const char* text;
        AngleUnit unit;
        double grads;
    } cases[] = {
        {"123.4567", AngleUnit::Grads, 123.4567},
        {"45", AngleUnit::Degrees, 50.0},
        {"-12.3045", AngleUnit::Dms, -k12d30m45s},
        {"0.5", AngleUnit::Mils, 0.03125},
    };
    for (const auto& c : cases) {
        double grads = 0;
        ASSERT_TRUE(AngleTextToGrads(c.text, c.unit, grads)) << c.text;
        EXPECT_NEAR(grads, c.grads, 1e-12) << c.text;
    }
    double ignored = 0;
    EXPECT_FALSE(AngleTextToGrads("12°30", AngleUnit::Dms, ignored));
    EXPECT_FALSE(AngleTextToGrads("12,5", AngleUnit::Degrees, ignored));
    EXPECT_FALSE(AngleTextToGrads("", AngleUnit::Grads, ignored));
}

// Out to each unit and back: exact for mils (a power of two), to rounding for degrees, to the millionth
// of a second that a ddd.mmss number holds for sexagesimal degrees (3e-10 gr). The text's round trip is
// checked below, over every minute and second.
TEST(AngleUnits, RoundTripsThroughEveryUnit) {
    for (double grads : {0.0, 100.0, 200.0, 399.99999, -0.00001, -123.456789, -399.99999, 987.654321}) {
        SCOPED_TRACE(grads);
        EXPECT_EQ(ToGrads(FromGrads(grads, AngleUnit::Mils), AngleUnit::Mils), grads);
        EXPECT_EQ(ToGrads(FromGrads(grads, AngleUnit::Grads), AngleUnit::Grads), grads);
        EXPECT_NEAR(ToGrads(FromGrads(grads, AngleUnit::Degrees), AngleUnit::Degrees), grads, 1e-12);
        EXPECT_NEAR(ToGrads(FromGrads(grads, AngleUnit::Dms), AngleUnit::Dms), grads, 1e-9);
    }
}

TEST(AngleUnits, SexagesimalTextRoundsAndCarries) {
    const struct {
        double degrees;
        int decimals;
        const char* text;
    } cases[] = {
        {12.5125, 0, "12.3045"},
        {12.5125, 2, "12.304500"},
        {SexagesimalToDegrees(12, 30, 45.12), 2, "12.304512"},
        {SexagesimalToDegrees(12, 30, 59.9999), 2, "12.310000"}, // never 12° 30' 60.00"
        {SexagesimalToDegrees(12, 30, 59.9999), 4, "12.30599999"},
        {SexagesimalToDegrees(12, 59, 59.96), 1, "13.00000"}, // through the minutes into the degrees
        {SexagesimalToDegrees(359, 59, 59.7), 0, "360.0000"}, // no wrap
        {SexagesimalToDegrees(0, 0, 0.0001), 4, "0.00000001"},
        {-45.5, 0, "-45.3000"},
        {-SexagesimalToDegrees(0, 0, 0.0004), 3, "0.0000000"}, // rounds to zero: no sign
        {0.0, 0, "0.0000"},
        {12.5125, -1, "12.3045"}, // decimals below 0 are none
    };
    for (const auto& c : cases)
        EXPECT_EQ(DegreesToDmsText(c.degrees, c.decimals), c.text) << c.degrees << " " << c.decimals;
}

// Whatever the angle, the text has minutes and seconds below 60 and reads back within half of its last
// decimal of a second.
TEST(AngleUnits, SexagesimalTextAlwaysHasMinutesAndSecondsBelowSixty) {
    for (int decimals = 0; decimals <= 4; ++decimals) {
        double halfUnit = 0.5;
        for (int i = 0; i < decimals; ++i)
            halfUnit /= 10.0;
        for (int step = 0; step < 20000; ++step) {
            const double degrees = step * 0.01799731 - 1.0; // an irregular stride, from -1° to 359°
            const std::string text = DegreesToDmsText(degrees, decimals);
            const std::string fraction = text.substr(text.find('.') + 1);
            ASSERT_EQ(fraction.size(), 4u + decimals) << text;
            ASSERT_LT(std::stoi(fraction.substr(0, 2)), 60) << text;
            ASSERT_LT(std::stoi(fraction.substr(2, 2)), 60) << text;
            double back = 0;
            ASSERT_TRUE(DmsTextToDegrees(text, back)) << text;
            ASSERT_LE(std::fabs(back - degrees) * 3600.0, halfUnit + 1e-9) << text;
        }
    }
}
