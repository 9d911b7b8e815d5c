#pragma once

#include <array>
#include <cstddef>
#include <string_view>

// The records of a Topcon GTS-7 / GTS-700 field book: a keyword in the first seven columns, then from
// the ninth the values separated by commas ("SD      74.39010,87.47000,2.1650").
namespace pyr::topcon {

enum class Keyword {
    Unknown,
    // Header of the job
    Job,
    Date,
    Name,
    Instrument,
    Units,
    Scale,
    Atmosphere,
    Temperature,
    Control,
    // Set-up
    Station,   // STN id,ih,code
    Position,  // XYZ E,N,Z of the station, of the backsight or of the point just measured
    Backsight, // BKB id,bearing,circle reading
    // Sightings, each followed by its observation
    BackSighting,  // BS id[,th]
    ForeSighting,  // FS id,th,code
    SideSighting,  // SS id,th,code
    AnglesOnly,    // HV ha,va
    SlopeDistance, // SD ha,va,sd
    Horizontal,    // HD ha,hd,vd
    Note,
    Offset
};

inline constexpr std::size_t kMaxFields = 8;

struct Record {
    std::string_view keyword; // as written
    Keyword kind = Keyword::Unknown;
    std::string_view values;                           // everything after the keyword, blanks trimmed
    std::array<std::string_view, kMaxFields> fields{}; // the values split at the commas, blanks trimmed
    std::size_t count = 0;                             // fields read (those beyond kMaxFields are dropped)

    // The field at `index`, or "" when the record has fewer.
    std::string_view Field(std::size_t index) const {
        return index < count ? fields[index] : std::string_view{};
    }
};

// Splits a line without blanks nor controls at its ends (TrimmedOfControls) into its keyword and values; the
// keyword is recognised whatever its case.
void SplitRecord(std::string_view line, Record& record);

} // namespace pyr::topcon
