#include "core/Angles.h"
#include "core/FrenchDate.h"
#include "core/Numbers.h"
#include "core/Undefined.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace pyr {

namespace {

constexpr int kMaxDecimals = 12;
constexpr const char* kUndefinedText = "-"; // a value never measured or computed

// Decimals written without the general conversion, and the powers of ten they scale by (exact doubles).
constexpr int kQuickDecimals = 9;
constexpr double kPowersOfTen[kQuickDecimals + 1] = {1e0, 1e1, 1e2, 1e3, 1e4, 1e5, 1e6, 1e7, 1e8, 1e9};
// Below 2^52, a double's units are exact and its halves too.
constexpr double kQuickLimit = 4503599627370496.0;

// `magnitude` × 10^decimals rounded to an integer as its exact decimal expansion gives it, ties to the
// even one: the digits of the text with `decimals` decimals, without the point. False when the value is
// too big or not finite, or has too many decimals: the general conversion then writes it.
bool ScaledDigits(double magnitude, int decimals, std::uint64_t& digits) {
    if (decimals > kQuickDecimals) return false;
    const double scale = kPowersOfTen[decimals];
    const double product = magnitude * scale;
    if (!(product < kQuickLimit)) return false;
    // The product rounded lost `error`: product + error is the exact one.
    const double error = std::fma(magnitude, scale, -product);
    const double nearest = std::nearbyint(product); // ties to even
    const double fraction = product - nearest;      // exact
    double rounded = nearest;
    // Only a product half-way between two integers can be moved by what the rounding lost; exactly
    // half-way, the nearest integer chosen is the even one.
    if (fraction == 0.5 && error > 0.0) rounded += 1.0;
    if (fraction == -0.5 && error < 0.0) rounded -= 1.0;
    digits = static_cast<std::uint64_t>(rounded);
    return true;
}

// The value with `decimals` decimals; a value that rounds to zero is written without a minus sign.
// Listings write millions of numbers: those of usual size are written from their digits directly.
std::string Fixed(double value, int decimals) {
    decimals = std::clamp(decimals, 0, kMaxDecimals);
    std::uint64_t digits = 0;
    if (!ScaledDigits(std::fabs(value), decimals, digits)) return FormatFixedShown(value, decimals);
    char text[32];
    char* const end = text + sizeof text;
    char* p = end;
    const bool minus = std::signbit(value) && digits != 0;
    for (int i = 0; i < decimals; ++i, digits /= 10)
        *--p = static_cast<char>('0' + digits % 10);
    if (decimals > 0) *--p = '.';
    do {
        *--p = static_cast<char>('0' + digits % 10);
        digits /= 10;
    } while (digits != 0);
    if (minus) *--p = '-';
    return std::string(p, end);
}

// Whether a direction in [0, 400) gr shows as 400 with that many decimals.
bool ShowsAsFullTurn(double value, int decimals) {
    std::uint64_t digits = 0;
    if (value >= 0.0 && ScaledDigits(value, decimals, digits))
        return digits >= 400 * static_cast<std::uint64_t>(kPowersOfTen[decimals]);
    return RoundToDecimals(value, decimals) >= 400.0;
}

} // namespace

int CDlgCfgListing::Deci(int index, int storeDecimals) const {
    return m_deci[index] >= 0 ? m_deci[index] : storeDecimals;
}

int CDlgCfgListing::GetDeciCoor() const {
    return Deci(0, CPointGen::DeciXY());
}
int CDlgCfgListing::GetDeciAlti() const {
    return Deci(1, CPointGen::DeciZ());
}
int CDlgCfgListing::GetDeciDist() const {
    return Deci(2, CPointGen::DeciXY());
}
int CDlgCfgListing::GetDeciDeni() const {
    return Deci(3, CPointGen::DeciZ());
}
int CDlgCfgListing::GetDeciAngl() const {
    return Deci(4, CStation::DeciAng());
}

std::string CDlgCfgListing::FormatCoor(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    return Fixed(value, decimals < 0 ? GetDeciCoor() : decimals);
}

std::string CDlgCfgListing::FormatAlti(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    return Fixed(value, decimals < 0 ? GetDeciAlti() : decimals);
}

std::string CDlgCfgListing::FormatDist(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    return Fixed(value, decimals < 0 ? GetDeciDist() : decimals);
}

std::string CDlgCfgListing::FormatDeni(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    std::string text = Fixed(value, decimals < 0 ? GetDeciDeni() : decimals);
    return text[0] == '-' ? text : "+" + text;
}

std::string CDlgCfgListing::FormatAngl(double value, int decimals, bool wrap) const {
    if (IsUndefined(value)) return kUndefinedText;
    const int n = std::clamp(decimals < 0 ? GetDeciAngl() : decimals, 0, kMaxDecimals);
    if (wrap) {
        value = WrapGrads(value);
        // 399.999996 gr shown with five decimals is a full turn: the direction is 0.
        if (ShowsAsFullTurn(value, n)) value = 0.0;
    }
    return Fixed(value, n);
}

std::string CDlgCfgListing::FormatTime() {
    return FormatFrenchDateNow(kComputationDateFormat);
}

} // namespace pyr
