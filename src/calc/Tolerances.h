#pragma once

#include <string>
#include <string_view>
#include <vector>

// The tolerances against which the computations check their observations: the gap between a measured
// and a computed horizontal distance, the spread of the partial orientations of a station, and the gap
// between a measured and a computed height difference. Angles in grads, lengths in metres.
namespace pyr {

// What "TypeTolerance" of the tolerance options selects.
enum class ToleranceMode {
    Normal = 0,  // the tolerances of ordinary surveying work
    Precise = 1, // precise work: the orientation tolerance of 0.0018 gr instead of 0.0043 gr
    Custom = 2   // "&Personnalisées": "TolAngles", "TolDistances", "TolAltitudes" as they stand
};

// The orientation tolerance of one direction, in grads, for ordinary and precise work.
inline constexpr double kV0ToleranceNormal = 0.0043;
inline constexpr double kV0TolerancePrecise = 0.0018;

// The two weights of the height-difference tolerance: the distance term across the line of sight (c1)
// and the divisor of the fourth-power term (c2).
struct HeightToleranceTerms {
    double c1;
    double c2;
};
// The orientation of stations checks its references with (80, 1); the points computed by intersection
// and resection check their heights with (40, 2).
inline constexpr HeightToleranceTerms kHeightTermsV0{80.0, 1.0};
inline constexpr HeightToleranceTerms kHeightTermsPoints{40.0, 2.0};

// T_D: (D / 1000 + 3) cm for a horizontal distance D in metres.
double DistanceTolerance(double distance);
// T_V0: sqrt((n - 1) / n) times the tolerance of one direction (kV0ToleranceNormal or Precise), for the
// mean of n partial orientations; 0 for fewer than one.
double V0Tolerance(int referenceCount, double directionTolerance);
// The height-difference tolerance of a sighting of horizontal distance D (metres) and zenith angle z
// (grads): with d = D / 1000,
// 0.01 x sqrt((d + 3)^2 sin^2 z + d^2 cos^2 z c1 + d^4 / c2 + 4) metres.
double HeightDifferenceTolerance(double distance, double zenith, HeightToleranceTerms terms);
// The same from the sine and cosine of z, when the sighting's reduction has them already.
double HeightDifferenceTolerance(double distance, double sinZ, double cosZ, HeightToleranceTerms terms);

// The tolerances as the options of section "Options_Tolerances" set them.
struct Tolerances {
    ToleranceMode mode = ToleranceMode::Normal;
    double customAngle = 0.01;    // "TolAngles", grads
    double customDistance = 0.01; // "TolDistances", metres
    double customHeight = 0.01;   // "TolAltitudes", metres

    static Tolerances FromOptions(std::string_view paramPath);

    double Distance(double distance) const;
    double V0(int referenceCount) const;
    double HeightDifference(double distance, double zenith, HeightToleranceTerms terms) const;
    double HeightDifference(double distance, double sinZ, double cosZ, HeightToleranceTerms terms) const;

    // The lines that describe them at the head of a listing.
    std::vector<std::string> Describe(HeightToleranceTerms terms) const;
};

} // namespace pyr
