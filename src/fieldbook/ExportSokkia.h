#pragma once

#include "fieldbook/PointExport.h"

#include <optional>

// The export of points to an SDR coordinate file (SDR33 or SDR2x) that Sokkia total stations and data
// collectors load as a job (docs/format-sokkia.md, "Export de points"): a header record 00 stating the
// units and the coordinate order, then one record 08 (keyboard input, KI) a point: identifier, the two
// coordinates in the stated order, altitude, description (its code). Fixed widths: a point whose
// identifier, code or coordinates do not fit in their fields is left out and said, never cut.
namespace pyr {

namespace sdr {

// The settings file's section and keys ("Export_Sokkia.ini").
inline constexpr const char* kKeyFormat = "Format";                     // SDR33 or SDR2x
inline constexpr const char* kKeyUniteDistances = "UniteDistances";     // metres or pieds
inline constexpr const char* kKeyOrdreCoordonnees = "OrdreCoordonnees"; // YX (N-E-Z) or XY (E-N-Z)
inline constexpr const char* kKeyDecimales = "Decimales";               // 0 to 8
inline constexpr const char* kKeyCode = "Code";                         // 1: description written, 0: not
inline constexpr const char* kKeyEncadrement = "Encadrement";           // 1: STX ... ETX and checksum

inline constexpr int kMaxExportDecimals = 8;
// The identifier characters that an SDR33 collector keeps of its 16-character field.
inline constexpr int kSdr33IdLength = 14;
inline constexpr int kSdr2xIdLength = 4;
inline constexpr int kDescriptionWidth = 16;

// The reasons of a point left out that only this format has.
inline constexpr const char* kWhyIdNotNumeric =
    "matricule non numérique (le SDR2x ne connaît que des numéros)";

struct ExportSettings {
    bool sdr33 = true;
    bool feet = false;      // lengths in international feet (else metres)
    bool northFirst = true; // N-E-Z (else E-N-Z)
    int decimals = 4;       // of the coordinates, in their unit
    bool code = true;       // the point's code written as its description
    bool framed = false;    // STX first, ETX and the checksum last
    bool crlf = true;       // lines ended by CR LF (else LF)
};

// The settings of the job's settings file; nothing, with the message shown, when a value cannot be used.
// An absent or empty key takes its default.
std::optional<ExportSettings> ReadExportSettings(const PointExportJob& job);

} // namespace sdr

class DlgCfgSok {
public:
    // Writes the points of the job's scope to its file, replaced or completed (the header record heads a
    // new or empty file only), whole or not at all. False, nothing written, when the settings file is
    // missing or wrong, or when the file cannot be written (the message said why).
    static bool Export(const PointExportJob& job);
};

} // namespace pyr
