#pragma once

#include "calc/CalcChem.h"
#include "ui/Form.h"

namespace pyr {

// The window of the polygonal traverses: the traverses of the GéoBase in a check list (none checked
// computes them all), the automatic search that adds those found among the set-ups, "&Calculer", a table
// of their closures against the tolerances, the status line, and at the foot "&Enregistrer", which writes
// the stations, "Fin + Listing" and "&Fermer".
class CCalcChemForm : public ui::Form {
public:
    enum Id : int {
        kLabelTraverses = 3,
        kTraverses,
        kSearch,
        kCalculate,
        kLabelResults,
        kResults,
        kStatus,
        kSave,
    };

    // `dialog` gives the command's inputs when the window opens; `model` is the dialog shown.
    CCalcChemForm(const ui::DialogModel& dialog, CCalcChem& model) : m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    std::string StatusText() const;
    // The traverse of rank `rank` checked or not: the others keep their marks.
    void CheckTraverse(int rank, bool on);
    void Finish(bool listingAsked);

    const ui::DialogModel& m_dialog;
    CCalcChem& m_model;
    bool m_saved = false;   // the results written into the GéoBase
    bool m_pending = false; // results computed and not yet written
    std::string m_message;  // what the last action left to say in the status line
};

} // namespace pyr
