#include "fieldbook/LectWildValues.h"

#include "core/AngleUnits.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Matricule.h"

namespace pyr::gsi {

namespace {

// Digits of a GSI word: 16 at most, so that 18 always fit in a long long.
constexpr std::size_t kMaxDigits = 18;

constexpr double kPowersOfTen[] = {1.0, 1e1, 1e2, 1e3, 1e4, 1e5, 1e6, 1e7, 1e8, 1e9};
// 1 foot = 0.3048 m: a length in feet with n decimals is N × 3048 / 10^(n + 4) metres.
constexpr double kTenThousandthsOfMetrePerFoot = 3048.0;

char AngleDigit(AngleUnit unit) {
    switch (unit) {
    case AngleUnit::Grads:
        return '2';
    case AngleUnit::Degrees:
        return '3';
    case AngleUnit::Dms:
        return '4';
    case AngleUnit::Mils:
        return '5';
    }
    return '2';
}

char LengthDigit(DistanceUnit unit) {
    return unit == DistanceUnit::Feet ? '1' : '0';
}

AngleUnit AngleUnitOf(char digit) {
    switch (digit) {
    case '3':
        return AngleUnit::Degrees;
    case '4':
        return AngleUnit::Dms;
    case '5':
        return AngleUnit::Mils;
    default:
        return AngleUnit::Grads;
    }
}

int LengthDecimals(char digit) {
    switch (digit) {
    case '6':
    case '7':
        return 4;
    case '8':
        return 5;
    default:
        return 3;
    }
}

bool IsFeet(char digit) {
    return digit == '1' || digit == '7';
}

// The data of a word without its blanks: Missing when nothing or dashes remain. Its value is `digits`
// (to be scaled by its unit's decimals), or `written` when it has a decimal point.
struct Number {
    Value status = Value::Read;
    std::string_view text;
    bool point = false;
    long long digits = 0; // without a decimal point
    double written = 0.0; // with one
};

Number NoNumber(Value status) {
    Number number;
    number.status = status;
    return number;
}

Number ReadNumber(std::string_view data) {
    Number number;
    number.text = Trimmed(data);
    const std::string_view text = number.text;
    if (text.empty()) return NoNumber(Value::Missing);
    if (text.size() > kMaxDigits)
        return NoNumber(text.find('-') != std::string_view::npos ? Value::Missing : Value::Bad);
    // One pass over the digits, the way nearly every value is written; anything else is looked at
    // again: a dash anywhere means no value, a decimal point a value written as a number.
    long long value = 0;
    for (char c : text) {
        const unsigned digit = static_cast<unsigned>(c - '0');
        if (digit > 9) {
            if (text.find('-') != std::string_view::npos) return NoNumber(Value::Missing);
            if (text.find('.') == std::string_view::npos || !ParseDouble(text, number.written) ||
                text.front() == '+')
                return NoNumber(Value::Bad);
            number.point = true;
            return number;
        }
        value = value * 10 + digit;
    }
    number.digits = value;
    return number;
}

double Signed(const Word& word, double value) {
    return word.sign == '-' ? -value : value;
}

} // namespace

bool IsAngleUnit(char unit) {
    return unit >= '2' && unit <= '5';
}

bool IsLengthUnit(char unit) {
    return unit == '0' || unit == '1' || (unit >= '6' && unit <= '8');
}

// The grads of the digits of an angle word in the unit of that digit; false for a DDD.MMSSs whose
// minutes reach 60 or seconds pass 60. The instruments round 59.96" up to 60.0" without carrying it into
// the minutes: that reading is the next minute, as the instrument means it. The digits are scaled to the
// unit first, as the same word written with its decimal point is read, so that both agree to the bit.
bool DigitsToGrads(long long n, char unit, double& grads) {
    switch (unit) {
    case '3': // 1e-5 degree
        grads = DegreesToGrads(static_cast<double>(n) / 1e5);
        return true;
    case '4': { // DDD.MMSSs: tenths of a second
        const long long tenths = n % 1000;
        const long long minutes = n / 1000 % 100;
        if (minutes >= 60 || tenths > 600) return false;
        grads =
            DegreesToGrads(SexagesimalToDegrees(static_cast<double>(n / 100000), static_cast<double>(minutes),
                                                static_cast<double>(tenths) / 10.0));
        return true;
    }
    case '5': // 1e-4 mil
        grads = MilsToGrads(static_cast<double>(n) / 1e4);
        return true;
    default: // 1e-5 grad
        grads = static_cast<double>(n) / 1e5;
        return true;
    }
}

Value ReadAngle(const Word& word, AngleUnit fallback, double& grads) {
    const char unit = IsAngleUnit(word.unit) ? word.unit : AngleDigit(fallback);
    const Number number = ReadNumber(word.data);
    if (number.status != Value::Read) return number.status;
    double value = 0.0;
    if (!number.point) {
        if (!DigitsToGrads(number.digits, unit, value)) return Value::Bad;
    } else if (!AngleTextToGrads(number.text, AngleUnitOf(unit), value)) {
        return Value::Bad;
    }
    grads = Signed(word, value);
    return Value::Read;
}

Value ReadLength(const Word& word, DistanceUnit fallback, double& metres) {
    const char unit = IsLengthUnit(word.unit) ? word.unit : LengthDigit(fallback);
    const Number number = ReadNumber(word.data);
    if (number.status != Value::Read) return number.status;
    const int decimals = LengthDecimals(unit);
    const double n = static_cast<double>(number.digits);
    double value = 0.0;
    if (number.point)
        value = IsFeet(unit) ? number.written * kMetresPerFoot : number.written;
    else
        value = IsFeet(unit) ? n * kTenThousandthsOfMetrePerFoot / kPowersOfTen[decimals + 4]
                             : n / kPowersOfTen[decimals];
    metres = Signed(word, value);
    return Value::Read;
}

Value ReadScaled(const Word& word, int decimals, double& value) {
    const Number number = ReadNumber(word.data);
    if (number.status != Value::Read) return number.status;
    if (IsLengthUnit(word.unit)) decimals = LengthDecimals(word.unit);
    value = Signed(word, number.point ? number.written
                                      : static_cast<double>(number.digits) / kPowersOfTen[decimals]);
    return Value::Read;
}

Value ReadPpmAndPrism(const Word& word, double& ppm, double& prismMm) {
    const std::string_view text = Trimmed(word.data);
    std::size_t split = 1;
    while (split < text.size() && text[split] != '+' && text[split] != '-')
        ++split;
    if (split >= text.size()) return text.find('-') == std::string_view::npos ? Value::Bad : Value::Missing;
    long long ppmDigits = 0, prismDigits = 0;
    if (!ParseInt(text.substr(0, split), ppmDigits) || text[0] == '+' || text[0] == '-' ||
        !ParseInt(text.substr(split + 1), prismDigits) || text[split + 1] == '+' || text[split + 1] == '-')
        return text.find("--") == std::string_view::npos ? Value::Bad : Value::Missing;
    ppm = Signed(word, static_cast<double>(ppmDigits));
    prismMm = static_cast<double>(text[split] == '-' ? -prismDigits : prismDigits);
    return Value::Read;
}

std::string_view WordText(const Word& word) {
    return FormMatView(word.data);
}

} // namespace pyr::gsi
