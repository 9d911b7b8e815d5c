#include "calc/Corrections.h"

#include "core/Angles.h"
#include "core/Undefined.h"
#include "settings/CalcOptions.h"

#include <cmath>

namespace pyr {

bool ReduceToFaceLeft(double& ah, double& av) {
    if (av < 200.0 || av > 400.0) return false;
    av = 400.0 - av;
    if (ah != kUndefined) ah = WrapGrads(ah + 200.0);
    return true;
}

void ReduceEccentricSighting(double& ah, double& av, double& di, double& hp, double er, double et, double ev,
                             bool foldVertical) {
    if ((er != 0.0 || et != 0.0) && av != kUndefined && di > 0.0) {
        const double z = GradsToRadians(av);
        const double h = std::sin(z) * di + er; // horizontal distance, lengthened by the radial offset
        const double v = std::cos(z) * di;
        const double horizontal = std::hypot(h, et);
        if (horizontal > 0.0 || v != 0.0) {
            av = 100.0 - RadiansToGrads(std::atan(v / horizontal));
            di = std::hypot(horizontal, v);
            // A target exactly over the station (h = 0) is seen across: a quarter turn aside.
            if (ah != kUndefined && (h != 0.0 || et != 0.0))
                ah = WrapGrads(RadiansToGrads(std::atan(et / h)) + ah);
        }
    }
    if (ev == 0.0) return;
    if (foldVertical && av != kUndefined && di > 0.0) {
        const double z = GradsToRadians(av);
        const double h = std::sin(z) * di;
        const double v = std::cos(z) * di;
        av = RadiansToGrads(std::atan2(h, v + ev));
        di = std::sqrt(di * di + 2.0 * di * ev * std::cos(z) + ev * ev);
        return;
    }
    if (hp != kUndefined) hp -= ev;
}

DistanceCorrection DistanceCorrection::FromOptions(std::string_view paramPath) {
    DistanceCorrection correction;
    correction.automatic = ReadOptionSwitch(paramPath, kSectionCorrections, "CorrAuto");
    correction.linearAlteration = ReadOptionReal(paramPath, kSectionCorrections, "AlterLineaire");
    correction.levelReduction = ReadOptionReal(paramPath, kSectionCorrections, "CorrNivZero");
    correction.projection =
        std::make_shared<const CProjection>(ReadOptionText(paramPath, kSectionCorrections, "Projection"),
                                            ReadOptionReal(paramPath, kSectionCorrections, "RayonTerre"));
    return correction;
}

std::string DistanceCorrection::ProjectionError() const {
    if (!automatic || !projection) return {};
    return projection->Error();
}

void CorrectHorizontalDistance(double& dh, double x, double y, double z,
                               const DistanceCorrection& correction) {
    if (!(dh > 0.0)) return;
    double alteration = correction.linearAlteration;
    double reduction = correction.levelReduction;
    if (correction.automatic) {
        alteration = 0.0;
        reduction = 0.0;
        if (correction.projection) {
            if (x != kUndefined && y != kUndefined) alteration = correction.projection->CalcLinearAlter(x, y);
            if (z != kUndefined) reduction = correction.projection->CalcEllipsReduc(x, y, z, 1);
        }
    }
    dh *= 1.0 + (alteration + reduction) * 1e-6;
}

} // namespace pyr
