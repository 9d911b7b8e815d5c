#pragma once

#include "calc/CalculV0.h"
#include "calc/SightingReduction.h"
#include "calc/Tolerances.h"
#include "core/Undefined.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <memory_resource>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

// Radiated points: every point sighted from an oriented station placed by its bearing (V0 + AH) and its
// corrected horizontal distance, and given an altitude by trigonometric levelling when the station's
// altitude, the instrument height, the zenith angle and the target height are known. A sighting of a
// point whose planimetry the GéoBase already holds is a check of the station, not a new point. A point
// radiated from several stations keeps the plain mean of its determinations, its spread checked against
// the tolerances. Angles in grads, bearings clockwise from the Y axis; lengths in metres.
//
// A job radiates a million sightings at once: the identifiers and codes of the results are viewed in the
// GéoBase's own elements, not copied, and hold while the GéoBase they come from stays open.
namespace pyr {

class CCarnet;
class CSelection;

struct RadiationSettings {
    // Instrument constants, face left, eccentric offsets, target heights, scale correction.
    SightingReductionOptions reduction;
    bool replaceZeroTargetHeight = false; // "RayonHp0Check"
    double zeroTargetHeight = 0.0;        // "ValeurDeHp0", put for a target height of 0
    bool computeV0 = false;               // "RayonV0Calcule": orient the station on its references first
    V0Settings v0;                        // how, when it does
    Tolerances tolerances;                // "TolDistances" and "TolAltitudes" for multiple determinations
};

// One radiated sighting: the repetitions of one point from one station merged into the first of them.
struct RadiatedSighting {
    int index = -1;              // the first sighting element of that point from the station
    int key = -1;                // of a new point: the rank of its identifier in the GéoBase, the same
                                 // from every station, which the merge groups by
    std::string_view mat;        // the point sighted
    std::string_view code;       // the sighting's code (its symbol)
    int repetitions = 1;         // sightings of the point merged
    bool reference = false;      // a reference sighting (1002)
    double hp = kUndefined;      // target height used (ValeurDeHp0 in place of 0 when asked)
    double ah = kUndefined;      // face left, reduced for the offsets, mean of the repetitions
    double av = kUndefined;      // face left, with the collimation, mean of the repetitions
    double di = kUndefined;      // reduced slope distance
    double dh = kUndefined;      // horizontal distance corrected for scale
    double bearing = kUndefined; // V0 + AH, in [0, 400)
    double x = kUndefined;
    double y = kUndefined;
    double z = kUndefined; // unknown without the station's altitude, HI, AV or HP
};

// A station's radiated sightings, in memory the caller may give: a whole job's are a hundred megabytes.
using RadiatedSightings = std::pmr::vector<RadiatedSighting>;

// A sighting of a point whose planimetry is known: what the radiation gives beside what the GéoBase holds.
struct RadiationCheck {
    RadiatedSighting sighting;
    double knownX = kUndefined;
    double knownY = kUndefined;
    double knownZ = kUndefined;
    double along = kUndefined;  // radiated minus known, along the line of sight (positive beyond)
    double across = kUndefined; // across it, positive to the right seen from the station
    double dz = kUndefined;     // radiated minus known altitude, when both are known
};

// A sighting that gave no point, and why ("sans distance", "sans angle horizontal").
struct SkippedSighting {
    int index = -1;
    std::string_view mat;
    std::string reason;
};

// What the radiation made of one station occurrence.
struct RadiatedStation {
    RadiatedStation() = default;
    explicit RadiatedStation(std::pmr::memory_resource* memory) : points(memory) {}

    StationPlace station;                 // its V0 is the one used (computed when asked and possible)
    bool usable = false;                  // placed and oriented
    std::string reason;                   // why not, in French, when not usable
    bool v0Computed = false;              // oriented on its references by the V0 rules ("RayonV0Calcule")
    V0Result v0;                          // that computation, when it was made
    RadiatedSightings points;             // new points, in GéoBase order of their first sighting
    std::vector<RadiationCheck> checks;   // known points
    std::vector<SkippedSighting> skipped;

    // Emptied for another run, its lists keeping their room and their memory.
    void Clear() {
        station = StationPlace{};
        usable = false;
        reason.clear();
        v0Computed = false;
        v0 = V0Result{};
        points.clear();
        checks.clear();
        skipped.clear();
    }
};

// Radiates the sightings of the station occurrence at `stationIndex` (limited to the points of `points`
// when it is not null). The station needs its place in the GéoBase and a V0: its own, or computed from
// its references when settings.computeV0 is on (its own, if it has one, when that fails).
RadiatedStation RadiateStation(const CCarnet& carnet, int stationIndex, const RadiationSettings& settings,
                               const CSelection* points = nullptr);
// The same, into `result`, whose lists keep the room they had: a job radiated again takes no new memory.
void RadiateStation(const CCarnet& carnet, int stationIndex, const RadiationSettings& settings,
                    const CSelection* points, RadiatedStation& result);

// Where one station placed a new point.
struct Determination {
    std::uint32_t station = 0; // rank of the station among those radiated
    std::uint32_t point = 0;   // rank of the sighting in its station's points
};

// The determinations of one point, in the order of the stations. Most points are seen from one station
// only: that one is kept in place, without a block of memory of its own.
class Determinations {
public:
    Determinations() = default;
    Determinations(const Determinations& other) { *this = other; }
    Determinations(Determinations&& other) noexcept { *this = std::move(other); }
    Determinations& operator=(const Determinations& other);
    Determinations& operator=(Determinations&& other) noexcept;
    ~Determinations() = default;

    std::size_t size() const { return m_size; }
    bool empty() const { return m_size == 0; }
    const Determination* begin() const { return m_size <= 1 ? &m_first : m_all.get(); }
    const Determination* end() const { return begin() + m_size; }
    const Determination& operator[](std::size_t i) const { return begin()[i]; }
    void push_back(const Determination& determination);

private:
    Determination m_first;
    std::uint32_t m_size = 0;
    std::uint32_t m_capacity = 0;           // of m_all
    std::unique_ptr<Determination[]> m_all; // every one, the first included, once there are two
};

// A new point and all its determinations: the plain mean of their X, Y (and of their Z where known).
struct RadiatedPoint {
    std::string_view mat;
    Determinations determinations; // in the order of the stations
    double x = kUndefined;
    double y = kUndefined;
    double z = kUndefined;
    double spreadXY = 0.0;       // the largest planimetric distance between two determinations
    double spreadZ = 0.0;        // the largest difference between two known altitudes
    bool outOfTolerance = false; // spreadXY > TolDistances or spreadZ > TolAltitudes
};

using RadiatedPoints = std::pmr::vector<RadiatedPoint>;

// The new points of the stations radiated, each once, in the order of their first determination.
RadiatedPoints MergeDeterminations(const std::vector<RadiatedStation>& stations, const Tolerances& tolerances);
// The same, into `merged`, which keeps its room.
void MergeDeterminations(const std::vector<RadiatedStation>& stations, const Tolerances& tolerances,
                         RadiatedPoints& merged);

} // namespace pyr
