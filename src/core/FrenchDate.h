#pragma once

#include <ctime>
#include <string>
#include <string_view>

namespace pyr {

// How the journals and the listings date a computation: "lundi 03 mars 2025 à 09 h 05 mn".
inline constexpr const char* kComputationDateFormat = "%A %d %B %Y à %H h %M mn";

// A date written with strftime's conversions but French day and month names, whatever the user's
// locale: "%A %d %B %Y à %H h %M mn" gives "lundi 03 mars 2025 à 09 h 05 mn". Understood: %A %a (day),
// %B %b (month), %d %m %Y %y %H %M %S, %%; any other text is copied as it is.
std::string FormatFrenchDate(std::string_view format, const std::tm& when);
// The same for the present local time.
std::string FormatFrenchDateNow(std::string_view format);
// The present local time.
std::tm LocalTimeNow();

} // namespace pyr
