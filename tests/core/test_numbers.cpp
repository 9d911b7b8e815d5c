#include "core/Numbers.h"
#include "core/Undefined.h"

#include <clocale>
#include <cmath>
#include <gtest/gtest.h>

using namespace pyr;

TEST(Numbers, FixedAndGeneralFormatsAreThoseOfPrintfInTheCLocale) {
    EXPECT_EQ(FormatFixed(1234.56789, 3), "1234.568");
    EXPECT_EQ(FormatFixed(-0.00049, 3), "-0.000");
    EXPECT_EQ(FormatFixed(6366.0, 6), "6366.000000");
    EXPECT_EQ(FormatFixed(2.5, 0), "2"); // round half to even, as printf
    EXPECT_EQ(FormatGeneral(0.0001), "0.0001");
    EXPECT_EQ(FormatGeneral(1234567.0), "1.23457e+06");
    EXPECT_EQ(FormatGeneral(100.0), "100");
}

TEST(Numbers, ShortestFormReadsBackExactlyAndNeverUsesAnExponent) {
    for (double v : {0.1, 651325.412, 6862371.905, 0.0003, -999999.0, 1e-7, 123456789012.0, -0.0}) {
        std::string text = FormatShortest(v);
        EXPECT_EQ(text.find('e'), std::string::npos) << text;
        double back = 1;
        ASSERT_TRUE(ParseDouble(text, back)) << text;
        EXPECT_EQ(std::signbit(back), std::signbit(v));
        EXPECT_EQ(back, v) << text;
    }
    EXPECT_EQ(FormatShortest(kUndefined), "-999999");
}

TEST(Numbers, RoundingGoesThroughTheTextAndKeepsTheUndefinedValue) {
    EXPECT_EQ(RoundToDecimals(651325.41249, 3), 651325.412);
    EXPECT_EQ(RoundToDecimals(12.34567, 4), 12.3457);
    EXPECT_EQ(RoundToDecimals(kUndefined, 2), kUndefined);
}

TEST(Numbers, StrictParsingRefusesTrailingText) {
    double v = 0;
    EXPECT_TRUE(ParseDouble(" +12.5 ", v));
    EXPECT_EQ(v, 12.5);
    EXPECT_FALSE(ParseDouble("12,5", v));
    EXPECT_FALSE(ParseDouble("", v));
    EXPECT_FALSE(ParseDouble("1.2.3", v));
    long long n = 0;
    EXPECT_TRUE(ParseInt("-42", n));
    EXPECT_EQ(n, -42);
    EXPECT_FALSE(ParseInt("4.2", n));
}

TEST(Numbers, LenientReadingsHaveTheMeaningOfAtoiAndAtof) {
    EXPECT_EQ(LenientAtoi("  42abc"), 42);
    EXPECT_EQ(LenientAtoi("-7"), -7);
    EXPECT_EQ(LenientAtoi("abc"), 0);
    EXPECT_EQ(LenientAtoi(""), 0);
    EXPECT_EQ(LenientAtoi("99999999999999"), 2147483647);
    EXPECT_EQ(LenientAtof("150.5"), 150.5);
    EXPECT_EQ(LenientAtof(" -0.25 m"), -0.25);
    EXPECT_EQ(LenientAtof("+3"), 3.0);
    EXPECT_EQ(LenientAtof("--3"), 0.0);
    EXPECT_EQ(LenientAtof("x1"), 0.0);
    EXPECT_EQ(LenientAtof("6,5"), 6.0); // the comma is not a decimal point in a parameter file
}

TEST(Numbers, AFrenchLocaleDoesNotChangeTheDecimalPoint) {
    const char* previous = std::setlocale(LC_ALL, nullptr);
    std::string saved = previous ? previous : "C";
    if (!std::setlocale(LC_ALL, "fr_FR.UTF-8")) GTEST_SKIP() << "fr_FR.UTF-8 is not installed";
    EXPECT_EQ(FormatFixed(1.5, 6), "1.500000");
    EXPECT_EQ(FormatShortest(0.25), "0.25");
    EXPECT_EQ(LenientAtof("2.75"), 2.75);
    double v = 0;
    EXPECT_TRUE(ParseDouble("3.5", v));
    EXPECT_EQ(v, 3.5);
    std::setlocale(LC_ALL, saved.c_str());
}
