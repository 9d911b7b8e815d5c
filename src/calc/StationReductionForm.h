#pragma once

#include "calc/StationReduction.h"
#include "ui/Form.h"

namespace pyr {

// The window of the reduction of stations: its seven check boxes in their three frames, OK, which keeps
// them and reduces the stations of the GéoBase in place, and Cancel, which leaves both as they were.
class CStationReductionForm : public ui::Form {
public:
    // The check box of the switch `which` (in the order of ReductionSwitches()) is kFirstSwitch + which;
    // the frames come after them.
    static constexpr int kFirstSwitch = 3;
    static constexpr int kFirstGroup = kFirstSwitch + static_cast<int>(kReductionSwitchCount);

    // `dialog` gives the command's inputs when the window opens; `model` is the dialog shown, given the
    // GéoBase it reduces by whoever opens it.
    CStationReductionForm(const ui::DialogModel& dialog, CReduction_Station& model)
        : m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    const ui::DialogModel& m_dialog;
    CReduction_Station& m_model;
};

} // namespace pyr
