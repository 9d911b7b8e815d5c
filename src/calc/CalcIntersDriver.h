#pragma once

#include "calc/CalcInters.h"
#include "calc/ComputationOptions.h"
#include "ui/Dialog.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pyr {

// Points by intersection run from a command line: "--point NOM" (again for each point, computed in turn
// as a person picks them one after the other in the combo), "--points SELECTION", "--visees LISTE" (the
// stations whose sightings are taken), "--plani 0|1", "--alti 0|1", "--enregistrer" (every point computed
// written and the GéoBase saved), "--listing [FICHIER]". Each point's result is printed as the dialog
// shows it. The run fails when a point asked for could not be computed.
class CCalcIntersDriver : public ui::Dialog {
public:
    std::string Caption() const override { return m_model.Caption(); }
    ui::DialogModel& Model() override { return m_model; }
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    bool ComputePoints(ui::FrontEnd& frontEnd);
    bool ComputePoint(ui::FrontEnd& frontEnd, const std::string& mat);
    void Print(ui::FrontEnd& frontEnd);

    CCalcInters m_model;
    struct Requests {
        std::vector<std::string> points;
        std::optional<std::string> selection;
        std::optional<std::string> stations;
        ComputationRequests computation;
    } m_requests;
};

} // namespace pyr
