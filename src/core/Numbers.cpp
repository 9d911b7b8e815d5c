#include "Numbers.h"

#include "Strings.h"
#include "Undefined.h"

#include <algorithm>
#include <bit>
#include <charconv>
#include <climits>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <vector>

namespace pyr {

namespace {

bool IsBlank(char c) {
    return c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\f' || c == '\v';
}

// A fixed format of a huge value needs about 310 digits before the point; the usual precisions fit on the
// stack, so that formatting a million coordinates allocates nothing but the strings returned.
constexpr int kStackPrecision = 64;
constexpr std::size_t kStackBuffer = 400 + kStackPrecision;

std::string ToChars(double value, std::chars_format format, int precision) {
    if (precision <= kStackPrecision) {
        char buffer[kStackBuffer];
        auto result = std::to_chars(buffer, buffer + sizeof buffer, value, format, precision);
        return std::string(buffer, result.ptr);
    }
    std::vector<char> buffer(static_cast<size_t>(400 + precision));
    auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value, format, precision);
    return std::string(buffer.data(), result.ptr);
}

// 10^0 to 10^22: the powers of ten that a double holds exactly.
constexpr double kExactPowersOfTen[] = {1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                        1e8,  1e9,  1e10, 1e11, 1e12, 1e13, 1e14, 1e15,
                                        1e16, 1e17, 1e18, 1e19, 1e20, 1e21, 1e22};
constexpr double kTwoTo52 = 4503599627370496.0;

// 10^-8 to 10^15, to find how many digits a value has before its decimal point (those below one are
// the nearest doubles, close enough for that).
constexpr double kPowersOfTenFromMinus8[] = {1e-8, 1e-7, 1e-6, 1e-5, 1e-4, 1e-3, 1e-2, 1e-1,
                                             1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                             1e8,  1e9,  1e10, 1e11, 1e12, 1e13, 1e14, 1e15};

constexpr char kDigitPairs[] =
    "00010203040506070809101112131415161718192021222324252627282930313233343536373839"
    "40414243444546474849505152535455565758596061626364656667686970717273747576777879"
    "8081828384858687888990919293949596979899";

// Eight characters '0' in a word.
constexpr std::uint64_t kZeroCharacters = 0x3030303030303030;

// Eight decimal digits of a number under 10^8, leading zeros included, as the eight characters of a word
// in the order of memory (the first in the lowest byte): four digits a half, two a quarter, one a byte,
// every part divided at once by multiplications exact for numbers that small.
std::uint64_t EightDigits(std::uint32_t value) {
    std::uint64_t parts = (value / 10000) | (static_cast<std::uint64_t>(value % 10000) << 32);
    std::uint64_t tens = ((parts * 10486) >> 20) & 0x0000007F0000007F; // quarters: / 100
    parts = ((parts - tens * 100) << 16) | tens;
    tens = ((parts * 103) >> 10) & 0x000F000F000F000F; // bytes: / 10
    parts = ((parts - tens * 10) << 8) | tens;
    return parts | kZeroCharacters;
}

// The characters '0' that end the eight of a word.
int ZeroCharactersAtEnd(std::uint64_t characters) {
    return std::countl_zero(characters ^ kZeroCharacters) / 8;
}

} // namespace

std::string FormatFixed(double value, int decimals) {
    if (decimals < 0) decimals = 6;
    return ToChars(value, std::chars_format::fixed, decimals);
}

std::string FormatFixedShown(double value, int decimals) {
    std::string text = FormatFixed(value, decimals);
    if (text[0] == '-' && text.find_first_not_of("-0.") == std::string::npos) text.erase(0, 1);
    return text;
}

void AppendFixedShown(std::string& out, double value, int decimals) {
    if (decimals < 0) decimals = 6;
    if (decimals > kStackPrecision) {
        out += FormatFixedShown(value, decimals);
        return;
    }
    char buffer[kStackBuffer];
    const auto result =
        std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed, decimals);
    const char* first = buffer;
    const char* last = result.ptr;
    if (*first == '-' && std::all_of(first + 1, last, [](char c) { return c == '0' || c == '.'; })) ++first;
    out.append(first, last);
}

std::string FormatGeneral(double value) {
    return ToChars(value, std::chars_format::general, 6);
}

std::string FormatShortest(double value) {
    std::string text;
    AppendShortest(text, value);
    return text;
}

char* WriteShortest(char* out, double value) {
    if (char* end = detail::WriteShortestQuick(out, value)) return end;
    return std::to_chars(out, out + kShortestRoom, value, std::chars_format::fixed).ptr;
}

void AppendShortest(std::string& out, double value) {
    char buffer[kShortestRoom];
    out.append(buffer, WriteShortest(buffer, value));
}

double RoundToDecimals(double value, int decimals) {
    if (IsUndefined(value) || !std::isfinite(value)) return value;
    if (decimals < 0) decimals = 6;
    if (static_cast<std::size_t>(decimals) < std::size(kExactPowersOfTen)) {
        const double scale = kExactPowersOfTen[decimals];
        // |value| × 10^n, rounded once to the nearest double.
        const double scaled = std::fabs(value * scale);
        if (scaled < kTwoTo52) {
            // The nearest integer, exact: beside 2^52 a double has no room for a fraction.
            const double whole = (scaled + kTwoTo52) - kTwoTo52;
            // Below 2^52 every half-integer is a double, and rounding keeps the order: the exact product
            // and its double lie on the same side of any half, and round to the same integer, the one the
            // text shows; whole / 10^n, the correctly rounded quotient of two exact values, is then the
            // double nearest to the text, the one reading it gives. A double that is itself a half may be
            // the rounding of a product on either side of it: the text settles it.
            if (std::fabs(scaled - whole) != 0.5) return std::copysign(whole, value) / scale;
        }
    }
    return detail::RoundThroughText(value, decimals);
}

namespace detail {

char* WriteShortestQuick(char* out, double value) {
    // The digits are put together in words in the order of a little-endian memory.
    if constexpr (std::endian::native != std::endian::little) return nullptr;
    if (value == 0) {
        if (std::signbit(value)) *out++ = '-';
        *out++ = '0';
        return out;
    }
    const double magnitude = std::fabs(value);
    // Outside [1e-7, 1e15), or not finite: the general way.
    if (!(magnitude >= 1e-7 && magnitude < 1e15)) return nullptr;
    // The decimals that bring the value to fifteen digits, 15 - k where 10^(k-1) <= magnitude < 10^k:
    // k first guessed from the binary exponent, at most one too small, then set right.
    const int binaryExponent = static_cast<int>(std::bit_cast<std::uint64_t>(magnitude) >> 52) - 1023;
    int k = ((binaryExponent * 1233) >> 12) + 1; // 1233 / 4096 just above log10(2)
    k += magnitude >= kPowersOfTenFromMinus8[k + 8];
    int decimals = 15 - k;
    if (decimals < 0 || decimals > 22) return nullptr;
    // Below 10^15 a double's spacing is under a fifth of a unit of the fifteenth digit: the product is
    // within a quarter of the integer nearest to the exact value, and at most one number of that many
    // decimals reads back as the value, the one whose digits are those of the shortest text.
    const double product = magnitude * kExactPowersOfTen[decimals];
    if (!(product < 1e15)) return nullptr;
    // The nearest integer, exact: beside 2^52 a double has no room for a fraction.
    const double scaled = (product + kTwoTo52) - kTwoTo52;
    // Both exact (an integer below 2^53, a power of ten up to 10^22): the quotient is rounded as reading
    // the text rounds it.
    if (scaled / kExactPowersOfTen[decimals] != magnitude) return nullptr;
    const auto digits = static_cast<std::uint64_t>(scaled);
    // Its sixteen digits (the first is a zero) as sixteen characters in a pair of words, built and
    // written out without going through memory: the digits of the text are a part of them.
    const std::uint64_t high = EightDigits(static_cast<std::uint32_t>(digits / 100000000));
    const std::uint64_t low = EightDigits(static_cast<std::uint32_t>(digits % 100000000));
    const unsigned __int128 all = (static_cast<unsigned __int128>(low) << 64) | high;
    // The decimals of the text end at its last digit other than zero (one stands among the last
    // fifteen digits: the integer is at least 10^14).
    const int zeros = low != kZeroCharacters ? ZeroCharactersAtEnd(low) : 8 + ZeroCharactersAtEnd(high);
    const int shown = decimals - zeros;
    *out = '-';
    out += value < 0;
    if (k >= 1) {
        // k digits, the point, the decimals: 15 digits after the leading zero, the decimals moved by one.
        const unsigned __int128 whole = all >> 8;
        const unsigned __int128 fraction = k < 15 ? all >> (8 * (k + 1)) : 0; // none from 10^14 up
        std::memcpy(out, &whole, 16);
        out[k] = '.';
        std::memcpy(out + k + 1, &fraction, 16);
        return out + k + (shown > 0 ? 1 + shown : 0);
    }
    // Under one: "0.", the zeros that 15 digits leave, then the digits.
    const unsigned __int128 significant = all >> 8;
    std::memcpy(out, "0.", 2);
    std::memcpy(out + 2, &kZeroCharacters, 8);
    std::memcpy(out + 2 - k, &significant, 16);
    return out + 2 + shown;
}

double RoundThroughText(double value, int decimals) {
    if (IsUndefined(value) || !std::isfinite(value)) return value;
    if (decimals < 0) decimals = 6;
    double rounded = value;
    if (decimals <= kStackPrecision) {
        char buffer[kStackBuffer];
        auto result =
            std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed, decimals);
        std::from_chars(buffer, result.ptr, rounded);
        return rounded;
    }
    ParseDouble(FormatFixed(value, decimals), rounded);
    return rounded;
}

} // namespace detail

bool ReadDecimalQuick(std::string_view text, double& value) {
    const char* c = text.data();
    const char* const end = c + text.size();
    const bool negative = c != end && *c == '-';
    c += negative;
    std::uint64_t digits = 0;
    int count = 0; // significant digits, leading zeros not counted
    int decimals = 0;
    const char* const wholeStart = c;
    for (; c != end && static_cast<unsigned char>(*c - '0') < 10; ++c) {
        digits = digits * 10 + static_cast<unsigned>(*c - '0');
        count += digits != 0;
    }
    if (c == wholeStart) return false;
    if (c != end) {
        if (*c != '.') return false;
        const char* const fractionStart = ++c;
        for (; c != end && static_cast<unsigned char>(*c - '0') < 10; ++c) {
            digits = digits * 10 + static_cast<unsigned>(*c - '0');
            count += digits != 0;
        }
        decimals = static_cast<int>(c - fractionStart);
        if (c != end || decimals == 0) return false;
    }
    // An integer below 10^15 and a power of ten up to 10^22 are exact doubles: their quotient is the
    // double nearest to the decimal value, the one from_chars gives.
    if (count > 15 || decimals >= static_cast<int>(std::size(kExactPowersOfTen))) return false;
    const double magnitude = static_cast<double>(digits) / kExactPowersOfTen[decimals];
    value = negative ? -magnitude : magnitude;
    return true;
}

bool ParseDouble(std::string_view text, double& value) {
    text = Trimmed(text);
    if (!text.empty() && text.front() == '+') text.remove_prefix(1);
    if (text.empty()) return false;
    double parsed = 0;
    auto [ptr, ec] = std::from_chars(text.data(), text.data() + text.size(), parsed);
    if (ec != std::errc() || ptr != text.data() + text.size()) return false;
    value = parsed;
    return true;
}

bool ParseInt(std::string_view text, long long& value) {
    text = Trimmed(text);
    if (!text.empty() && text.front() == '+') text.remove_prefix(1);
    if (text.empty()) return false;
    long long parsed = 0;
    auto [ptr, ec] = std::from_chars(text.data(), text.data() + text.size(), parsed);
    if (ec != std::errc() || ptr != text.data() + text.size()) return false;
    value = parsed;
    return true;
}

double LenientAtof(std::string_view text) {
    while (!text.empty() && IsBlank(text.front()))
        text.remove_prefix(1);
    bool negative = false;
    if (!text.empty() && (text.front() == '+' || text.front() == '-')) {
        negative = text.front() == '-';
        text.remove_prefix(1);
    }
    // from_chars would read a second sign; atof does not.
    if (text.empty() || text.front() == '+' || text.front() == '-') return 0.0;
    double parsed = 0;
    auto [ptr, ec] = std::from_chars(text.data(), text.data() + text.size(), parsed);
    if (ec == std::errc::result_out_of_range)
        parsed = HUGE_VAL; // the magnitude only matters to the clamping that follows
    else if (ec != std::errc())
        return 0.0;
    return negative ? -parsed : parsed;
}

int LenientAtoi(std::string_view text) {
    while (!text.empty() && IsBlank(text.front()))
        text.remove_prefix(1);
    bool negative = false;
    if (!text.empty() && (text.front() == '+' || text.front() == '-')) {
        negative = text.front() == '-';
        text.remove_prefix(1);
    }
    long long parsed = 0;
    for (char c : text) {
        if (c < '0' || c > '9') break;
        parsed = parsed * 10 + (c - '0');
        if (parsed > static_cast<long long>(INT_MAX) + 1) break;
    }
    if (negative) parsed = -parsed;
    if (parsed > INT_MAX) return INT_MAX;
    if (parsed < INT_MIN) return INT_MIN;
    return static_cast<int>(parsed);
}

} // namespace pyr
