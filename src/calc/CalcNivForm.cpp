#include "calc/CalcNivForm.h"

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

constexpr const char* kColumns[] = {"Départ", "Arrivée",  "Stations", "Longueur (m)",
                                    "fz (m)", "Tol. (m)", "État"};
constexpr const char* kAny = "(toutes)";
constexpr const char* kStateIn = "dans la tolérance";
constexpr const char* kStateOut = "HORS TOLÉRANCE";
constexpr const char* kStateFlagged = "dénivelées mal contrôlées";
constexpr const char* kStatusReady = "%d repère(s) d'altitude connue parmi les lectures sur mire.";
constexpr const char* kStatusComputed = "%d cheminement(s) calculé(s), %d hors tolérance, %d remarque(s).";
// Misclosures and tolerances to the tenth of a millimetre, as the text window and the listing show them.
constexpr int kClosureDecimals = 4;

std::string Row(const LevellingRun& run) {
    int setUps = 0;
    for (const LevellingStep& step : run.steps)
        setUps += static_cast<int>(step.setUps.size());
    const std::string length =
        IsKnown(run.length) ? FormatFixedShown(run.length, CPointGen::DeciXY()) : std::string("-");
    const char* state = !run.inTolerance ? kStateOut : run.flagged ? kStateFlagged : kStateIn;
    return run.start + '\t' + run.end + '\t' + std::to_string(setUps) + '\t' + length + '\t' +
           FormatFixedShown(run.misclosure, kClosureDecimals) + '\t' +
           FormatFixedShown(run.tolerance, kClosureDecimals) + '\t' + state;
}

std::string Tip(const LevellingRun& run) {
    std::string tip;
    for (const std::string& warning : run.warnings)
        tip += (tip.empty() ? "" : "\n") + warning;
    return tip;
}

} // namespace

std::vector<ui::Control> CCalcNivForm::Controls() const {
    // The choice of the runs on one line, the results and the remarks across the window under it.
    using K = ControlKind;
    std::vector<ui::Control> controls{
        Ctl(kLabelStart, K::Label, "etiquetteDepart", "&Départ :").Buddy(kStart),
        Ctl(kStart, K::Combo, "depart").At(0, 1).Width(14),
        Ctl(kLabelEnd, K::Label, "etiquetteArrivee", "&Arrivée :").At(0, 2).Buddy(kEnd),
        Ctl(kEnd, K::Combo, "arrivee").At(0, 3).Width(14),
        Ctl(kCalculate, K::Button, "calculer", "&Calculer").At(0, 4).Default(),
        Ctl(kLabelResults, K::Label, "etiquetteResultats", "&Résultats :").At(1, 0, 1, 5).Buddy(kResults),
        Ctl(kResults, K::List, "resultats")
            .At(2, 0, 1, 5)
            .Columns({std::begin(kColumns), std::end(kColumns)})
            .Width(84)
            .Lines(5),
        Ctl(kLabelProblems, K::Label, "etiquetteRemarques", "Re&marques :").At(3, 0, 1, 5).Buddy(kProblems),
        Ctl(kProblems, K::List, "remarques").At(4, 0, 1, 5).Width(84).Lines(3),
        Ctl(kStatus, K::Status, "etat").At(5, 0, 1, 5),
    };
    const std::vector<ui::Control> foot = FootButtons();
    controls.insert(controls.end(), foot.begin(), foot.end());
    return controls;
}

bool CCalcNivForm::Open(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    if (m_model.Open(frontEnd)) {
        m_benchmarks = m_model.Benchmarks();
        return true;
    }
    // No GéoBase chosen is a cancel; any other refusal (no staff reading) was told by a message.
    End(m_model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed);
    return false;
}

ui::ControlState CCalcNivForm::BenchmarkState(const std::string& chosen) const {
    ui::ControlState state;
    state.items.push_back(kAny);
    state.items.insert(state.items.end(), m_benchmarks.begin(), m_benchmarks.end());
    const auto found = std::find(m_benchmarks.begin(), m_benchmarks.end(), chosen);
    state.current = chosen.empty() || found == m_benchmarks.end()
                        ? 0
                        : 1 + static_cast<int>(found - m_benchmarks.begin());
    return state;
}

std::string CCalcNivForm::StatusText() const {
    if (!Message().empty()) return Message();
    if (!m_computed) return Sprintf(kStatusReady, static_cast<int>(m_benchmarks.size()));
    const std::vector<LevellingRun>& runs = m_model.Runs();
    const auto out =
        std::count_if(runs.begin(), runs.end(), [](const LevellingRun& run) { return !run.inTolerance; });
    return Sprintf(kStatusComputed, static_cast<int>(runs.size()), static_cast<int>(out),
                   static_cast<int>(m_model.Problems().size()));
}

ui::ControlState CCalcNivForm::State(int id) const {
    ui::ControlState state;
    switch (id) {
    case kStart:
        return BenchmarkState(m_model.Start());
    case kEnd:
        return BenchmarkState(m_model.End());
    case kResults:
        for (const LevellingRun& run : m_model.Runs()) {
            state.items.push_back(Row(run));
            state.tips.push_back(Tip(run));
        }
        break;
    case kProblems:
        state.items = m_model.Problems();
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

void CCalcNivForm::Act(ui::FrontEnd&, int id, const ui::Event& event) {
    using ui::EventKind;
    switch (id) {
    case kStart:
    case kEnd: {
        if (event.kind != EventKind::Select || event.rank < 0 ||
            event.rank > static_cast<int>(m_benchmarks.size()))
            return;
        const std::string chosen =
            event.rank == 0 ? std::string() : m_benchmarks[static_cast<std::size_t>(event.rank - 1)];
        if (id == kStart)
            m_model.Choose(chosen, m_model.End());
        else
            m_model.Choose(m_model.Start(), chosen);
        return;
    }
    case kCalculate:
        m_computed = true;
        Computed(m_model.Calculate());
        return;
    default:
        FootAct(id);
        return;
    }
}

} // namespace pyr
