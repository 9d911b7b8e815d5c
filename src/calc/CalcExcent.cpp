#include "calc/CalcExcent.h"

#include "calc/EccentricListing.h"
#include "calc/EccentricTexts.h"
#include "calc/SessionTexts.h"
#include "calc/StationTexts.h"
#include "core/Angles.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "geobase/Selection.h"
#include "settings/Journal.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <optional>

namespace pyr {

namespace {

// The parts of the dialog a change notice names, beside those of every computation.
constexpr int kPartCentre = 32; // the combo of the centre

bool IsSighting(int kind) {
    return kind == kKindReference || kind == kKindMesure;
}

} // namespace

CCalcExcent::CCalcExcent()
    : CStationComputation(
          {{{kJournalEccentric, session::kQuestionStationInvariantXY, session::kQuestionStationInvariantZ},
            "Calcul Station exc",
            ListingKind::EccentricStation},
           excent::kCaption,
           excent::kMsgNoStation,
           excent::kMsgStationNotOffered}) {}

// The station's sightings, up to the next station, on points with X and Y with a zenith angle and a
// distance: each point once, by its first such sighting.
std::vector<CCalcExcent::Candidate> CCalcExcent::CandidatesOf(int stationIndex) {
    const CCarnet& carnet = m_session.Carnet();
    const std::string station = PlaceOf(stationIndex).name;
    std::vector<Candidate> candidates;
    for (int i = stationIndex + 1; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (kind == kKindStation) break;
        if (!IsSighting(kind)) continue;
        const std::string mat = carnet.matAt(i);
        const double av = carnet.avAt(i), di = carnet.diAt(i);
        if (mat.empty() || mat == station || IsUndefined(av) || av < 0.0 || !(di > 0.0)) continue;
        if (!carnet.hasXY(mat)) continue;
        const bool seen = std::any_of(candidates.begin(), candidates.end(),
                                      [&](const Candidate& c) { return c.mat == mat; });
        if (!seen) candidates.push_back({i, mat, di});
    }
    return candidates;
}

void CCalcExcent::StationChosen() {
    m_centres = CandidatesOf(StationIndex());
    m_centreNames.clear();
    for (const Candidate& candidate : m_centres)
        m_centreNames.push_back(candidate.mat);
    // The centre offered first is the nearest point sighted: a station is set up eccentric a few metres
    // from a point it cannot occupy, while its reference points lie much farther away.
    const auto nearest = std::min_element(m_centres.begin(), m_centres.end(),
                                          [](const Candidate& a, const Candidate& b) { return a.di < b.di; });
    ChooseCentre(nearest->mat);
}

bool CCalcExcent::ChooseCentre(std::string_view mat) {
    const auto found = std::find(m_centreNames.begin(), m_centreNames.end(), mat);
    if (found == m_centreNames.end()) {
        if (m_frontEnd)
            m_frontEnd->MessageBox(
                Sprintf(excent::kMsgCentreNotSighted, std::string(mat).c_str(), Station().c_str()),
                ui::kCaption, ui::kIconWarning);
        return false;
    }
    m_centre = static_cast<int>(found - m_centreNames.begin());
    m_result = EccentricResult();
    m_result.centre = *found;
    m_lists.Fill(SightingsOnKnownPoints(StationIndex(), *found));
    Notify(kPartCentre);
    Moved(true);
    return true;
}

bool CCalcExcent::SelectReferences(std::string_view selection) {
    const std::optional<CSelection> parsed = CSelection::Parse(selection);
    if (!parsed) return false;
    const CCarnet& carnet = m_session.Carnet();
    const bool any =
        m_lists.SelectOnly([&](const Line& line) { return parsed->Contains(carnet.matAt(line.index)); });
    Moved(true);
    return any;
}

// ---- Computing -------------------------------------------------------------------------------------------

EccentricSighting CCalcExcent::Gather(const Line& line) {
    const CCarnet& carnet = m_session.Carnet();
    const ReducedSighting reduced =
        ReduceSighting(carnet, PlaceOf(line.station), line.index, m_session.Reduction());
    EccentricSighting s;
    s.index = line.index;
    s.reference = reduced.mat;
    PointPlace(carnet, reduced.mat, s.x, s.y, s.z);
    s.hp = reduced.hp;
    s.ah = reduced.ah, s.av = reduced.av, s.di = reduced.di;
    return s;
}

// The sighting on the centre. Its horizontal distance is corrected for scale without a place: the
// station's place is what is being computed, and a few metres from C the correction is the same.
void CCalcExcent::GatherCentre() {
    const CCarnet& carnet = m_session.Carnet();
    const Candidate& centre = m_centres[static_cast<std::size_t>(m_centre)];
    const ReducedSighting reduced =
        ReduceSighting(carnet, PlaceOf(StationIndex()), centre.index, m_session.Reduction());
    m_result.centre = centre.mat;
    m_result.hpC = reduced.hp;
    m_result.ahC = reduced.ah, m_result.avC = reduced.av, m_result.diC = reduced.di;
    PointPlace(carnet, centre.mat, m_result.xC, m_result.yC, m_result.zC);
    // Turned to face left, the zenith angle lies within [0, 200] gr: its sine is the fold's.
    if (reduced.di > 0.0 && IsKnown(reduced.av)) {
        double dh = reduced.di * SinGrads(reduced.av);
        if (dh > 0.0) {
            CorrectHorizontalDistance(dh, kUndefined, kUndefined, kUndefined,
                                      m_session.Reduction().correction);
            m_result.dhC = dh;
        }
    }
}

void CCalcExcent::Recompute() {
    const std::string centre = m_result.centre;
    m_result = EccentricResult();
    m_result.centre = centre;
    if (StationIndex() < 0 || m_centre < 0) {
        Notify(kPartResult);
        return;
    }
    const StationPlace& place = PlaceOf(StationIndex());
    m_result.stationIndex = StationIndex();
    m_result.station = place.name;
    m_result.reprise = place.reprise;
    m_result.hi = place.hi;
    GatherCentre();
    // No reference taken: nothing computed, the fields cleared.
    if (m_lists.Selected().empty()) {
        Notify(kPartResult);
        return;
    }
    for (const Line& line : m_lists.Selected())
        m_result.sightings.push_back(Gather(line));
    const int flags = ComputeEccentricStation(m_result, Plani(), Alti());
    if ((flags & (kExcentIncomplete | kExcentNoConvergence)) && m_frontEnd)
        m_frontEnd->MessageBox(session::kMsgNotComputed, ui::kCaption, ui::kIconWarning);
    if (Computed()) m_results.Keep(Station(), m_result);
    Notify(kPartResult);
}

bool CCalcExcent::Computed() const {
    return (m_result.flags & kExcentComputed) != 0 || IsKnown(m_result.z);
}

bool CCalcExcent::CanWrite() const {
    return (IsKnown(m_result.x) && IsKnown(m_result.y)) || IsKnown(m_result.z);
}

bool CCalcExcent::CanFinish() const {
    return m_lists.Count() >= 1;
}

std::string CCalcExcent::XText() const {
    return Shown(m_result.x, CPointGen::DeciXY());
}
std::string CCalcExcent::YText() const {
    return Shown(m_result.y, CPointGen::DeciXY());
}
std::string CCalcExcent::V0Text() const {
    return Shown(m_result.v0, CStation::DeciAng());
}
std::string CCalcExcent::ZText() const {
    return Shown(m_result.z, CPointGen::DeciZ());
}
std::string CCalcExcent::EmqZText() const {
    return Shown(m_result.emqZ, CPointGen::DeciZ());
}

void CCalcExcent::WriteResult(CDlgCfgListing& listing, std::size_t index) const {
    WriteEccentricResult(listing, Results()[index], m_session.Tolerance());
}

// ---- Writing ---------------------------------------------------------------------------------------------

bool CCalcExcent::Write() {
    return WriteStation(m_result.x, m_result.y, m_result.z, m_result.v0);
}

} // namespace pyr
