#pragma once

#include <string>
#include <string_view>

// The units in which instruments and field books write angles, and their conversion to and from the
// grads of a GéoBase. Every conversion keeps the undefined value (-999999) undefined where it takes an
// AngleUnit; the plain ones are arithmetic only.
namespace pyr {

enum class AngleUnit {
    Grads,   // 400 to the circle
    Degrees, // decimal degrees, 360 to the circle
    Dms,     // sexagesimal degrees written ddd.mmss (12.3045 is 12° 30' 45")
    Mils     // 6400 to the circle
};

inline constexpr double kGradsPerTurn = 400.0;
inline constexpr double kDegreesPerTurn = 360.0;
inline constexpr double kMilsPerTurn = 6400.0;

// Multiplying first keeps whole values exact: 45° is 18 000 / 360 = 50 gr, not 45 × 1.1111...
constexpr double DegreesToGrads(double degrees) {
    return degrees * kGradsPerTurn / kDegreesPerTurn;
}
constexpr double GradsToDegrees(double grads) {
    return grads * kDegreesPerTurn / kGradsPerTurn;
}
// 16 mils to the grad: a power of two, so both ways are exact.
constexpr double MilsToGrads(double mils) {
    return mils / (kMilsPerTurn / kGradsPerTurn);
}
constexpr double GradsToMils(double grads) {
    return grads * (kMilsPerTurn / kGradsPerTurn);
}

// Decimal degrees of whole degrees, minutes and seconds (the seconds may carry decimals).
constexpr double SexagesimalToDegrees(double degrees, double minutes, double seconds) {
    return degrees + minutes / 60.0 + seconds / 3600.0;
}

// Decimal degrees of an angle written ddd.mmss (a negative one keeps its sign); the seconds may carry
// decimals (12.304512 is 12° 30' 45.12").
double DmsToDegrees(double dms);
// The same from its text, digit by digit, so that no rounding of the binary value shifts a second:
// false when the text is no number. Minutes and seconds are not checked against 60.
bool DmsTextToDegrees(std::string_view text, double& degrees);

// The text ddd.mmss of decimal degrees, with `secondDecimals` (0 to 9) decimals of seconds after the
// four digits of minutes and seconds: 12.5125° with 2 is "12.304500". Rounding carries into the minutes
// and the degrees (59.9999" to 2 decimals is the next minute, never 60.00"); no wrap is made, so
// 359° 59' 59.7" to whole seconds is "360.0000". A value that rounds to zero has no minus sign.
std::string DegreesToDmsText(double degrees, int secondDecimals);
// ddd.mmss as a number, to a millionth of a second: read back exactly by DmsToDegrees.
double DegreesToDms(double degrees);

// An angle in `unit` brought to grads, and back.
double ToGrads(double angle, AngleUnit unit);
double FromGrads(double grads, AngleUnit unit);

// The text of an angle in `unit` read into grads, ddd.mmss digit by digit; the undefined value written
// out stays undefined. False when the text is no number.
bool AngleTextToGrads(std::string_view text, AngleUnit unit, double& grads);

} // namespace pyr
