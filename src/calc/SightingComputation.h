#pragma once

#include "calc/ComputationSession.h"
#include "calc/SightingLists.h"
#include "settings/ListingKinds.h"
#include "ui/DialogModel.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

// What the dialogs that compute from a choice of sightings share (a point by intersection, a station by
// resection, by the combined method or off its centre): the session on the GéoBase, the two switches
// "CalculPlani" and "CalculAlti" kept in the computation's section, the two lists of sightings with their
// four arrows (the subject computed again after every move), the places of the stations met, and the
// closing with the listing of every result kept.
namespace pyr {

class CDlgCfgListing;

// The keys of the two switches, in each computation's own section.
inline constexpr const char* kKeyCalculPlani = "CalculPlani";
inline constexpr const char* kKeyCalculAlti = "CalculAlti";

// The words of one computation beside those of its session.
struct ComputationWords {
    SessionWords session;
    const char* section; // the parameter section of its switches: "Calcul Intersection"
    ListingKind listing;
};

class CSightingComputation : public ui::DialogModel {
public:
    // The parts of the dialog a change notice names.
    enum Part : int {
        kPartSubject = 1,  // the combo of the points or stations that can be computed
        kPartLists = 2,    // the two lists and their highlighted lines
        kPartResult = 4,   // the result fields, the status line and the enabling of the buttons
        kPartSwitches = 8, // "CalculPlani", "CalculAlti"
        kPartCaption = 16,
    };

    using Line = CSightingLists::Line;

    // ---- What each computation gives its window and its command line
    // Offers the last GéoBase, loads it, reads the options and lists the subjects that can be computed.
    // False, a message having said why, when there is none or no GéoBase could be read.
    virtual bool Open(ui::FrontEnd& frontEnd) = 0;
    // The points or stations that can be computed, the one chosen, and the choice of one by its name:
    // false, with a message, for a name that is not offered.
    virtual const std::vector<std::string>& Subjects() const = 0;
    virtual const std::string& Subject() const = 0;
    virtual bool ChooseSubject(std::string_view name) = 0;
    // The status line: why the last computation failed, "" otherwise.
    virtual const std::string& Status() const = 0;
    // Whether there is a result to write, and its writing into the GéoBase (not saved yet): false when
    // there is nothing to write or the GéoBase refused it.
    virtual bool CanWrite() const = 0;
    virtual bool Write() = 0;
    // Whether "Fin + Listing" may end the dialog: enough lines in the two lists together.
    virtual bool CanFinish() const = 0;

    bool Cancelled() const { return m_session.Cancelled(); }
    // Leaves the dialog: the switches are kept, a modified GéoBase is offered to be saved, the listing of
    // the results is offered (or written at once after "Fin + Listing", `listingAsked`, in `listingPath`
    // when named in advance), and the journal receives what was written. Returns the listing's path, or "".
    std::string Close(bool listingAsked = false, std::string listingPath = {});
    // "Fin + Listing".
    std::string FinishWithListing(std::string listingPath = {}) {
        return Close(true, std::move(listingPath));
    }

    // ---- The switches; a change computes the subject again.
    bool Plani() const { return m_plani; }
    bool Alti() const { return m_alti; }
    void SetPlani(bool on);
    void SetAlti(bool on);

    // ---- The two lists and the four arrows
    const std::vector<Line>& Available() const { return m_lists.Available(); }
    const std::vector<Line>& Selected() const { return m_lists.Selected(); }
    // The highlighted line of each list, -1 for none.
    void HighlightAvailable(int rank);
    void HighlightSelected(int rank);
    int HighlightedAvailable() const { return m_lists.HighlightedAvailable(); }
    int HighlightedSelected() const { return m_lists.HighlightedSelected(); }
    void AddOne() { Moved(m_lists.AddOne()); }
    void AddAll() { Moved(m_lists.AddAll()); }
    void RemoveOne() { Moved(m_lists.RemoveOne()); }
    void RemoveAll() { Moved(m_lists.RemoveAll()); }
    bool CanAddOne() const { return m_lists.CanAddOne(); }
    bool CanAddAll() const { return m_lists.CanAddAll(); }
    bool CanRemoveOne() const { return m_lists.CanRemoveOne(); }
    bool CanRemoveAll() const { return m_lists.CanRemoveAll(); }

    // ---- The GéoBase
    // Saves it now.
    bool Save() { return m_session.Save(); }
    const CCarnet& Carnet() const { return m_session.Carnet(); }
    bool Modified() const { return m_session.Modified(); }

protected:
    explicit CSightingComputation(ComputationWords words);

    // Reads the switches and opens the session (ComputationSession.h), the sightings reduced with the
    // instrument's constants. False, a message having said why, when no GéoBase could be read.
    bool OpenSession(ui::FrontEnd& frontEnd);
    // The subject computed again from the sightings taken; notifies kPartResult.
    virtual void Recompute() = 0;
    // The results kept since the dialog opened, and the block of one in the listing.
    virtual std::size_t ResultCount() const = 0;
    virtual void WriteResult(CDlgCfgListing& listing, std::size_t index) const = 0;

    // After a move of the lists: they are shown again and the subject computed again.
    void Moved(bool moved);
    // The place and orientation of a station occurrence, read once from the GéoBase until a write
    // changes them (Forget).
    const StationPlace& PlaceOf(int station);
    void ForgetPlaces() { m_places.clear(); }
    // Writes a computed station into the GéoBase (not saved yet): its point receives X and Y, Z (any of
    // them kUndefined is left alone; invariant ones are replaced only when the person agrees), the station
    // its V0 when known. False when the GéoBase refused it.
    bool WriteStationAt(int stationIndex, double x, double y, double z, double v0);
    // A value with that many decimals, "" when unknown.
    static std::string Shown(double value, int decimals);

    ui::FrontEnd* m_frontEnd = nullptr;
    CComputationSession m_session;
    CSightingLists m_lists;

private:
    ComputationWords m_words;
    bool m_plani = true;
    bool m_alti = true;
    std::unordered_map<int, StationPlace> m_places; // by station element
};

// The results of a dialog, one per subject in the order of their first computation: a subject computed
// again replaces its earlier result in its place.
template <class Result>
class KeptResults {
public:
    void Keep(const std::string& key, const Result& result) {
        const auto [at, added] = m_rankOf.try_emplace(key, m_results.size());
        if (added)
            m_results.push_back(result);
        else
            m_results[at->second] = result;
    }
    const std::vector<Result>& All() const { return m_results; }

private:
    std::vector<Result> m_results;
    std::unordered_map<std::string, std::size_t> m_rankOf;
};

} // namespace pyr
