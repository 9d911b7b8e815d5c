#pragma once

#include "calc/EccentricStation.h"
#include "calc/SightingComputation.h"
#include "calc/StationChoice.h"

#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The dialog "Calcul de la station excentrée %s": a station set up beside a known point that cannot be
// occupied, the centre C, placed and oriented by its sighting on C with a distance and its sightings on
// known points (the "points d'appui"), and given its altitude from C or from those points. The station is
// chosen in a combo as "S (2)", then its centre among the points it sights with a distance, then its
// reference sightings ("---> P") in the two lists. Its switches are kept in the section
// "Calcul Station exc"; its result is written into the GéoBase: the station's point receives X, Y and Z,
// the station its V0.
class CCalcExcent : public CSightingComputation {
public:
    CCalcExcent();

    std::string Caption() const override;

    // ---- Opening
    // Offers the last GéoBase, loads it, reads the options and lists the stations that sight a known
    // point with a distance. False, a message having said why, when there is none or no GéoBase could
    // be read.
    bool Open(ui::FrontEnd& frontEnd);

    // ---- The combo of the stations: "S1 (1)", "S1 (2)"...
    const std::vector<std::string>& Stations() const { return m_stations.Shown(); }
    // Chooses a station by its name, "NOM" (its first occurrence offered) or "NOM(2)" / "NOM (2)": its
    // candidates for the centre fill the centre's combo and the nearest is chosen. False, with a
    // message, for a station that is not offered.
    bool ChooseStation(std::string_view designation);
    const std::string& Station() const { return m_station; }

    // ---- The combo of the centre: the known points the station sights with a distance.
    const std::vector<std::string>& Centres() const { return m_centreNames; }
    // Chooses the centre: the station's other sightings on known points fill the available list. False,
    // with a message, for a point the station does not sight with a distance.
    bool ChooseCentre(std::string_view mat);
    const std::string& Centre() const { return m_result.centre; }

    // Takes exactly the reference lines whose point a selection names; false when it names none of them.
    bool SelectReferences(std::string_view selection);

    // ---- Enabling rules
    bool CanWrite() const;  // the computed X and Y, or Z
    bool CanFinish() const; // a reference in the two lists, beside the sighting on the centre

    // ---- The result of the chosen station
    const EccentricResult& Result() const { return m_result; }
    const std::string& Status() const { return m_result.status; }
    // The fields, with the GéoBase's decimals; "" when unknown.
    std::string XText() const;
    std::string YText() const;
    std::string V0Text() const;
    std::string ZText() const;
    std::string EmqZText() const;
    bool Computed() const; // planimetry, or altitude
    // The stations computed since the dialog opened, in the order of their first computation.
    const std::vector<EccentricResult>& Results() const { return m_results.All(); }

    // ---- Writing
    // Writes the station's computed point (X and Y, Z) and its V0 into the GéoBase (not saved yet),
    // asking before invariant coordinates are replaced. False when there is nothing to write or the
    // GéoBase refused it.
    bool WriteStation();

private:
    // A candidate for the centre: a sighting with a distance on a known point.
    struct Candidate {
        int index;       // the sighting element
        std::string mat; // the point sighted
        double di;       // its slope distance as read, m
    };

    void Recompute() override;
    std::size_t ResultCount() const override { return m_results.All().size(); }
    void WriteResult(CDlgCfgListing& listing, std::size_t index) const override;
    void FindStations();
    std::vector<Candidate> CandidatesOf(int stationIndex);
    // The reference lines of the station: its sightings on known points other than the centre.
    std::vector<Line> LinesOf(int stationIndex, const std::string& centre);
    EccentricSighting Gather(const Line& line);
    void GatherCentre();

    CStationChoice m_stations;
    std::string m_station;
    int m_stationIndex = -1;
    std::vector<Candidate> m_centres;
    std::vector<std::string> m_centreNames;
    int m_centre = -1; // the candidate chosen
    EccentricResult m_result;
    KeptResults<EccentricResult> m_results;
};

} // namespace pyr
