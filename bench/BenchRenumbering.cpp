// Renumbering in the GéoBase editor, on a job of a million elements: it must stay linear in the size
// of the GéoBase, whatever the number of points renumbered (no identifier compared with every element).
#include "JobGenerator.h"
#include "editor/Renumbering.h"
#include "geobase/Carnet.h"

#include <benchmark/benchmark.h>

namespace pyr::bench {

namespace {

constexpr int kJobElements = 1'000'000;

const CCarnet& Job() {
    static const CCarnet job = MakeJobOfSize(kJobElements);
    return job;
}

// The detail points are numbered from 1000: the first hundred thousand of them, each a sighting and a
// point, moved by a million (clear of every number the job holds).
RenumberRequest HundredThousandPoints() {
    RenumberRequest request;
    request.selection = "1000-100999";
    request.offset = 1'000'000;
    return request;
}

void BM_RenumberPoints(benchmark::State& state) {
    const CCarnet& job = Job();
    const RenumberRequest request = HundredThousandPoints();
    std::size_t renamed = 0, replaced = 0;
    for (auto _ : state) {
        const RenumberResult result = RenumberPoints(job, request);
        renamed = result.renamed.size();
        replaced = result.replacements.size();
    }
    state.counters["points"] = static_cast<double>(renamed);
    state.counters["elements"] = static_cast<double>(replaced);
}
BENCHMARK(BM_RenumberPoints)->Unit(benchmark::kMillisecond);

// The whole edit as the editor does it: computed, exchanged into the store, then undone; the store's
// index is built again after each change.
void BM_RenumberPointsAppliedAndUndone(benchmark::State& state) {
    CCarnet job = Job();
    const RenumberRequest request = HundredThousandPoints();
    for (auto _ : state) {
        RenumberResult result = RenumberPoints(job, request);
        for (ElementReplacement& replacement : result.replacements)
            job.ExchangeAt(replacement.index, replacement.element);
        for (ElementReplacement& replacement : result.replacements)
            job.ExchangeAt(replacement.index, replacement.element);
    }
}
BENCHMARK(BM_RenumberPointsAppliedAndUndone)->Unit(benchmark::kMillisecond);

// Every station under a new prefix: stations, their points, the sightings between them and the
// traverses' designations.
void BM_RenumberStationsWithAPrefix(benchmark::State& state) {
    const CCarnet& job = Job();
    RenumberRequest request;
    request.selection = "S1-S999999";
    request.newPrefix = "ST";
    std::size_t replaced = 0;
    for (auto _ : state)
        replaced = RenumberPoints(job, request).replacements.size();
    state.counters["elements"] = static_cast<double>(replaced);
}
BENCHMARK(BM_RenumberStationsWithAPrefix)->Unit(benchmark::kMillisecond);

void BM_RenameStation(benchmark::State& state) {
    const CCarnet& job = Job();
    std::size_t replaced = 0;
    for (auto _ : state)
        replaced = RenameStation(job, "S100", "NOUVELLE").replacements.size();
    state.counters["elements"] = static_cast<double>(replaced);
}
BENCHMARK(BM_RenameStation)->Unit(benchmark::kMillisecond);

} // namespace

} // namespace pyr::bench
