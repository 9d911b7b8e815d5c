#pragma once

// The GéoBase of a traverse measured by a perfect instrument: A and B known, each with a reference to
// orient it on, T1 and T2 set up between them, every station's instrument turned its own way. What the
// tests of the traverses change in it, they ask for.
#include "calc/test_v0_geometry.h"

#include <initializer_list>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace pyr::test {

namespace traverse_job {
inline const Place kA{651200.000, 6862300.000, 52.310}, kB{651688.731, 6862554.562, 49.870};
inline const Place kT1{651325.412, 6862371.905, 53.874}, kT2{651502.118, 6862492.447, 55.021};
inline const Place kR1{651050.118, 6862512.447, 55.0}, kR2{651900.0, 6862300.0, 48.0};
inline const Place kP1{651390.5, 6862350.25, 54.1}; // a point sighted from T1 only
inline constexpr double kHi = 1.55, kHp = 1.3;
} // namespace traverse_job

struct TraverseJobOptions {
    bool endKnown = true;       // B in the GéoBase
    double t2Shift = 0.0;       // where T2 really stood (metres east) when T1 sights it: no closure then
    double twist = 0.0;         // T2's reading on B turned by that much (grads): an angular misclosure
    double sigmaAh = 0.0;       // > 0: A and T1 measured with an instrument of that precision of directions,
                                // T2 and B with one that gives none
    bool measuredTwice = false; // T1 sights T2 twice
    bool sideShot = false;      // T1 also sights P1
    // The traverses written at the end, each by its stations.
    std::vector<std::pair<std::string, std::vector<std::string>>> traverses;
};

inline void AddInstrument(CCarnet& carnet, double sigmaAh) {
    auto instrument = std::make_unique<CAppareil>("T");
    instrument->setSigmaAh(sigmaAh);
    carnet.Add(std::move(instrument), kKindAppareil);
}

inline CCarnet TraverseJob(const TraverseJobOptions& o = {}) {
    using namespace traverse_job;
    CCarnet carnet;
    AddPoint(carnet, "A", kA);
    AddPoint(carnet, "R1", kR1);
    if (o.endKnown) AddPoint(carnet, "B", kB);
    AddPoint(carnet, "R2", kR2);
    const Place t2Seen{kT2.x + o.t2Shift, kT2.y, kT2.z};
    if (o.sigmaAh > 0.0) AddInstrument(carnet, o.sigmaAh);
    AddStation(carnet, "A", kHi);
    AddSighting(carnet, "R1", kA, kHi, kR1, kHp, 12.5);
    AddSighting(carnet, "T1", kA, kHi, kT1, kHp, 12.5, kKindMesure);
    AddStation(carnet, "T1", kHi);
    AddSighting(carnet, "A", kT1, kHi, kA, kHp, 210.0, kKindMesure);
    AddSighting(carnet, "T2", kT1, kHi, t2Seen, kHp, 210.0, kKindMesure);
    if (o.measuredTwice) AddSighting(carnet, "T2", kT1, kHi, t2Seen, kHp, 210.0, kKindMesure);
    if (o.sideShot) AddSighting(carnet, "P1", kT1, kHi, kP1, kHp, 210.0, kKindMesure);
    if (o.sigmaAh > 0.0) AddInstrument(carnet, 0.0);
    AddStation(carnet, "T2", kHi);
    AddSighting(carnet, "T1", kT2, kHi, kT1, kHp, 399.995, kKindMesure);
    AddSighting(carnet, "B", kT2, kHi, kB, kHp, 399.995 - o.twist, kKindMesure);
    AddStation(carnet, "B", kHi);
    AddSighting(carnet, "T2", kB, kHi, kT2, kHp, 77.0, kKindMesure);
    AddSighting(carnet, "R2", kB, kHi, kR2, kHp, 77.0);
    for (const auto& [name, stations] : o.traverses) {
        auto chain = std::make_unique<CChemin>(name);
        for (const std::string& station : stations)
            chain->add(station);
        carnet.Add(std::move(chain), kKindChemin);
    }
    return carnet;
}

// CH1, from A to B.
inline const std::pair<std::string, std::vector<std::string>> kTraverseCH1{"CH1", {"A", "T1", "T2", "B"}};

} // namespace pyr::test
