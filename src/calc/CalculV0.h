#pragma once

#include "calc/Corrections.h"
#include "calc/SightingReduction.h"
#include "calc/Tolerances.h"
#include "core/Undefined.h"

#include <string>
#include <vector>

// The orientation unknown V0 of a station: the bearing of the zero of its horizontal circle, found from
// its sightings of points whose coordinates are known. Each reference gives a partial V0 (its bearing
// from the station's coordinates less its horizontal direction); their mean, weighted by the distances
// or not, is the station's V0 once the references out of tolerance have been dropped one by one.
// Angles in grads, bearings clockwise from the Y axis; lengths in metres.
namespace pyr {

class CCarnet;

// One chosen reference of a station and what the computation made of it.
struct V0Reference {
    int index = -1;        // the sighting's element in the GéoBase
    std::string mat;       // the point sighted
    double x = kUndefined; // its coordinates in the GéoBase
    double y = kUndefined;
    double z = kUndefined;
    bool valid = true;                    // still in the mean
    double bearing = kUndefined;          // G, from the station's coordinates
    double distance = kUndefined;         // D from the coordinates: the weight of the reference
    double measuredDistance = kUndefined; // Dh measured, corrected for the scale of the projection
    double ah = kUndefined;               // the direction, turned to face left and reduced for eccentricity
    double partialV0 = kUndefined;        // V0i = G - AH, in [0, 400)
    double wrappedV0 = kUndefined;        // V0i within 200 gr of the first valid reference's
    double residual = kUndefined;         // ei = V0 - V0i
};

struct V0Settings {
    bool weighted = true; // "Ponderation": the mean weighted by the distances
    bool forced = false;  // "Forcer l'utilisation des réf. choisies": no reference is dropped
    Tolerances tolerances;
    // Sightings are taken with their target heights and without instrument constants: the orientation
    // needs only directions, and its checks compare what was measured.
    SightingReductionOptions reduction;
};

// The orientation of one station: computed from its references or fixed by hand.
struct V0Result {
    StationPlace station; // its V0 is the one the GéoBase held before the computation
    std::vector<V0Reference> references;
    bool computed = false; // a V0 was found (or fixed)
    bool byHand = false;   // fixed by hand: no reference was used
    bool weighted = true;
    double v0 = kUndefined;            // the result, rounded to 6 decimals, in [0, 400)
    double tolerance = kUndefined;     // T_V0 of the references kept
    int used = 0;                      // references kept in the mean
    std::vector<std::string> remarks;  // for the listing
    std::vector<std::string> warnings; // for the person, as they arose
    bool written = false;              // written into the GéoBase's station
};

// The places of the points that sightings name, as PointPlaceOf gives them. Orienting every station of a
// job reads each reference point once, and not again for each station that sights it: with `remember`,
// each place found is kept in a table of the GéoBase's identifiers (made for the computation of many
// stations, since it is as long as the identifiers are many). Valid while the GéoBase does not change.
class PointPlaces {
public:
    PointPlaces(const CCarnet& carnet, bool remember);

    const CCarnet& Carnet() const { return m_carnet; }
    // The station occurrence at that index, as StationPlaceAt places it.
    StationPlace Station(int stationIndex);
    // The place of the point that the element at `index` names; false when its planimetry is unknown.
    bool Of(int index, double& x, double& y, double& z);

private:
    struct Place {
        double x, y, z; // x is NaN until the place is looked up
    };
    const CCarnet& m_carnet;
    std::vector<Place> m_places; // by the rank of the identifier; empty when nothing is kept
};

// The sightings of a station occurrence that can orient it: its references and measured sightings of
// points whose planimetry is known, in GéoBase order.
std::vector<int> OfferedReferences(const CCarnet& carnet, int stationIndex);
// Those chosen at first among them: the reference sightings (1002), or all when there is none.
std::vector<int> DefaultReferences(const CCarnet& carnet, int stationIndex);
std::vector<int> DefaultReferences(PointPlaces& places, int stationIndex);

// The partial orientation of one sighting from the station: the sighting turned to face left, reduced
// for its eccentric offsets, its horizontal distance corrected for scale and checked, with the
// reference's coordinates, against the tolerances of distances and height differences. The warnings of
// those checks are appended to `warnings`; the reference stays in the computation all the same.
V0Reference PrepareReference(const CCarnet& carnet, const StationPlace& station, int sighting,
                             const V0Settings& settings, std::vector<std::string>& warnings);
V0Reference PrepareReference(PointPlaces& places, const StationPlace& station, int sighting,
                             const V0Settings& settings, std::vector<std::string>& warnings);

// The mean of the valid references of `result`, dropping the worst out of tolerance one at a time
// (unless forced), then rounded. Sets computed, v0, used, tolerance, the residuals and the remarks.
void SolveV0(V0Result& result, const V0Settings& settings);

// The whole computation of a station from the chosen sightings.
V0Result ComputeStationV0(const CCarnet& carnet, const StationPlace& station,
                          const std::vector<int>& sightings, const V0Settings& settings);
V0Result ComputeStationV0(PointPlaces& places, const StationPlace& station, const std::vector<int>& sightings,
                          const V0Settings& settings);

// A V0 brought into [0, 400) and rounded to 6 decimals; a full turn is 0.
double RoundV0(double v0);

} // namespace pyr
