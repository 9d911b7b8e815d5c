#pragma once

#include "core/NameSet.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/FieldBookUnits.h"
#include "fieldbook/ParamDriver.h"

#include <array>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace pyr {

// The reader of Nikon comma field books (docs/format-nikon.md), the same for the three Nikon entries.
// Two writings are recognised record by record, so that a file may even hold both:
//  - the raw format V2.00: a record type then its fields, "CO" declarations and comments, coordinates
//    (UP, MP, CC, RE, MC), stations (ST), backsight shots (F1, F2), side shots (SS), check and set-out
//    shots (CP, SO); a type starting with "*" is a superseded record and is skipped;
//  - the older DTM-series format: "state, type, units, id[-hi], values..., target height", a type 0
//    being an observation and 1 to 3 coordinates; an identifier followed by "-" and the instrument
//    height sets up a station on that point.
// Angles are brought to grads, vertical angles to zenith angles, lengths to metres; a unit, a vertical
// zero or an axis order that the file declares wins over the settings of the parameter file.
class CLectNikon : public CFieldBookReader {
private:
    // The fields of one record, blanks trimmed, as views into the line.
    static constexpr std::size_t kMaxFields = 16;
    struct Fields {
        std::array<std::string_view, kMaxFields> at;
        std::size_t count = 0;
        std::string_view operator[](std::size_t i) const { return i < count ? at[i] : std::string_view(); }
    };
    static void Split(std::string_view line, Fields& fields);

protected:
    void BeginReading() override;
    void ReadLine(std::string_view line, int number) override;

private:
    void ReadSettings();
    void Started(const char* format);

    // ---- Raw format V2.00
    void ReadComment(std::string_view text, int number);
    bool ReadDeclaration(std::string_view key, std::string_view value, int number);
    void ReadCoordinates(int number);
    void ReadStation(int number);
    void ReadShot(int number, bool backsight);

    // ---- DTM-series format
    void ReadDtm(int number);

    // ---- Shared
    bool Length(std::string_view text, DistanceUnit unit, double& metres, int number) const;
    bool Angle(std::string_view text, AngleUnit unit, double& grads, int number) const;
    bool Zenith(std::string_view text, AngleUnit unit, bool fromZenith, double& grads, int number) const;
    bool OpenStation(std::string_view name, double hi, int number, double v0 = kUndefined);
    bool StationInForce(int number);
    bool AddPosition(std::string_view name, double first, double second, double elevation,
                     std::string_view code, int number);
    void AddSighting(std::string_view point, bool reference, double hp, double ah, double av, double di,
                     std::string_view code, int number);
    bool IsReference(std::string_view point, std::string_view code) const;

    // ---- Settings of the parameter file, then what the field book declares
    InstrumentSettings m_settings;
    bool m_zeroAtZenith = true; // vertical angles read from the zenith (else from the horizon)

    // ---- The line being read
    Fields m_fields;

    // ---- What holds from one line to the next
    bool m_hasStation = false;
    std::string m_station;    // the station in force
    std::string m_backsight;  // its backsight point, as the station record names it
    bool m_onAzimuth = false; // it names none but gives the azimuth and reading: its V0 is known
    bool m_firstSighting = false;
    NameSet m_known; // points given with their planimetry
    bool m_started = false;
    bool m_rawStarted = false;
    bool m_dtmStarted = false;
};

// The reader of Nikon raw V2.00 and DTM-series comma field books (the three Nikon entries).
std::unique_ptr<CFieldBookReader> MakeNikonReader();

} // namespace pyr
