#include "calc/CalcRayon.h"

#include "calc/CalculV0Texts.h"
#include "calc/RadiationListing.h"
#include "calc/RadiationTexts.h"
#include "calc/SessionTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Selection.h"
#include "settings/CalcOptions.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <exception>
#include <optional>
#include <thread>

namespace pyr {

CCalcRayon::CCalcRayon()
    : m_session({rayon::kJournal, session::kQuestionInvariantXY, session::kQuestionInvariantZ}) {
    const unsigned workers = std::clamp(std::thread::hardware_concurrency(), 1u, kMostWorkers);
    for (unsigned w = 0; w < workers; ++w)
        m_memory.push_back(
            std::make_unique<std::pmr::monotonic_buffer_resource>(kFirstBlockBytes, LargeBlocks()));
}
CCalcRayon::~CCalcRayon() = default;

std::string CCalcRayon::Caption() const {
    return rayon::kCaption;
}

// ---- Settings ------------------------------------------------------------------------------------------

void CCalcRayon::LoadSettings() {
    if (m_settingsLoaded) return;
    m_settingsLoaded = true;
    int type = static_cast<int>(RadiationType::Toutes);
    ReadParamInt(Inputs().paramPath, rayon::kSection, rayon::kKeyType, type, 0, 2, type);
    m_type = static_cast<RadiationType>(type);
}

RadiationType CCalcRayon::Type() {
    LoadSettings();
    return m_type;
}

void CCalcRayon::SetType(RadiationType type) {
    LoadSettings();
    m_type = type;
}

// The options of the computation, as the options sheet sets them.
void CCalcRayon::ReadOptions() {
    const std::string_view path = m_session.ParamPath();
    m_settings.reduction = m_session.Reduction();
    m_settings.reduction.instrumentConstants = true;
    m_settings.reduction.targetHeights = true;
    m_settings.replaceZeroTargetHeight = ReadOptionSwitch(path, kSectionCalculations, rayon::kKeyZeroTarget);
    m_settings.zeroTargetHeight = ReadOptionReal(path, kSectionCalculations, rayon::kKeyZeroTargetValue);
    m_settings.computeV0 = ReadOptionSwitch(path, kSectionCalculations, rayon::kKeyComputeV0);
    m_settings.tolerances = m_session.Tolerance();
    m_settings.v0.tolerances = m_session.Tolerance();
    m_settings.v0.reduction.correction = m_session.Reduction().correction;
    m_checkKnown = ReadOptionSwitch(path, kSectionListings, rayon::kKeyCheckKnown);
    m_columns = RadiationColumns(ReadOptionText(path, kSectionListings, rayon::kKeyColumns));
}

// ---- Opening -------------------------------------------------------------------------------------------

bool CCalcRayon::Open(ui::FrontEnd& frontEnd) {
    m_frontEnd = &frontEnd;
    LoadSettings();
    // The results of another opening view the elements of the GéoBase then open, which the opening
    // replaces, whether it succeeds or not.
    m_results.clear();
    m_newPoints.clear();
    for (auto& memory : m_memory)
        memory->release();
    m_stationIndex.clear();
    m_stations.clear();
    if (!m_session.Open(frontEnd, *this)) {
        m_cancelled = m_session.Cancelled();
        return false;
    }
    ReadOptions();
    const CCarnet& carnet = m_session.Carnet();
    for (int i = carnet.Find(kKindStation, ""); i >= 0; i = carnet.Find(kKindStation, "", i + 1)) {
        m_stationIndex.push_back(i);
        const int reprise = carnet.RepriseAt(i);
        m_stations.push_back(reprise == 1 ? carnet.matAt(i) : carnet.StationDesignation(i));
    }
    if (m_stations.empty()) {
        frontEnd.MessageBox(Sprintf(v0::kMsgNoStation, m_session.Path().c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    m_stationRank = 0;
    return true;
}

std::string CCalcRayon::Close(bool saved, bool listingAsked, std::string listingPath) {
    if (saved) WriteParamInt(Inputs().paramPath, rayon::kSection, rayon::kKeyType, static_cast<int>(Type()));
    ListingRequest request;
    request.kind = ListingKind::RadiatedPoints;
    request.resultCount = m_results.empty() ? 0 : 1;
    request.writeResult = [this](CDlgCfgListing& listing, std::size_t) {
        WriteRadiation(listing, {m_results, m_newPoints, m_columns, m_checkKnown});
    };
    request.writeTolerances = [this](CDlgCfgListing& listing) {
        WriteRadiationTolerances(listing, m_settings, m_checkKnown);
    };
    request.ask = !listingAsked;
    request.path = std::move(listingPath);
    return m_session.Close(std::move(request));
}

// ---- Choices -------------------------------------------------------------------------------------------

bool CCalcRayon::ChooseStation(std::string_view designation) {
    std::string name;
    int reprise = 1;
    const CCarnet& carnet = m_session.Carnet();
    const int index = CCarnet::extrStaRep(designation, name, reprise) ? carnet.findStaRep(name, reprise) : -1;
    for (std::size_t rank = 0; index >= 0 && rank < m_stationIndex.size(); ++rank)
        if (m_stationIndex[rank] == index) {
            m_stationRank = static_cast<int>(rank);
            return true;
        }
    if (m_frontEnd)
        m_frontEnd->MessageBox(Sprintf(v0::kMsgStationUnknown, std::string(designation).c_str()),
                               ui::kCaption, ui::kIconWarning);
    return false;
}

bool CCalcRayon::SetList(std::string_view selection) {
    if (!IsValidSelString(selection)) {
        if (m_frontEnd) m_frontEnd->MessageBox(msg::kNoSelection, ui::kCaption, ui::kIconWarning);
        return false;
    }
    m_list = selection;
    return true;
}

bool CCalcRayon::SetPoints(std::string_view selection) {
    if (!Trimmed(selection).empty() && !IsValidSelString(selection)) {
        if (m_frontEnd) m_frontEnd->MessageBox(msg::kNoSelection, ui::kCaption, ui::kIconWarning);
        return false;
    }
    m_points = Trimmed(selection);
    return true;
}

// The station elements to radiate, in GéoBase order; empty, with a message, when none is chosen.
std::vector<int> CCalcRayon::ChosenStations() {
    if (Type() == RadiationType::Unique)
        return m_stationRank >= 0 ? std::vector<int>{m_stationIndex[static_cast<std::size_t>(m_stationRank)]}
                                  : std::vector<int>{};
    if (Type() == RadiationType::Toutes) return m_stationIndex;
    const std::optional<CSelection> list = CSelection::Parse(m_list);
    if (!list) {
        m_frontEnd->MessageBox(msg::kNoSelection, ui::kCaption, ui::kIconWarning);
        return {};
    }
    std::vector<int> chosen;
    for (int index : m_stationIndex)
        if (list->Contains(m_session.Carnet().GetAt(index)->mat())) chosen.push_back(index);
    if (chosen.empty())
        m_frontEnd->MessageBox(Sprintf(v0::kMsgNoStationInList, m_list.c_str()), ui::kCaption,
                               ui::kIconWarning);
    return chosen;
}

// ---- Computing -----------------------------------------------------------------------------------------

void CCalcRayon::Show(const RadiatedStation& result) {
    CPyrTxtWnd txt(*m_frontEnd);
    const std::string designation = result.station.Designation();
    // What the orientation on the references said of them (a reference out of tolerance): in the text
    // window, not in a box for each of thousands of stations.
    for (const std::string& warning : result.v0.warnings)
        txt.PrintText(warning);
    if (!result.usable) {
        txt.Print(rayon::kLineStationNotUsed, designation.c_str(), result.reason.c_str());
        return;
    }
    const std::string v0 = result.v0Computed
                               ? Sprintf(rayon::kLineV0Computed,
                                         FormatFixedShown(result.station.v0, CStation::DeciAng()).c_str())
                               : std::string();
    txt.Print(rayon::kLineStation, designation.c_str(), static_cast<int>(result.points.size()),
              static_cast<int>(result.checks.size()), v0.c_str());
    if (m_settings.computeV0 && !result.v0Computed) txt.PrintText(rayon::kLineV0Kept);
    for (const SkippedSighting& skipped : result.skipped)
        txt.Print(rayon::kLineSkipped, std::string(skipped.mat).c_str(), skipped.reason.c_str());
}

// Computed again into the results of the last run, which keep their room.
void CCalcRayon::RadiateChosen(const std::vector<int>& chosen, const CSelection* points) {
    const std::size_t workers = chosen.size() < kStationsForWorkers ? 1 : m_memory.size();
    if (m_results.size() > chosen.size())
        m_results.erase(m_results.begin() + static_cast<std::ptrdiff_t>(chosen.size()), m_results.end());
    while (m_results.size() < chosen.size())
        m_results.emplace_back(m_memory[m_results.size() % m_memory.size()].get());
    const CCarnet& carnet = m_session.Carnet();
    // The GéoBase's index built once before the workers share it: from here on they only read it.
    carnet.NameCount();
    std::vector<std::exception_ptr> failures(workers);
    auto radiate = [&](std::size_t worker) {
        try {
            for (std::size_t k = worker; k < chosen.size(); k += workers)
                RadiateStation(carnet, chosen[k], m_settings, points, m_results[k]);
        } catch (...) {
            failures[worker] = std::current_exception();
        }
    };
    {
        std::vector<std::jthread> threads;
        for (std::size_t w = 1; w < workers; ++w)
            threads.emplace_back(radiate, w);
        radiate(0);
    }
    for (const std::exception_ptr& failure : failures)
        if (failure) std::rethrow_exception(failure);
}

bool CCalcRayon::Calculate() {
    if (!m_frontEnd || !m_session.IsOpen()) return false;
    m_notUsed = m_outOfTolerance = 0;
    m_written = false;
    std::optional<CSelection> points;
    if (!m_points.empty()) points = CSelection::Parse(m_points);

    RadiateChosen(ChosenStations(), points ? &*points : nullptr);
    int used = 0;
    for (const RadiatedStation& result : m_results) {
        Show(result);
        if (result.usable)
            ++used;
        else
            ++m_notUsed;
    }
    MergeDeterminations(m_results, m_settings.tolerances, m_newPoints);

    CPyrTxtWnd txt(*m_frontEnd);
    for (const RadiatedPoint& point : m_newPoints) {
        if (!point.outOfTolerance) continue;
        ++m_outOfTolerance;
        txt.Print(rayon::kLineOutOfTolerance, std::string(point.mat).c_str(),
                  static_cast<int>(point.determinations.size()), point.spreadXY, point.spreadZ);
    }
    if (!m_results.empty()) txt.Print(rayon::kLineTotal, static_cast<int>(m_newPoints.size()), used);
    if (m_notUsed > 0)
        m_frontEnd->MessageBox(Sprintf(rayon::kMsgStationsNotUsed, m_notUsed), ui::kCaption,
                               ui::kIconWarning);
    if (m_outOfTolerance > 0)
        m_frontEnd->MessageBox(Sprintf(rayon::kMsgOutOfTolerance, m_outOfTolerance), ui::kCaption,
                               ui::kIconWarning);
    if (used == 0 && !m_results.empty())
        m_frontEnd->MessageBox(rayon::kMsgNothingRadiated, ui::kCaption, ui::kIconWarning);
    Notify(kPartResults);
    return used > 0;
}

// ---- Writing -------------------------------------------------------------------------------------------

bool CCalcRayon::Enregistrer() {
    if (!m_frontEnd || !m_session.IsOpen()) return false;
    CPyrTxtWnd txt(*m_frontEnd);
    // Written once: a GéoBase that could not be saved is saved again as it stands.
    int stations = 0, points = 0;
    if (!m_written) {
        for (const RadiatedStation& result : m_results)
            if (result.usable && result.v0Computed &&
                m_session.WriteStationV0(result.station.index, result.station.Designation(),
                                         result.station.v0))
                ++stations;
        for (const RadiatedPoint& point : m_newPoints) {
            if (point.outOfTolerance &&
                m_frontEnd->Ask(Sprintf(rayon::kQuestionOutOfTolerance, std::string(point.mat).c_str(),
                                        static_cast<int>(point.determinations.size()), point.spreadXY,
                                        point.spreadZ),
                                ui::kCaption, ui::Buttons::YesNo, ui::Answer::No) != ui::Answer::Yes) {
                txt.Print(rayon::kLineNotWritten, std::string(point.mat).c_str());
                continue;
            }
            if (m_session.WritePoint(point.mat, point.x, point.y, point.z)) ++points;
        }
    }
    m_written = true;
    if (!m_session.Modified()) {
        txt.PrintText(msg::kNoChange);
        return true;
    }
    if (!m_session.Save()) return false;
    txt.Print(rayon::kLineWritten, points, stations);
    Notify(kPartResults);
    return true;
}

} // namespace pyr
