#include "core/Angles.h"
#include "core/FrenchDate.h"
#include "core/Numbers.h"
#include "core/Undefined.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <algorithm>

namespace pyr {

namespace {

constexpr int kMaxDecimals = 12;
constexpr const char* kUndefinedText = "-"; // a value never measured or computed

// The value with `decimals` decimals; a value that rounds to zero is written without a minus sign.
std::string Fixed(double value, int decimals) {
    return FormatFixedShown(value, std::clamp(decimals, 0, kMaxDecimals));
}

} // namespace

int CDlgCfgListing::Deci(int index, int storeDecimals) const {
    return m_deci[index] >= 0 ? m_deci[index] : storeDecimals;
}

int CDlgCfgListing::GetDeciCoor() const {
    return Deci(0, CPointGen::DeciXY());
}
int CDlgCfgListing::GetDeciAlti() const {
    return Deci(1, CPointGen::DeciZ());
}
int CDlgCfgListing::GetDeciDist() const {
    return Deci(2, CPointGen::DeciXY());
}
int CDlgCfgListing::GetDeciDeni() const {
    return Deci(3, CPointGen::DeciZ());
}
int CDlgCfgListing::GetDeciAngl() const {
    return Deci(4, CStation::DeciAng());
}

std::string CDlgCfgListing::FormatCoor(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    return Fixed(value, decimals < 0 ? GetDeciCoor() : decimals);
}

std::string CDlgCfgListing::FormatAlti(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    return Fixed(value, decimals < 0 ? GetDeciAlti() : decimals);
}

std::string CDlgCfgListing::FormatDist(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    return Fixed(value, decimals < 0 ? GetDeciDist() : decimals);
}

std::string CDlgCfgListing::FormatDeni(double value, int decimals) const {
    if (IsUndefined(value)) return kUndefinedText;
    std::string text = Fixed(value, decimals < 0 ? GetDeciDeni() : decimals);
    return text[0] == '-' ? text : "+" + text;
}

std::string CDlgCfgListing::FormatAngl(double value, int decimals, bool wrap) const {
    if (IsUndefined(value)) return kUndefinedText;
    const int n = std::clamp(decimals < 0 ? GetDeciAngl() : decimals, 0, kMaxDecimals);
    if (wrap) {
        value = WrapGrads(value);
        // 399.999996 gr shown with five decimals is a full turn: the direction is 0.
        if (RoundToDecimals(value, n) >= 400.0) value = 0.0;
    }
    return Fixed(value, n);
}

std::string CDlgCfgListing::FormatTime() {
    return FormatFrenchDateNow(kComputationDateFormat);
}

} // namespace pyr
