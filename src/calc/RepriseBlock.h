#pragma once

#include "core/Undefined.h"

#include <string>
#include <utility>
#include <vector>

// The set-ups (reprises) of one station point, and the formulas that merge them into one station: the
// orientation offset between two set-ups, the mean of a point sighted several times from one station,
// and the transfer of a sighting to another instrument height. Angles in grads, lengths in metres.
namespace pyr {

class CVisee;
struct CRepriseBlock;
using CRepriseList = std::vector<CRepriseBlock>;

// One set-up of a station point inside the GéoBase: its station element and the elements that go with
// it. The eccentric offsets and instruments written in front of the station belong to it; it ends after
// its last sighting.
struct CRepriseBlock {
    CRepriseList* owner = nullptr; // the list of blocks it belongs to, when it belongs to one
    int stationIndex = -1;         // the station element (1001)
    int repriseNumber = 0;         // rank from 1 among the set-ups of its point, in GéoBase order
    int startIndex = -1;           // first element: the station moved back over the elements in front of it
    int endIndex = -1;           // one past its last sighting; the end of the GéoBase after the last station
    double V0 = kUndefined;      // the station's orientation, known when >= 0
    std::vector<int> links;      // reprise numbers minus one of the set-ups whose offset to this one is known
    std::vector<double> offsets; // for each link: what to add to that set-up's AH to bring it into this one's
    int merged = 0;              // 1 once its sightings are copied into the merged station
    std::string name;            // the station's point identifier

    bool HasV0() const { return V0 >= 0.0; }
    void AddLink(int otherReprise, double offset) {
        links.push_back(otherReprise - 1);
        offsets.push_back(offset);
    }
};

// The orientation offset of set-up B to set-up A from pairs (AH in A, AH in B) of sightings of the same
// points: the mean of the differences AH_A - AH_B, each brought within 200 gr of the first pair's, in
// [0, 400). Unknown (kUndefined) without any pair.
double MeanOrientationOffset(const std::vector<std::pair<double, double>>& pairs);

// The orientation offset of set-up B to set-up A from their known orientations: V0_B - V0_A in [0, 400).
double V0Offset(double v0A, double v0B);

// A horizontal direction of a repetition brought near the running mean of the directions before it:
// by 200 gr when it lies 150 to 250 gr away (the other face), by 400 gr when more than 300 gr away (the
// other side of zero). Between 250 and 300 gr it is left as it stands.
double BringNearMean(double ah, double mean);

// The zenith angle of a line of sight of horizontal length h and height difference v (metres, v > 0
// upwards) once its far end is raised by `rise` metres: atan2(h, v + rise), in grads.
double ZenithRaised(double h, double v, double rise);

// The mean of the sightings of one point from one station: the first sighting (already turned to face
// left and reduced for its eccentricities) and the repetitions added one by one as they stand.
class CRepetitionMean {
public:
    explicit CRepetitionMean(const CVisee& first);
    void Add(const CVisee& repetition);
    // Writes the mean directions, zenith angle, target height and slope distance into the first sighting.
    void WriteInto(CVisee& first) const;

private:
    double m_ahSum = 0.0;
    int m_ahCount = 0;
    double m_avSum = kUndefined; // the zenith angles, all on the target height m_hp
    int m_avCount = 0;
    double m_hp = kUndefined;
    double m_diSum = 0.0;
    int m_diCount = 0;
    double m_hSum = 0.0; // horizontal distances
    int m_hCount = 0;
};

} // namespace pyr
