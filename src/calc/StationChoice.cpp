#include "calc/StationChoice.h"

#include "calc/SightingReduction.h"
#include "calc/StationTexts.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"

namespace pyr {

void CStationChoice::Clear() {
    m_shown.clear();
    m_offered.clear();
}

std::string CStationChoice::ShownAs(const StationPlace& place) {
    return Sprintf(station::kChoice, place.name.c_str(), place.reprise);
}

const std::string& CStationChoice::Offer(const StationPlace& place) {
    m_offered.push_back({place.index, place.name, place.reprise});
    m_shown.push_back(ShownAs(place));
    return m_shown.back();
}

int CStationChoice::Find(std::string_view designation) const {
    std::string name;
    int reprise = 1;
    if (!CCarnet::extrStaRep(designation, name, reprise)) return -1;
    const bool bare = Trimmed(designation).back() != ')';
    for (const Offered& offered : m_offered)
        if (offered.name == name && (bare || offered.reprise == reprise)) return offered.index;
    return -1;
}

} // namespace pyr
