#include "core/Angles.h"

#include <cmath>

namespace pyr {

double WrapGrads(double grads) {
    double wrapped = std::fmod(grads, 400.0);
    if (wrapped < 0) wrapped += 400.0;
    // fmod of a tiny negative value plus 400 rounds to 400 itself.
    return wrapped >= 400.0 ? 0.0 : wrapped;
}

double CentredGrads(double grads) {
    const double w = WrapGrads(grads);
    return w > 200.0 ? w - 400.0 : w;
}

double NearGrads(double grads, double reference) {
    double delta = WrapGrads(grads - reference);
    if (delta > 200.0) delta -= 400.0;
    return reference + delta;
}

// Reduced exactly to an octant first: the quadrant is taken out as a whole number of 100 gr, the
// remainder lies within [-50, 50] gr.
void SinCosGrads(double grads, double& s, double& c) {
    double r = std::remainder(grads, 400.0); // exact, in [-200, 200]
    double q = std::round(r / 100.0);        // quadrant -2..2
    r -= q * 100.0;                          // exact, in [-50, 50]
    double sr = std::sin(GradsToRadians(r));
    double cr = std::cos(GradsToRadians(r));
    if (r == 0.0) sr = 0.0, cr = 1.0;
    switch (static_cast<int>(q)) {
    case 0:
        s = sr, c = cr;
        break;
    case 1:
        s = cr, c = -sr;
        break;
    case -1:
        s = -cr, c = sr;
        break;
    default: // +2 or -2: half a turn
        s = -sr, c = -cr;
        break;
    }
    // A zero sine or cosine is +0, never -0.
    s += 0.0;
    c += 0.0;
}

double SinGrads(double grads) {
    double s, c;
    SinCosGrads(grads, s, c);
    return s;
}

double CosGrads(double grads) {
    double s, c;
    SinCosGrads(grads, s, c);
    return c;
}

double Bearing(double xa, double ya, double xb, double yb) {
    double dx = xb - xa;
    double dy = yb - ya;
    if (dx == 0.0 && dy == 0.0) return 0.0;
    return WrapGrads(RadiansToGrads(std::atan2(dx, dy)));
}

} // namespace pyr
