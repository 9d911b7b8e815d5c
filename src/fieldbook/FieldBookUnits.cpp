#include "fieldbook/FieldBookUnits.h"

#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/Undefined.h"

#include <algorithm>
#include <cmath>
#include <string>

namespace pyr {

double DmsToDegrees(double dms) {
    const double magnitude = std::fabs(dms);
    // The value is read as text with enough digits to hold tenths of a thousandth of a second, so that
    // 12.3045 (held as 12.30449999...) gives 45" and not 44.99999".
    double degrees = 0.0;
    DmsTextToDegrees(FormatFixed(magnitude, 10), degrees);
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
    degrees = static_cast<double>(wholeDegrees) + static_cast<double>(minutes) / 60.0 + seconds / 3600.0;
    if (negative) degrees = -degrees;
    return true;
}

double ToGrads(double angle, AngleUnit unit) {
    if (IsUndefined(angle)) return angle;
    switch (unit) {
    case AngleUnit::Grads:
        return angle;
    case AngleUnit::Degrees:
        return angle * 400.0 / 360.0;
    case AngleUnit::Dms:
        return DmsToDegrees(angle) * 400.0 / 360.0;
    case AngleUnit::Mils:
        return angle * 400.0 / 6400.0;
    }
    return angle;
}

double ToMetres(double length, DistanceUnit unit) {
    if (IsUndefined(length) || unit == DistanceUnit::Metres) return length;
    return length * kMetresPerFoot;
}

void SlopeFromHorizontal(double horizontal, double heightDifference, double& zenith, double& slope) {
    // A zenith angle this close to 0 or 200 gr gives no horizontal distance to divide by.
    constexpr double kVerticalSine = 1e-9;
    constexpr double kHorizontalSighting = 100.0; // gr
    if (IsKnown(slope) || IsUndefined(horizontal)) return;
    const double sine = IsKnown(zenith) ? std::fabs(SinGrads(zenith)) : 0.0;
    if (sine > kVerticalSine) {
        slope = horizontal / sine;
    } else if (IsUndefined(zenith) && IsKnown(heightDifference)) {
        slope = std::hypot(horizontal, heightDifference);
        if (slope > 0.0) zenith = RadiansToGrads(std::atan2(horizontal, heightDifference));
    } else if (IsUndefined(zenith)) {
        zenith = kHorizontalSighting;
        slope = horizontal;
    }
}

} // namespace pyr
