#pragma once

#include "fieldbook/FieldBookReader.h"
#include "fieldbook/FieldBookUnits.h"
#include "fieldbook/LectSokkiaRecords.h"
#include "fieldbook/ParamDriver.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The reader of SDR2x and SDR33 field books (docs/format-sokkia.md). Each line is a fixed-width record
// (LectSokkiaRecords.h), its type in columns 1-2 and its derivation code in 3-4:
//  - 00 the header: version, date, and the units and coordinate order that win over the settings;
//    01 the instrument, 04 to 06 the constants, 10 the job: header comments;
//  - 02 a station (its coordinates also make a point of its name), 03 the target height that holds
//    until the next one, 07 the backsight of the station;
//  - 08 a known point; 09 an observation, a reference sighting when it sights the backsight point (or
//    when "References" marks it), else a measured one; 13 a note, kept as a comment;
//  - descriptions are codes, written in front of the element they go with.
// A transfer framed by STX and ETX has its checksum verified: a wrong one is said, never fatal.
class CLectSokkia : public CFieldBookReader {
protected:
    void BeginReading() override;
    void ReadLine(std::string_view line, int number) override;
    void EndReading() override;

private:
    // The backsight of the station in force, as its 07 record gave it (angles in grads).
    struct Backsight {
        std::string point;
        double hz = kUndefined; // the circle reading set on it
        double azimuth = kUndefined;
        bool sighted = false; // an observation of it was read, which is the reference sighting
    };

    void ReadSettings();
    void ReadRecord(std::string_view line, int number);
    void CheckFrame(std::string_view checksum, int number);
    void HeaderOnce();
    void SetVariant(sdr::Variant variant);

    void ReadHeader(std::string_view line, int number);
    void ReadInstrument(std::string_view line);
    void ReadConstants(std::string_view type, std::string_view line);
    void ReadStation(int number);
    void ReadTargetHeight(int number);
    void ReadBacksight(int number);
    void ReadCoordinates(int number);
    void ReadObservation(std::string_view derivation, int number);
    void ReadNote();

    bool Real(int field, double& value, int number);
    bool Length(int field, double& metres, int number);
    bool Angle(int field, double& grads, int number);
    bool Position(int first, double& x, double& y, double& z, int number);
    bool StationFor(std::string_view from, int number);
    bool OpenStation(std::string_view name, double hi, int number);
    void WriteBacksight();
    void CloseStation();
    bool IsReference(std::string_view point, std::string_view code) const;

    // ---- Settings ("Sokkia.ini"), and what the header of the field book says instead
    InstrumentSettings m_settings;
    bool m_zenith = true; // vertical angles from the zenith (else from the horizon)
    sdr::Variant m_variant = sdr::Variant::Sdr33;
    bool m_variantKnown = false;

    // ---- The record being read
    sdr::Fields m_fields;

    // ---- What holds from one line to the next
    CStation* m_station = nullptr; // the station in force (owned by the result)
    std::string m_stationName;
    bool m_firstSighting = false;
    bool m_azimuthWarned = false; // an MC azimuth kept as a reading was said for the station
    Backsight m_backsight;
    double m_targetHeight = kUndefined;
    std::string m_lastSighted; // the point of the observation just read: an 08 after it is computed
    bool m_started = false;
    bool m_framed = false;
    sdr::Checksum m_checksum;
};

// The reader of SDR2x and SDR33 field books.
std::unique_ptr<CFieldBookReader> MakeSokkiaReader();

} // namespace pyr
