// Orienting every station of a big job at once ("Toutes"): the time must grow with the number of
// stations, each found with its references through the store's index, never by a scan of the GéoBase.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "calc/CalculV0Sta.h"
#include "calc/Corrections.h"
#include "core/Angles.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <benchmark/benchmark.h>
#include <cmath>
#include <filesystem>
#include <unistd.h>

namespace pyr::bench {

namespace {

// The job's reference sightings read again as a good instrument would read them from the coordinates:
// each station's circle turned by a V0 of its own, the directions off by at most 0.1 mgon.
void ReadReferencesFromCoordinates(CCarnet& carnet) {
    double sx = 0, sy = 0, sz = 0, hi = 0, v0 = 0;
    bool placed = false;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        if (carnet.GetType(i) == kKindStation) {
            const std::string name = carnet.matAt(i);
            placed = carnet.hasXY(name, sx, sy) && carnet.hasZ(name, sz);
            hi = carnet.hiAt(i);
            v0 = WrapGrads(i * 37.123);
            continue;
        }
        double tx, ty, tz;
        if (carnet.GetType(i) != kKindReference || !placed) continue;
        auto* sighting = carnet.As<CVisee>(i);
        if (!carnet.hasXY(sighting->mat(), tx, ty) || !carnet.hasZ(sighting->mat(), tz)) continue;
        const double horizontal = std::hypot(tx - sx, ty - sy);
        const double rise = tz + sighting->hp() - sz - hi - CurvatureRefraction(horizontal);
        const double noise = ((i * 7919) % 21 - 10) * 1e-5;
        sighting->setAH(WrapGrads(Bearing(sx, sy, tx, ty) - v0 + noise));
        sighting->setAV(RadiansToGrads(std::atan2(horizontal, rise)));
        sighting->setDI(std::hypot(horizontal, rise));
    }
}

void BM_OrientAllStations(benchmark::State& state) {
    const int stations = static_cast<int>(state.range(0));
    CCarnet carnet = MakeJob(stations);
    ReadReferencesFromCoordinates(carnet);
    const std::filesystem::path folder =
        std::filesystem::temp_directory_path() / ("pyralis-bench-v0-" + std::to_string(getpid()));
    std::filesystem::create_directories(folder);
    const std::string geo = (folder / "job.geo").string();
    carnet.Save(geo);

    SilentFrontEnd frontEnd;
    CCalculV0Sta dialog;
    dialog.SetInputs({geo, (folder / "Pyralis.ini").string(), "", "calcul du V0 d'une station"});
    if (!dialog.Open(frontEnd)) state.SkipWithError("la GéoBase n'a pas pu être ouverte");
    dialog.SetType(V0CalculationType::Toutes);
    for (auto _ : state)
        if (!dialog.Calculate()) state.SkipWithError("aucun V0 calculé");
    state.counters["stations"] = static_cast<double>(dialog.Results().size());
    state.counters["non_calculables"] = dialog.NotComputable();
    state.counters["messages"] = frontEnd.messages;
    state.SetComplexityN(stations);
    state.SetItemsProcessed(state.iterations() * stations);
    std::filesystem::remove_all(folder);
}
BENCHMARK(BM_OrientAllStations)
    ->Arg(10000)
    ->Arg(20000)
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

} // namespace

} // namespace pyr::bench
