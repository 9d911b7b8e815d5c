// Reducing the stations of a big job at once: repeated sightings averaged, eccentric offsets folded in,
// reprises of a station merged into its first set-up and deleted. Every step finds what it needs through
// the store's index, so the time grows with the job and not with its square.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "calc/StationReduction.h"

#include <benchmark/benchmark.h>

namespace pyr::bench {

namespace {

void BM_ReduceAllStations(benchmark::State& state) {
    const int stations = static_cast<int>(state.range(0));
    SilentFrontEnd frontEnd;
    int elements = 0;
    for (auto _ : state) {
        state.PauseTiming();
        CCarnet carnet = MakeJob(stations);
        CReduction_Station reduction(&carnet);
        reduction.Options() = ReductionOptions{.suppress = true, .doMeans = true, .inExcent = true};
        state.ResumeTiming();
        reduction.Reduce(frontEnd);
        elements = carnet.GetSize();
    }
    state.counters["elements_restants"] = elements;
    state.SetComplexityN(stations);
    state.SetItemsProcessed(state.iterations() * stations);
}
BENCHMARK(BM_ReduceAllStations)
    ->Arg(10000)
    ->Arg(20000)
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

} // namespace

} // namespace pyr::bench
