#pragma once

#include "calc/CalculV0Sta.h"
#include "calc/ComputationSession.h"
#include "calc/Radiation.h"
#include "core/LargeBlocks.h"
#include "ui/DialogModel.h"

#include <memory>
#include <memory_resource>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pyr {

// The stations radiated: one, those of a list, or all, as the orientation of stations chooses them.
using RadiationType = V0CalculationType;

// The dialog "PYRALIS - Calcul de points rayonnés": every point sighted from the stations chosen gets its
// coordinates, the points already known are checked, a point seen from several stations keeps the mean of
// its determinations. "&Enregistrer" writes the new points (and the V0 computed for the stations) into
// the GéoBase; the listing and the journal report them.
//
// Its actions are the methods below; a front end calls Open first. Stations are chosen by their
// designation, "S1" for the first occurrence of S1 and "S1(2)" for its second.
class CCalcRayon : public ui::DialogModel {
public:
    // The part of a change notice: the results of a computation, or what was written.
    static constexpr int kPartResults = 1;

    CCalcRayon();
    ~CCalcRayon() override;

    std::string Caption() const override;

    // ---- Opening and closing
    // Offers the GéoBase (the last one used), loads it, reads the options and chooses the first station.
    // False, a message having said why, when there is no station, or when the person chose no GéoBase.
    bool Open(ui::FrontEnd& frontEnd);
    bool Cancelled() const { return m_cancelled; }
    // Closes after "&Enregistrer" (`saved`) or "Annuler": the listing of the computation, offered or
    // written at once when asked (`listingAsked`, in `listingPath` when named), then the journal.
    std::string Close(bool saved, bool listingAsked = false, std::string listingPath = {});

    // ---- The choices
    RadiationType Type();
    void SetType(RadiationType type);
    bool ChooseStation(std::string_view designation);
    const std::vector<std::string>& StationNames() const { return m_stations; }
    int StationRank() const { return m_stationRank; }
    // False, with a message, for an incorrect selection.
    bool SetList(std::string_view selection);
    const std::string& List() const { return m_list; }
    // Only the points of that selection are radiated ("" for all); false, with a message, when incorrect.
    bool SetPoints(std::string_view selection);
    const std::string& Points() const { return m_points; }

    // The calculation options read at Open, which this run may change.
    RadiationSettings& Settings() { return m_settings; }
    bool CheckKnownPoints() const { return m_checkKnown; } // "ControleV0Rayonne"
    void SetCheckKnownPoints(bool check) { m_checkKnown = check; }
    // The columns of the listing's points, from "RayonContenu".
    const std::vector<std::string>& Columns() const { return m_columns; }

    // ---- Actions
    // "&Calculer": radiates the stations chosen and merges the points seen from several. True when at
    // least one station could be used.
    bool Calculate();
    // "&Enregistrer": the new points and the V0 computed go into the GéoBase, which is saved. A point out
    // of tolerance is written only when the person agrees. False when the GéoBase could not be saved.
    bool Enregistrer();

    // ---- What is shown
    const std::vector<RadiatedStation>& Results() const { return m_results; }
    const RadiatedPoints& NewPoints() const { return m_newPoints; }
    int NotUsed() const { return m_notUsed; }
    int OutOfTolerance() const { return m_outOfTolerance; }
    const CCarnet& Carnet() const { return m_session.Carnet(); }

private:
    static constexpr std::size_t kFirstBlockBytes = 4 * kHugePageBytes;
    static constexpr unsigned kMostWorkers = 8;
    // Below that many stations, a single worker: a thread costs more than it saves.
    static constexpr std::size_t kStationsForWorkers = 64;

    void RadiateChosen(const std::vector<int>& chosen, const CSelection* points);

    void LoadSettings();
    void ReadOptions();
    std::vector<int> ChosenStations();
    void Show(const RadiatedStation& result);

    ui::FrontEnd* m_frontEnd = nullptr;
    bool m_cancelled = false;
    CComputationSession m_session;
    bool m_settingsLoaded = false;
    RadiationType m_type = RadiationType::Toutes;
    RadiationSettings m_settings;
    bool m_checkKnown = true;
    std::vector<std::string> m_columns;

    std::vector<std::string> m_stations; // every station occurrence: "S1", "S1(2)"
    std::vector<int> m_stationIndex;     // their elements
    int m_stationRank = -1;
    std::string m_list;
    std::string m_points;

    // The stations are radiated on every core, the station of rank k by worker k modulo their number.
    // Each worker takes its stations' sightings from its own memory, kept for as long as the GéoBase stays
    // open: a job's results are taken together, and kept for the next run.
    std::vector<std::unique_ptr<std::pmr::monotonic_buffer_resource>> m_memory;
    std::vector<RadiatedStation> m_results;
    RadiatedPoints m_newPoints{LargeBlocks()};
    int m_notUsed = 0;
    int m_outOfTolerance = 0;
    bool m_written = false;
};

} // namespace pyr
