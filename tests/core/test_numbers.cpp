#include "core/Numbers.h"
#include "core/Undefined.h"

#include <bit>
#include <charconv>
#include <clocale>
#include <cmath>
#include <cstdint>
#include <gtest/gtest.h>
#include <random>
#include <string>

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

TEST(Numbers, RoundingGivesWhatTheTextReadsBackAndKeepsTheUndefinedValue) {
    EXPECT_EQ(RoundToDecimals(651325.41249, 3), 651325.412);
    EXPECT_EQ(RoundToDecimals(12.34567, 4), 12.3457);
    EXPECT_EQ(RoundToDecimals(kUndefined, 2), kUndefined);
    // The decimal text of the double decides, not the decimals typed: 2.675 is held as 2.67499999...
    EXPECT_EQ(RoundToDecimals(2.675, 2), 2.67);
    EXPECT_EQ(RoundToDecimals(1.005, 2), 1.0);
    // An exact half goes to the even neighbour, as printf does.
    EXPECT_EQ(RoundToDecimals(0.125, 2), 0.12);
    EXPECT_EQ(RoundToDecimals(0.375, 2), 0.38);
    EXPECT_EQ(RoundToDecimals(-2.5, 0), -2.0);
    // A negative value that rounds to nothing is read back as -0, as "-0.00" is.
    EXPECT_TRUE(std::signbit(RoundToDecimals(-0.001, 2)));
    EXPECT_FALSE(std::signbit(RoundToDecimals(0.001, 2)));
    EXPECT_TRUE(std::isnan(RoundToDecimals(NAN, 3)));
    EXPECT_EQ(RoundToDecimals(-INFINITY, 3), -INFINITY);
}

namespace {

// Counts the values whose rounding differs, bit for bit (the sign of zero included), from the text's.
struct RoundingCheck {
    int checked = 0;
    int differing = 0;
    void operator()(double value, int decimals) {
        ++checked;
        const double quick = RoundToDecimals(value, decimals);
        const double text = detail::RoundThroughText(value, decimals);
        if (std::bit_cast<std::uint64_t>(quick) == std::bit_cast<std::uint64_t>(text)) return;
        if (++differing <= 10)
            ADD_FAILURE() << FormatShortest(value) << " to " << decimals
                          << " decimals: " << FormatShortest(quick) << " instead of " << FormatShortest(text);
    }
};

} // namespace

TEST(Numbers, RoundingIsBitForBitThatOfTheTextOnCoordinatesHalvesAndLimits) {
    RoundingCheck check;
    std::mt19937_64 random(20240611);
    std::uniform_real_distribution<double> exponent(-3.0, 7.0), unit(0.0, 1.0);
    std::uniform_int_distribution<int> decimals(0, 8), ulps(-6, 6);
    // Coordinates, distances and angles of every size a job holds, of both signs.
    for (int i = 0; i < 1000000; ++i) {
        const double value = std::pow(10.0, exponent(random)) * (unit(random) < 0.5 ? -1.0 : 1.0);
        check(value, decimals(random));
    }
    // Values written with one decimal more than kept, ending in 5, and their neighbours a few ulps
    // away: the product lands on a half, or just beside it, where the two ways could part.
    for (int i = 0; i < 400000; ++i) {
        const int n = decimals(random);
        const double tenths = std::floor(std::pow(10.0, exponent(random) + 1.0)) * 10.0 + 5.0;
        const double value = tenths / std::pow(10.0, n + 1) * (unit(random) < 0.5 ? -1.0 : 1.0);
        double nearby = value;
        for (int step = ulps(random); step != 0; step += step > 0 ? -1 : 1)
            nearby = std::nextafter(nearby, step > 0 ? INFINITY : -INFINITY);
        check(value, n);
        check(nearby, n);
    }
    // Exact halves: q / 2^(n+1), q odd, is the only kind of double that ends in a 5 just after its n-th
    // decimal (0.125 to 2 decimals, -2.5 to none). Then their neighbours, a binary digit off.
    for (int n = 0; n <= 8; ++n) {
        const double halves = std::ldexp(1.0, n + 1);
        std::uniform_int_distribution<long long> odd(0, static_cast<long long>(halves * 5e6));
        for (int i = 0; i < 4000; ++i) {
            const double value = static_cast<double>(2 * (i < 2000 ? i : odd(random)) + 1) / halves;
            for (double v : {value, -value, std::nextafter(value, 0.0), std::nextafter(value, INFINITY)})
                check(v, n);
        }
    }
    // Zeros, and magnitudes around 2^52 / 10^n where the quick way gives way to the text.
    for (int n = 0; n <= 25; ++n) {
        check(0.0, n);
        check(-0.0, n);
        const double limit = 0x1p52 / std::pow(10.0, n);
        for (double factor : {0.999, 0.9999999, 1.0, 1.0000001, 1.001}) {
            double value = limit * factor;
            for (int step = 0; step < 8; ++step) {
                check(value, n);
                check(-value, n);
                value = std::nextafter(value, INFINITY);
            }
        }
    }
    EXPECT_EQ(check.differing, 0) << "of " << check.checked;
}

namespace {

// Compares the shortest text of a value with to_chars's and the quick reading of a text with from_chars's,
// byte for byte and bit for bit; counts what the quick ways took on themselves.
struct ShortestCheck {
    long long checked = 0;
    long long quick = 0;
    int differing = 0;

    void Fail(const std::string& what) {
        if (++differing <= 10) ADD_FAILURE() << what;
    }
    void Write(double value) {
        ++checked;
        char expected[kShortestRoom];
        char written[kShortestRoom];
        char* expectedEnd =
            std::to_chars(expected, expected + sizeof expected, value, std::chars_format::fixed).ptr;
        char* writtenEnd = WriteShortest(written, value);
        quick += detail::WriteShortestQuick(written, value) != nullptr;
        const std::string want(expected, expectedEnd);
        if (std::string(written, writtenEnd) != want)
            Fail("written " + std::string(written, writtenEnd) + " instead of " + want);
        Read(want);
    }
    void Read(const std::string& text) {
        double expected = 0;
        const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), expected);
        double read = 0;
        if (!ReadDecimalQuick(text, read)) return;
        if (error != std::errc() || end != text.data() + text.size() ||
            std::bit_cast<std::uint64_t>(read) != std::bit_cast<std::uint64_t>(expected))
            Fail("read " + text + " as " + FormatShortest(read));
    }
};

} // namespace

TEST(Numbers, ShortestTextIsThatOfToCharsForEveryKindOfDouble) {
    ShortestCheck check;
    std::mt19937_64 random(20251125);
    std::uniform_real_distribution<double> exponent(-9.0, 17.0), unit(0.0, 1.0);
    std::uniform_int_distribution<int> decimals(0, 17), ulps(-3, 3);
    // Values rounded to their decimals (coordinates, angles, distances of every size and sign), their
    // neighbours a few ulps away, and doubles of any bits (subnormals, huge values, NaN, infinities).
    for (int i = 0; i < 600000; ++i) {
        const double value = std::pow(10.0, exponent(random)) * (unit(random) < 0.5 ? -1.0 : 1.0);
        const double rounded = detail::RoundThroughText(value, decimals(random));
        double nearby = rounded;
        for (int step = ulps(random); step != 0; step += step > 0 ? -1 : 1)
            nearby = std::nextafter(nearby, step > 0 ? INFINITY : -INFINITY);
        check.Write(rounded);
        check.Write(nearby);
        check.Write(value);
        check.Write(std::bit_cast<double>(random()));
    }
    // Survey values as a job holds them: a million coordinates to the millimetre and angles to 0.1 mgon.
    for (int i = 0; i < 1000000; ++i) {
        check.Write(RoundToDecimals(600000.0 + 400000.0 * unit(random), 3));
        check.Write(RoundToDecimals(-400.0 + 800.0 * unit(random), 5));
    }
    // Powers of ten and the doubles around them, where the count of digits changes; the limits of the
    // quick way (1e-7, 1e15, fifteen digits); zeros and the undefined value.
    for (int e = -330; e <= 310; ++e) {
        double up = std::pow(10.0, e);
        double down = up;
        for (int step = 0; step < 20; ++step) {
            for (double v : {up, down})
                for (double sign : {1.0, -1.0})
                    check.Write(sign * v);
            up = std::nextafter(up, INFINITY);
            down = std::nextafter(down, 0.0);
        }
    }
    for (double v : {0.0,
                     -0.0,
                     0.1,
                     0.2,
                     0.1 + 0.2,
                     1e-7,
                     -1e-7,
                     651234.5678,
                     -651234.5678,
                     kUndefined,
                     999999999999999.0,
                     999999999999999.9,
                     1e15,
                     1234567890123456.0,
                     0x1p53,
                     0x1p53 + 2.0,
                     123456.78901234567,
                     5e-324,
                     2.2250738585072014e-308,
                     1.7976931348623157e308,
                     double{INFINITY},
                     -double{INFINITY},
                     double{NAN}})
        check.Write(v);
    EXPECT_EQ(check.differing, 0) << "of " << check.checked;
    // The quick ways did take most values on themselves.
    EXPECT_GT(check.quick * 2, check.checked);
}

TEST(Numbers, QuickReadingIsThatOfFromCharsOrStandsAside) {
    ShortestCheck check;
    std::mt19937_64 random(7);
    std::uniform_int_distribution<int> length(0, 18), digit(0, 9), fraction(0, 24), sign(0, 3);
    for (int i = 0; i < 1000000; ++i) {
        std::string text = sign(random) == 0 ? "-" : "";
        for (int n = length(random); n > 0; --n)
            text += static_cast<char>('0' + digit(random));
        if (sign(random) != 0) {
            text += '.';
            for (int n = fraction(random); n > 0; --n)
                text += static_cast<char>('0' + digit(random));
        }
        check.Read(text);
    }
    EXPECT_EQ(check.differing, 0);
    double v = 7;
    for (const char* text : {"", "-", "+1", "1.", ".5", "-.5", "1e5", "1,5", " 1", "1 ", "0x1", "1.2.3",
                             "0.00000000000000000000001", "1234567890123456"}) {
        EXPECT_FALSE(ReadDecimalQuick(text, v)) << text;
        EXPECT_EQ(v, 7);
    }
    EXPECT_TRUE(ReadDecimalQuick("-0", v));
    EXPECT_TRUE(std::signbit(v) && v == 0);
    EXPECT_TRUE(ReadDecimalQuick("000651234.567800", v));
    EXPECT_EQ(v, 651234.5678);
    EXPECT_TRUE(ReadDecimalQuick("-999999", v));
    EXPECT_EQ(v, kUndefined);
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
