#pragma once

#include "calc/CalcNiv.h"
#include "calc/ResultsForm.h"

namespace pyr {

// The window of direct levelling, simple or by double station as its model is: the benchmarks a run
// leaves and reaches chosen in two combos ("(toutes)" for any), "&Calculer", a table of the runs with
// their misclosures against their tolerances, the remarks on what could not be made into a run, the
// status line, and at the foot "&Enregistrer", which writes the heights, "Fin + Listing" and "&Fermer".
class CCalcNivForm : public CResultsForm {
public:
    enum Id : int {
        kLabelStart = 3,
        kStart,
        kLabelEnd,
        kEnd,
        kCalculate,
        kLabelResults,
        kResults,
        kLabelProblems,
        kProblems,
        kStatus,
        kSave,
    };

    // `dialog` gives the command's inputs when the window opens; `model` is the dialog shown.
    CCalcNivForm(const ui::DialogModel& dialog, CCalcNiv& model)
        : CResultsForm(kSave), m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    std::string StatusText() const;
    ui::ControlState BenchmarkState(const std::string& chosen) const;
    bool WriteResults() override { return m_model.Enregistrer(); }
    void CloseModel(bool saved, bool listingAsked) override { m_model.Close(saved, listingAsked); }
    bool HasResults() const override { return !m_model.Runs().empty(); }

    const ui::DialogModel& m_dialog;
    CCalcNiv& m_model;
    std::vector<std::string> m_benchmarks; // read when the window opens
    bool m_computed = false;
};

} // namespace pyr
