#pragma once

#include "calc/StationReduction.h"
#include "ui/Dialog.h"

#include <array>
#include <memory>
#include <optional>
#include <string>

namespace pyr {

// The reduction of stations run from a command line: "--VisComm 0|1" ... one option for each check box,
// holding over the parameter file's value, and the run that opens the dialog on the GéoBase it was given
// and closes it with OK, there being nothing else to choose.
class CReductionDriver : public ui::Dialog {
public:
    std::string Caption() const override { return m_model.Caption(); }
    ui::DialogModel& Model() override { return m_model; }
    CReduction_Station& Reduction() { return m_model; }
    const CReduction_Station& Reduction() const { return m_model; }

    void DeclareOptions(ui::DialogOptions& options) override;
    // Fails when no GéoBase was given to the reduction.
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    CReduction_Station m_model;
    // The check boxes the command line set, in the order of ReductionSwitches().
    std::array<std::optional<bool>, kReductionSwitchCount> m_given;
};

} // namespace pyr
