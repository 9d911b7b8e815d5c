#include "calc/ComputationSession.h"

#include "calc/SessionTexts.h"
#include "core/Files.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "settings/CalcOptions.h"
#include "settings/LastGeoBase.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

namespace pyr {

namespace {
// Computed values go into the GéoBase with its own decimals, rounded once: a height rounded first to
// the tenth of a millimetre and then to the millimetre may lose half a millimetre (100.67852 would give
// 100.6785, then 100.678).
double Kept(double value, int decimals) {
    return IsKnown(value) ? RoundToDecimals(value, decimals) : kUndefined;
}
} // namespace

bool CComputationSession::Open(ui::FrontEnd& frontEnd, ui::DialogModel& dialog) {
    m_frontEnd = &frontEnd;
    m_paramPath = dialog.Inputs().paramPath;
    ApplyStoreOptions(m_paramPath);
    // The last GéoBase is offered first; the person may take another.
    if (!dialog.GeoBaseNamed() && !dialog.GeoBase().empty()) {
        auto chosen = frontEnd.ChooseFile(
            {false, session::kChooseGeoBase, kGeoFileFilter, kGeoFileExtension, dialog.GeoBase()});
        if (!chosen) {
            m_cancelled = true;
            return false;
        }
        dialog.SetGeoBase(*chosen);
    }
    m_path = dialog.GeoBase();
    if (m_path.empty()) {
        frontEnd.MessageBox(session::kMsgNoGeoBase, ui::kCaption, ui::kIconWarning);
        return false;
    }
    CPyrTxtWnd txt(frontEnd);
    if (!m_carnet.Load(&txt, m_path, {}, 0, &frontEnd)) return false;
    if (m_carnet.IsEmpty()) {
        frontEnd.MessageBox(Sprintf(session::kMsgEmptyGeoBase, m_path.c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    m_tolerances = Tolerances::FromOptions(m_paramPath);
    m_reduction.correction = DistanceCorrection::FromOptions(m_paramPath);
    m_reduction.defaultInstrument = DefaultInstrument(m_paramPath);
    if (const std::string why = m_reduction.correction.ProjectionError(); !why.empty())
        frontEnd.MessageBox(why, ui::kCaption, ui::kIconWarning);
    m_journal = std::make_unique<CJournal>(m_path, m_words.journal);
    m_open = true;
    return true;
}

bool CComputationSession::WritePoint(std::string_view mat, double x, double y, double z) {
    if (!IsOpen()) return false;
    x = Kept(x, CPointGen::DeciXY()), y = Kept(y, CPointGen::DeciXY()), z = Kept(z, CPointGen::DeciZ());
    bool withXY = IsKnown(x) && IsKnown(y);
    bool withZ = IsKnown(z);
    const std::string name(mat);
    const int found = m_carnet.findMat(mat);
    auto* point = found >= 0 ? m_carnet.As<CPointGen>(found) : nullptr;
    auto replaceInvariant = [&](const char* question) {
        return m_frontEnd->Ask(Sprintf(question, name.c_str()), ui::kCaption, ui::Buttons::YesNo,
                               ui::Answer::No) == ui::Answer::Yes;
    };
    if (point && withXY && point->hasXY() && point->invariantXY() && !replaceInvariant(m_words.invariantXY))
        withXY = false;
    if (point && withZ && point->hasZ() && point->invariantZ() && !replaceInvariant(m_words.invariantZ))
        withZ = false;
    if (!withXY && !withZ) {
        CPyrTxtWnd(*m_frontEnd).Print(session::kLineInvariantKept, name.c_str());
        return true;
    }

    bool written = false;
    if (point) {
        written = withXY && withZ ? point->setPt(x, y, z) : withXY ? point->setPt(x, y) : point->setPt(z);
    } else {
        auto created = std::make_unique<CPointGen>(name, kUndefined, kUndefined, kUndefined);
        written = withXY && withZ ? created->setPt(x, y, z)
                  : withXY        ? created->setPt(x, y)
                                  : created->setPt(z);
        written = written && m_carnet.Add(std::move(created), kKindPoint) >= 0;
    }
    if (!written) {
        m_frontEnd->MessageBox(session::kMsgWriteRefused, ui::kCaption, ui::kIconWarning);
        return false;
    }
    m_modified = true;
    m_journal->AddPoint(name, withXY ? x : kUndefined, withXY ? y : kUndefined, withZ ? z : kUndefined,
                        CPointGen::SwapXY());
    CPyrTxtWnd(*m_frontEnd).Print(session::kLinePointWritten, name.c_str());
    return true;
}

bool CComputationSession::WriteStationV0(int stationIndex, std::string_view designation, double v0) {
    auto* station = m_carnet.As<CStation>(stationIndex);
    if (!IsOpen() || !station) return false;
    station->setV0(v0);
    m_modified = true;
    m_journal->AddStation(designation, v0);
    return true;
}

bool CComputationSession::Save() {
    if (!IsOpen()) return false;
    if (!m_carnet.BackUp(m_frontEnd) || !m_carnet.Save(m_path, m_frontEnd, false)) return false;
    m_modified = false;
    m_saved = true;
    WriteLastGeoBase(m_paramPath, WholePath(m_path));
    CPyrTxtWnd(*m_frontEnd).Print(msg::kSaved, m_path.c_str());
    return true;
}

bool CComputationSession::OfferSave() {
    if (!IsOpen() || !m_modified) return true;
    if (m_frontEnd->Ask(session::kQuestionSaveModified, ui::kCaption, ui::Buttons::YesNo, ui::Answer::Yes) !=
        ui::Answer::Yes)
        return true;
    return Save();
}

std::string CComputationSession::Close(ListingRequest listing) {
    if (!m_frontEnd) return {};
    std::string path;
    if (listing.resultCount > 0) {
        listing.paramPath = m_paramPath;
        listing.geobasePath = m_path;
        path = WriteComputationListing(*m_frontEnd, listing);
    }
    // A journal that cannot be completed is told to the front end as a failure of the command; the
    // GéoBase, already saved, stands.
    if (m_saved && m_journal && JournalWanted(m_paramPath)) m_journal->Append(*m_frontEnd);
    return path;
}

} // namespace pyr
