#pragma once

#include "calc/CalcRecoup.h"
#include "calc/CalcRelev.h"
#include "calc/ComputationDriver.h"

#include <memory>
#include <optional>
#include <string>

namespace pyr {

// A station computed by resection or by the combined method from a command line: "--station NOM" (or "NOM(2)"
// for an occurrence), "--visees SELECTION" (the points, or the sighting stations, whose lines are taken; by
// default every line the dialog offers), "--plani 0|1", "--alti 0|1", "--enregistrer" (the station's point
// and V0 written and the GéoBase saved), "--listing [FICHIER]". The result is printed as the dialog shows it;
// the run fails when the station could not be computed.
class CResectionDriver : public CComputationDriver {
public:
    std::unique_ptr<ui::Form> MakeForm() override;

protected:
    // `model` is the derived driver's own member: only kept here, used once the driver is built.
    explicit CResectionDriver(CResectionComputation& model);

private:
    void DeclareOwnOptions(ui::DialogOptions& options) override;
    bool Compute(ui::FrontEnd& frontEnd) override;
    void Print(ui::FrontEnd& frontEnd);

    CResectionComputation& m_model;
    struct Requests {
        std::optional<std::string> station;
        std::optional<std::string> sightings;
    } m_requests;
};

// "CalRelev".
class CCalcRelevDriver final : public CResectionDriver {
public:
    CCalcRelevDriver() : CResectionDriver(m_relev) {}

private:
    CCalcRelev m_relev;
};

// "CalRecou".
class CCalcRecoupDriver final : public CResectionDriver {
public:
    CCalcRecoupDriver() : CResectionDriver(m_recoup) {}

private:
    CCalcRecoup m_recoup;
};

} // namespace pyr
