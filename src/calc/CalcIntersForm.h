#pragma once

#include "calc/CalcInters.h"
#include "calc/SightingComputationForm.h"

namespace pyr {

// The window of points by intersection: the point chosen in the combo, the results X, Y and Z with
// their EMQ in the surveyor's order of the axes, and the button that writes the point.
class CCalcIntersForm : public CSightingComputationForm {
public:
    // The result lines.
    enum Line : int { kLineFirst, kLineSecond, kLineZ };

    CCalcIntersForm(const ui::DialogModel& dialog, CCalcInters& model)
        : CSightingComputationForm(dialog, model, "&Point :", "É&crire le point"), m_model(model) {}

private:
    std::vector<ResultLine> ResultLines() const override;

    CCalcInters& m_model;
};

} // namespace pyr
