#pragma once

#include "core/NameSet.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/LectWildBlock.h"
#include "fieldbook/ParamDriver.h"

#include <bitset>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace pyr {

// The reader of Wild / Leica GSI field books, GSI-8 and GSI-16 (docs/format-gsi.md). Each line is a
// block of words (LectWildWord.h) read into grads and metres (LectWildValues.h, LectWildBlock.h):
//  - a station is a block of words 84, 85, 86 (87, 88) named by its word 11, or a code block 41 whose
//    code is one of "CodesStation", 42 naming the station and 43 giving its instrument height (the
//    setting "ConventionStation" says which: auto, 84, 41); its coordinates make a point of its name;
//  - a block of observations (21, 22, 31, 32, 33) is a sighting of the station in force: a reference
//    when its point has coordinates in the field book or when "References" marks it (the first sighting
//    of each station, or a code among "CodesReference"), otherwise a measured sighting; the reflector
//    height (87) holds until the next one;
//  - a block of coordinates (81, 82, 83) without observations is a known point;
//  - codes (code blocks 41, words 71 to 79) are written in front of the sighting they go with;
//  - the instrument, dates and constants (12, 13, 17, 19, 51, 58, 59) become header comments;
//  - levelling staff readings (331, 335 back; 330, 332, 333, 336 fore) become levelling readings.
// A line that cannot be read is reported with its number; the reading goes on.
class CLectWild : public CFieldBookReader {
protected:
    void BeginReading() override;
    void ReadLine(std::string_view line, int number) override;

private:
    void ReadSettings();
    void HeaderComments();
    void Header(std::string& last, const char* label, std::string_view value);
    void Header(std::string& last, double& shown, const char* label, double value, const char* unit);
    void Warnings(int number);
    void ReadCodeBlock(int number);
    void ReadDataBlock(int number);
    void ReadPointOrStation(int number);
    void ReadSighting(int number);
    void ReadStaff(int number);

    bool OpenStation(std::string_view name, double hi, int number);
    bool AddPosition(std::string_view name, double first, double second, double elevation, bool known,
                     int number);
    void CheckInstrumentHeight(double hi, int number);
    void AddRemarks();
    bool IsReference(std::string_view point) const;

    // ---- Settings of the format ("Wild.ini")
    gsi::Units m_units;
    InstrumentSettings m_settings;
    StationConvention m_convention = StationConvention::Auto;
    std::vector<std::string> m_stationCodes;

    // ---- The line being read
    gsi::Block m_block;
    gsi::BlockContent m_content;
    std::string m_text;

    // ---- What holds from one line to the next
    CStation* m_station = nullptr; // the station in force (owned by the result)
    bool m_firstSighting = false;  // no sighting read yet since the station
    bool m_heightWarned = false;   // its differing instrument heights were said
    double m_reflector = kUndefined;
    std::string m_pendingCode; // the code of the last code block, for the next sighting
    NameSet m_known;           // points given with their planimetry
    bool m_started = false;
    std::string m_format, m_serial, m_type, m_date, m_dateTime, m_ppm, m_prism;
    double m_ppmShown = 0.0, m_prismShown = 0.0; // the values of m_ppm and m_prism (NaN: none yet)
    std::bitset<1000> m_wordWarned, m_unitWarned;
};

} // namespace pyr
