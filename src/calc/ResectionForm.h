#pragma once

#include "calc/ResectionComputation.h"
#include "calc/SightingComputationForm.h"
#include "calc/StationTexts.h"

namespace pyr {

// The window of a station computed by resection or by the combined method: the station chosen in the combo,
// the results X, Y, V0 and Z with their EMQ (X and Y in the surveyor's order), and the button that writes the
// station.
class CResectionForm : public CSightingComputationForm {
public:
    // The result lines.
    enum Line : int { kLineFirst, kLineSecond, kLineV0, kLineZ };

    CResectionForm(const ui::DialogModel& dialog, CResectionComputation& model)
        : CSightingComputationForm(dialog, model, station::kLabelStation, station::kLabelWrite),
          m_model(model) {}

private:
    std::vector<ResultLine> ResultLines() const override;

    CResectionComputation& m_model;
};

} // namespace pyr
