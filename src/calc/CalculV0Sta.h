#pragma once

#include "calc/CalculV0.h"
#include "calc/ComputationSession.h"
#include "geobase/Carnet.h"
#include "settings/Journal.h"
#include "ui/DialogModel.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pyr {

// The radio group "&Type de calcul :".
enum class V0CalculationType {
    Unique = 0, // one station occurrence, its references chosen by the person
    Liste = 1,  // every occurrence of the stations named by a selection
    Toutes = 2  // every station of the GéoBase
};

// The dialog "PYRALIS - Calcul des V0 de stations": the orientation of one station, of the stations of a
// list or of all of them, checked against the tolerances, kept in the GéoBase by "&Enregistrer", reported
// in a listing and in the journal.
//
// Its actions are the methods below; a front end calls Open first. Stations are chosen by their
// designation, "S1" for the first occurrence of S1 and "S1(2)" for its second.
class CCalculV0Sta : public ui::DialogModel {
public:
    // One sighting offered in the list "&Références :".
    struct Offered {
        int index;       // of the sighting in the GéoBase
        std::string mat; // the point sighted
        bool reference;  // a reference sighting (1002), rather than a measured one (1003)
        bool chosen;
    };

    CCalculV0Sta();
    ~CCalculV0Sta() override;

    std::string Caption() const override;

    // ---- Opening and closing
    // Offers the GéoBase (the last one used) to be confirmed or changed, loads it, reads the options and
    // shows the first station. False, a message having said why, when there is nothing to orient, or when
    // the person chose no GéoBase.
    bool Open(ui::FrontEnd& frontEnd);
    // Whether the person chose no GéoBase at Open.
    bool Cancelled() const { return m_cancelled; }
    // Closes the dialog, after "&Enregistrer" (`saved`) or "Annuler": with results, the listing is
    // offered, or written at once when the person asked for it (`listingAsked`, in `listingPath` when
    // named in advance); after "&Enregistrer", the settings of the dialog are kept and the journal
    // receives the stations written. A listing, a journal or settings that cannot be written are told to
    // the front end (the file and why) as failures of the command; the GéoBase saved stands. Returns the
    // listing's path, or "".
    std::string Close(bool saved, bool listingAsked = false, std::string listingPath = {});

    // ---- Settings of the dialog ("Calcul_V0"), read when it opens
    V0CalculationType Type();
    void SetType(V0CalculationType type);
    bool Weighted();
    void SetWeighted(bool weighted);
    bool Forced() const { return m_settings.forced; }
    void SetForced(bool forced) { m_settings.forced = forced; }

    // ---- One station
    // Chooses the station (a designation "S1" or "S1(2)"), shows its coordinates and offers its
    // references, the reference sightings chosen. False, with a message, for a station not in the GéoBase.
    bool ChooseStation(std::string_view designation);
    bool ChooseStationAt(int stationIndex);
    const StationPlace& Station() const { return m_station; }
    // Every station occurrence of the GéoBase by its designation, in GéoBase order: "S1" for the first
    // set-up on S1, "S1(2)" for the second; and the rank of the chosen one among them, -1 for none.
    const std::vector<std::string>& Stations() const { return m_stations; }
    int StationRank() const;
    // Coordinates typed for a station that the GéoBase does not place (Z may be kUndefined). False, with
    // a message, when the GéoBase already places it.
    bool SetStationCoordinates(double x, double y, double z);
    const std::vector<Offered>& References() const { return m_offered; }
    void ChooseReference(std::size_t rank, bool chosen);
    // Chooses exactly the offered sightings whose point the selection names; false, with a message, for
    // an incorrect selection or one that names no offered point.
    bool ChooseReferences(std::string_view selection);

    // ---- The stations of a list
    // False, with a message, for an incorrect selection.
    bool SetList(std::string_view selection);
    const std::string& List() const { return m_list; }

    // ---- Actions
    // "&Calculer": the chosen station, or the stations of the list, or all of them. True when at least
    // one V0 was found.
    bool Calculate();
    // "Entrée du V0 de la station": a V0 fixed by hand for the chosen station, in [0, 400].
    bool EnterV0(double v0);
    // "&Enregistrer": the V0 found go into their stations, then the GéoBase is backed up and saved and
    // recorded as the last one used. False when it could not be saved.
    bool Enregistrer();

    // ---- What is shown
    const std::vector<V0Result>& Results() const { return m_results; }
    // The result of the chosen station, or null.
    const V0Result* StationResult() const;
    // The field "&V0 :": the chosen station's new V0, else its V0 in the GéoBase.
    double V0() const;
    // Stations of the last computation of a list (or of all) that could not be oriented.
    int NotComputable() const { return m_notComputable; }
    const CCarnet& Carnet() const { return m_session.Carnet(); }

private:
    void LoadSettings();
    void WriteSettings();
    void Show(const V0Result& result);
    void Keep(V0Result result);
    bool CalculateStation();
    int CalculateList();
    bool AddTypedStationPoint();
    CCarnet& Carnet() { return m_session.Carnet(); }

    ui::FrontEnd* m_frontEnd = nullptr;
    bool m_cancelled = false; // the person did not choose a GéoBase
    CComputationSession m_session;
    V0Settings m_settings;
    bool m_settingsLoaded = false;
    V0CalculationType m_type = V0CalculationType::Unique;

    std::vector<std::string> m_stations;
    std::unordered_map<int, int> m_stationRank; // station element to its rank in m_stations
    StationPlace m_station;
    bool m_typedPlace = false;
    std::vector<Offered> m_offered;
    std::string m_list;

    std::vector<V0Result> m_results;
    std::vector<int> m_resultOf; // of each station element (by its index), its result's rank, -1 for none
    int m_notComputable = 0;
};

} // namespace pyr
