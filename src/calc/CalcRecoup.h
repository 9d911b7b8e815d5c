#pragma once

#include "calc/ResectionComputation.h"

namespace pyr {

// The dialog "Calcul de la station %s par recoupement": a station occurrence placed, oriented and given
// its altitude by its sightings on known points and the sightings taken on it from other stations
// already placed and oriented. Its switches are kept in the section "Calcul Recoupement".
class CCalcRecoup : public CResectionComputation {
public:
    CCalcRecoup();

private:
    int Compute(StationResult& result, bool plani, bool alti) const override;
    void Warn(int flags) override;
    void WriteResult(CDlgCfgListing& listing, std::size_t index) const override;
};

} // namespace pyr
