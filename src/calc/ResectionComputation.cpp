#include "calc/ResectionComputation.h"

#include "calc/SessionTexts.h"
#include "calc/StationTexts.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "geobase/Selection.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <cstddef>
#include <optional>

namespace pyr {

std::vector<CResectionComputation::Line> CResectionComputation::LinesOf(int stationIndex) {
    const CCarnet& carnet = m_session.Carnet();
    const StationPlace station = PlaceOf(stationIndex);
    std::vector<Line> lines = SightingsOnKnownPoints(stationIndex);
    if (!m_withIntersections) return lines;
    // On the station from the others, placed and oriented, in GéoBase order.
    const std::size_t fromStation = lines.size();
    std::string name;
    for (int kind : {kKindReference, kKindMesure})
        for (int i = carnet.Find(kind, station.name); i >= 0; i = carnet.Find(kind, station.name, i + 1)) {
            const int from = carnet.findRepAt(i, name);
            if (from < 0 || from == stationIndex) continue;
            const StationPlace& other = PlaceOf(from);
            if (!other.HasPlace() || !other.IsOriented()) continue;
            lines.push_back({i, from, Sprintf(station::kLineIntersection, other.name.c_str(), other.reprise),
                             Tooltip(i, station.name)});
        }
    std::sort(lines.begin() + static_cast<std::ptrdiff_t>(fromStation), lines.end(),
              [](const Line& a, const Line& b) { return a.index < b.index; });
    return lines;
}

void CResectionComputation::StationChosen() {
    m_lists.Fill(LinesOf(StationIndex()));
    Moved(true);
}

bool CResectionComputation::SelectSightings(std::string_view selection) {
    const std::optional<CSelection> parsed = CSelection::Parse(selection);
    if (!parsed) return false;
    const CCarnet& carnet = m_session.Carnet();
    const bool any = m_lists.SelectOnly([&](const Line& line) {
        const std::string known =
            line.station == StationIndex() ? carnet.matAt(line.index) : carnet.matAt(line.station);
        return parsed->Contains(known);
    });
    Moved(true);
    return any;
}

// ---- Computing -------------------------------------------------------------------------------------------

StationSighting CResectionComputation::Gather(const Line& line) {
    const CCarnet& carnet = m_session.Carnet();
    const StationPlace& from = PlaceOf(line.station);
    const ReducedSighting reduced = ReduceSighting(carnet, from, line.index, m_session.Reduction());
    StationSighting s;
    s.index = line.index;
    s.hp = reduced.hp;
    s.ah = reduced.ah, s.av = reduced.av, s.di = reduced.di, s.dh = reduced.dh;
    if (line.station == StationIndex()) {
        s.reference = reduced.mat;
        PointPlace(carnet, reduced.mat, s.x, s.y, s.z);
    } else {
        s.onStation = true;
        s.reference = from.name;
        s.reprise = from.reprise;
        s.x = from.x, s.y = from.y, s.z = from.z;
        s.v0s = from.v0;
        s.his = from.hi;
    }
    return s;
}

void CResectionComputation::Recompute() {
    const int stationIndex = StationIndex();
    m_result = StationResult();
    if (stationIndex < 0) return Notify(kPartResult);
    const StationPlace& place = PlaceOf(stationIndex);
    m_result.stationIndex = stationIndex;
    m_result.station = place.name;
    m_result.reprise = place.reprise;
    m_result.hi = place.hi;
    if (m_lists.Selected().empty()) return Notify(kPartResult);
    for (const Line& line : m_lists.Selected())
        m_result.sightings.push_back(Gather(line));
    const int flags = Compute(m_result, Plani(), Alti());
    Warn(flags);
    if ((flags & kStationFailed) && m_frontEnd)
        m_frontEnd->MessageBox(session::kMsgNotComputed, ui::kCaption, ui::kIconWarning);
    if (Computed()) m_results.Keep(Station(), m_result);
    Notify(kPartResult);
}

bool CResectionComputation::Computed() const {
    return (m_result.flags & kStationComputed) != 0 || IsKnown(m_result.z);
}

bool CResectionComputation::CanWrite() const {
    return (IsKnown(m_result.x) && IsKnown(m_result.y)) || IsKnown(m_result.z);
}

bool CResectionComputation::CanFinish() const {
    return m_lists.Count() >= 3;
}

std::string CResectionComputation::XText() const {
    return Shown(m_result.x, CPointGen::DeciXY());
}
std::string CResectionComputation::YText() const {
    return Shown(m_result.y, CPointGen::DeciXY());
}
std::string CResectionComputation::V0Text() const {
    return Shown(m_result.v0, CStation::DeciAng());
}
std::string CResectionComputation::ZText() const {
    return Shown(m_result.z, CPointGen::DeciZ());
}
std::string CResectionComputation::EmqXText() const {
    return Shown(m_result.emqX, CPointGen::DeciXY());
}
std::string CResectionComputation::EmqYText() const {
    return Shown(m_result.emqY, CPointGen::DeciXY());
}
std::string CResectionComputation::EmqV0Text() const {
    return Shown(m_result.emqV0, CStation::DeciAng());
}
std::string CResectionComputation::EmqZText() const {
    return Shown(m_result.emqZ, CPointGen::DeciZ());
}

// ---- Writing ---------------------------------------------------------------------------------------------

bool CResectionComputation::Write() {
    return WriteStation(m_result.x, m_result.y, m_result.z, m_result.v0);
}

} // namespace pyr
