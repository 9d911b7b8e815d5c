#pragma once

#include "calc/ChangeRep.h"
#include "ui/Dialog.h"

#include <array>
#include <memory>
#include <optional>
#include <string>

namespace pyr {

// The change of reference frame run from a command line: "--repere1 XA,YA,XB,YB" and "--repere2 ..." fill
// the eight fields, "--selection SEL" the selection, and one "0|1" option for each check box holds over the
// parameter file's value. The run opens the dialog on the GéoBase it was given and closes it with OK.
class CChangeRepDriver : public ui::Dialog {
public:
    std::string Caption() const override { return m_model.Caption(); }
    ui::DialogModel& Model() override { return m_model; }
    CChange_Rep& FrameChange() { return m_model; }
    // The selection the command line gave, when it gave one.
    const std::optional<std::string>& SelectionText() const { return m_selection; }
    const CChange_Rep& FrameChange() const { return m_model; }

    void DeclareOptions(ui::DialogOptions& options) override;
    // Fails when no GéoBase was given, when a frame is incomplete or the selection is not correct (a
    // message says why); nothing is changed then.
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    CChange_Rep m_model;
    // The two frames' four values as typed, and the selection, when the command line gives them.
    std::array<std::optional<std::array<std::string, 4>>, 2> m_frames;
    std::optional<std::string> m_selection;
    // The check boxes the command line set, in the order of ChangeRepSwitches().
    std::array<std::optional<bool>, kChangeRepSwitchCount> m_given;
};

} // namespace pyr
