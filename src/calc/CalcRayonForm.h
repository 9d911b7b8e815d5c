#pragma once

#include "calc/CalcRayon.h"
#include "calc/StationTypeGroup.h"
#include "ui/Form.h"

namespace pyr {

// The window of the radiated points: the stations to radiate (one, a list, all), the points to compute,
// the checks "Contrôler les points connus" and "V0 calculé", the new points found with their spread, the
// count of what was done; "&Calculer", and "&Enregistrer" which writes the points and closes.
class CCalcRayonForm : public ui::Form {
public:
    enum Id : int {
        kType = 3,
        kUnique,
        kListe,
        kToutes,
        kLabelList,
        kList,
        kLabelStation,
        kStation,
        kLabelPoints,
        kPoints,
        kComputeV0,
        kCheckKnown,
        kLabelResults,
        kResults,
        kStatus,
        kCalculate,
    };
    // "&Type de calcul :", from kType to kList.
    static constexpr StationTypeGroup kTypeGroup{kType};

    // The new points shown at most: beyond, the listing gives them all.
    static constexpr std::size_t kShownPoints = 2000;

    CCalcRayonForm(const ui::DialogModel& dialog, CCalcRayon& model) : m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    std::vector<std::string> ResultLines() const;
    std::string Status() const;

    const ui::DialogModel& m_dialog;
    CCalcRayon& m_model;
};

} // namespace pyr
