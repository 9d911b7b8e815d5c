// A station by resection. The dialog computes the station again on every click of an arrow, and the
// search for the best triple of sightings grows with the cube of their number: from 50 known points
// the whole computation, planimetry and altimetry, must stay well under a millisecond.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "TemporaryJob.h"
#include "calc/CalcRelev.h"
#include "calc/Corrections.h"
#include "calc/Resection.h"
#include "core/Angles.h"

#include <benchmark/benchmark.h>
#include <cmath>

namespace pyr::bench {

namespace {

constexpr double kStationX = 982345.678, kStationY = 6543210.987, kStationZ = 123.45;
constexpr double kHi = 1.6, kHp = 1.3, kV0 = 271.3456;

// The station sighting `count` known points spread around it on a spiral, from 80 m to about 1.5 km,
// read by a good instrument: directions and zenith angles off by at most 1 mgon.
StationResult MakeStation(int count) {
    StationResult result;
    result.station = "ST";
    result.hi = kHi;
    for (int i = 0; i < count; ++i) {
        const double bearing = WrapGrads(i * 137.50776); // the golden angle, in grads: no two alike
        const double horizontal = 80.0 + 1400.0 * i / count;
        const double z = kStationZ + 20.0 * SinGrads(i * 53.0);
        const double rise = z + kHp - kStationZ - kHi - CurvatureRefraction(horizontal);
        const double noise = ((i * 7919) % 21 - 10) * 1e-4;
        StationSighting s;
        s.index = i;
        s.x = kStationX + horizontal * SinGrads(bearing);
        s.y = kStationY + horizontal * CosGrads(bearing);
        s.z = z;
        s.hp = kHp;
        s.ah = WrapGrads(bearing - kV0 + noise);
        s.av = RadiansToGrads(std::atan2(horizontal, rise)) - noise;
        s.dh = horizontal;
        result.sightings.push_back(s);
    }
    return result;
}

void BM_ResectionCompute(benchmark::State& state) {
    StationResult result = MakeStation(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        benchmark::DoNotOptimize(ComputeResection(result, true, true));
        benchmark::ClobberMemory();
    }
    if (result.flags != kStationComputed) state.SkipWithError("la station n'a pas été calculée");
    // How far the computed station lies from the true one: a wrong computation shows here.
    state.counters["ecart_xy_mm"] = std::hypot(result.x - kStationX, result.y - kStationY) * 1e3;
    state.counters["ecart_z_mm"] = std::fabs(result.z - kStationZ) * 1e3;
    state.counters["emq_v0_mgon"] = result.emqV0 * 1e3;
    state.counters["altitudes"] = result.altitudes;
}
BENCHMARK(BM_ResectionCompute)->Arg(10)->Arg(50)->Arg(200)->Unit(benchmark::kMicrosecond);

// The dialog itself: "<<" then ">>" on the station E of a GéoBase, each sighting gathered from the
// GéoBase (reduced, its point found) and the station computed from all of them.
void BM_ResectionDialogRecompute(benchmark::State& state) {
    CCarnet carnet = MakeResectionStation(static_cast<int>(state.range(0)));
    TemporaryJob job(carnet, "relev");
    SilentFrontEnd frontEnd;
    CCalcRelev dialog;
    dialog.SetInputs({job.GeoBase(), job.Params(), "", "calcul d'un point par relèvement"});
    dialog.SetGeoBase(job.GeoBase());
    if (!dialog.Open(frontEnd) || !dialog.ChooseStation(kFreeStation))
        state.SkipWithError("E n'est pas proposée");
    for (auto _ : state) {
        dialog.RemoveAll();
        dialog.AddAll();
        benchmark::ClobberMemory();
    }
    const StationResult& result = dialog.Result();
    if (!(result.flags & kStationComputed)) state.SkipWithError("E n'a pas été calculée");
    state.counters["ecart_xy_mm"] = std::hypot(result.x - kStarX, result.y - kStarY) * 1e3;
    state.counters["ecart_z_mm"] = std::fabs(result.z - kStarZ) * 1e3;
}
BENCHMARK(BM_ResectionDialogRecompute)->Arg(10)->Arg(50)->Arg(200)->Unit(benchmark::kMicrosecond);

} // namespace

} // namespace pyr::bench
