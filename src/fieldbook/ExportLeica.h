#pragma once

#include "fieldbook/PointExport.h"

#include <optional>

// The export of points to a GSI coordinate file that Leica and Wild total stations load as a job
// (docs/format-gsi.md, "Export de points"). One block a point: word 11 its identifier, 81 the easting,
// 82 the northing, 83 the altitude, 71 its code. Nothing is cut or rounded beyond the unit chosen: a
// point whose identifier, code or coordinates do not fit in the words is left out and said.
namespace pyr {

namespace gsi {

// The settings file's section and keys ("Export_Leica.ini").
inline constexpr const char* kKeyFormatGsi = "FormatGsi";           // 8 or 16
inline constexpr const char* kKeyUniteLongueurs = "UniteLongueurs"; // the unit digit: 0, 1, 6, 7, 8
inline constexpr const char* kKeyCode = "Code";                     // 1: word 71 written, 0: not

// The reasons of a point left out that only this format has.

} // namespace gsi

class CDlgConfigLeica {
public:
    struct Settings {
        bool gsi16 = true;
        char unit = '0';  // the unit digit of the lengths: 0 mm, 6 0.1 mm, 8 0.01 mm, 1 ft/1000, 7 ft/10000
        bool code = true; // word 71 written when the point has a code
        bool crlf = true; // lines ended by CR LF (else LF)
    };

    // The settings of the job's settings file; nothing, with the message shown, when a value cannot be
    // used. An absent or empty key takes its default.
    static std::optional<Settings> ReadSettings(const PointExportJob& job);

    // Writes the points of the job's scope to its file, replaced or completed, whole or not at all.
    // False, nothing written, when the settings file is missing or wrong, or when the file cannot be
    // written (the message said why). Points that the words cannot hold are left out and said.
    static bool Export(const PointExportJob& job);
};

} // namespace pyr
