#pragma once

#include <cstddef>
#include <string>
#include <string_view>

// Numbers written to and read from files, always with the decimal point '.', whatever the user's
// locale: std::to_chars / std::from_chars never look at LC_NUMERIC.
namespace pyr {

// The value with that many decimals, as printf "%.*f" gives it in the C locale.
std::string FormatFixed(double value, int decimals);
// The same for a person to read (a listing, a dialog's field): a value that rounds to zero is written
// without its minus sign ("0.000", not "-0.000"), a residual of -0.00001 gr being no residual at all.
std::string FormatFixedShown(double value, int decimals);
// FormatFixedShown appended to `out`: the form of the numbers that exports write by the million.
void AppendFixedShown(std::string& out, double value, int decimals);

// The value as printf "%g" gives it in the C locale (six significant digits, trailing zeros dropped).
std::string FormatGeneral(double value);

// The shortest text that reads back as exactly the same double, without an exponent ("0.0003").
std::string FormatShortest(double value);
void AppendShortest(std::string& out, double value);
// The same text written at `out`, which has room for kShortestRoom characters (the smallest subnormal
// written out in full); returns its end.
inline constexpr std::size_t kShortestRoom = 512;
char* WriteShortest(char* out, double value);

// Rounds to n decimals the way the store does it: the double read back from the text "%.*f" writes,
// bit for bit, found without the text for the coordinates and angles of a job. The undefined value
// stays undefined.
double RoundToDecimals(double value, int decimals);

// The reading of a whole field of the form [-]digits[.digits] with at most fifteen significant digits,
// the form that numbers written by AppendShortest take (coordinates, angles, distances): the same double
// as std::from_chars, without its general way. False, `value` untouched, for any other text, which
// from_chars then reads.
bool ReadDecimalQuick(std::string_view text, double& value);

// Strict reading of a whole field: optional blanks around, an optional sign, the number, nothing else.
bool ParseDouble(std::string_view text, double& value);
bool ParseInt(std::string_view text, long long& value);

// The lenient readings of the C library's atof and atoi, locale-free: leading blanks are skipped, the
// longest prefix that is a number is read, and a text that does not start with a number reads as 0.
double LenientAtof(std::string_view text);
int LenientAtoi(std::string_view text);

namespace detail {
// The shortest text the quick way, for the values of at most fifteen significant digits between 1e-7 and
// 1e15 (coordinates, angles, distances rounded to their decimals): null, nothing written, for any other.
char* WriteShortestQuick(char* out, double value);
// RoundToDecimals the long way, through the decimal text: what its quick way must always agree with.
double RoundThroughText(double value, int decimals);
} // namespace detail

} // namespace pyr
