#pragma once

#include "projection/Projection.h"

#include <memory>
#include <string>
#include <string_view>

// The corrections every computation applies to a sighting before it uses it: the turn of a face-right
// sighting to face left, the reduction of a sighting on an eccentric target to its point, and the
// scale correction of a horizontal distance. Angles in grads, lengths in metres; an unknown value is
// kUndefined and is left as it is.
namespace pyr {

// Turns a face-right sighting (200 <= AV <= 400) to face left: AV becomes 400 - AV and a known AH moves
// by 200. A zenith angle of exactly 200 counts as face right: AH turns, AV stays 200. True when the
// sighting was turned.
bool ReduceToFaceLeft(double& ah, double& av);

// A zenith angle as a height difference uses it, in [0, 200] gr: one read face right is folded, 400 - AV.
constexpr double FoldedZenith(double av) {
    return av > 200.0 ? 400.0 - av : av;
}

// Reduces a sighting on an eccentric target to the point itself. The radial offset ER lies along the
// line of sight (positive beyond the target), the tangential offset ET across it (positive to the right
// of the line of sight, seen from the station), the vertical offset EV upwards; all in metres.
// With `foldVertical`, EV is folded into AV and DI (the target height stays); otherwise it is taken
// off a known HP.
void ReduceEccentricSighting(double& ah, double& av, double& di, double& hp, double er, double et, double ev,
                             bool foldVertical);

// The combined curvature and refraction term of a trigonometric height difference over a horizontal
// distance Dh, in metres: Dh² (1 - k) / 2R with k = 0.16 and R = 6 384 km, that is 0.84 / 12 768 000 Dh².
constexpr double CurvatureRefraction(double dh) {
    return dh * dh * 6.578947368421052e-08;
}

// The scale correction of horizontal distances, as the corrections options set it.
struct DistanceCorrection {
    bool automatic = false;        // "CorrAuto": from the projection and the height of the place
    double linearAlteration = 0.0; // "AlterLineaire", mm/km, the manual form
    double levelReduction = 0.0;   // "CorrNivZero", mm/km, the manual form
    std::shared_ptr<const CProjection> projection; // "Projection", with "RayonTerre"

    // Reads the options of the parameter file (or registry root).
    static DistanceCorrection FromOptions(std::string_view paramPath);
    // The French reason why the automatic form cannot use the projection named in the options, or "".
    std::string ProjectionError() const;
};

// Corrects a horizontal distance Dh (> 0, else untouched) measured at (X, Y, Z), any of them possibly
// unknown: Dh x (1 + (A + N) x 10^-6), A the linear alteration and N the reduction to the level surface
// in parts per million. The manual form takes both from the options; the automatic form computes A at
// (X, Y) when both are known and N at height Z when it is known (0 otherwise).
void CorrectHorizontalDistance(double& dh, double x, double y, double z,
                               const DistanceCorrection& correction);

} // namespace pyr
