#pragma once

#include "calc/CalcInters.h"
#include "ui/Form.h"

namespace pyr {

// The window of points by intersection: the point chosen in a combo, its sightings in two lists moved by
// four arrows (the point computed again on every move), the two switches, the results with their EMQ in
// the surveyor's order of the axes, the status line, the button that writes the point, and "Fin +
// Listing", which takes the focus after every move.
class CCalcIntersForm : public ui::Form {
public:
    enum Id : int {
        kLabelPoint = 3,
        kPoint,
        kLabelAvailable,
        kAvailable,
        kAddOne,
        kAddAll,
        kRemoveOne,
        kRemoveAll,
        kLabelSelected,
        kSelected,
        kPlani,
        kAlti,
        kResults,
        kLabelFirst, // "X =" or "Y =", as the axes are shown
        kFirst,
        kLabelEmqFirst,
        kEmqFirst,
        kLabelSecond,
        kSecond,
        kLabelEmqSecond,
        kEmqSecond,
        kLabelZ,
        kZ,
        kLabelEmqZ,
        kEmqZ,
        kStatus,
        kWrite,
    };

    // `dialog` gives the command's inputs when the window opens; `model` is the dialog shown.
    CCalcIntersForm(const ui::DialogModel& dialog, CCalcInters& model) : m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    // After a move between the lists, "Fin + Listing" takes the focus when it can end the dialog.
    void Moved();

    const ui::DialogModel& m_dialog;
    CCalcInters& m_model;
    bool m_written = false; // a point was written into the GéoBase
};

} // namespace pyr
