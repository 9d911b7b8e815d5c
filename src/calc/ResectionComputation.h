#pragma once

#include "calc/Resection.h"
#include "calc/StationComputation.h"

#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// A station computed, as by resection, from sightings chosen in two lists: those taken from the station
// on known points ("---> P"), and, for the combined method, those taken on the station from other
// stations placed and oriented ("<--- S (2)"). The resection and the combined method differ only by
// those second lines, by their computation and by their listing.
class CResectionComputation : public CStationComputation {
public:
    // Takes exactly the lines whose point (or sighting station) a selection names; false when it names
    // none of them.
    bool SelectSightings(std::string_view selection);

    // ---- Enabling rules
    bool CanWrite() const override;  // the computed X and Y, or Z
    bool CanFinish() const override; // three lines at least in the two lists

    // ---- The result of the chosen station
    const StationResult& Result() const { return m_result; }
    const std::string& Status() const override { return m_result.status; }
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

    // Writes the station's computed point (X and Y, Z) and its V0 into the GéoBase (not saved yet),
    // asking before invariant coordinates are replaced.
    bool Write() override;

protected:
    // `withIntersections`: the sightings taken on the station from other stations are offered too.
    CResectionComputation(StationWords words, bool withIntersections)
        : CStationComputation(words), m_withIntersections(withIntersections) {}

    // The computation itself; returns the result's flags.
    virtual int Compute(StationResult& result, bool plani, bool alti) const = 0;
    // The messages a computation's flags call for besides a failure (a weak crossing).
    virtual void Warn(int flags) { (void)flags; }

private:
    bool Offers(int stationIndex) override { return !LinesOf(stationIndex).empty(); }
    void StationChosen() override;
    void Recompute() override;
    std::size_t ResultCount() const override { return m_results.All().size(); }
    // The lines of a station: its sightings on known points, then the sightings on it from other
    // stations placed and oriented when the computation takes them.
    std::vector<Line> LinesOf(int station);
    StationSighting Gather(const Line& line);

    bool m_withIntersections;
    StationResult m_result;
    KeptResults<StationResult> m_results;
};

} // namespace pyr
