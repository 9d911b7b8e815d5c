#include "calc/CalcRelev.h"

#include "calc/SessionTexts.h"
#include "calc/StationListing.h"
#include "settings/Journal.h"

namespace pyr {

CCalcRelev::CCalcRelev()
    : CStationComputation(
          {{{kJournalResection, session::kQuestionStationInvariantXY, session::kQuestionStationInvariantZ},
            "Calcul Relevement",
            ListingKind::Resection},
           "Calcul de la station %s par relèvement",
           false}) {}

int CCalcRelev::Compute(StationResult& result, bool plani, bool alti) const {
    return ComputeResection(result, plani, alti);
}

void CCalcRelev::WriteResult(CDlgCfgListing& listing, std::size_t index) const {
    WriteStationResult(listing, Results()[index], false);
}

} // namespace pyr
