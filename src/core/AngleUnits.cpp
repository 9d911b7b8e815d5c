#include "core/AngleUnits.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/Undefined.h"

#include <algorithm>
#include <cmath>

namespace pyr {

namespace {

// Decimals of seconds that a ddd.mmss number holds and that DmsToDegrees reads back: four digits of
// minutes and seconds and six of seconds make ten decimals, well within the 15 significant digits of a
// double for any angle up to a few turns.
constexpr int kDmsNumberSecondDecimals = 6;
constexpr int kMaxSecondDecimals = 9;

// A count that is not negative, written with leading zeros to `width` digits.
void AppendDigits(std::string& text, long long value, int width) {
    const std::string digits = std::to_string(value);
    if (static_cast<int>(digits.size()) < width) text.append(width - digits.size(), '0');
    text += digits;
}

} // namespace

double DmsToDegrees(double dms) {
    const double magnitude = std::fabs(dms);
    // The value is read as text with enough digits to hold a millionth of a second, so that 12.3045
    // (held as 12.30449999...) gives 45" and not 44.99999".
    double degrees = 0.0;
    DmsTextToDegrees(FormatFixed(magnitude, 4 + kDmsNumberSecondDecimals), degrees);
    return dms < 0.0 ? -degrees : degrees;
}

bool DmsTextToDegrees(std::string_view text, double& degrees) {
    text = Trimmed(text);
    double check = 0.0;
    if (!ParseDouble(text, check)) return false;
    bool negative = false;
    if (!text.empty() && (text.front() == '-' || text.front() == '+')) {
        negative = text.front() == '-';
        text.remove_prefix(1);
    }
    const std::size_t point = text.find('.');
    const std::string_view whole = text.substr(0, point);
    std::string fraction(point == std::string_view::npos ? std::string_view() : text.substr(point + 1));
    fraction.resize(std::max<std::size_t>(fraction.size(), 4), '0');
    long long wholeDegrees = 0;
    if (!whole.empty() && !ParseInt(whole, wholeDegrees)) return false;
    long long minutes = 0;
    double seconds = 0.0;
    ParseInt(std::string_view(fraction).substr(0, 2), minutes);
    std::string secondsText = fraction.substr(2, 2);
    if (fraction.size() > 4) secondsText += "." + fraction.substr(4);
    ParseDouble(secondsText, seconds);
    degrees = SexagesimalToDegrees(static_cast<double>(wholeDegrees), static_cast<double>(minutes), seconds);
    if (negative) degrees = -degrees;
    return true;
}

std::string DegreesToDmsText(double degrees, int secondDecimals) {
    const int decimals = std::clamp(secondDecimals, 0, kMaxSecondDecimals);
    if (!std::isfinite(degrees)) return FormatFixed(degrees, 4 + decimals);
    long long perSecond = 1;
    for (int i = 0; i < decimals; ++i)
        perSecond *= 10;
    const long long perMinute = 60 * perSecond;
    const long long perDegree = 60 * perMinute;
    // The whole degrees apart, so that the fraction, exact, is rounded once in units of the last
    // decimal of a second; a rounding up to a whole degree carries into the degrees.
    const double magnitude = std::fabs(degrees);
    double whole = std::floor(magnitude);
    long long units = std::llround((magnitude - whole) * static_cast<double>(perDegree));
    if (units >= perDegree) {
        whole += 1.0;
        units -= perDegree;
    }
    std::string text = degrees < 0.0 && (whole > 0.0 || units > 0) ? "-" : "";
    text += FormatFixed(whole, 0);
    text += '.';
    AppendDigits(text, units / perMinute, 2);
    AppendDigits(text, units % perMinute, 2 + decimals);
    return text;
}

double DegreesToDms(double degrees) {
    double dms = 0.0;
    ParseDouble(DegreesToDmsText(degrees, kDmsNumberSecondDecimals), dms);
    return dms;
}

double ToGrads(double angle, AngleUnit unit) {
    if (IsUndefined(angle)) return angle;
    switch (unit) {
    case AngleUnit::Grads:
        return angle;
    case AngleUnit::Degrees:
        return DegreesToGrads(angle);
    case AngleUnit::Dms:
        return DegreesToGrads(DmsToDegrees(angle));
    case AngleUnit::Mils:
        return MilsToGrads(angle);
    }
    return angle;
}

double FromGrads(double grads, AngleUnit unit) {
    if (IsUndefined(grads)) return grads;
    switch (unit) {
    case AngleUnit::Grads:
        return grads;
    case AngleUnit::Degrees:
        return GradsToDegrees(grads);
    case AngleUnit::Dms:
        return DegreesToDms(GradsToDegrees(grads));
    case AngleUnit::Mils:
        return GradsToMils(grads);
    }
    return grads;
}

bool AngleTextToGrads(std::string_view text, AngleUnit unit, double& grads) {
    double value = 0.0;
    if (unit == AngleUnit::Dms) {
        if (!DmsTextToDegrees(text, value)) return false;
        unit = AngleUnit::Degrees;
    } else if (!ParseDouble(text, value)) {
        return false;
    }
    grads = ToGrads(value, unit);
    return true;
}

} // namespace pyr
