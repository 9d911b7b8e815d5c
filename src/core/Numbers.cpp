#include "Numbers.h"

#include "Strings.h"
#include "Undefined.h"

#include <algorithm>
#include <charconv>
#include <climits>
#include <cmath>
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
    const auto result = std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed, decimals);
    const char* first = buffer;
    const char* last = result.ptr;
    if (*first == '-' && std::all_of(first + 1, last, [](char c) { return c == '0' || c == '.'; }))
        ++first;
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

void AppendShortest(std::string& out, double value) {
    char buffer[512]; // room for the smallest subnormal written out in full
    auto result = std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed);
    out.append(buffer, result.ptr);
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
