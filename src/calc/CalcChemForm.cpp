#include "calc/CalcChemForm.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

#include <algorithm>

namespace pyr {

namespace {

using ui::ControlKind;
using ui::Ctl;

// Angular misclosures in grads, planimetric and height ones in metres: each heading says its unit, the
// two "Tol." columns being told apart by theirs.
constexpr const char* kColumns[] = {"Cheminement", "Type", "fa (gr)", "Tol. (gr)", "f (m)",
                                    "Tol. (m)",    "1/n",  "fz (m)",  "Tol. (m)",  "État"};
constexpr const char* kStateIn = "dans les tolérances";
constexpr const char* kStateOut = "HORS TOLÉRANCE";
constexpr const char* kStateNotComputed = "non calculé";
constexpr const char* kStatusNone =
    "La GéoBase ne contient aucun cheminement : lancez la recherche automatique.";
constexpr const char* kStatusChoice = "%d cheminement(s) dans la GéoBase, %s.";
constexpr const char* kChoiceAll = "aucun coché : tous seront calculés";
constexpr const char* kChoiceSome = "%d coché(s)";
constexpr const char* kStatusComputed = "%d cheminement(s) calculé(s) sur %d, %d hors tolérance.";
constexpr const char* kStatusFound = "Recherche automatique : %d cheminement(s) ajouté(s) dans la GéoBase.";

std::string Fixed(double value, int decimals) {
    return IsKnown(value) ? FormatFixedShown(value, decimals) : std::string("-");
}

// The misclosure beside its tolerance, "-" for a closure the traverse does not have.
std::string Closure(double misclosure, double tolerance, int decimals) {
    return Fixed(misclosure, decimals) + '\t' + (IsKnown(misclosure) ? Fixed(tolerance, decimals) : "-");
}

std::string Row(const ComputedTraverse& t) {
    const TraverseResult& r = t.result;
    const TraverseTolerances& tolerances = t.tolerances;
    if (!r.ok) return t.name + "\t-\t-\t-\t-\t-\t-\t-\t-\t" + kStateNotComputed;
    const int metres = CPointGen::DeciXY();
    const std::string ratio = r.Ratio() > 0.0 ? Sprintf("1/%.0f", r.Ratio()) : std::string("-");
    return t.name + '\t' + TraverseKindText(t.gathered.input.kind) + '\t' +
           Closure(r.angularMisclosure, tolerances.angular, CStation::DeciAng()) + '\t' +
           Closure(r.f, tolerances.planimetric, metres) + '\t' + ratio + '\t' +
           Closure(r.fz, tolerances.height, metres) + '\t' + (t.OutOfTolerance() ? kStateOut : kStateIn);
}

// What a line's tooltip tells: why a traverse was not computed, or which closures are out.
std::string Tip(const ComputedTraverse& t) {
    if (!t.result.ok) return t.result.why;
    std::string tip;
    for (const auto& [out, word] : {std::pair{t.angularOut, "angulaire"},
                                    {t.planimetricOut, "planimétrique"},
                                    {t.heightOut, "altimétrique"}})
        if (out) tip += (tip.empty() ? "Fermeture hors tolérance : " : ", ") + std::string(word);
    return tip;
}

} // namespace

std::vector<ui::Control> CCalcChemForm::Controls() const {
    // The traverses with the two actions beside them, the results across the whole window under them.
    using K = ControlKind;
    std::vector<ui::Control> controls{
        Ctl(kLabelTraverses, K::Label, "etiquetteCheminements", "C&heminements :").Buddy(kTraverses),
        Ctl(kTraverses, K::CheckList, "cheminements").At(1, 0, 3, 1).Width(24).Lines(5),
        Ctl(kSearch, K::Button, "recherche", "Recherche &automatique").At(1, 1),
        Ctl(kCalculate, K::Button, "calculer", "&Calculer").At(2, 1).Default(),
        Ctl(kLabelResults, K::Label, "etiquetteResultats", "&Résultats :").At(4, 0, 1, 2).Buddy(kResults),
        Ctl(kResults, K::List, "resultats")
            .At(5, 0, 1, 2)
            .Columns({std::begin(kColumns), std::end(kColumns)})
            .Width(104)
            .Lines(6),
        Ctl(kStatus, K::Status, "etat").At(6, 0, 1, 2),
    };
    const std::vector<ui::Control> foot = FootButtons();
    controls.insert(controls.end(), foot.begin(), foot.end());
    return controls;
}

bool CCalcChemForm::Open(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    // A GéoBase without traverses still opens: the automatic search is in the window.
    if (m_model.Open(frontEnd, true)) return true;
    // No GéoBase chosen is a cancel; any other refusal was told by a message.
    End(m_model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed);
    return false;
}

std::string CCalcChemForm::StatusText() const {
    if (!Message().empty()) return Message();
    const int count = static_cast<int>(m_model.TraverseNames().size());
    if (count == 0) return kStatusNone;
    const std::vector<ComputedTraverse>& results = m_model.Results();
    if (!results.empty()) {
        const auto computed = std::count_if(results.begin(), results.end(),
                                            [](const ComputedTraverse& t) { return t.result.ok; });
        const auto out = std::count_if(results.begin(), results.end(),
                                       [](const ComputedTraverse& t) { return t.OutOfTolerance(); });
        return Sprintf(kStatusComputed, static_cast<int>(computed), static_cast<int>(results.size()),
                       static_cast<int>(out));
    }
    const int chosen = static_cast<int>(m_model.Chosen().size());
    return Sprintf(kStatusChoice, count, chosen == 0 ? kChoiceAll : Sprintf(kChoiceSome, chosen).c_str());
}

ui::ControlState CCalcChemForm::State(int id) const {
    ui::ControlState state;
    const std::vector<ComputedTraverse>& results = m_model.Results();
    switch (id) {
    case kTraverses: {
        state.items = m_model.TraverseNames();
        state.checks.assign(state.items.size(), false);
        for (int rank : m_model.Chosen())
            if (rank >= 0 && rank < static_cast<int>(state.checks.size()))
                state.checks[static_cast<std::size_t>(rank)] = true;
        break;
    }
    case kCalculate:
        state.enabled = !m_model.TraverseNames().empty();
        break;
    case kResults:
        for (const ComputedTraverse& t : results) {
            state.items.push_back(Row(t));
            state.tips.push_back(Tip(t));
        }
        break;
    case kStatus:
        state.text = StatusText();
        break;
    default:
        FootState(id, state);
        break;
    }
    return state;
}

void CCalcChemForm::CheckTraverse(int rank, bool on) {
    const std::vector<std::string>& names = m_model.TraverseNames();
    if (rank < 0 || rank >= static_cast<int>(names.size())) return;
    std::vector<int> chosen = m_model.Chosen();
    chosen.erase(std::remove(chosen.begin(), chosen.end(), rank), chosen.end());
    if (on) chosen.push_back(rank);
    m_model.ChooseAll();
    for (int kept : chosen)
        m_model.Choose(names[static_cast<std::size_t>(kept)]);
}

void CCalcChemForm::Act(ui::FrontEnd&, int id, const ui::Event& event) {
    using ui::EventKind;
    switch (id) {
    case kTraverses:
        if (event.kind == EventKind::CheckLine) {
            CheckTraverse(event.rank, event.on);
            Say({});
        }
        return;
    case kSearch: {
        const int added = m_model.Search();
        if (added < 0)
            SayNotSaved();
        else
            Say(Sprintf(kStatusFound, added));
        return;
    }
    case kCalculate:
        if (m_model.TraverseNames().empty()) return;
        Computed(m_model.Calculate());
        return;
    default:
        FootAct(id);
        return;
    }
}

} // namespace pyr
