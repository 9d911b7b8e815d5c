#pragma once

#include "calc/CalcInters.h"
#include "calc/ComputationDriver.h"

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
class CCalcIntersDriver : public CComputationDriver {
public:
    CCalcIntersDriver();
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    void DeclareOwnOptions(ui::DialogOptions& options) override;
    // Every point asked, by name or by selection, computed in turn.
    bool Compute(ui::FrontEnd& frontEnd) override;
    bool ComputePoint(ui::FrontEnd& frontEnd, const std::string& mat);
    void Print(ui::FrontEnd& frontEnd);

    CCalcInters m_model;
    struct Requests {
        std::vector<std::string> points;
        std::optional<std::string> selection;
        std::optional<std::string> stations;
    } m_requests;
};

} // namespace pyr
