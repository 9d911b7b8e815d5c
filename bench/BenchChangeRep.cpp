// Moving every point of a big job into another frame at once: a million known points (each rewritten, its
// state before kept for the editor's undo), then a job of stations whose V0 are turned as well, and the same
// points chosen through a selection. The first iteration is reported on its own ("premier_ms"): a person
// changes the frame once, in a process whose memory has not yet held a million copies.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "calc/ChangeRep.h"
#include "core/Numbers.h"

#include <benchmark/benchmark.h>
#include <chrono>
#include <memory>

namespace pyr::bench {

namespace {

// Frame 2 turned by some 37 gr and carried some kilometres away from the Lambert-93 frame of the job.
void GiveFrames(CChange_Rep& change) {
    const double values[] = {651200.0, 6862300.0, 652300.0, 6861900.0, 1000.0, 5000.0, 1870.512, 5707.381};
    for (int i = 0; i < CChange_Rep::kFieldCount; ++i)
        change.SetField(i, FormatFixed(values[i], 3));
}

void Run(benchmark::State& state, CCarnet (*make)(int), ChangeRepOptions options, const char* selection) {
    const int size = static_cast<int>(state.range(0));
    SilentFrontEnd frontEnd;
    int points = 0;
    double firstMs = -1.0;
    for (auto _ : state) {
        state.PauseTiming();
        auto carnet = std::make_unique<CCarnet>(make(size));
        auto change = std::make_unique<CChange_Rep>(carnet.get());
        GiveFrames(*change);
        change->Options() = options;
        change->SetSelection(selection);
        state.ResumeTiming();
        const auto start = std::chrono::steady_clock::now();
        benchmark::DoNotOptimize(change->Apply(frontEnd));
        const std::chrono::duration<double, std::milli> elapsed = std::chrono::steady_clock::now() - start;
        state.PauseTiming();
        if (firstMs < 0.0) firstMs = elapsed.count();
        points = change->PointsComputed();
        change.reset(); // the job and the copies kept for the undo freed out of the timing
        carnet.reset();
        state.ResumeTiming();
    }
    state.counters["points"] = points;
    state.counters["premier_ms"] = firstMs;
    state.SetItemsProcessed(state.iterations() * points);
}

CCarnet Points(int count) {
    CCarnet carnet;
    JobGenerator().AddControlPoints(carnet, count);
    return carnet;
}

void BM_ChangeRepOfAMillionPoints(benchmark::State& state) {
    Run(state, Points, {.fixedPoints = true}, "");
}
BENCHMARK(BM_ChangeRepOfAMillionPoints)->Arg(1000000)->Unit(benchmark::kMillisecond)->Iterations(3);

void BM_ChangeRepOfASelection(benchmark::State& state) {
    Run(state, Points, {.allPoints = false, .fixedPoints = true}, "A1-A500000 A900000-A1000000");
}
BENCHMARK(BM_ChangeRepOfASelection)->Arg(1000000)->Unit(benchmark::kMillisecond)->Iterations(3);

void BM_ChangeRepOfAJobWithItsV0(benchmark::State& state) {
    Run(state, MakeJob, {.modifyV0 = true, .fixedPoints = true}, "");
}
BENCHMARK(BM_ChangeRepOfAJobWithItsV0)->Arg(20000)->Unit(benchmark::kMillisecond)->Iterations(3);

} // namespace

} // namespace pyr::bench
