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
//    when the settings "References" mark it; otherwise a measured sighting. The sightings of a set-up
//    program written before its station line are that station's;
//  - a point line with coordinates only (X, Y, Z) is a known point, unless it follows a sighting of the
//    same point: it is then the instrument's computation of that sighting.
// In an M5 book, the places of the point id and code in the information block come from the header or,
// without it, from the point lines themselves: the lines are held until enough point lines are seen.
// X is the northing and Y the easting unless the header or "OrdreCoordonnees" say otherwise; E and N are
// what they say. A unit written beside a value wins over the settings. Lines that cannot be read are
// reported with their number; the reading goes on.
class CLectZeiss : public CFieldBookReader {
protected:
    void BeginReading() override;
    void ReadLine(std::string_view line, int number) override;
    void EndReading() override;

private:
    // The values of one line in grads and metres, kUndefined where the line gives none.
    struct Values {
        double hz = kUndefined, zenith = kUndefined;
        double slope = kUndefined, horizontal = kUndefined, heightDifference = kUndefined;
        double east = kUndefined, north = kUndefined, elevation = kUndefined;
        double reflector = kUndefined, instrument = kUndefined;

        bool HasObservation() const {
            return IsKnown(hz) || IsKnown(zenith) || IsKnown(slope) || IsKnown(horizontal);
        }
        bool HasPosition() const { return IsKnown(east) || IsKnown(north) || IsKnown(elevation); }
    };
    // A sighting as read, with what it needs to be written later.
    struct Sighting {
        std::string point;
        std::string code;  // as written: the reference codes are compared with it
        std::string label; // the code and the information, for the code table
        Values values;     // with the instrument's coordinates of the point, if it wrote them
        double reflector;  // the reflector height in force on its line
        int number;
    };
    struct HeldLine {
        std::string text;
        int number;
    };

    void ReadSettings();
    bool HoldForPlaces(std::string_view line, int number);
    void FindPlaces();
    void ReadRecordLine(std::string_view line, int number);
    bool Split(std::string_view line, int number);
    bool ReadValues(int number, Values& values);
    void ReadTextRecord(const Values& values);
    void ReadHeaderWord(std::string_view type, std::string_view text);
    void ReadPoint(const Values& values, int number);
    void ReadStation(const Values& values, int number);
    void ReadSighting(const Values& values, int number);
    void ReadComputed(const Values& values, int number);
    void WriteSighting(const Sighting& sighting);
    void WriteHeldSightings();
    const std::string& PointCode();
    bool AddPosition(std::string_view name, const Values& values, bool keepCode, int number);
    bool OpenStation(std::string_view name, int number);
    void SetInstrumentHeight(double hi);
    void SettleInstrumentHeight();
    void Header(std::string& last, const char* label, std::string_view value);
    bool IsReference(std::string_view code) const;
    void WarnOnce(std::vector<std::string>& said, const char* format, std::string_view what, int number);

    // ---- Settings of the format ("Zeiss.ini"), and what the file's header changes of them
    InstrumentSettings m_settings;
    bool m_xNorth = true; // the file's X is the northing

    // ---- The line being read
    zeiss::Record m_record;
    zeiss::Layout m_layout = zeiss::Layout::Unknown; // of the file, from its first line that says it
    zeiss::InfoPlaces m_places;
    bool m_placesKnown = false;        // from the header, or found from the point lines
    std::vector<HeldLine> m_heldLines; // from the first point line while the places are not known
    int m_heldPoints = 0;              // the point lines among them

    // ---- What holds from one line to the next
    CStation* m_station = nullptr; // the station in force (owned by the result)
    bool m_sighted = false;        // a sighting was written to the station
    bool m_measured = false;       // a sighting line was read after the station line
    bool m_settingUp = false;      // the station's set-up lines go on (no sighting, no program since)
    bool m_setUp = false;          // a set-up program runs: its sightings are references
    bool m_programStation = false; // a station line was read since the program began
    bool m_knownStation = false;   // a known-station set-up: the next stations are oriented
    double m_hi = kUndefined;      // the last instrument height
    bool m_heightPending = false;  // m_hi given before the station measured: its station is not known yet
    std::vector<Sighting> m_held;  // sightings of a set-up program waiting for its station line
    std::string m_lineSighted;     // the point sighted on the line just read
    std::string m_sightedBefore;   // the point sighted on the line before
    double m_reflector = kUndefined;
    std::string m_text;
    std::vector<std::string> m_typesSaid, m_unitsSaid;
    std::string m_instrument, m_serial, m_version, m_axes, m_scale, m_orientation, m_temperature, m_pressure;
    bool m_started = false;
};

// The reader of the format "Zeiss".
std::unique_ptr<CFieldBookReader> MakeZeissReader();

} // namespace pyr
