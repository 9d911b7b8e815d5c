#include "calc/CalcRelev.h"

#include "calc/ResectionTexts.h"
#include "calc/SessionTexts.h"
#include "calc/StationListing.h"
#include "calc/StationTexts.h"
#include "settings/Journal.h"
#include "ui/FrontEnd.h"

namespace pyr {

CCalcRelev::CCalcRelev()
    : CResectionComputation(
          {{{kJournalResection, session::kQuestionStationInvariantXY, session::kQuestionStationInvariantZ},
            "Calcul Relevement",
            ListingKind::Resection},
           "Calcul de la station %s par relèvement",
           station::kMsgNoStation,
           station::kMsgStationNotOffered},
          false) {}

int CCalcRelev::Compute(StationResult& result, bool plani, bool alti) const {
    return ComputeResection(result, plani, alti);
}

// Fewer than three sightings taken is said at once, as well as in the status line: no triple, no place.
void CCalcRelev::Warn(int flags) {
    if ((flags & kStationTooFew) && m_frontEnd)
        m_frontEnd->MessageBox(resec::kMsgTooFew, ui::kCaption, ui::kIconWarning);
}

void CCalcRelev::WriteResult(CDlgCfgListing& listing, std::size_t index) const {
    WriteStationResult(listing, Results()[index], false);
}

} // namespace pyr
