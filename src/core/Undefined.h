#pragma once

namespace pyr {

// A real field, result or coordinate without a value holds this marker. It is compared exactly:
// every test for a missing value is `v == kUndefined`, and 0.0 is a value like any other.
inline constexpr double kUndefined = -999999.0;

constexpr bool IsUndefined(double value) {
    return value == kUndefined;
}
constexpr bool IsKnown(double value) {
    return value != kUndefined;
}

} // namespace pyr
