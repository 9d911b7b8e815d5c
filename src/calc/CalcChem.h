#pragma once

#include "calc/ComputationSession.h"
#include "calc/TraverseGathering.h"
#include "calc/TraverseListing.h"
#include "ui/DialogModel.h"

#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// A traverse as the computation made it.
struct ComputedTraverse {
    std::string name;
    int element = -1; // of the traverse (1007) in the GéoBase
    GatheredTraverse gathered;
    TraverseResult result;
    TraverseTolerances tolerances; // the angular one is this traverse's own with normal or precise tolerances
    bool angularOut = false;
    bool planimetricOut = false;
    bool heightOut = false;
    bool OutOfTolerance() const { return angularOut || planimetricOut || heightOut; }
};

// The dialog "PYRALIS - Calcul de cheminements polygonaux": the traverses of the GéoBase (its elements of
// kind 1007), those chosen or all of them computed, their closures checked against the tolerances
// "FermAngulaire", "FermPlanimetr" and "FermAltimetr"; "&Enregistrer" writes the stations' coordinates and
// V0 into the GéoBase (a traverse out of tolerance only when the person agrees); the listing (".ccp") and
// the journal report them.
class CCalcChem : public ui::DialogModel {
public:
    static constexpr int kPartResults = 1;

    CCalcChem();
    std::string Caption() const override;

    // ---- Opening and closing
    // Offers the GéoBase, loads it and reads the options. False, a message having said why, when it holds
    // no traverse (unless the search is to run first) or when the person chose no GéoBase.
    bool Open(ui::FrontEnd& frontEnd, bool searchFirst = false);
    bool Cancelled() const { return m_cancelled; }
    std::string Close(bool saved, bool listingAsked = false, std::string listingPath = {});

    // ---- The choices: the traverses by their names; none chosen computes them all
    const std::vector<std::string>& TraverseNames() const { return m_names; }
    bool Choose(std::string_view name); // false, with a message, for a name the GéoBase does not hold
    void ChooseAll() { m_chosen.clear(); }
    const std::vector<int>& Chosen() const { return m_chosen; }
    TraverseGatherSettings& Settings() { return m_settings; }
    // The switches of "Cheminements" (TraverseTexts.h), read at Open.
    int Switches() const { return m_switches; }

    // ---- Actions
    // "Recherche automatique": the traverses found among the set-ups written into the GéoBase, which is
    // saved. The number of traverses added; -1 when the GéoBase could not be saved.
    int Search();
    // "&Calculer": true when at least one traverse could be computed.
    bool Calculate();
    // "&Enregistrer": false when the GéoBase could not be saved.
    bool Enregistrer();

    const std::vector<ComputedTraverse>& Results() const { return m_results; }
    const CCarnet& Carnet() const { return m_session.Carnet(); }

private:
    void ReadOptions();
    void ListTraverses();
    // The points sighted from the stations written, radiated and written: their number.
    int RadiateFrom(const std::vector<int>& stations);
    void Show(const ComputedTraverse& traverse);

    ui::FrontEnd* m_frontEnd = nullptr;
    bool m_cancelled = false;
    CComputationSession m_session;
    TraverseGatherSettings m_settings;
    TraverseTolerances m_tolerances;
    int m_switches = 32;
    std::vector<std::string> m_names; // the traverses of the GéoBase
    std::vector<int> m_elements;      // their elements
    std::vector<int> m_chosen;        // ranks in m_names
    std::vector<ComputedTraverse> m_results;
    bool m_written = false;
};

} // namespace pyr
