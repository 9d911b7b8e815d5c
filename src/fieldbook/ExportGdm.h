#pragma once

#include "fieldbook/PointExport.h"

#include <optional>

// The export of points to a Trimble GDM (Geodimeter) area file, one "label=value" a line, that the total
// stations load as coordinates (docs/format-gdm.md, "Export de points"): 5 the identifier, 4 the code,
// 38 the easting, 37 the northing, 39 the altitude, each point a block opened by its label 5.
namespace pyr {

namespace gdm {

// The settings file's section and keys ("Export_Gdm.ini").
inline constexpr const char* kKeyUniteDistances = "UniteDistances"; // metres or pieds
inline constexpr const char* kKeyDecimales = "Decimales";           // 0 to 8
inline constexpr const char* kKeyLabelUnites = "LabelUnites";       // 1: label 23 written, 0: not
inline constexpr const char* kKeyCode = "Code";                     // 1: label 4 written, 0: not

inline constexpr int kMaxExportDecimals = 8;

// The reason of a point left out that has neither planimetry nor altitude.

struct ExportSettings {
    bool feet = false;     // coordinates in international feet (else metres)
    int decimals = 3;      // of the coordinates, in their unit
    bool unitLabel = true; // label 23 heads the points written
    bool code = true;      // label 4 written when the point has a code
    bool crlf = true;      // lines ended by CR LF (else LF)
};

// The settings of the job's settings file; nothing, with the message shown, when a value cannot be used.
// An absent or empty key takes its default.
std::optional<ExportSettings> ReadExportSettings(const PointExportJob& job);

} // namespace gdm

// Writes the points of the job's scope to its file as an area file, replaced or completed, whole or not at
// all. False, nothing written, when the settings file is missing or wrong, or when the file cannot be
// written (the message said why). A point without identifier or coordinates is left out and said.
bool dll_ExportSpectra(const PointExportJob& job);

} // namespace pyr
