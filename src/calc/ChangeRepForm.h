#pragma once

#include "calc/ChangeRep.h"
#include "ui/Form.h"

namespace pyr {

// The window of the change of reference frame: the two common points in the frames "Repère 1" and
// "Repère 2", the distances between them, the rotation and the translation, the check boxes and the
// selection; OK, enabled once both frames are complete, moves the points; Annuler leaves everything as it
// was.
class CChangeRepForm : public ui::Form {
public:
    enum Id : int {
        kFirstFrameGroup = 3,                                      // "Repère 1", then "Repère 2"
        kFirstField = kFirstFrameGroup + 2,                        // the eight fields, in the model's order
        kFirstFrameLabel = kFirstField + CChange_Rep::kFieldCount, // four labels in each frame
        kDistances = kFirstFrameLabel + 8,
        kResultsGroup,
        kLabelRotation,
        kRotation,
        kUnitRotation,
        kLabelTranslationX,
        kTranslationX,
        kLabelTranslationY,
        kTranslationY,
        kOptionsGroup,
        kLabelSelection,
        kSelection,
        kFirstSwitch, // the check box of switch `which` is kFirstSwitch + which
    };

    // `dialog` gives the command's inputs when the window opens; `model` is the dialog shown, given the
    // GéoBase it changes by whoever opens it.
    CChangeRepForm(const ui::DialogModel& dialog, CChange_Rep& model) : m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    const ui::DialogModel& m_dialog;
    CChange_Rep& m_model;
};

} // namespace pyr
