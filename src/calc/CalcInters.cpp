#include "calc/CalcInters.h"

#include "calc/IntersectionListing.h"
#include "calc/IntersectionTexts.h"
#include "calc/SessionTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Selection.h"
#include "settings/CalcOptions.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <unordered_set>

namespace pyr {

namespace {
// The calculation option by which the intersection takes the target heights and vertical offsets.
constexpr const char* kKeyTargetHeights = "IntersAvecHp";
} // namespace

CCalcInters::CCalcInters()
    : CSightingComputation(
          {{kJournalIntersection, session::kQuestionInvariantXY, session::kQuestionInvariantZ},
           inters::kSection,
           ListingKind::Intersection}) {}

std::string CCalcInters::Caption() const {
    return m_point.empty() ? Inputs().title : Sprintf(inters::kCaption, m_point.c_str());
}

// ---- Opening and closing --------------------------------------------------------------------------------

bool CCalcInters::Open(ui::FrontEnd& frontEnd) {
    if (!OpenSession(frontEnd)) return false;
    m_session.Reduction().targetHeights =
        ReadOptionSwitch(m_session.ParamPath(), kSectionCalculations, kKeyTargetHeights);
    FindPoints();
    if (m_points.empty()) {
        frontEnd.MessageBox(Sprintf(inters::kMsgNoPoint, m_session.Path().c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    Notify(kPartSubject | kPartSwitches);
    return true;
}

void CCalcInters::WriteResult(CDlgCfgListing& listing, std::size_t index) const {
    WriteIntersectionResult(listing, m_results.All()[index]);
}

// ---- The combo and the lists ----------------------------------------------------------------------------

// Points measured from at least one station whose place and orientation are known, in the order they
// were first sighted.
void CCalcInters::FindPoints() {
    const CCarnet& carnet = m_session.Carnet();
    m_points.clear();
    m_offered.clear();
    std::string name;
    for (int i = carnet.Find(kKindMesure, ""); i >= 0; i = carnet.Find(kKindMesure, "", i + 1)) {
        std::string mat = carnet.matAt(i);
        if (mat.empty() || m_offered.count(mat)) continue;
        const int station = carnet.findRepAt(i, name);
        if (station < 0) continue;
        const StationPlace& place = PlaceOf(station);
        if (!place.HasPlace() || !place.IsOriented()) continue;
        m_offered.insert(mat);
        m_points.push_back(std::move(mat));
    }
}

bool CCalcInters::ChoosePoint(std::string_view mat) {
    if (!m_offered.count(std::string(mat))) {
        if (m_frontEnd)
            m_frontEnd->MessageBox(Sprintf(inters::kMsgPointNotOffered, std::string(mat).c_str()),
                                   ui::kCaption, ui::kIconWarning);
        return false;
    }
    const CCarnet& carnet = m_session.Carnet();
    m_point = mat;
    std::vector<Line> available;
    std::string name;
    for (int i = carnet.Find(kKindMesure, mat); i >= 0; i = carnet.Find(kKindMesure, mat, i + 1)) {
        const int station = carnet.findRepAt(i, name);
        if (station < 0) continue;
        const StationPlace& place = PlaceOf(station);
        if (!place.HasPlace() || !place.IsOriented()) continue;
        Line line;
        line.index = i;
        line.station = station;
        line.text = Sprintf(inters::kLine, place.Designation().c_str(), m_point.c_str());
        line.tooltip =
            Sprintf(inters::kTooltip, carnet.cmdAt(i).c_str(), m_point.c_str(), carnet.parAt(i).c_str());
        available.push_back(std::move(line));
    }
    m_lists.Fill(std::move(available));
    Notify(kPartCaption);
    Moved(true);
    return true;
}

bool CCalcInters::SelectStations(std::string_view selection) {
    const std::optional<CSelection> parsed = CSelection::Parse(selection);
    if (!parsed) return false;
    const CCarnet& carnet = m_session.Carnet();
    const bool any =
        m_lists.SelectOnly([&](const Line& line) { return parsed->Contains(carnet.matAt(line.station)); });
    Moved(true);
    return any;
}

// ---- Computing ------------------------------------------------------------------------------------------

InterSighting CCalcInters::Gather(const Line& line) {
    const StationPlace& station = PlaceOf(line.station);
    const ReducedSighting reduced =
        ReduceSighting(m_session.Carnet(), station, line.index, m_session.Reduction());
    InterSighting sighting;
    sighting.index = line.index;
    sighting.station = station.name;
    sighting.reprise = station.reprise;
    sighting.reference = reduced.mat;
    sighting.xs = station.x, sighting.ys = station.y, sighting.zs = station.z;
    sighting.v0 = station.v0;
    sighting.hi = station.hi;
    sighting.hp = reduced.hp;
    sighting.ah = reduced.ah, sighting.av = reduced.av, sighting.di = reduced.di;
    sighting.dh = reduced.dh;
    return sighting;
}

bool CCalcInters::Computed() const {
    return (m_result.flags & kInterComputed) != 0 || IsKnown(m_result.z);
}

void CCalcInters::Recompute() {
    m_result = InterResult();
    m_result.mat = m_point;
    if (m_point.empty() || m_lists.Selected().empty()) {
        Notify(kPartResult);
        return;
    }
    for (const Line& line : m_lists.Selected())
        m_result.sightings.push_back(Gather(line));
    const int flags = ComputeIntersection(m_result, Plani(), Alti());
    if ((flags & kInterTooClose) && (flags & kInterComputed) && m_frontEnd)
        m_frontEnd->MessageBox(inters::kMsgTooClose, ui::kCaption, ui::kIconWarning);
    if (Computed()) {
        m_results.Keep(m_result.mat, m_result);
    } else if (!(flags & (kInterTooFew | kInterParallel)) && m_frontEnd) {
        m_frontEnd->MessageBox(session::kMsgNotComputed, ui::kCaption, ui::kIconWarning);
    }
    Notify(kPartResult);
}

bool CCalcInters::CanWrite() const {
    return (IsKnown(m_result.x) && IsKnown(m_result.y)) || IsKnown(m_result.z);
}

bool CCalcInters::CanFinish() const {
    return m_lists.Count() >= 2;
}

std::string CCalcInters::XText() const {
    return Shown(m_result.x, CPointGen::DeciXY());
}
std::string CCalcInters::YText() const {
    return Shown(m_result.y, CPointGen::DeciXY());
}
std::string CCalcInters::EmqXText() const {
    return Shown(m_result.emqX, CPointGen::DeciXY());
}
std::string CCalcInters::EmqYText() const {
    return Shown(m_result.emqY, CPointGen::DeciXY());
}
std::string CCalcInters::ZText() const {
    return Shown(m_result.z, CPointGen::DeciZ());
}
std::string CCalcInters::EmqZText() const {
    return Shown(m_result.emqZ, CPointGen::DeciZ());
}

// ---- Writing --------------------------------------------------------------------------------------------

bool CCalcInters::WritePoint() {
    if (!CanWrite() || !m_session.IsOpen()) return false;
    const bool written = m_session.WritePoint(m_result.mat, m_result.x, m_result.y, m_result.z);
    ForgetPlaces(); // a station on the point written is placed by it from now on
    Notify(kPartResult);
    return written;
}

} // namespace pyr
