#include "calc/Tolerances.h"

#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "settings/CalcOptions.h"

#include <algorithm>
#include <cmath>

namespace pyr {

namespace {

constexpr const char* kKeyMode = "TypeTolerance";
constexpr const char* kKeyAngle = "TolAngles";
constexpr const char* kKeyDistance = "TolDistances";
constexpr const char* kKeyHeight = "TolAltitudes";

} // namespace

double DistanceTolerance(double distance) {
    return (distance * 0.001 + 3.0) * 0.01;
}

double V0Tolerance(int referenceCount, double directionTolerance) {
    if (referenceCount < 1) return 0.0;
    const double n = referenceCount;
    return std::sqrt((n - 1.0) / n) * directionTolerance;
}

double HeightDifferenceTolerance(double distance, double sinZ, double cosZ, HeightToleranceTerms terms) {
    const double d = distance * 0.001;
    return 0.01 * std::sqrt((d + 3.0) * (d + 3.0) * sinZ * sinZ + d * d * cosZ * cosZ * terms.c1 +
                            d * d * d * d / terms.c2 + 4.0);
}

double HeightDifferenceTolerance(double distance, double zenith, HeightToleranceTerms terms) {
    double s = 0.0, c = 0.0;
    SinCosGrads(zenith, s, c);
    return HeightDifferenceTolerance(distance, s, c, terms);
}

Tolerances Tolerances::FromOptions(std::string_view paramPath) {
    Tolerances tolerances;
    tolerances.mode =
        static_cast<ToleranceMode>(std::clamp(ReadOptionInt(paramPath, kSectionTolerances, kKeyMode), 0, 2));
    tolerances.customAngle = ReadOptionReal(paramPath, kSectionTolerances, kKeyAngle);
    tolerances.customDistance = ReadOptionReal(paramPath, kSectionTolerances, kKeyDistance);
    tolerances.customHeight = ReadOptionReal(paramPath, kSectionTolerances, kKeyHeight);
    return tolerances;
}

double Tolerances::Distance(double distance) const {
    return mode == ToleranceMode::Custom ? customDistance : DistanceTolerance(distance);
}

double Tolerances::V0(int referenceCount) const {
    switch (mode) {
    case ToleranceMode::Custom:
        return customAngle;
    case ToleranceMode::Precise:
        return V0Tolerance(referenceCount, kV0TolerancePrecise);
    case ToleranceMode::Normal:
        break;
    }
    return V0Tolerance(referenceCount, kV0ToleranceNormal);
}

double Tolerances::HeightDifference(double distance, double zenith, HeightToleranceTerms terms) const {
    return mode == ToleranceMode::Custom ? customHeight : HeightDifferenceTolerance(distance, zenith, terms);
}

double Tolerances::HeightDifference(double distance, double sinZ, double cosZ,
                                    HeightToleranceTerms terms) const {
    return mode == ToleranceMode::Custom ? customHeight
                                         : HeightDifferenceTolerance(distance, sinZ, cosZ, terms);
}

std::vector<std::string> Tolerances::Describe(HeightToleranceTerms terms) const {
    if (mode == ToleranceMode::Custom)
        return {"Tolérances personnalisées :", "  angles     : " + FormatFixed(customAngle, 4) + " Gr",
                "  distances  : " + FormatFixed(customDistance, 3) + " m",
                "  dénivelées : " + FormatFixed(customHeight, 3) + " m"};
    const double direction = mode == ToleranceMode::Precise ? kV0TolerancePrecise : kV0ToleranceNormal;
    return {mode == ToleranceMode::Precise ? "Tolérances de précision :" : "Tolérances normales :",
            "  V0 sur n références : " + FormatFixed(direction, 4) + " Gr x racine((n - 1) / n)",
            "  distances           : (3 + D / 1000) cm",
            Sprintf("  dénivelées          : 0.01 x racine((d + 3)² sin²z + %g d² cos²z + d⁴ / %g + 4) m, "
                    "d = D / 1000",
                    terms.c1, terms.c2)};
}

} // namespace pyr
