#pragma once

#include "fieldbook/FieldBookReader.h"
#include "fieldbook/LectZeissRecord.h"
#include "fieldbook/ParamDriver.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The reader of Trimble (Zeiss) field books, in their M5, R4, R5 and Rec 500 layouts (docs/format-zeiss.md).
// Each line is cut into its fields (LectZeissRecord.h), then:
//  - a text line names the program that follows ("KN STAT", "OR.COOR", "POLAR" ...), carries the
//    instrument and reflector heights (ih, th), the scale and orientation (m, Om), the weather (T, P), or
//    the instrument's header between "START" and "END" (type, serial number, axes of the coordinates);
//  - a point line whose code is the marker "S" is a station: its coordinates give a point of its name,
//    its instrument height is the last ih given;
//  - a point line with observations (Hz, V1 to V4, SD, HD, h) is a sighting of the station in force: a
//    reference while a set-up program runs (a text holding "STAT", "OR." or "ORIENT", or "RESECT"), or
//    when the settings "References" mark it; otherwise a measured sighting;
//  - a point line with coordinates only (X, Y, Z) is a known point.
// X is the northing and Y the easting unless the header or "OrdreCoordonnees" say otherwise; E and N are
// what they say. A unit written beside a value wins over the settings. Lines that cannot be read are
// reported with their number; the reading goes on.
class CLectZeiss : public CFieldBookReader {
protected:
    void BeginReading() override;
    void ReadLine(std::string_view line, int number) override;

private:
    struct Values;

    void ReadSettings();
    bool Split(std::string_view line, int number);
    bool ReadValues(int number, Values& values);
    void ReadTextRecord(const Values& values);
    void ReadHeaderWord(std::string_view type, std::string_view text);
    void ReadPoint(const Values& values, int number);
    void ReadStation(const Values& values, int number);
    void ReadSighting(const Values& values, int number);
    const std::string& PointCode();
    bool AddPosition(std::string_view name, const Values& values, bool keepCode, int number);
    bool OpenStation(std::string_view name, int number);
    void SetInstrumentHeight(double hi);
    void Header(std::string& last, const char* label, std::string_view value);
    bool IsReference() const;
    void WarnOnce(std::vector<std::string>& said, const char* format, std::string_view what, int number);

    // ---- Settings of the format ("Zeiss.ini"), and what the file's header changes of them
    InstrumentSettings m_settings;
    bool m_xNorth = true; // the file's X is the northing

    // ---- The line being read
    zeiss::Record m_record;
    zeiss::Layout m_layout = zeiss::Layout::Unknown; // of the file, from its first line that says it
    zeiss::InfoPlaces m_places;

    // ---- What holds from one line to the next
    CStation* m_station = nullptr; // the station in force (owned by the result)
    bool m_sighted = false;        // a sighting was read since the station
    bool m_settingUp = false;      // the station's set-up lines go on (no sighting, no program since)
    bool m_setUp = false;          // a set-up program runs: its sightings are references
    bool m_knownStation = false;   // a known-station set-up: the next stations are oriented
    double m_hi = kUndefined;      // the last instrument height
    double m_reflector = kUndefined;
    std::string m_text;
    std::vector<std::string> m_typesSaid, m_unitsSaid;
    std::string m_instrument, m_serial, m_version, m_axes, m_scale, m_orientation, m_temperature, m_pressure;
    bool m_started = false;
};

// The reader of the format "Zeiss".
std::unique_ptr<CFieldBookReader> MakeZeissReader();

} // namespace pyr
