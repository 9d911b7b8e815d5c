#pragma once

#include "calc/Resection.h"
#include "calc/SightingComputation.h"
#include "calc/StationChoice.h"

#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The words of a station computation beside those of every computation.
struct StationWords {
    ComputationWords computation;
    const char* caption; // "Calcul de la station %s par relèvement"
    // Whether the station's sightings may also be taken on it from other stations already placed and
    // oriented (the combined method).
    bool withIntersections;
};

// A dialog that computes a station occurrence (its place, its V0 and its altitude) from sightings chosen
// in two lists: those taken from the station on known points ("---> P"), and, for the combined method,
// those taken on the station from other stations placed and oriented ("<--- S (2)"). The station is
// chosen in a combo as "S (2)", its name and occurrence. Its results are written into the GéoBase: the
// station's point receives X, Y and Z, the station its V0.
class CStationComputation : public CSightingComputation {
public:
    std::string Caption() const override;

    // ---- Opening
    // Offers the last GéoBase, loads it, reads the options and lists the stations that can be computed.
    // False, a message having said why, when there is none or no GéoBase could be read.
    bool Open(ui::FrontEnd& frontEnd);

    // ---- The combo: "S1 (1)", "S1 (2)"...
    const std::vector<std::string>& Stations() const { return m_stations.Shown(); }
    // Chooses a station by its name, "NOM" (its first occurrence offered) or "NOM(2)" / "NOM (2)": its
    // sightings fill the available list. False, with a message, for a station that is not offered.
    bool ChooseStation(std::string_view designation);
    const std::string& Station() const { return m_station; }
    // Takes exactly the lines whose point (or sighting station) a selection names; false when it names
    // none of them.
    bool SelectSightings(std::string_view selection);

    // ---- Enabling rules
    bool CanWrite() const;  // the computed X and Y, or Z
    bool CanFinish() const; // three lines at least in the two lists

    // ---- The result of the chosen station
    const StationResult& Result() const { return m_result; }
    const std::string& Status() const { return m_result.status; }
    // The fields, with the GéoBase's decimals; "" when unknown.
    std::string XText() const;
    std::string YText() const;
    std::string V0Text() const;
    std::string ZText() const;
    std::string EmqXText() const;
    std::string EmqYText() const;
    std::string EmqV0Text() const;
    std::string EmqZText() const;
    bool Computed() const; // planimetry, or altitude
    // The stations computed since the dialog opened, in the order of their first computation.
    const std::vector<StationResult>& Results() const { return m_results.All(); }

    // ---- Writing
    // Writes the station's computed point (X and Y, Z) and its V0 into the GéoBase (not saved yet),
    // asking before invariant coordinates are replaced. False when there is nothing to write or the
    // GéoBase refused it.
    bool WriteStation();

protected:
    explicit CStationComputation(StationWords words);

    // The computation itself; returns the result's flags.
    virtual int Compute(StationResult& result, bool plani, bool alti) const = 0;
    // The messages a computation's flags call for besides a failure (a weak crossing).
    virtual void Warn(int flags) { (void)flags; }

private:
    void Recompute() override;
    std::size_t ResultCount() const override { return m_results.All().size(); }
    void FindStations();
    // The lines of a station: its sightings on known points, then the sightings on it from other
    // stations placed and oriented when the computation takes them.
    std::vector<Line> LinesOf(int station);
    StationSighting Gather(const Line& line);

    StationWords m_words;
    CStationChoice m_stations;
    std::string m_station;
    int m_stationIndex = -1;
    StationResult m_result;
    KeptResults<StationResult> m_results;
};

} // namespace pyr
