#pragma once

#include "calc/CalcRayon.h"
#include "calc/ComputationOptions.h"
#include "ui/Dialog.h"

#include <memory>
#include <optional>
#include <string>

namespace pyr {

// The radiated points run from a command line: "--type", "--station", "--liste", "--points",
// "--enregistrer" and "--listing"; the run opens the GéoBase, radiates, writes and closes. It fails when
// no station could be used, or when the GéoBase could not be saved.
class CCalcRayonDriver : public ui::Dialog {
public:
    std::string Caption() const override { return m_model.Caption(); }
    ui::DialogModel& Model() override { return m_model; }
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    CCalcRayon m_model;
    struct Requests {
        StationChoiceRequests choice;
        std::optional<std::string> points;
        ComputationRequests computation;
    } m_requests;
};

} // namespace pyr
