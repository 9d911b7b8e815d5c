// The search of duplicate points on a million elements: it must stay linear, whatever the tolerance, and
// leave the GéoBase's index as it found it (built once, before the timing).
#include "JobGenerator.h"
#include "editor/DuplicatePoints.h"
#include "geobase/Carnet.h"

#include <benchmark/benchmark.h>

namespace pyr::bench {

namespace {

constexpr int kElements = 1'000'000;

// A survey job: stations, sightings, eccentric offsets, and the points computed from them.
const CCarnet& Job() {
    static const CCarnet job = [] {
        CCarnet carnet = MakeJobOfSize(kElements);
        carnet.NameCount(); // the index, built once
        return carnet;
    }();
    return job;
}

// A million points, as an export of a survey writes them.
const CCarnet& Survey() {
    static const CCarnet survey = [] {
        CCarnet carnet = MakePointSurvey(kElements);
        carnet.NameCount();
        return carnet;
    }();
    return survey;
}

void Search(benchmark::State& state, const CCarnet& carnet) {
    const double tolerance = static_cast<double>(state.range(0)) / 100.0; // cm to m
    std::size_t pairs = 0, conflicts = 0;
    int examined = 0;
    for (auto _ : state) {
        const DuplicatePoints found = FindDuplicatePoints(carnet, tolerance);
        pairs = found.pairs.size();
        conflicts = found.conflicts.size();
        examined = found.examined;
        benchmark::DoNotOptimize(found.pairs.data());
    }
    state.counters["points"] = examined;
    state.counters["couples"] = static_cast<double>(pairs);
    state.counters["conflicts"] = static_cast<double>(conflicts);
}

void BM_DuplicatePointsInAJob(benchmark::State& state) {
    Search(state, Job());
}
BENCHMARK(BM_DuplicatePointsInAJob)->Arg(0)->Arg(5)->Arg(100)->Unit(benchmark::kMillisecond);

void BM_DuplicatePointsInASurvey(benchmark::State& state) {
    Search(state, Survey());
}
BENCHMARK(BM_DuplicatePointsInASurvey)->Arg(0)->Arg(5)->Arg(100)->Unit(benchmark::kMillisecond);

} // namespace

} // namespace pyr::bench
