#pragma once

#include "calc/Intersection.h"
#include "calc/SightingComputation.h"

#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace pyr {

// The dialog "Calcul du point %s par intersection": a combo of the points that can be computed (sighted
// from a station whose place and V0 are known), the sightings of the chosen point in two lists (those
// available and those taken into the calculation) moved by four arrows, and the point computed again on
// every move. Its results can be written into the GéoBase one point at a time; it ends with "Fin +
// Listing" or by closing, with the listing, the journal and the save of a modified GéoBase.
class CCalcInters : public CSightingComputation {
public:
    CCalcInters();

    std::string Caption() const override;

    bool Open(ui::FrontEnd& frontEnd) override;

    // ---- The combo
    const std::vector<std::string>& Points() const { return m_points; }
    // Chooses a point: its sightings fill the available list, the list of those taken is emptied. False,
    // with a message, for a point that is not in the combo.
    bool ChoosePoint(std::string_view mat);
    const std::string& Point() const { return m_point; }
    const std::vector<std::string>& Subjects() const override { return m_points; }
    const std::string& Subject() const override { return m_point; }
    bool ChooseSubject(std::string_view mat) override { return ChoosePoint(mat); }
    // Takes exactly the sightings of the stations a selection names (their names, every set-up); false
    // when it names none of them.
    bool SelectStations(std::string_view selection);

    // ---- Enabling rules
    bool CanWrite() const override;  // the computed X and Y, or Z
    bool CanFinish() const override; // two sightings at least in the two lists

    // ---- The result of the chosen point
    const InterResult& Result() const { return m_result; }
    const std::string& Status() const override { return m_result.status; }
    // The fields, with the GéoBase's decimals; "" when unknown.
    std::string XText() const;
    std::string YText() const;
    std::string EmqXText() const;
    std::string EmqYText() const;
    std::string ZText() const;
    std::string EmqZText() const;
    // Whether the last computation gave anything (planimetry, or altitude).
    bool Computed() const;
    // The points computed since the dialog opened, in the order of their first computation.
    const std::vector<InterResult>& Results() const { return m_results.All(); }

    // ---- Writing
    // Writes the chosen point's computed coordinates into the GéoBase (not saved yet). False when there
    // is nothing to write or the GéoBase refused it.
    bool WritePoint();
    bool Write() override { return WritePoint(); }

private:
    void Recompute() override;
    std::size_t ResultCount() const override { return m_results.All().size(); }
    void WriteResult(CDlgCfgListing& listing, std::size_t index) const override;
    void FindPoints();
    InterSighting Gather(const Line& line);

    std::vector<std::string> m_points;
    std::unordered_set<std::string> m_offered; // the same points, to find one at once
    std::string m_point;
    InterResult m_result;
    KeptResults<InterResult> m_results;
};

} // namespace pyr
