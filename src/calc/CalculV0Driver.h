#pragma once

#include "calc/CalculV0Sta.h"
#include "calc/ComputationOptions.h"
#include "ui/Dialog.h"

#include <memory>
#include <optional>
#include <string>

namespace pyr {

// The orientation of stations run from a command line: its options ("--type", "--station",
// "--references", "--x/--y/--z", "--liste", "--ponderation", "--forcer", "--v0", "--enregistrer",
// "--listing"), and the run that opens the GéoBase, applies what was asked, computes, writes and closes.
class CCalculV0Driver : public ui::Dialog {
public:
    std::string Caption() const override { return m_model.Caption(); }
    ui::DialogModel& Model() override { return m_model; }
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    bool ApplyRequests(ui::FrontEnd& frontEnd);

    CCalculV0Sta m_model;
    // What the command line asked for, applied once the GéoBase is open.
    struct Requests {
        StationChoiceRequests choice;
        std::optional<bool> weighted;
        bool forced = false;
        std::optional<std::string> references;
        std::optional<double> x, y, z;
        std::optional<double> v0;
        ComputationRequests computation;
    } m_requests;
};

} // namespace pyr
