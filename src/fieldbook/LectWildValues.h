#pragma once

#include "fieldbook/FieldBookUnits.h"
#include "fieldbook/LectWildWord.h"

#include <string_view>

// The values of GSI words brought to grads and metres. The unit digit of a word says how to read its
// data, which carries no decimal point:
//   angles   2 grads (5 decimals), 3 decimal degrees (5), 4 sexagesimal DDD.MMSSs (5, the last digit
//            tenths of a second), 5 mils (4);
//   lengths  0 metre (3 decimals, mm), 1 foot (3), 6 metre (4, 0.1 mm), 7 foot (4), 8 metre (5, 0.01 mm).
// A word without a unit digit (or with one of the other kind) is read in the unit of the format's
// settings, with the decimals that unit has in a GSI word. A value written with a decimal point is read
// as written. Each value is computed from its digits with a single rounding.
namespace pyr::gsi {

enum class Value {
    Read,    // the value was read
    Missing, // the word says it has no value: dashes ("+00000000000-----") or blanks
    Bad      // the data is no number
};

// The units a field book's words fall back on: those of the format's settings.
struct Units {
    AngleUnit angles = AngleUnit::Grads;
    DistanceUnit distances = DistanceUnit::Metres;
};

// Whether the unit digit is one of the angles, or one of the lengths.
bool IsAngleUnit(char unit);
bool IsLengthUnit(char unit);

Value ReadAngle(const Word& word, AngleUnit fallback, double& grads);
Value ReadLength(const Word& word, DistanceUnit fallback, double& metres);
// A number with the decimals of the word's length unit, `decimals` without one, unconverted (ppm).
Value ReadScaled(const Word& word, int decimals, double& value);

// Word 51: the ppm correction and the prism constant in one field, "+0000+034" (0 ppm, +34 mm).
Value ReadPpmAndPrism(const Word& word, double& ppm, double& prismMm);

// The text of a word (a point id, a code, an information): blanks around and the zeros that pad it
// on the left dropped, as every identifier of a GéoBase is written. "00000000" gives "0".
std::string_view WordText(const Word& word);

} // namespace pyr::gsi
