#include "calc/CalcExcentForm.h"

#include "calc/EccentricTexts.h"
#include "calc/StationTexts.h"
#include "geobase/Elements.h"
#include "ui/FormControls.h"

#include <algorithm>

namespace pyr {

std::vector<CSightingComputationForm::ResultLine> CCalcExcentForm::ResultLines() const {
    // The names say the place, the labels the axis: X or Y first as the options show them.
    const bool swap = CPointGen::SwapXY();
    ResultLine x{station::kLabelX, "Premiere", m_model.XText(), "", false};
    ResultLine y{station::kLabelY, "Seconde", m_model.YText(), "", false};
    if (swap) std::swap(x.label, y.label), std::swap(x.value, y.value);
    return {x,
            y,
            {station::kLabelV0, "V0", m_model.V0Text(), "", false},
            {station::kLabelZ, "Altitude", m_model.ZText(), m_model.EmqZText()}};
}

// The centre on the station's row, across the arrows' column from it, and next after the station when
// the keyboard tabs through the window.
void CCalcExcentForm::AddOwnControls(std::vector<ui::Control>& controls) const {
    using ui::ControlKind;
    using ui::Ctl;
    auto at =
        std::find_if(controls.begin(), controls.end(), [](const ui::Control& c) { return c.id == kSubject; });
    at = at == controls.end() ? at : at + 1;
    controls.insert(at, {Ctl(kLabelCentre, ControlKind::Label, "etiquetteCentre", excent::kLabelCentre)
                             .At(0, 2)
                             .Buddy(kCentre),
                         Ctl(kCentre, ControlKind::Combo, "centre").At(0, 3).Width(12)});
}

ui::ControlState CCalcExcentForm::OwnState(int id) const {
    ui::ControlState state;
    if (id != kCentre) return state;
    state.items = m_model.Centres();
    for (std::size_t i = 0; i < state.items.size(); ++i)
        if (state.items[i] == m_model.Centre()) state.current = static_cast<int>(i);
    state.text = m_model.Centre();
    state.enabled = !state.items.empty();
    return state;
}

void CCalcExcentForm::OwnAct(ui::FrontEnd&, int id, const ui::Event& event) {
    if (id != kCentre || event.kind != ui::EventKind::Select) return;
    const std::vector<std::string>& centres = m_model.Centres();
    if (event.rank < 0 || event.rank >= static_cast<int>(centres.size())) return;
    const std::string& centre = centres[static_cast<std::size_t>(event.rank)];
    // The centre shown again keeps the references taken.
    if (centre != m_model.Centre() && m_model.ChooseCentre(centre)) Focus(kAvailable);
}

} // namespace pyr
