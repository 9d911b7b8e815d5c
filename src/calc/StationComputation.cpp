#include "calc/StationComputation.h"

#include "calc/StationTexts.h"
#include "core/Strings.h"
#include "geobase/Kinds.h"
#include "ui/FrontEnd.h"

namespace pyr {

CStationComputation::CStationComputation(StationWords words)
    : CSightingComputation(words.computation), m_words(words) {}

std::string CStationComputation::Caption() const {
    return m_station.empty() ? Inputs().title : Sprintf(m_words.caption, m_stationName.c_str());
}

// Every station occurrence the computation can take, in GéoBase order.
bool CStationComputation::Open(ui::FrontEnd& frontEnd) {
    if (!OpenSession(frontEnd)) return false;
    const CCarnet& carnet = m_session.Carnet();
    m_stations.Clear();
    for (int i = carnet.Find(kKindStation, ""); i >= 0; i = carnet.Find(kKindStation, "", i + 1))
        if (Offers(i)) m_stations.Offer(PlaceOf(i));
    if (m_stations.Empty()) {
        frontEnd.MessageBox(Sprintf(m_words.msgNoStation, m_session.Path().c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    Notify(kPartSubject | kPartSwitches);
    return true;
}

bool CStationComputation::ChooseStation(std::string_view designation) {
    const int index = m_stations.Find(designation);
    if (index < 0) {
        if (m_frontEnd)
            m_frontEnd->MessageBox(Sprintf(m_words.msgNotOffered, std::string(designation).c_str()),
                                   ui::kCaption, ui::kIconWarning);
        return false;
    }
    const StationPlace& place = PlaceOf(index);
    m_stationIndex = index;
    m_station = CStationChoice::ShownAs(place);
    m_stationName = place.name;
    Notify(kPartCaption);
    StationChosen();
    return true;
}

std::string CStationComputation::Tooltip(int sighting, const std::string& mat) const {
    const CCarnet& carnet = m_session.Carnet();
    return Sprintf(station::kTooltip, carnet.cmdAt(sighting).c_str(), mat.c_str(),
                   carnet.parAt(sighting).c_str());
}

std::vector<CStationComputation::Line> CStationComputation::SightingsOnKnownPoints(int stationIndex,
                                                                                   std::string_view except) {
    const CCarnet& carnet = m_session.Carnet();
    const std::string station = PlaceOf(stationIndex).name;
    std::vector<Line> lines;
    for (int i = stationIndex + 1; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (kind == kKindStation) break;
        if (kind != kKindReference && kind != kKindMesure) continue;
        const std::string mat = carnet.matAt(i);
        if (mat.empty() || mat == station || mat == except || !carnet.hasXY(mat)) continue;
        lines.push_back({i, stationIndex, Sprintf(station::kLineResection, mat.c_str()), Tooltip(i, mat)});
    }
    return lines;
}

bool CStationComputation::WriteStation(double x, double y, double z, double v0) {
    if (!CanWrite() || m_stationIndex < 0) return false;
    return WriteStationAt(m_stationIndex, x, y, z, v0);
}

} // namespace pyr
