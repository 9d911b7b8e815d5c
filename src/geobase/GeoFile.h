#pragma once

#include <memory>
#include <string>
#include <string_view>

// The text layout of a GéoBase file: a header line, then one element a line, its kind code first and
// its fields separated by tabulations (see docs/format-geobase.md).
namespace pyr {

class CElement;

inline constexpr std::string_view kGeoHeader = "GEOBASE PYRALIS";
inline constexpr int kGeoFormatVersion = 1;

// How a GéoBase is offered in a file choice.
inline constexpr const char* kGeoFileFilter = "GéoBase PYRALIS (*.geo)|*.geo||";
inline constexpr const char* kGeoFileExtension = "geo";

// "GEOBASE PYRALIS\t1"
std::string GeoHeaderLine();
// The version of a header line, or 0 when the line is not a header.
int GeoHeaderVersion(std::string_view line);

// Appends the line of an element (without its end) to `out`.
void AppendElementLine(std::string& out, const CElement& element, int kind);
std::string ElementLine(const CElement& element, int kind);

// Reads one element line. On failure returns null and says why in `error` (French, for the text
// window). `lenient` accepts fields past the known ones (a file from a newer version of the program).
std::unique_ptr<CElement> ParseElementLine(std::string_view line, int& kind, std::string& error,
                                           bool lenient);

} // namespace pyr
