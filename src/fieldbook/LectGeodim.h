#pragma once

#include "core/NameSet.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/FieldBookUnits.h"
#include "fieldbook/ParamDriver.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace pyr {

// The reader of Trimble GDM (Geodimeter) label files (docs/format-gdm.md): job files of observations and
// area files of coordinates, one "label=value" a line, told apart block by block by what they hold.
//  - a station block opens at label 2 (3 its instrument height, 37/38/39 its coordinates, 62 the point it
//    is oriented on, 37/38/39 after it being that point's coordinates and 21 the circle reading on it);
//    a point block at label 5 (4 its code, 6 the signal height, then its observations
//    or its coordinates); a block ends where the next one opens, and a label repeated in a block keeps
//    its last value;
//  - observations: 7/8 the horizontal and vertical angles, 24/25 the same in face I, 17/18 in face II
//    (brought to face I), 9 the slope distance, 11 the horizontal one, 10 the height difference;
//  - coordinates: 38 the easting (X), 37 the northing (Y), 39 the elevation;
//  - the angle and distance units of label 23 win over "UniteAngles" and "UniteDistances";
//  - the job, date, operator ... labels (0, 1, 50 to 56) and the units, ppm and scale become header
//    comments.
// The reading runs in two passes: the records are first copied, one a line with the number of the line
// they came from, into a temporary file beside the field book (in memory for a text given in memory),
// the records that end early reported; the blocks are then read from that copy, which is deleted.
class CLectGeodim : public CFieldBookReader {
protected:
    void BeginReading() override;
    void ReadLine(std::string_view line, int number) override;
    void EndReading() override;

private:
    // What a block has gathered; the texts are views into the records being read.
    struct Block {
        int label = -1; // kLabelStation, kLabelPoint, or -1 when no block is open
        int number = 0; // the line of its opening label
        std::string_view name, code, orientedOn;
        double hi = kUndefined;
        double ahGeneric = kUndefined, avGeneric = kUndefined; // 7, 8
        double ahFaceI = kUndefined, avFaceI = kUndefined;     // 24, 25
        double ahFaceII = kUndefined, avFaceII = kUndefined;   // 17, 18
        double slope = kUndefined, horizontal = kUndefined, heightDifference = kUndefined;
        double north = kUndefined, east = kUndefined, elevation = kUndefined;
        // A station block names its orientation point (62) and may give that point's coordinates after
        // it, then the circle reading on it (21).
        bool afterOrientation = false;
        double orientationNorth = kUndefined, orientationEast = kUndefined, orientationElevation = kUndefined;
        double readingOnOrientation = kUndefined;
        bool HasObservation() const;
    };

    void ReadSettings();
    void ReadRecords(std::string_view records);
    void ReadRecord(int number, int label, std::string_view value);
    bool ReadAngle(int number, int label, std::string_view value, double& grads);
    bool ReadLength(int number, int label, std::string_view value, double& metres);
    void ReadUnits(int number, std::string_view value);
    void Header(std::string& last, const char* label, std::string_view value);

    void CloseBlock();
    void WriteStation();
    void WritePoint();
    void WriteSighting(double ah, double av, bool withDistances);
    bool WritePosition(bool known);
    void WriteOrientationPoint();
    bool IsReference(std::string_view point) const;

    // ---- Settings of the format ("Geodim.ini"), then what the field book declares
    InstrumentSettings m_settings;

    // ---- The first pass: the records, one a line
    std::string m_records;

    // ---- The second pass
    Block m_block;
    CStation* m_station = nullptr; // the station in force (owned by the result)
    std::string m_orientedOn;      // the point its label 62 names
    bool m_firstSighting = false;
    double m_signalHeight = kUndefined; // label 6 holds until the next one
    NameSet m_known;                    // points given with their planimetry
    std::vector<bool> m_labelWarned;
    std::string m_units, m_ppm, m_scale;
};

// The reader of Trimble GDM (Geodimeter) label job and area files.
std::unique_ptr<CFieldBookReader> MakeGeodimReader();

} // namespace pyr
