#include "fieldbook/FieldBookUnits.h"

#include "core/Angles.h"
#include "core/Undefined.h"

#include <cmath>

namespace pyr {

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
