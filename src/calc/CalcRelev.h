#pragma once

#include "calc/ResectionComputation.h"

namespace pyr {

// The dialog "Calcul de la station %s par relèvement": a station occurrence placed, oriented and given
// its altitude by its sightings on three or more known points. Its switches are kept in the section
// "Calcul Relevement".
class CCalcRelev : public CResectionComputation {
public:
    CCalcRelev();

private:
    int Compute(StationResult& result, bool plani, bool alti) const override;
    void Warn(int flags) override;
    void WriteResult(CDlgCfgListing& listing, std::size_t index) const override;
};

} // namespace pyr
