#pragma once

#include "calc/CalcChem.h"
#include "calc/ResultsForm.h"

namespace pyr {

// The window of the polygonal traverses: the traverses of the GéoBase in a check list (none checked
// computes them all), the automatic search that adds those found among the set-ups, "&Calculer", a table
// of their closures against the tolerances, the status line, and at the foot "&Enregistrer", which writes
// the stations, "Fin + Listing" and "&Fermer".
class CCalcChemForm : public CResultsForm {
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
    CCalcChemForm(const ui::DialogModel& dialog, CCalcChem& model)
        : CResultsForm(kSave), m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    std::string StatusText() const;
    // The traverse of rank `rank` checked or not: the others keep their marks.
    void CheckTraverse(int rank, bool on);
    bool WriteResults() override { return m_model.Enregistrer(); }
    void CloseModel(bool saved, bool listingAsked) override { m_model.Close(saved, listingAsked); }
    bool HasResults() const override { return !m_model.Results().empty(); }

    const ui::DialogModel& m_dialog;
    CCalcChem& m_model;
};

} // namespace pyr
