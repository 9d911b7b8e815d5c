// Points by intersection. The dialog computes the chosen point again on every click of an arrow: from
// 50 sightings that must stay well under a millisecond. Computing every point of a big job one after
// the other must grow with the number of points, each found with its sightings through the store's
// index, never by a scan of the GéoBase or of the list of points.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "TemporaryJob.h"
#include "calc/CalcInters.h"
#include "calc/Intersection.h"

#include <benchmark/benchmark.h>
#include <chrono>
#include <cmath>
#include <string>

namespace pyr::bench {

namespace {

void Prepare(CCalcInters& dialog, const TemporaryJob& job) {
    dialog.SetInputs({job.GeoBase(), job.Params(), "", "calcul d'un point par intersection"});
    dialog.SetGeoBase(job.GeoBase()); // named: no file is offered
}

// Seconds per event, shown by the benchmark library in the time unit that fits.
benchmark::Counter PerEvent(double eventsPerIteration) {
    return benchmark::Counter(eventsPerIteration,
                              benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

// The star of 50 stations around P opened, P chosen and all its sightings taken.
struct StarDialog {
    explicit StarDialog(int stations) : carnet(MakeIntersectionStar(stations)), job(carnet, "star") {
        Prepare(dialog, job);
        ok = dialog.Open(frontEnd) && dialog.ChoosePoint(kStarPoint);
        dialog.AddAll();
    }
    // How far the computed point lies from the true one, in metres: a wrong computation shows here.
    double PlanimetricError() const {
        const InterResult& result = dialog.Result();
        return std::hypot(result.x - kStarX, result.y - kStarY);
    }
    double AltimetricError() const { return std::abs(dialog.Result().z - kStarZ); }

    CCarnet carnet;
    TemporaryJob job;
    SilentFrontEnd frontEnd;
    CCalcInters dialog;
    bool ok = false;
};

void ReportStar(benchmark::State& state, const StarDialog& star) {
    state.counters["visees"] = static_cast<double>(star.dialog.Result().sightings.size());
    state.counters["ecart_xy_mm"] = star.PlanimetricError() * 1e3;
    state.counters["ecart_z_mm"] = star.AltimetricError() * 1e3;
    state.counters["messages"] = star.frontEnd.messages;
}

// "<<" then ">>": the point computed from no sighting (at once), then from all 50.
void BM_IntersRecomputeAll50(benchmark::State& state) {
    StarDialog star(static_cast<int>(state.range(0)));
    if (!star.ok) state.SkipWithError("P n'est pas calculable");
    for (auto _ : state) {
        star.dialog.RemoveAll();
        star.dialog.AddAll();
        benchmark::DoNotOptimize(star.dialog.Result().x);
    }
    if (!star.dialog.Computed()) state.SkipWithError("P n'a pas été calculé");
    state.counters["par_recalcul"] = PerEvent(1);
    ReportStar(state, star);
}
BENCHMARK(BM_IntersRecomputeAll50)->Arg(50)->Unit(benchmark::kMicrosecond);

// "<" then ">" on a highlighted line: two computations, from 49 sightings then from 50.
void BM_IntersRecomputeOne50(benchmark::State& state) {
    StarDialog star(static_cast<int>(state.range(0)));
    if (!star.ok) state.SkipWithError("P n'est pas calculable");
    for (auto _ : state) {
        star.dialog.HighlightSelected(17);
        star.dialog.RemoveOne();
        star.dialog.HighlightAvailable(0);
        star.dialog.AddOne();
        benchmark::DoNotOptimize(star.dialog.Result().x);
    }
    if (star.dialog.Selected().size() != static_cast<std::size_t>(state.range(0)) || !star.dialog.Computed())
        state.SkipWithError("P n'a pas été calculé de toutes ses visées");
    state.counters["par_recalcul"] = PerEvent(2);
    ReportStar(state, star);
}
BENCHMARK(BM_IntersRecomputeOne50)->Arg(50)->Unit(benchmark::kMicrosecond);

// The computation alone, on the 50 sightings the dialog gathered: what is left of a recomputation once
// the gathering from the GéoBase is taken away.
void BM_IntersComputeOnly50(benchmark::State& state) {
    StarDialog star(static_cast<int>(state.range(0)));
    if (!star.ok || !star.dialog.Computed()) state.SkipWithError("P n'a pas été calculé");
    const std::vector<InterSighting> gathered = star.dialog.Result().sightings;
    InterResult result;
    result.mat = kStarPoint;
    for (auto _ : state) {
        result.sightings = gathered; // the planimetry rewrites the distances: gathered afresh each time
        benchmark::DoNotOptimize(ComputeIntersection(result, true, true));
        benchmark::DoNotOptimize(result.z);
    }
    if (!(result.flags & kInterComputed)) state.SkipWithError("P n'a pas été calculé");
    state.counters["visees"] = static_cast<double>(result.sightings.size());
    state.counters["ecart_xy_mm"] = std::hypot(result.x - kStarX, result.y - kStarY) * 1e3;
    state.counters["iterations_z"] = result.iterations;
}
BENCHMARK(BM_IntersComputeOnly50)->Arg(50)->Unit(benchmark::kMicrosecond);

// Every point of a grid of stations computed in turn, as one would by choosing each point of the combo
// and taking all its sightings: the dialog opened on the GéoBase (read from its file), then for each
// point ChoosePoint and ">>". The argument is the number of rows of 100 stations.
void BM_IntersAllPoints(benchmark::State& state) {
    const int rows = static_cast<int>(state.range(0));
    IntersectionGrid grid = MakeIntersectionGrid(100, rows);
    TemporaryJob job(grid.carnet, "grid");
    std::size_t offered = 0;
    int computed = 0, messages = 0;
    double openSeconds = 0.0;
    for (auto _ : state) {
        SilentFrontEnd frontEnd;
        CCalcInters dialog;
        Prepare(dialog, job);
        const auto start = std::chrono::steady_clock::now();
        if (!dialog.Open(frontEnd)) {
            state.SkipWithError("aucun point calculable");
            break;
        }
        openSeconds += std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
        computed = 0;
        for (const std::string& point : dialog.Points()) {
            dialog.ChoosePoint(point);
            dialog.AddAll();
            computed += dialog.Computed() ? 1 : 0;
        }
        offered = dialog.Points().size();
        messages = frontEnd.messages;
    }
    state.counters["stations"] = grid.stations;
    state.counters["visees"] = grid.sightings;
    state.counters["points"] = static_cast<double>(offered);
    state.counters["calcules"] = computed;
    state.counters["messages"] = messages;
    state.counters["par_point"] = PerEvent(static_cast<double>(offered));
    state.counters["ouverture_s"] =
        openSeconds / static_cast<double>(std::max<std::int64_t>(state.iterations(), 1));
    state.SetComplexityN(grid.sightings);
}
BENCHMARK(BM_IntersAllPoints)
    ->Arg(10)  //  1 000 stations,   ~9 900 sightings
    ->Arg(30)  //  3 000 stations,  ~29 700 sightings
    ->Arg(100) // 10 000 stations,  ~98 000 sightings
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

} // namespace

} // namespace pyr::bench
