#include "calc/StationComputation.h"

#include "calc/SessionTexts.h"
#include "calc/StationTexts.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "geobase/Selection.h"
#include "ui/FrontEnd.h"

#include <optional>

namespace pyr {

CStationComputation::CStationComputation(StationWords words)
    : CSightingComputation(words.computation), m_words(words) {}

std::string CStationComputation::Caption() const {
    return m_station.empty() ? Inputs().title : Sprintf(m_words.caption, m_result.station.c_str());
}

// ---- Opening ---------------------------------------------------------------------------------------------

bool CStationComputation::Open(ui::FrontEnd& frontEnd) {
    if (!OpenSession(frontEnd)) return false;
    // The station's sightings arrive as the instrument would have read them without its constants, with
    // their targets' heights and offsets.
    SightingReductionOptions& reduction = m_session.Reduction();
    reduction.instrumentConstants = true;
    reduction.targetHeights = true;
    FindStations();
    if (m_stations.Empty()) {
        frontEnd.MessageBox(Sprintf(station::kMsgNoStation, m_session.Path().c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    Notify(kPartSubject | kPartSwitches);
    return true;
}

// Every station occurrence that has at least one line, in GéoBase order.
void CStationComputation::FindStations() {
    const CCarnet& carnet = m_session.Carnet();
    m_stations.Clear();
    for (int i = carnet.Find(kKindStation, ""); i >= 0; i = carnet.Find(kKindStation, "", i + 1))
        if (!LinesOf(i).empty()) m_stations.Offer(PlaceOf(i));
}

std::vector<CStationComputation::Line> CStationComputation::LinesOf(int stationIndex) {
    const CCarnet& carnet = m_session.Carnet();
    const StationPlace station = PlaceOf(stationIndex);
    std::vector<Line> lines;
    auto tooltip = [&](int element, const std::string& mat) {
        return Sprintf(station::kTooltip, carnet.cmdAt(element).c_str(), mat.c_str(),
                       carnet.parAt(element).c_str());
    };
    // From the station on known points, up to the next station.
    for (int i = stationIndex + 1; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (kind == kKindStation) break;
        if (kind != kKindReference && kind != kKindMesure) continue;
        const std::string mat = carnet.matAt(i);
        double x = kUndefined, y = kUndefined, z = kUndefined;
        if (mat.empty() || mat == station.name || !PointPlace(carnet, mat, x, y, z)) continue;
        lines.push_back({i, stationIndex, Sprintf(station::kLineResection, mat.c_str()), tooltip(i, mat)});
    }
    if (!m_words.withIntersections) return lines;
    // On the station from the others, placed and oriented.
    std::string name;
    for (int kind : {kKindReference, kKindMesure})
        for (int i = carnet.Find(kind, station.name); i >= 0; i = carnet.Find(kind, station.name, i + 1)) {
            const int from = carnet.findRepAt(i, name);
            if (from < 0 || from == stationIndex) continue;
            const StationPlace& other = PlaceOf(from);
            if (!other.HasPlace() || !other.IsOriented()) continue;
            lines.push_back({i, from, Sprintf(station::kLineIntersection, other.name.c_str(), other.reprise),
                             tooltip(i, station.name)});
        }
    return lines;
}

bool CStationComputation::ChooseStation(std::string_view designation) {
    const int index = m_stations.Find(designation);
    if (index < 0) {
        if (m_frontEnd)
            m_frontEnd->MessageBox(Sprintf(station::kMsgStationNotOffered, std::string(designation).c_str()),
                                   ui::kCaption, ui::kIconWarning);
        return false;
    }
    const StationPlace& place = PlaceOf(index);
    m_stationIndex = index;
    m_station = CStationChoice::ShownAs(place);
    m_result = StationResult();
    m_result.station = place.name;
    m_result.reprise = place.reprise;
    m_lists.Fill(LinesOf(index));
    Notify(kPartCaption);
    Moved(true);
    return true;
}

bool CStationComputation::SelectSightings(std::string_view selection) {
    const std::optional<CSelection> parsed = CSelection::Parse(selection);
    if (!parsed) return false;
    const CCarnet& carnet = m_session.Carnet();
    const bool any = m_lists.SelectOnly([&](const Line& line) {
        const std::string known =
            line.station == m_stationIndex ? carnet.matAt(line.index) : carnet.matAt(line.station);
        return parsed->Contains(known);
    });
    Moved(true);
    return any;
}

// ---- Computing -------------------------------------------------------------------------------------------

StationSighting CStationComputation::Gather(const Line& line) {
    const CCarnet& carnet = m_session.Carnet();
    const StationPlace& from = PlaceOf(line.station);
    const ReducedSighting reduced = ReduceSighting(carnet, from, line.index, m_session.Reduction());
    StationSighting s;
    s.index = line.index;
    s.hp = reduced.hp;
    s.ah = reduced.ah, s.av = reduced.av, s.di = reduced.di, s.dh = reduced.dh;
    if (line.station == m_stationIndex) {
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

void CStationComputation::Recompute() {
    const StationPlace& place = PlaceOf(m_stationIndex);
    m_result = StationResult();
    m_result.stationIndex = m_stationIndex;
    m_result.station = place.name;
    m_result.reprise = place.reprise;
    m_result.hi = place.hi;
    if (m_stationIndex < 0 || m_lists.Selected().empty()) {
        Notify(kPartResult);
        return;
    }
    for (const Line& line : m_lists.Selected())
        m_result.sightings.push_back(Gather(line));
    const int flags = Compute(m_result, Plani(), Alti());
    Warn(flags);
    if ((flags & kStationFailed) && m_frontEnd)
        m_frontEnd->MessageBox(session::kMsgNotComputed, ui::kCaption, ui::kIconWarning);
    if (Computed()) m_results.Keep(m_station, m_result);
    Notify(kPartResult);
}

bool CStationComputation::Computed() const {
    return (m_result.flags & kStationComputed) != 0 || IsKnown(m_result.z);
}

bool CStationComputation::CanWrite() const {
    return (IsKnown(m_result.x) && IsKnown(m_result.y)) || IsKnown(m_result.z);
}

bool CStationComputation::CanFinish() const {
    return m_lists.Count() >= 3;
}

std::string CStationComputation::XText() const {
    return Shown(m_result.x, CPointGen::DeciXY());
}
std::string CStationComputation::YText() const {
    return Shown(m_result.y, CPointGen::DeciXY());
}
std::string CStationComputation::V0Text() const {
    return Shown(m_result.v0, CStation::DeciAng());
}
std::string CStationComputation::ZText() const {
    return Shown(m_result.z, CPointGen::DeciZ());
}
std::string CStationComputation::EmqXText() const {
    return Shown(m_result.emqX, CPointGen::DeciXY());
}
std::string CStationComputation::EmqYText() const {
    return Shown(m_result.emqY, CPointGen::DeciXY());
}
std::string CStationComputation::EmqV0Text() const {
    return Shown(m_result.emqV0, CStation::DeciAng());
}
std::string CStationComputation::EmqZText() const {
    return Shown(m_result.emqZ, CPointGen::DeciZ());
}

// ---- Writing ---------------------------------------------------------------------------------------------

bool CStationComputation::WriteStation() {
    if (!CanWrite() || m_stationIndex < 0) return false;
    return CSightingComputation::WriteStation(m_stationIndex, m_result.x, m_result.y, m_result.z,
                                              m_result.v0);
}

} // namespace pyr
