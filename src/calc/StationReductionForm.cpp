#include "calc/StationReductionForm.h"

#include "ui/FormControls.h"

#include <string_view>

namespace pyr {

using ui::Ctl;

std::vector<ui::Control> CStationReductionForm::Controls() const {
    // One frame for each group of switches, in the order the switches name them, one above the other.
    std::vector<ui::Control> groups, switches;
    std::vector<int> rows; // the next row of each frame
    const std::span<const ReductionSwitch> all = ReductionSwitches();
    for (std::size_t i = 0; i < all.size(); ++i) {
        if (groups.empty() || groups.back().text != all[i].group) {
            const int id = kFirstGroup + static_cast<int>(groups.size());
            groups.push_back(
                Ctl(id, ui::ControlKind::Group, "groupe" + std::to_string(groups.size() + 1), all[i].group)
                    .At(static_cast<int>(groups.size()), 0));
            rows.push_back(0);
        }
        switches.push_back(
            Ctl(kFirstSwitch + static_cast<int>(i), ui::ControlKind::Check, all[i].key, all[i].checkBox)
                .In(groups.back().id)
                .At(rows.back()++, 0));
    }
    // The tab order runs through the frames' check boxes; each frame comes before its own.
    std::vector<ui::Control> controls;
    for (const ui::Control& group : groups) {
        controls.push_back(group);
        for (const ui::Control& box : switches)
            if (box.parent == group.id) controls.push_back(box);
    }
    controls.push_back(Ctl(ui::kIdOk, ui::ControlKind::Button, "ok", "OK").In(ui::kButtonRow).Default());
    controls.push_back(
        Ctl(ui::kIdCancel, ui::ControlKind::Button, "annuler", "Annuler").In(ui::kButtonRow).At(0, 1));
    return controls;
}

bool CStationReductionForm::Open(ui::FrontEnd&) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    if (!m_model.Carnet()) {
        End(ui::DialogResult::Failed);
        return false;
    }
    m_model.OnInitDialog();
    return true;
}

ui::ControlState CStationReductionForm::State(int id) const {
    ui::ControlState state;
    const int which = id - kFirstSwitch;
    if (which >= 0 && which < static_cast<int>(kReductionSwitchCount))
        state.checked = m_model.Switch(static_cast<std::size_t>(which));
    return state;
}

void CStationReductionForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    const int which = id - kFirstSwitch;
    if (event.kind == ui::EventKind::Check && which >= 0 && which < static_cast<int>(kReductionSwitchCount)) {
        // A box ticked in the window is the dialog's own state, kept in the parameter file on OK only: it
        // does not hold over the file the next time the dialog opens, as a command line's does.
        m_model.Options().*ReductionSwitches()[static_cast<std::size_t>(which)].member = event.on;
        return;
    }
    if (id == ui::kIdOk) {
        m_model.OnOK(frontEnd);
        End(ui::DialogResult::Ok);
    } else if (id == ui::kIdCancel) {
        End(ui::DialogResult::Cancel);
    }
}

} // namespace pyr
