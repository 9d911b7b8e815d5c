#include "calc/CalcRecoup.h"

#include "calc/Recoupement.h"
#include "calc/RecoupementTexts.h"
#include "calc/SessionTexts.h"
#include "calc/StationListing.h"
#include "calc/StationTexts.h"
#include "settings/Journal.h"
#include "ui/FrontEnd.h"

namespace pyr {

CCalcRecoup::CCalcRecoup()
    : CResectionComputation(
          {{{kJournalRecoupement, session::kQuestionStationInvariantXY, session::kQuestionStationInvariantZ},
            "Calcul Recoupement",
            ListingKind::Recoupement},
           "Calcul de la station %s par recoupement",
           station::kMsgNoStation,
           station::kMsgStationNotOffered},
          true) {}

int CCalcRecoup::Compute(StationResult& result, bool plani, bool alti) const {
    return ComputeRecoupement(result, plani, alti);
}

void CCalcRecoup::Warn(int flags) {
    if ((flags & kStationWeakCrossing) && m_frontEnd)
        m_frontEnd->MessageBox(recoup::kMsgWeakCrossing, ui::kCaption, ui::kIconWarning);
}

void CCalcRecoup::WriteResult(CDlgCfgListing& listing, std::size_t index) const {
    WriteStationResult(listing, Results()[index], true);
}

} // namespace pyr
