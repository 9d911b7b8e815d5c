#pragma once

#include "calc/CalcExcent.h"
#include "calc/ComputationDriver.h"

#include <memory>
#include <optional>
#include <string>

namespace pyr {

// An eccentric station computed from a command line, "CalExcen": "--station NOM" (or "NOM(2)" for an
// occurrence), "--centre C" (the known point sighted with a distance beside which it stands), "--appuis
// SELECTION" (the reference points whose sightings are taken; by default every one the dialog offers),
// "--plani 0|1", "--alti 0|1", "--enregistrer" (the station's point and V0 written and the GéoBase
// saved), "--listing [FICHIER]". The result is printed as the dialog shows it; the run fails when the
// station could not be computed.
class CCalcExcentDriver : public CComputationDriver {
public:
    CCalcExcentDriver();
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    void DeclareOwnOptions(ui::DialogOptions& options) override;
    bool Compute(ui::FrontEnd& frontEnd) override;
    void Print(ui::FrontEnd& frontEnd);

    CCalcExcent m_model;
    struct Requests {
        std::optional<std::string> station;
        std::optional<std::string> centre;
        std::optional<std::string> references;
    } m_requests;
};

} // namespace pyr
