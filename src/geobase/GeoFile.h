#pragma once

#include <cstddef>
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

// What the lines of a file say of it. A GéoBase has its header line, or at least half of its lines read as
// elements (a file of an older version, or one put together by hand). A raw field book, a coordinate list
// or a text has neither: the loader still shows its lines (as comments), but no save may replace it, since
// it holds what a GéoBase cannot give back.
struct GeoFileCensus {
    bool header = false;
    long long lines = 0;      // the lines that are neither blank nor a header
    long long unreadable = 0; // those of them that read as no element

    void Line(bool readable) {
        ++lines;
        if (!readable) ++unreadable;
    }
    bool IsForeign() const { return !header && unreadable > 0 && unreadable * 2 > lines; }
};

// A line of blanks and tabulations only: it carries nothing and is skipped.
bool IsBlankGeoLine(std::string_view line);

// The census of a file's text, whatever its encoding (the kinds that tell a line are ASCII).
GeoFileCensus TakeGeoFileCensus(std::string_view text);

// Appends the line of an element (without its end) to `out`.
void AppendElementLine(std::string& out, const CElement& element, int kind);
// The same line written at `out`, which has room for ElementLineBound(element, kind) bytes; returns its
// end. A store of a million elements is written through it without a copy.
char* WriteElementLine(char* out, const CElement& element, int kind);
size_t ElementLineBound(const CElement& element, int kind);
std::string ElementLine(const CElement& element, int kind);

// Reads one element line. On failure returns null and says why in `error` (French, for the text
// window). `lenient` accepts fields past the known ones (a file from a newer version of the program).
std::unique_ptr<CElement> ParseElementLine(std::string_view line, int& kind, std::string& error,
                                           bool lenient);

} // namespace pyr
