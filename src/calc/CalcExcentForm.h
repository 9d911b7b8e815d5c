#pragma once

#include "calc/CalcExcent.h"
#include "calc/SightingComputationForm.h"
#include "calc/StationTexts.h"

namespace pyr {

// The window of an eccentric station: the station chosen in the combo, its centre in a second combo
// beside it, the results X, Y and V0 (no error: one sighting places the station) and Z with the error of
// the altitude from the references, and the button that writes the station.
class CCalcExcentForm : public CSightingComputationForm {
public:
    // The result lines.
    enum Line : int { kLineFirst, kLineSecond, kLineV0, kLineZ };
    // The controls of the centre.
    enum Own : int { kLabelCentre = kFirstOwn, kCentre };

    CCalcExcentForm(const ui::DialogModel& dialog, CCalcExcent& model)
        : CSightingComputationForm(dialog, model, station::kLabelStation, station::kLabelWrite),
          m_model(model) {}

private:
    std::vector<ResultLine> ResultLines() const override;
    void AddOwnControls(std::vector<ui::Control>& controls) const override;
    ui::ControlState OwnState(int id) const override;
    void OwnAct(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

    CCalcExcent& m_model;
};

} // namespace pyr
