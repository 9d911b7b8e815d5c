#include "calc/CalcRayonForm.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

namespace pyr {

namespace {

using ui::Control;
using ui::ControlKind;
using ui::Ctl;

constexpr const char* kColumns[] = {"Matricule", "X", "Y", "Z", "Déterm.", "Ecart XY", "Ecart Z"};
constexpr const char* kStatusNone = "Choisissez les stations, puis Calculer.";
constexpr const char* kStatusDone = "%d point(s) nouveau(x), %d contrôle(s), %d station(s) non utilisée(s), "
                                    "%d hors tolérance";
constexpr const char* kStatusMore = " (les %d premiers affichés)";

std::string Fixed(double value, int decimals) {
    return IsKnown(value) ? FormatFixedShown(value, decimals) : std::string("-");
}

} // namespace

std::vector<ui::Control> CCalcRayonForm::Controls() const {
    using K = ControlKind;
    std::vector<std::string> columns(std::begin(kColumns), std::end(kColumns));
    if (CPointGen::SwapXY()) std::swap(columns[1], columns[2]);
    std::vector<ui::Control> controls{
        Ctl(kLabelStation, K::Label, "etiquetteStation", "&Station :").At(1, 0).Buddy(kStation),
        Ctl(kStation, K::Combo, "station").At(1, 1).Width(12),
        Ctl(kLabelPoints, K::Label, "etiquettePoints", "&Points à calculer :").At(1, 2).Buddy(kPoints),
        Ctl(kPoints, K::Edit, "points").At(1, 3).Width(16),
        Ctl(kComputeV0, K::Check, "v0Calcule", "Rayonnement avec le &V0 calculé").At(2, 0, 1, 2),
        Ctl(kCheckKnown, K::Check, "controle", "C&ontrôler les points connus").At(2, 2),
        Ctl(kCalculate, K::Button, "calculer", "&Calculer").At(2, 3).Default(),
        Ctl(kLabelResults, K::Label, "etiquetteResultats", "Points &nouveaux :")
            .At(3, 0, 1, 4)
            .Buddy(kResults),
        Ctl(kResults, K::List, "resultats").At(4, 0, 1, 4).Columns(columns).Width(90).Lines(10),
        Ctl(kStatus, K::Status, "etat").At(5, 0, 1, 4),
        Ctl(ui::kIdOk, K::Button, "enregistrer", "&Enregistrer").In(ui::kButtonRow),
        Ctl(ui::kIdCancel, K::Button, "annuler", "Annuler").In(ui::kButtonRow).At(0, 1),
    };
    const std::vector<ui::Control> type = kTypeGroup.Controls();
    controls.insert(controls.begin(), type.begin(), type.end());
    return controls;
}

bool CCalcRayonForm::Open(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    if (m_model.Open(frontEnd)) return true;
    End(m_model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed);
    return false;
}

std::vector<std::string> CCalcRayonForm::ResultLines() const {
    const bool swap = CPointGen::SwapXY();
    const int xy = CPointGen::DeciXY(), z = CPointGen::DeciZ();
    std::vector<std::string> lines;
    for (const RadiatedPoint& point : m_model.NewPoints()) {
        if (lines.size() == kShownPoints) break;
        const bool several = point.determinations.size() > 1;
        lines.push_back(std::string(point.mat) + '\t' + Fixed(swap ? point.y : point.x, xy) + '\t' +
                        Fixed(swap ? point.x : point.y, xy) + '\t' + Fixed(point.z, z) + '\t' +
                        std::to_string(point.determinations.size()) + '\t' +
                        (several ? Fixed(point.spreadXY, xy) : "-") + '\t' +
                        (several ? Fixed(point.spreadZ, z) : "-") + (point.outOfTolerance ? "  !" : ""));
    }
    return lines;
}

std::string CCalcRayonForm::Status() const {
    if (m_model.Results().empty()) return kStatusNone;
    int checks = 0;
    for (const RadiatedStation& station : m_model.Results())
        checks += static_cast<int>(station.checks.size());
    const std::size_t points = m_model.NewPoints().size();
    std::string status =
        Sprintf(kStatusDone, static_cast<int>(points), checks, m_model.NotUsed(), m_model.OutOfTolerance());
    if (points > kShownPoints) status += Sprintf(kStatusMore, static_cast<int>(kShownPoints));
    return status;
}

ui::ControlState CCalcRayonForm::State(int id) const {
    ui::ControlState state;
    CCalcRayon& model = m_model;
    const RadiationType type = model.Type();
    if (kTypeGroup.Holds(id)) return kTypeGroup.State(id, type, model.List());
    switch (id) {
    case kLabelStation:
    case kStation:
        state.enabled = type == RadiationType::Unique;
        if (id == kStation) {
            state.items = model.StationNames();
            state.current = model.StationRank();
        }
        break;
    case kPoints:
        state.text = model.Points();
        break;
    case kComputeV0:
        state.checked = model.Settings().computeV0;
        break;
    case kCheckKnown:
        state.checked = model.CheckKnownPoints();
        break;
    case kResults:
        state.items = ResultLines();
        break;
    case kStatus:
        state.text = Status();
        break;
    case kCalculate:
        state.enabled = type != RadiationType::Liste || !model.List().empty();
        break;
    case ui::kIdOk:
        state.enabled = !model.Results().empty();
        break;
    default:
        break;
    }
    return state;
}

void CCalcRayonForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    (void)frontEnd;
    using ui::EventKind;
    if (const std::optional<V0CalculationType> type = kTypeGroup.Chosen(id, event)) {
        m_model.SetType(*type);
        return;
    }
    if (const std::optional<std::string> list = kTypeGroup.TypedList(id, event)) {
        if (*list != m_model.List()) m_model.SetList(*list);
        return;
    }
    if (kTypeGroup.Holds(id)) return;
    switch (id) {
    case kStation: {
        const auto& stations = m_model.StationNames();
        if (event.kind == EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(stations.size()))
            m_model.ChooseStation(stations[static_cast<std::size_t>(event.rank)]);
        return;
    }
    case kPoints:
        if (event.kind == EventKind::Text && Trimmed(event.text) != m_model.Points())
            m_model.SetPoints(event.text);
        return;
    case kComputeV0:
        if (event.kind == EventKind::Check) m_model.Settings().computeV0 = event.on;
        return;
    case kCheckKnown:
        if (event.kind == EventKind::Check) m_model.SetCheckKnownPoints(event.on);
        return;
    case kCalculate:
        if (State(kCalculate).enabled) m_model.Calculate();
        return;
    case ui::kIdOk: {
        const bool saved = m_model.Enregistrer();
        m_model.Close(saved);
        End(saved ? ui::DialogResult::Ok : ui::DialogResult::Failed);
        return;
    }
    case ui::kIdCancel:
        m_model.Close(false);
        End(ui::DialogResult::Cancel);
        return;
    default:
        return;
    }
}

} // namespace pyr
