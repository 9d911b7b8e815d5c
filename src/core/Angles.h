#pragma once

// Angles in grads (400 to the circle). Conversions reduce the angle exactly before taking a sine or a
// cosine, so that cos(100 gr) is exactly 0 and sin(200 gr) exactly 0.
namespace pyr {

inline constexpr double kPi = 3.14159265358979323846;

constexpr double GradsToRadians(double grads) {
    return grads * kPi * 0.005;
}
constexpr double RadiansToGrads(double radians) {
    return radians / kPi * 200.0;
}

// Into [0, 400).
double WrapGrads(double grads);
// A difference of directions brought within [-200, 200] gr: a misclosure or a residual.
double CentredGrads(double grads);
// The value plus or minus a multiple of 400 that lies within 200 gr of the reference.
double NearGrads(double grads, double reference);

double SinGrads(double grads);
double CosGrads(double grads);
// Both at once, for the price of one: exact at every multiple of 100 gr.
void SinCosGrads(double grads, double& s, double& c);

// Bearing (gisement) from A to B: clockwise from the +Y axis (north), X being the easting, in
// [0, 400). Zero for two identical points.
double Bearing(double xa, double ya, double xb, double yb);

} // namespace pyr
