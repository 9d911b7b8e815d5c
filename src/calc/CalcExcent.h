#pragma once

#include "calc/EccentricStation.h"
#include "calc/StationComputation.h"

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
class CCalcExcent : public CStationComputation {
public:
    CCalcExcent();

    // ---- The combo of the centre: the known points the station sights with a distance.
    const std::vector<std::string>& Centres() const { return m_centreNames; }
    // Chooses the centre: the station's other sightings on known points fill the available list. False,
    // with a message, for a point the station does not sight with a distance.
    bool ChooseCentre(std::string_view mat);
    const std::string& Centre() const { return m_result.centre; }

    // Takes exactly the reference lines whose point a selection names; false when it names none of them.
    bool SelectReferences(std::string_view selection);

    // ---- Enabling rules
    bool CanWrite() const override;  // the computed X and Y, or Z
    bool CanFinish() const override; // a reference in the two lists, beside the sighting on the centre

    // ---- The result of the chosen station
    const EccentricResult& Result() const { return m_result; }
    const std::string& Status() const override { return m_result.status; }
    // The fields, with the GéoBase's decimals; "" when unknown.
    std::string XText() const;
    std::string YText() const;
    std::string V0Text() const;
    std::string ZText() const;
    std::string EmqZText() const;
    bool Computed() const; // planimetry, or altitude
    // The stations computed since the dialog opened, in the order of their first computation.
    const std::vector<EccentricResult>& Results() const { return m_results.All(); }

    // Writes the station's computed point (X and Y, Z) and its V0 into the GéoBase (not saved yet),
    // asking before invariant coordinates are replaced.
    bool Write() override;

private:
    // A candidate for the centre: a sighting with a distance on a known point.
    struct Candidate {
        int index;       // the sighting element
        std::string mat; // the point sighted
        double di;       // its slope distance as read, m
    };

    bool Offers(int stationIndex) override { return !CandidatesOf(stationIndex).empty(); }
    // Its candidates for the centre fill the centre's combo, and the nearest is chosen.
    void StationChosen() override;
    void Recompute() override;
    std::size_t ResultCount() const override { return m_results.All().size(); }
    void WriteResult(CDlgCfgListing& listing, std::size_t index) const override;
    std::vector<Candidate> CandidatesOf(int stationIndex);
    EccentricSighting Gather(const Line& line);
    void GatherCentre();

    std::vector<Candidate> m_centres;
    std::vector<std::string> m_centreNames;
    int m_centre = -1; // the candidate chosen
    EccentricResult m_result;
    KeptResults<EccentricResult> m_results;
};

} // namespace pyr
