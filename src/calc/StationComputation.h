#pragma once

#include "calc/SightingComputation.h"
#include "calc/StationChoice.h"

#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The words of a station computation beside those of every computation.
struct StationWords {
    ComputationWords computation;
    const char* caption;       // "Calcul de la station %s par relèvement"
    const char* msgNoStation;  // no station to offer in the GéoBase "%s"
    const char* msgNotOffered; // the station "%s" named is not offered
};

// A dialog that computes a station occurrence (its place, its V0 and its altitude) from its sightings:
// the station is chosen in a combo as "S (2)", its name and occurrence, or named "S", "S(2)", "S (2)";
// its results are written into the GéoBase, the station's point receiving X, Y and Z and the station its
// V0. Each computation says which stations it offers and what choosing one fills.
class CStationComputation : public CSightingComputation {
public:
    std::string Caption() const override;
    bool Open(ui::FrontEnd& frontEnd) override;

    // ---- The combo: "S1 (1)", "S1 (2)"...
    const std::vector<std::string>& Stations() const { return m_stations.Shown(); }
    // Chooses a station by its name, "NOM" (its first occurrence offered) or "NOM(2)" / "NOM (2)". False,
    // with a message, for a station that is not offered.
    bool ChooseStation(std::string_view designation);
    const std::string& Station() const { return m_station; }
    const std::vector<std::string>& Subjects() const override { return Stations(); }
    const std::string& Subject() const override { return m_station; }
    bool ChooseSubject(std::string_view designation) override { return ChooseStation(designation); }

protected:
    explicit CStationComputation(StationWords words);

    // Whether a station occurrence has what its computation needs to be offered.
    virtual bool Offers(int stationIndex) = 0;
    // Fills the dialog for the station chosen (StationIndex()).
    virtual void StationChosen() = 0;
    int StationIndex() const { return m_stationIndex; }
    // The sightings of a station, up to the next station, on points known in X and Y other than the
    // station itself and `except`: the lines "---> P".
    std::vector<Line> SightingsOnKnownPoints(int stationIndex, std::string_view except = {});
    // The tooltip of a line: the sighting's command, the point and the parameters.
    std::string Tooltip(int sighting, const std::string& mat) const;
    // Writes the station computed (WriteStation of every computation) when there is a result to write.
    bool WriteStation(double x, double y, double z, double v0);

private:
    StationWords m_words;
    CStationChoice m_stations;
    std::string m_station;     // as the combo shows it
    std::string m_stationName; // its name, for the caption
    int m_stationIndex = -1;
};

} // namespace pyr
