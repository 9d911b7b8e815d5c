#include "calc/Rays.h"

#include "core/Angles.h"

#include <cmath>

namespace pyr {

double IntersectionAngle(double g1, double g2) {
    // The bearings of a line and of its opposite differ by 200 gr: the difference taken modulo 200
    // measures the angle between the lines, and past 100 gr its supplement is the acute one.
    double a = std::fmod(g2 - g1 + 800.0, 200.0);
    if (a < 0.0) a += 200.0;
    return a > 100.0 ? 200.0 - a : a;
}

bool IntersectRays(double xa, double ya, double g1, double xb, double yb, double g2, double& x, double& y) {
    const double s = SinGrads(g1 - g2);
    if (std::fabs(s) < kParallelRaysSine) return false;
    const double l = ((xb - xa) * CosGrads(g2) - (yb - ya) * SinGrads(g2)) / s;
    x = xa + l * SinGrads(g1);
    y = ya + l * CosGrads(g1);
    return true;
}

} // namespace pyr
