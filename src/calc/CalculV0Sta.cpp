#include "calc/CalculV0Sta.h"

#include "calc/CalculV0Listing.h"
#include "calc/CalculV0Texts.h"
#include "calc/SessionTexts.h"
#include "core/Files.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "geobase/Selection.h"
#include "settings/CalcOptions.h"
#include "settings/LastGeoBase.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>

namespace pyr {

namespace {

std::string AngleText(double grads) {
    return IsKnown(grads) ? FormatFixedShown(grads, CStation::DeciAng()) : std::string("-");
}

} // namespace

CCalculV0Sta::CCalculV0Sta()
    : m_session({kJournalStationV0, session::kQuestionInvariantXY, session::kQuestionInvariantZ}) {}
CCalculV0Sta::~CCalculV0Sta() = default;

std::string CCalculV0Sta::Caption() const {
    return v0::kCaption;
}

// ---- Settings ------------------------------------------------------------------------------------------

void CCalculV0Sta::LoadSettings() {
    if (m_settingsLoaded) return;
    m_settingsLoaded = true;
    const std::string_view path = Inputs().paramPath;
    int type = 0, weighted = 1;
    ReadParamInt(path, v0::kSection, v0::kKeyType, 0, 0, 2, type);
    ReadParamInt(path, v0::kSection, v0::kKeyWeighting, 1, 0, 1, weighted);
    m_type = static_cast<V0CalculationType>(type);
    m_settings.weighted = weighted != 0;
}

void CCalculV0Sta::WriteSettings() {
    const std::string_view path = Inputs().paramPath;
    WriteParamInt(path, v0::kSection, v0::kKeyType, static_cast<int>(Type()));
    WriteParamInt(path, v0::kSection, v0::kKeyWeighting, Weighted() ? 1 : 0);
}

V0CalculationType CCalculV0Sta::Type() {
    LoadSettings();
    return m_type;
}

void CCalculV0Sta::SetType(V0CalculationType type) {
    LoadSettings();
    m_type = type;
}

bool CCalculV0Sta::Weighted() {
    LoadSettings();
    return m_settings.weighted;
}

void CCalculV0Sta::SetWeighted(bool weighted) {
    LoadSettings();
    m_settings.weighted = weighted;
}

// ---- Opening -------------------------------------------------------------------------------------------

bool CCalculV0Sta::Open(ui::FrontEnd& frontEnd) {
    m_frontEnd = &frontEnd;
    LoadSettings();
    if (!m_session.Open(frontEnd, *this)) {
        m_cancelled = m_session.Cancelled();
        return false;
    }
    m_settings.tolerances = m_session.Tolerance();
    m_settings.reduction.correction = m_session.Reduction().correction;
    const int first = Carnet().Find(kKindStation, "");
    std::unordered_map<std::string, int> setUps;
    for (int i = first; i >= 0; i = Carnet().Find(kKindStation, "", i + 1)) {
        const std::string name = Carnet().matAt(i);
        const int reprise = ++setUps[name];
        m_stationRank.emplace(i, static_cast<int>(m_stations.size()));
        m_stations.push_back(reprise == 1 ? name : Sprintf("%s(%d)", name.c_str(), reprise));
    }
    if (first < 0) {
        frontEnd.MessageBox(Sprintf(v0::kMsgNoStation, m_session.Path().c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    return ChooseStationAt(first);
}

// ---- One station ---------------------------------------------------------------------------------------

bool CCalculV0Sta::ChooseStation(std::string_view designation) {
    std::string name;
    int reprise = 1;
    const int index =
        CCarnet::extrStaRep(designation, name, reprise) ? Carnet().findStaRep(name, reprise) : -1;
    if (index < 0) {
        if (m_frontEnd)
            m_frontEnd->MessageBox(Sprintf(v0::kMsgStationUnknown, std::string(designation).c_str()),
                                   ui::kCaption, ui::kIconWarning);
        return false;
    }
    return ChooseStationAt(index);
}

int CCalculV0Sta::StationRank() const {
    const auto found = m_stationRank.find(m_station.index);
    return found == m_stationRank.end() ? -1 : found->second;
}

bool CCalculV0Sta::ChooseStationAt(int stationIndex) {
    if (Carnet().GetType(stationIndex) != kKindStation) return false;
    m_station = StationPlaceAt(Carnet(), stationIndex);
    m_typedPlace = false;
    m_offered.clear();
    for (int i : OfferedReferences(Carnet(), stationIndex)) {
        const bool reference = Carnet().GetType(i) == kKindReference;
        m_offered.push_back({i, Carnet().GetAt(i)->mat(), reference, reference});
    }
    // Without reference sightings, every sighting of a known point is chosen.
    if (std::none_of(m_offered.begin(), m_offered.end(), [](const Offered& o) { return o.reference; }))
        for (Offered& offered : m_offered)
            offered.chosen = true;
    return true;
}

bool CCalculV0Sta::SetStationCoordinates(double x, double y, double z) {
    if (m_station.index < 0) return false;
    if (Carnet().hasXY(m_station.name)) {
        m_frontEnd->MessageBox(Sprintf(v0::kMsgStationCoordinatesKnown, m_station.name.c_str()), ui::kCaption,
                               ui::kIconWarning);
        return false;
    }
    if (!IsKnown(x) || !IsKnown(y)) {
        m_frontEnd->MessageBox(v0::kMsgCoordinatesIncomplete, ui::kCaption, ui::kIconWarning);
        return false;
    }
    m_station.x = x;
    m_station.y = y;
    m_station.z = z;
    m_typedPlace = true;
    return true;
}

void CCalculV0Sta::ChooseReference(std::size_t rank, bool chosen) {
    if (rank < m_offered.size()) m_offered[rank].chosen = chosen;
}

bool CCalculV0Sta::ChooseReferences(std::string_view selection) {
    if (!m_frontEnd) return false;
    const std::optional<CSelection> parsed = CSelection::Parse(selection);
    if (!parsed) {
        m_frontEnd->MessageBox(msg::kNoSelection, ui::kCaption, ui::kIconWarning);
        return false;
    }
    bool any = false;
    for (Offered& offered : m_offered)
        any |= offered.chosen = parsed->Contains(offered.mat);
    if (!any)
        m_frontEnd->MessageBox(Sprintf(v0::kMsgReferenceNotOffered, m_station.Designation().c_str(),
                                       std::string(selection).c_str()),
                               ui::kCaption, ui::kIconWarning);
    return any;
}

bool CCalculV0Sta::SetList(std::string_view selection) {
    if (!IsValidSelString(selection)) {
        if (m_frontEnd) m_frontEnd->MessageBox(msg::kNoSelection, ui::kCaption, ui::kIconWarning);
        return false;
    }
    m_list = selection;
    return true;
}

// ---- Computing -----------------------------------------------------------------------------------------

void CCalculV0Sta::Show(const V0Result& result) {
    CPyrTxtWnd txt(*m_frontEnd);
    const std::string designation = result.station.Designation();
    if (result.byHand) {
        txt.Print(v0::kLineHandV0, designation.c_str(), AngleText(result.v0).c_str());
        return;
    }
    txt.Print(v0::kLineComputed, designation.c_str(), AngleText(result.v0).c_str(), result.used,
              static_cast<int>(result.references.size()));
}

// A station computed again replaces its earlier result, in its place.
void CCalculV0Sta::Keep(V0Result result) {
    const auto at = static_cast<std::size_t>(result.station.index);
    if (at >= m_resultOf.size())
        m_resultOf.resize(std::max(at + 1, static_cast<std::size_t>(Carnet().GetSize())), -1);
    int& rank = m_resultOf[at];
    if (rank >= 0) {
        m_results[static_cast<std::size_t>(rank)] = std::move(result);
        return;
    }
    rank = static_cast<int>(m_results.size());
    m_results.push_back(std::move(result));
}

bool CCalculV0Sta::CalculateStation() {
    if (m_station.index < 0) return false;
    if (!m_station.HasPlace()) {
        m_frontEnd->MessageBox(Sprintf(v0::kMsgStationWithoutCoordinates, m_station.Designation().c_str()),
                               ui::kCaption, ui::kIconWarning);
        return false;
    }
    std::vector<int> chosen;
    for (const Offered& offered : m_offered)
        if (offered.chosen) chosen.push_back(offered.index);
    V0Result result = ComputeStationV0(Carnet(), m_station, chosen, m_settings);
    for (const std::string& warning : result.warnings)
        m_frontEnd->MessageBox(warning, ui::kCaption, ui::kIconWarning);
    if (!result.computed) return false;
    Show(result);
    CPyrTxtWnd txt(*m_frontEnd);
    for (const V0Reference& ref : result.references)
        txt.Print(v0::kLineReference, ref.mat.c_str(), AngleText(ref.partialV0).c_str(),
                  AngleText(ref.residual).c_str(), ref.valid ? "" : v0::kLineEliminated);
    Keep(std::move(result));
    return true;
}

int CCalculV0Sta::CalculateList() {
    std::optional<CSelection> selection;
    if (m_type == V0CalculationType::Liste) {
        selection = CSelection::Parse(m_list);
        if (!selection) {
            m_frontEnd->MessageBox(msg::kNoSelection, ui::kCaption, ui::kIconWarning);
            return 0;
        }
    }
    CPyrTxtWnd txt(*m_frontEnd);
    int computed = 0, named = 0;
    m_notComputable = 0;
    // Stations rest on the same control points: each one's place is looked up once for them all.
    PointPlaces places(Carnet(), true);
    for (int i = Carnet().Find(kKindStation, ""); i >= 0; i = Carnet().Find(kKindStation, "", i + 1)) {
        if (selection && !selection->Contains(Carnet().GetAt(i)->mat())) continue;
        ++named;
        const StationPlace station = places.Station(i);
        if (!station.HasPlace()) {
            ++m_notComputable;
            txt.Print(v0::kLineNotComputed, station.Designation().c_str(),
                      Sprintf(v0::kMsgStationWithoutCoordinates, station.name.c_str()).c_str());
            continue;
        }
        V0Result result = ComputeStationV0(places, station, DefaultReferences(places, i), m_settings);
        // One station without references does not stop the others: it is counted and named.
        for (const std::string& warning : result.warnings)
            if (warning != v0::kMsgNoValidReference)
                m_frontEnd->MessageBox(warning, ui::kCaption, ui::kIconWarning);
        if (!result.computed) {
            ++m_notComputable;
            txt.Print(v0::kLineNotComputed, station.Designation().c_str(), v0::kMsgNoValidReference);
            continue;
        }
        Show(result);
        Keep(std::move(result));
        ++computed;
    }
    if (named == 0)
        m_frontEnd->MessageBox(Sprintf(v0::kMsgNoStationInList, m_list.c_str()), ui::kCaption,
                               ui::kIconWarning);
    else if (m_notComputable > 0)
        m_frontEnd->MessageBox(Sprintf(v0::kMsgStationsNotComputable, m_notComputable), ui::kCaption,
                               ui::kIconWarning);
    return computed;
}

bool CCalculV0Sta::Calculate() {
    if (!m_frontEnd) return false;
    if (Type() == V0CalculationType::Unique) return CalculateStation();
    return CalculateList() > 0;
}

bool CCalculV0Sta::EnterV0(double v0) {
    if (!m_frontEnd || m_station.index < 0) return false;
    if (!(v0 >= 0.0 && v0 <= 400.0)) {
        m_frontEnd->MessageBox(v0::kMsgHandV0OutOfRange, ui::kCaption, ui::kIconWarning);
        return false;
    }
    V0Result result;
    result.station = m_station;
    result.computed = true;
    result.byHand = true;
    result.weighted = m_settings.weighted;
    result.v0 = RoundV0(v0);
    result.remarks.push_back(v0::kRemarkHandV0);
    Show(result);
    Keep(std::move(result));
    return true;
}

const V0Result* CCalculV0Sta::StationResult() const {
    const auto at = static_cast<std::size_t>(m_station.index);
    if (m_station.index < 0 || at >= m_resultOf.size() || m_resultOf[at] < 0) return nullptr;
    return &m_results[static_cast<std::size_t>(m_resultOf[at])];
}

double CCalculV0Sta::V0() const {
    const V0Result* result = StationResult();
    return result ? result->v0 : m_station.v0;
}

// ---- Writing -------------------------------------------------------------------------------------------

// The coordinates typed for the station become a point of the GéoBase when the person agrees.
bool CCalculV0Sta::AddTypedStationPoint() {
    const V0Result* result = StationResult();
    if (!m_typedPlace || !result || !result->written || Carnet().hasXY(m_station.name)) return false;
    const bool withZ = IsKnown(m_station.z);
    if (m_frontEnd->Ask(Sprintf(v0::kQuestionAddStationPoint, withZ ? 3 : 2), ui::kCaption,
                        ui::Buttons::YesNo, ui::Answer::Yes) != ui::Answer::Yes)
        return false;
    return m_session.WritePoint(m_station.name, m_station.x, m_station.y, m_station.z);
}

bool CCalculV0Sta::Enregistrer() {
    if (!m_frontEnd || !m_session.IsOpen()) return false;
    int written = 0;
    for (V0Result& result : m_results) {
        if (!result.computed || result.written) continue;
        if (!m_session.WriteStationV0(result.station.index, result.station.Designation(), result.v0))
            continue;
        result.written = true;
        ++written;
    }
    const bool pointAdded = AddTypedStationPoint();
    CPyrTxtWnd txt(*m_frontEnd);
    if (written == 0 && !pointAdded) {
        txt.PrintText(msg::kNoChange);
        return true;
    }
    if (!m_session.Save()) return false;
    txt.Print(v0::kLineWritten, written);
    return true;
}

std::string CCalculV0Sta::Close(bool saved, bool listingAsked, std::string listingPath) {
    if (saved) WriteSettings();
    std::vector<const V0Result*> results;
    for (const V0Result& result : m_results)
        if (result.computed) results.push_back(&result);
    ListingRequest request;
    request.kind = ListingKind::StationV0;
    request.resultCount = results.size();
    request.writeResult = [&results](CDlgCfgListing& listing, std::size_t i) {
        WriteV0Result(listing, *results[i]);
    };
    request.writeTolerances = [this](CDlgCfgListing& listing) {
        WriteV0Tolerances(listing, m_settings.tolerances, m_settings.weighted, m_settings.forced);
    };
    request.ask = !listingAsked;
    request.path = std::move(listingPath);
    return m_session.Close(std::move(request));
}

} // namespace pyr
