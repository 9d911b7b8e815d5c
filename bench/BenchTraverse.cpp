// Polygonal traverses: the automatic search on jobs of a thousand to ten thousand set-ups (it must grow
// linearly: no pair of set-ups looked at twice), and the computation of a traverse of a thousand legs.
#include "calc/Traverse.h"
#include "calc/TraverseSearch.h"
#include "core/Angles.h"
#include "geobase/Carnet.h"

#include <benchmark/benchmark.h>
#include <cmath>
#include <string>

namespace pyr::bench {

namespace {

// `setUps` set-ups in traverses of ten: a known station, eight unknown ones, the next known station, each
// set-up sighting its two neighbours and a few side points.
CCarnet TraverseJob(int setUps) {
    CCarnet carnet;
    const auto name = [](int i) { return (i % 9 == 0 ? "K" : "T") + std::to_string(i); };
    for (int i = 0; i <= setUps; i += 9)
        carnet.Add(std::make_unique<CPointGen>(name(i), 1000.0 + i, 2000.0, 100.0), kKindPoint);
    for (int i = 0; i < setUps; ++i) {
        carnet.Add(std::make_unique<CStation>(name(i), 1.5), kKindStation);
        if (i > 0) carnet.Add(std::make_unique<CMesure>(name(i - 1), 1.3, 300.0, 100.0, 80.0), kKindMesure);
        carnet.Add(std::make_unique<CMesure>(name(i + 1), 1.3, 100.0, 100.0, 80.0), kKindMesure);
        for (int side = 0; side < 5; ++side)
            carnet.Add(std::make_unique<CMesure>("P" + std::to_string(i * 5 + side), 1.3, 50.0, 100.0, 20.0),
                       kKindMesure);
    }
    return carnet;
}

void BM_TraverseSearch(benchmark::State& state) {
    const CCarnet carnet = TraverseJob(static_cast<int>(state.range(0)));
    std::size_t found = 0;
    for (auto _ : state)
        found = FindTraverses(carnet).size();
    state.counters["cheminements"] = static_cast<double>(found);
    state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_TraverseSearch)
    ->Arg(1000)
    ->Arg(10000)
    ->Arg(30000)
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

// A traverse of a thousand legs winding over Lambert-93 ground, linked at both ends.
void BM_TraverseOfAThousandLegs(benchmark::State& state) {
    const int legs = static_cast<int>(state.range(0));
    TraverseInput input;
    double x = 651200.0, y = 6862300.0, bearing = 50.0;
    input.x0 = x, input.y0 = y, input.z0 = 50.0, input.v00 = 0.0;
    for (int i = 0; i <= legs; ++i) {
        TraverseStation station{"S" + std::to_string(i)};
        if (i > 0) station.back = WrapGrads(bearing + 200.0);
        if (i < legs) {
            bearing = WrapGrads(bearing + std::sin(i * 0.1) * 30.0);
            station.forward = bearing;
            station.distance = 150.0 + 50.0 * std::cos(i * 0.3);
            station.dz = std::sin(i * 0.2);
            x += station.distance * SinGrads(bearing);
            y += station.distance * CosGrads(bearing);
        }
        input.stations.push_back(station);
    }
    input.xn = x + 0.02, input.yn = y - 0.01, input.zn = 50.0, input.v0n = 0.001;
    double f = 0.0;
    for (auto _ : state) {
        const TraverseResult result = ComputeTraverse(input);
        f = result.f;
        benchmark::DoNotOptimize(result.stations.data());
    }
    state.counters["f_mm"] = f * 1000.0;
}
BENCHMARK(BM_TraverseOfAThousandLegs)->Arg(1000)->Unit(benchmark::kMicrosecond);

} // namespace

} // namespace pyr::bench
