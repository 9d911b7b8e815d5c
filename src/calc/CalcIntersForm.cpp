#include "calc/CalcIntersForm.h"

#include "calc/IntersectionTexts.h"
#include "geobase/Elements.h"

namespace pyr {

std::vector<CSightingComputationForm::ResultLine> CCalcIntersForm::ResultLines() const {
    // The names say the place, the labels the axis: X or Y first as the options show them.
    const bool swap = CPointGen::SwapXY();
    ResultLine x{inters::kLabelX, "X", m_model.XText(), m_model.EmqXText()};
    ResultLine y{inters::kLabelY, "Y", m_model.YText(), m_model.EmqYText()};
    std::vector<ResultLine> lines{
        swap ? y : x, swap ? x : y, {"Z =", "Altitude", m_model.ZText(), m_model.EmqZText()}};
    lines[0].name = "Premiere", lines[1].name = "Seconde";
    return lines;
}

} // namespace pyr
