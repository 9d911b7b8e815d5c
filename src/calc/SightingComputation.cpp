#include "calc/SightingComputation.h"

#include "core/Numbers.h"
#include "settings/ParamStore.h"

namespace pyr {

CSightingComputation::CSightingComputation(ComputationWords words)
    : m_session(words.session), m_words(words) {}

bool CSightingComputation::OpenSession(ui::FrontEnd& frontEnd) {
    m_frontEnd = &frontEnd;
    const std::string_view path = Inputs().paramPath;
    int plani = 1, alti = 1;
    ReadParamInt(path, m_words.section, kKeyCalculPlani, 1, 0, 1, plani);
    ReadParamInt(path, m_words.section, kKeyCalculAlti, 1, 0, 1, alti);
    m_plani = plani != 0, m_alti = alti != 0;
    if (!m_session.Open(frontEnd, *this)) return false;
    // The sightings arrive as the instrument would have read them without its constants.
    m_session.Reduction().instrumentConstants = true;
    return true;
}

std::string CSightingComputation::Close(bool listingAsked, std::string listingPath) {
    if (!m_frontEnd) return {};
    WriteParamInt(Inputs().paramPath, m_words.section, kKeyCalculPlani, m_plani ? 1 : 0);
    WriteParamInt(Inputs().paramPath, m_words.section, kKeyCalculAlti, m_alti ? 1 : 0);
    m_session.OfferSave();
    ListingRequest request;
    request.kind = m_words.listing;
    request.resultCount = ResultCount();
    request.writeResult = [this](CDlgCfgListing& listing, std::size_t i) { WriteResult(listing, i); };
    request.ask = !listingAsked;
    request.path = std::move(listingPath);
    return m_session.Close(std::move(request));
}

void CSightingComputation::SetPlani(bool on) {
    m_plani = on;
    Notify(kPartSwitches);
    Recompute();
}

void CSightingComputation::SetAlti(bool on) {
    m_alti = on;
    Notify(kPartSwitches);
    Recompute();
}

void CSightingComputation::HighlightAvailable(int rank) {
    m_lists.HighlightAvailable(rank);
    Notify(kPartLists);
}

void CSightingComputation::HighlightSelected(int rank) {
    m_lists.HighlightSelected(rank);
    Notify(kPartLists);
}

void CSightingComputation::Moved(bool moved) {
    if (!moved) return;
    Notify(kPartLists);
    Recompute();
}

const StationPlace& CSightingComputation::PlaceOf(int station) {
    auto found = m_places.find(station);
    if (found == m_places.end())
        found = m_places.emplace(station, StationPlaceAt(m_session.Carnet(), station)).first;
    return found->second;
}

bool CSightingComputation::WriteStationAt(int stationIndex, double x, double y, double z, double v0) {
    const StationPlace place = PlaceOf(stationIndex);
    bool written = m_session.WritePoint(place.name, x, y, z);
    if (written && IsKnown(v0)) written = m_session.WriteStationV0(stationIndex, place.Designation(), v0);
    ForgetPlaces(); // the station, and what it sighted, are placed by what was written from now on
    Notify(kPartResult);
    return written;
}

std::string CSightingComputation::Shown(double value, int decimals) {
    return IsKnown(value) ? FormatFixedShown(value, decimals) : std::string();
}

} // namespace pyr
