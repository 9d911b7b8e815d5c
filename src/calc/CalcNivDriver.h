#pragma once

#include "calc/CalcNiv.h"
#include "calc/ComputationOptions.h"
#include "ui/Dialog.h"

#include <memory>
#include <string>

namespace pyr {

// Direct levelling run from a command line, simple or by double station as constructed: "--depart A" and
// "--arrivee B" choose the runs leaving A and reaching B (every run between known heights by default),
// "--enregistrer" and "--listing"; the run opens the GéoBase, computes, writes and closes. With "--oui",
// a run out of tolerance is written, as a person answering yes would. It fails when no run could be
// computed, or when the GéoBase could not be saved.
class CCalcNivDriver : public ui::Dialog {
public:
    explicit CCalcNivDriver(LevellingMethod method) : m_model(method) {}
    std::string Caption() const override { return m_model.Caption(); }
    ui::DialogModel& Model() override { return m_model; }
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    CCalcNiv m_model;
    std::string m_start, m_end;
    ComputationRequests m_computation;
};

} // namespace pyr
