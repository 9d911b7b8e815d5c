#pragma once

#include "calc/ComputationSession.h"
#include "calc/Intersection.h"
#include "calc/SightingLists.h"
#include "ui/DialogModel.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace pyr {

// The dialog "Calcul du point %s par intersection": a combo of the points that can be computed (sighted
// from a station whose place and V0 are known), the sightings of the chosen point in two lists (those
// available and those taken into the calculation) moved by four arrows, and the point computed again on
// every move. Its results can be written into the GéoBase one point at a time; it ends with "Fin +
// Listing" or by closing, with the listing, the journal and the save of a modified GéoBase.
class CCalcInters : public ui::DialogModel {
public:
    // The parts of the dialog a change notice names.
    enum Part : int {
        kPartPoints = 1,   // the combo of points
        kPartLists = 2,    // the two lists and their highlighted lines
        kPartResult = 4,   // the result fields, the status line and the enabling of the buttons
        kPartSwitches = 8, // "CalculPlani", "CalculAlti"
        kPartCaption = 16,
    };

    using Line = CSightingLists::Line;

    CCalcInters();

    std::string Caption() const override;

    // ---- Opening and closing
    // Offers the last GéoBase, loads it, reads the options and lists the points that can be computed.
    // False, a message having said why, when there is none or no GéoBase could be read.
    bool Open(ui::FrontEnd& frontEnd);
    bool Cancelled() const { return m_session.Cancelled(); }
    // Leaves the dialog: the settings are kept, a modified GéoBase is offered to be saved, the listing
    // of the points computed is offered (or written at once after "Fin + Listing", `listingAsked`, in
    // `listingPath` when named in advance), and the journal receives the points written. Returns the
    // listing's path, or "".
    std::string Close(bool listingAsked = false, std::string listingPath = {});
    // "Fin + Listing".
    std::string FinishWithListing(std::string listingPath = {}) {
        return Close(true, std::move(listingPath));
    }

    // ---- The switches, kept in the section "Calcul Intersection"; a change computes the point again.
    bool Plani() const { return m_plani; }
    bool Alti() const { return m_alti; }
    void SetPlani(bool on);
    void SetAlti(bool on);

    // ---- The combo
    const std::vector<std::string>& Points() const { return m_points; }
    // Chooses a point: its sightings fill the available list, the list of those taken is emptied. False,
    // with a message, for a point that is not in the combo.
    bool ChoosePoint(std::string_view mat);
    const std::string& Point() const { return m_point; }

    // ---- The two lists and the four arrows
    const std::vector<Line>& Available() const { return m_lists.Available(); }
    const std::vector<Line>& Selected() const { return m_lists.Selected(); }
    // The highlighted line of each list, -1 for none.
    void HighlightAvailable(int rank);
    void HighlightSelected(int rank);
    int HighlightedAvailable() const { return m_lists.HighlightedAvailable(); }
    int HighlightedSelected() const { return m_lists.HighlightedSelected(); }
    void AddOne();
    void AddAll();
    void RemoveOne();
    void RemoveAll();
    // Takes exactly the sightings of the stations a selection names (their names, every set-up); false
    // when it names none of them.
    bool SelectStations(std::string_view selection);

    // ---- Enabling rules
    bool CanAddOne() const { return m_lists.CanAddOne(); }
    bool CanAddAll() const { return m_lists.CanAddAll(); }
    bool CanRemoveOne() const { return m_lists.CanRemoveOne(); }
    bool CanRemoveAll() const { return m_lists.CanRemoveAll(); }
    bool CanWrite() const;  // the computed X and Y, or Z
    bool CanFinish() const; // two sightings at least in the two lists

    // ---- The result of the chosen point
    const InterResult& Result() const { return m_result; }
    const std::string& Status() const { return m_result.status; }
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
    const std::vector<InterResult>& Results() const { return m_results; }

    // ---- Writing
    // Writes the chosen point's computed coordinates into the GéoBase (not saved yet). False when there
    // is nothing to write or the GéoBase refused it.
    bool WritePoint();
    // Saves the GéoBase now.
    bool Save() { return m_session.Save(); }
    const CCarnet& Carnet() const { return m_session.Carnet(); }
    bool Modified() const { return m_session.Modified(); }

private:
    void FindPoints();
    void Recompute();
    void Clear();
    void Keep();
    InterSighting Gather(const Line& line);
    const StationPlace& PlaceOf(int station);
    // After a move of the lists: they are shown again and the point computed again.
    void Moved(bool moved);
    std::string Coordinate(double value, int decimals) const;

    ui::FrontEnd* m_frontEnd = nullptr;
    CComputationSession m_session;
    bool m_plani = true;
    bool m_alti = true;
    std::vector<std::string> m_points;
    std::unordered_set<std::string> m_offered; // the same points, to find one at once
    std::string m_point;
    CSightingLists m_lists;
    InterResult m_result;
    std::vector<InterResult> m_results;
    std::unordered_map<std::string, std::size_t> m_resultOf;
    std::unordered_map<int, StationPlace> m_places; // by station element
};

} // namespace pyr
