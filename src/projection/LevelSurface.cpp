#include "projection/LevelSurface.h"

#include <cmath>

namespace pyr {

double GaussianMeanRadius(double semiMajorAxisMetre, double flattening, double latitudeRadian) {
    // rho = a (1 - e2) / W^3 and N = a / W with W = sqrt(1 - e2 sin2 phi): sqrt(rho N) = a sqrt(1 - e2) / W2.
    const double e2 = flattening * (2.0 - flattening);
    const double sinPhi = std::sin(latitudeRadian);
    return semiMajorAxisMetre * std::sqrt(1.0 - e2) / (1.0 - e2 * sinPhi * sinPhi);
}

double LevelSurfaceReductionPpm(double heightMetre, double radiusMetre, int direction) {
    // A height at or below the centre of the earth is no height: no reduction rather than an infinity.
    if (!(radiusMetre > 0.0) || !(radiusMetre + heightMetre > 0.0)) return 0.0;
    if (direction >= 0) return -heightMetre / (radiusMetre + heightMetre) * 1e6;
    return heightMetre / radiusMetre * 1e6;
}

} // namespace pyr
