#pragma once

#include "fieldbook/FieldBookReader.h"
#include "fieldbook/LectTopconRecord.h"
#include "fieldbook/ParamDriver.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The reader of Topcon GTS-7 / GTS-700 keyword field books (docs/format-topcon.md):
//  - JOB, DATE, NAME, INST, UNITS, SCALE, ATMOS, TEMP, CTL become header comments; UNITS (M or F for
//    the lengths, D for ddd.mmss or G for grads) is obeyed from its line on, over the parameter file;
//  - STN id,ih,code opens a station; an XYZ E,N,Z right after it makes a point of the station's name;
//  - BKB id,bearing,reading names the backsight (a comment gives the orientation); an XYZ after it makes
//    the backsight's point;
//  - BS id[,th] is a reference sighting, FS and SS id,th,code measured sightings (a reference when they
//    aim at the backsight, or when "References" marks them); each takes its values from the next line,
//    HV ha,va, SD ha,va,sd or HD ha,hd,vd (a horizontal distance and a height difference, turned into
//    a zenith angle and a slope distance); an XYZ after it is the point the instrument computed, kept
//    with "PointsCalcules";
//  - NOTE is a comment; OFFSET is said not to be applied; any other line is reported.
class CLectTopcon : public CFieldBookReader {
protected:
    std::string OpenFailure(const std::string& path, int code) const override;
    void BeginReading() override;
    void ReadLine(std::string_view line, int number) override;
    void EndReading() override;

private:
    enum class SightingKind { None, Back, Fore };
    // Whose coordinates an XYZ line gives.
    enum class PositionOwner { None, Station, Backsight, Measured };

    void ReadSettings();
    void Header(const char* label, const topcon::Record& record, const char* separator = ", ");
    void ReadUnits(int number);
    void ReadStation(int number);
    void FlushStation();
    void ReadPosition(int number);
    void ReadBacksight(int number);
    void ReadSighting(SightingKind kind, int number);
    void ReadObservation(int number);
    void ReportPendingSighting();
    void ReadOffset(int number);
    bool OpenUnknownStation(int number);
    bool IsReference() const;

    bool ReadAngle(std::string_view text, double& grads, int number) const;
    bool ReadLength(std::string_view text, double& metres, int number) const;
    bool ReadNumber(std::string_view text, double& read, bool dms, int number) const;

    // ---- Settings of the format ("Topcon.ini"), and the units the field book declares
    InstrumentSettings m_settings;

    // ---- The line being read
    topcon::Record m_record;
    std::string m_text;
    bool m_lineSeen = false; // a line with content was read
    bool m_started = false;  // a record of the format was read: the header comments are written
    std::string m_software;  // the first line, when it is no record: the program that wrote the book

    // ---- A station waits for the XYZ line that may follow it
    bool m_stationPending = false;
    std::string m_stationName, m_stationCode;
    double m_stationHi = kUndefined;
    int m_stationLine = 0;

    // ---- What holds from one line to the next
    CStation* m_station = nullptr;                // the station in force (owned by the result)
    bool m_firstSighting = false;                 // no sighting read yet since the station
    std::string m_backsight;                      // the point named by BKB for the station in force
    SightingKind m_sighting = SightingKind::None; // a sighting line waiting for its observation
    std::string m_target, m_targetCode;
    double m_targetHeight = kUndefined;
    int m_targetLine = 0;
    PositionOwner m_owner = PositionOwner::None;
    std::string m_ownerName;
    std::string m_lastMeasured; // the point of the last sighting, for an OFFSET
};

// The reader of Topcon GTS-7 / GTS-700 keyword field books.
std::unique_ptr<CFieldBookReader> MakeTopconReader();

} // namespace pyr
