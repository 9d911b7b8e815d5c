#pragma once

#include "calc/ComputationOptions.h"
#include "calc/SightingComputation.h"
#include "ui/Dialog.h"

#include <string>

namespace pyr {

// A computation from chosen sightings run from a command line. Its own options come first, then those
// every computation takes: "--plani 0|1", "--alti 0|1", "--enregistrer" and "--listing [FICHIER]". The
// run opens the model, sets its switches, does the command's own work, saves the GéoBase when
// "--enregistrer" asks it (without the question of the closing) and closes the model, with its listing
// when "--listing" asks it. It fails when what was asked could not be computed.
class CComputationDriver : public ui::Dialog {
public:
    std::string Caption() const override { return m_computation.Caption(); }
    ui::DialogModel& Model() override { return m_computation; }
    void DeclareOptions(ui::DialogOptions& options) final;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) final;

protected:
    // `computation` is the derived driver's own member: only kept here, used once the driver is built.
    // `saveHelp` is the help line of "--enregistrer".
    CComputationDriver(CSightingComputation& computation, const char* saveHelp)
        : m_computation(computation), m_saveHelp(saveHelp) {}

    virtual void DeclareOwnOptions(ui::DialogOptions& options) = 0;
    // The command's own work, on the model opened: false when what was asked could not be computed.
    virtual bool Compute(ui::FrontEnd& frontEnd) = 0;
    // Whether "--enregistrer" asks each result to be written.
    bool SaveAsked() const { return m_requests.save; }

private:
    CSightingComputation& m_computation;
    const char* m_saveHelp;
    ComputationRequests m_requests;
};

// A field of a dialog as the text window shows it: "-" when it is empty.
std::string Dashed(const std::string& text);
// A linear residual to the tenth of a millimetre, a zero without its sign; "-" when unknown.
std::string DashedMetres(double metres);

} // namespace pyr
