#pragma once

#include <string>
#include <string_view>

// The last GéoBase used, kept in the current parameter file: read by every command before its dialog
// opens, written back when a GéoBase has been chosen or created.
namespace pyr {

inline constexpr const char* kSectionGeoBase = "GeoBase";
inline constexpr const char* kKeyLastGeoBase = "Derniere";

// Empty when none was recorded.
std::string ReadLastGeoBase(std::string_view paramPath);
bool WriteLastGeoBase(std::string_view paramPath, std::string_view geoBase);

} // namespace pyr
