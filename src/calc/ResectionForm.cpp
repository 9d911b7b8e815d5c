#include "calc/ResectionForm.h"

#include "calc/StationTexts.h"
#include "geobase/Elements.h"

namespace pyr {

std::vector<CSightingComputationForm::ResultLine> CResectionForm::ResultLines() const {
    // The names say the place, the labels the axis: X or Y first as the options show them.
    const bool swap = CPointGen::SwapXY();
    ResultLine x{station::kLabelX, "Premiere", m_model.XText(), m_model.EmqXText()};
    ResultLine y{station::kLabelY, "Seconde", m_model.YText(), m_model.EmqYText()};
    if (swap) std::swap(x.label, y.label), std::swap(x.value, y.value), std::swap(x.emq, y.emq);
    return {x,
            y,
            {station::kLabelV0, "V0", m_model.V0Text(), m_model.EmqV0Text()},
            {station::kLabelZ, "Altitude", m_model.ZText(), m_model.EmqZText()}};
}

} // namespace pyr
