#include "calc/CalcChem.h"

#include "calc/Radiation.h"
#include "calc/SessionTexts.h"
#include "calc/TraverseSearch.h"
#include "calc/TraverseTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/GeoBaseMessages.h"
#include "settings/CalcOptions.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <cmath>

namespace pyr {

namespace {

const char* Beyond(bool out) {
    return out ? chem::kOutOfTolerance : "";
}

} // namespace

CCalcChem::CCalcChem()
    : m_session({chem::kJournal, session::kQuestionInvariantXY, session::kQuestionInvariantZ}) {}

std::string CCalcChem::Caption() const {
    return chem::kCaption;
}

void CCalcChem::ReadOptions() {
    const std::string_view path = m_session.ParamPath();
    m_settings.reduction = m_session.Reduction();
    m_settings.reduction.instrumentConstants = true;
    m_settings.reduction.targetHeights = true;
    m_settings.tolerances = m_session.Tolerance();
    m_settings.v0.tolerances = m_session.Tolerance();
    m_settings.v0.reduction.correction = m_session.Reduction().correction;
    m_switches = ReadOptionInt(path, kSectionCalculations, chem::kKeySwitches);
    m_tolerances.angular = ReadOptionReal(path, kSectionTolerances, chem::kKeyAngular);
    m_tolerances.planimetric = ReadOptionReal(path, kSectionTolerances, chem::kKeyPlanimetric);
    m_tolerances.height = ReadOptionReal(path, kSectionTolerances, chem::kKeyHeight);
    const ToleranceMode mode = m_session.Tolerance().mode;
    m_tolerances.angularFromInstruments = mode != ToleranceMode::Custom;
    m_tolerances.direction = mode == ToleranceMode::Precise ? kV0TolerancePrecise : kV0ToleranceNormal;
}

void CCalcChem::ListTraverses() {
    m_names.clear();
    m_elements.clear();
    const CCarnet& carnet = m_session.Carnet();
    for (int i = carnet.Find(kKindChemin, ""); i >= 0; i = carnet.Find(kKindChemin, "", i + 1)) {
        m_elements.push_back(i);
        m_names.push_back(carnet.matAt(i));
    }
}

bool CCalcChem::Open(ui::FrontEnd& frontEnd, bool searchFirst) {
    m_frontEnd = &frontEnd;
    m_results.clear();
    m_names.clear();
    m_elements.clear();
    m_chosen.clear();
    m_written = false;
    if (!m_session.Open(frontEnd, *this)) {
        m_cancelled = m_session.Cancelled();
        return false;
    }
    ReadOptions();
    ListTraverses();
    if (m_names.empty() && !searchFirst) {
        frontEnd.MessageBox(Sprintf(chem::kMsgNoTraverse, m_session.Path().c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    return true;
}

std::string CCalcChem::Close(bool, bool listingAsked, std::string listingPath) {
    ListingRequest request;
    request.kind = ListingKind::Traverse;
    request.resultCount = m_results.size();
    request.writeResult = [this](CDlgCfgListing& listing, std::size_t index) {
        const ComputedTraverse& t = m_results[index];
        WriteTraverse(listing, {t.name, t.gathered, t.result, t.tolerances});
    };
    request.writeTolerances = [this](CDlgCfgListing& listing) {
        WriteTraverseTolerances(listing, m_tolerances);
    };
    request.ask = !listingAsked;
    request.path = std::move(listingPath);
    return m_session.Close(std::move(request));
}

bool CCalcChem::Choose(std::string_view name) {
    const auto found = std::find(m_names.begin(), m_names.end(), name);
    if (found == m_names.end()) {
        if (m_frontEnd)
            m_frontEnd->MessageBox(Sprintf(chem::kMsgTraverseUnknown, std::string(name).c_str()),
                                   ui::kCaption, ui::kIconWarning);
        return false;
    }
    const int rank = static_cast<int>(found - m_names.begin());
    if (std::find(m_chosen.begin(), m_chosen.end(), rank) == m_chosen.end()) m_chosen.push_back(rank);
    return true;
}

int CCalcChem::Search() {
    if (!m_frontEnd || !m_session.IsOpen()) return -1;
    CPyrTxtWnd txt(*m_frontEnd);
    CCarnet& carnet = m_session.Carnet();
    const std::vector<FoundTraverse> found = FindTraverses(carnet);
    const std::vector<std::string> added = AddFoundTraverses(carnet, found);
    for (const std::string& name : added) {
        const int element = carnet.Find(kKindChemin, name);
        std::string stations;
        for (const std::string& station : carnet.As<CChemin>(element)->stations())
            stations += (stations.empty() ? "" : " - ") + station;
        txt.Print(chem::kLineFound, name.c_str(), stations.c_str(),
                  carnet.As<CChemin>(element)->isClosed() ? chem::kClosedMark : "");
    }
    txt.Print(chem::kLineSearch, static_cast<int>(found.size()), static_cast<int>(added.size()));
    ListTraverses();
    if (added.empty()) return 0;
    m_session.MarkModified();
    if (!m_session.Save()) return -1;
    return static_cast<int>(added.size());
}

void CCalcChem::Show(const ComputedTraverse& t) {
    CPyrTxtWnd txt(*m_frontEnd);
    if (!t.result.ok) {
        txt.Print(chem::kLineNotComputed, t.name.c_str(), t.result.why.c_str());
        return;
    }
    const TraverseResult& r = t.result;
    txt.Print(chem::kLineTraverse, t.name.c_str(), TraverseKindText(t.gathered.input.kind),
              static_cast<int>(r.stations.size()), r.length);
    for (const TraverseLegWarning& w : t.gathered.warnings)
        txt.Print(chem::kLineLegWarning, w.from.c_str(), w.to.c_str(),
                  w.height ? chem::kHeight : chem::kDistance, w.forward, w.height ? -w.backward : w.backward,
                  w.tolerance);
    if (IsKnown(r.angularMisclosure))
        txt.Print(chem::kLineAngular, FormatFixedShown(r.angularMisclosure, 4).c_str(),
                  FormatFixedShown(t.tolerances.angular, 4).c_str(), Beyond(t.angularOut));
    if (IsKnown(r.f))
        txt.Print(chem::kLinePlanimetric, FormatFixedShown(r.fx, 4).c_str(),
                  FormatFixedShown(r.fy, 4).c_str(), FormatFixedShown(r.f, 4).c_str(),
                  TraverseRatioText(r).c_str(), FormatFixedShown(t.tolerances.planimetric, 4).c_str(),
                  Beyond(t.planimetricOut));
    if (IsKnown(r.fz))
        txt.Print(chem::kLineHeight, FormatFixedShown(r.fz, 4).c_str(),
                  FormatFixedShown(t.tolerances.height, 4).c_str(), Beyond(t.heightOut));
}

bool CCalcChem::Calculate() {
    if (!m_frontEnd || !m_session.IsOpen()) return false;
    m_results.clear();
    m_written = false;
    if (m_names.empty()) {
        m_frontEnd->MessageBox(Sprintf(chem::kMsgNoTraverse, m_session.Path().c_str()), ui::kCaption,
                               ui::kIconWarning);
        return false;
    }
    std::vector<int> ranks = m_chosen;
    if (ranks.empty())
        for (int rank = 0; rank < static_cast<int>(m_names.size()); ++rank)
            ranks.push_back(rank);
    const CCarnet& carnet = m_session.Carnet();
    int computed = 0;
    for (int rank : ranks) {
        ComputedTraverse t;
        t.name = m_names[static_cast<std::size_t>(rank)];
        t.element = m_elements[static_cast<std::size_t>(rank)];
        m_settings.rule =
            (m_switches & chem::kByCoordinates) ? TraverseRule::Component : TraverseRule::Compass;
        t.gathered = GatherTraverse(carnet, *carnet.As<CChemin>(t.element), m_settings);
        if (t.gathered.ok) {
            TraverseInput& input = t.gathered.input;
            input.distributeAngular = !(m_switches & chem::kKeepAngular);
            input.distributePlanimetric = !(m_switches & chem::kKeepPlanimetric);
            input.distributeHeight = !(m_switches & chem::kKeepHeight);
            t.result = ComputeTraverse(input);
        } else {
            t.result.why = t.gathered.why;
        }
        t.tolerances = m_tolerances;
        if (t.result.ok) {
            ++computed;
            const TraverseResult& r = t.result;
            if (m_tolerances.angularFromInstruments)
                t.tolerances.angular =
                    AngularClosureTolerance(carnet, t.gathered, r.angles, m_tolerances.direction);
            t.angularOut =
                IsKnown(r.angularMisclosure) && std::fabs(r.angularMisclosure) > t.tolerances.angular;
            t.planimetricOut = IsKnown(r.f) && r.f > t.tolerances.planimetric;
            t.heightOut = IsKnown(r.fz) && std::fabs(r.fz) > t.tolerances.height;
        }
        Show(t);
        m_results.push_back(std::move(t));
    }
    if (computed == 0) m_frontEnd->MessageBox(chem::kMsgNothingComputed, ui::kCaption, ui::kIconWarning);
    Notify(kPartResults);
    return computed > 0;
}

int CCalcChem::RadiateFrom(const std::vector<int>& stations) {
    CPyrTxtWnd txt(*m_frontEnd);
    RadiationSettings settings;
    settings.reduction = m_settings.reduction;
    settings.tolerances = m_session.Tolerance();
    const CCarnet& carnet = m_session.Carnet();
    std::vector<RadiatedStation> results;
    for (int index : stations)
        results.push_back(RadiateStation(carnet, index, settings));
    const RadiatedPoints points = MergeDeterminations(results, settings.tolerances);
    int count = 0;
    for (const RadiatedPoint& point : points) {
        if (point.outOfTolerance) {
            txt.Print(chem::kLineRadiatedOut, std::string(point.mat).c_str());
            continue;
        }
        // The identifier copied: writing a point may add an element to the GéoBase.
        const std::string mat(point.mat);
        if (m_session.WritePoint(mat, point.x, point.y, point.z)) ++count;
    }
    return count;
}

bool CCalcChem::Enregistrer() {
    if (!m_frontEnd || !m_session.IsOpen()) return false;
    CPyrTxtWnd txt(*m_frontEnd);
    int stations = 0, orientations = 0, radiated = 0;
    std::vector<int> written; // the station occurrences of the traverses written
    if (!m_written) {
        for (const ComputedTraverse& t : m_results) {
            if (!t.result.ok) continue;
            if (t.OutOfTolerance()) {
                std::string what;
                for (const auto& [out, word] : {std::pair{t.angularOut, "angulaire"},
                                                {t.planimetricOut, "planimétrique"},
                                                {t.heightOut, "altimétrique"}})
                    if (out) what += (what.empty() ? "" : ", ") + std::string(word);
                if (m_frontEnd->Ask(Sprintf(chem::kQuestionOutOfTolerance, t.name.c_str(), what.c_str()),
                                    ui::kCaption, ui::Buttons::YesNo, ui::Answer::No) != ui::Answer::Yes) {
                    txt.Print(chem::kLineNotWritten, t.name.c_str());
                    continue;
                }
            }
            const TraverseKind kind = t.gathered.input.kind;
            const std::size_t count = t.result.stations.size();
            for (std::size_t i = 0; i < count; ++i) {
                const StationPlace& place = t.gathered.places[i];
                const TraverseStationResult& station = t.result.stations[i];
                // The known ends keep their coordinates; every station gets its orientation.
                const bool known =
                    i == 0 ||
                    (i + 1 == count && (kind == TraverseKind::Linked || kind == TraverseKind::Position));
                if (!known && m_session.WritePoint(place.name, station.x, station.y, station.z)) ++stations;
                if (!(m_switches & chem::kNoV0) && IsKnown(station.v0) &&
                    m_session.WriteStationV0(place.index, place.Designation(), station.v0))
                    ++orientations;
                if (std::find(written.begin(), written.end(), place.index) == written.end())
                    written.push_back(place.index);
            }
        }
        if ((m_switches & chem::kRadiate) && !written.empty()) radiated = RadiateFrom(written);
    }
    m_written = true;
    if (!m_session.Modified()) {
        txt.PrintText(msg::kNoChange);
        return true;
    }
    if (!m_session.Save()) return false;
    txt.Print(chem::kLineWritten, stations, orientations);
    if (m_switches & chem::kRadiate) txt.Print(chem::kLineRadiated, radiated);
    Notify(kPartResults);
    return true;
}

} // namespace pyr
