// Radiated points: every sighting of a whole job given its coordinates, the points seen twice merged, and
// the listing written. A job of a million sightings from ten thousand stations must take under a second.
#include "SilentFrontEnd.h"
#include "TemporaryJob.h"
#include "calc/CalcRayon.h"
#include "core/Angles.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <benchmark/benchmark.h>
#include <chrono>
#include <cmath>
#include <filesystem>
#include <memory>
#include <string>

namespace pyr::bench {

namespace {

// `stations` stations on a grid 100 m apart, each known in X, Y, Z and oriented, each reading a
// reference on its neighbour and `perStation` - 1 detail points up to 50 m around it, one in ten of them
// a point of the station before: seen twice. Readings from the coordinates, face left.
CCarnet MakeRadiationJob(int stations, int perStation) {
    CCarnet carnet;
    const int columns = static_cast<int>(std::sqrt(stations));
    auto place = [columns](int s, double& x, double& y) {
        x = 651000.0 + 100.0 * (s % columns);
        y = 6862000.0 + 100.0 * (s / columns);
    };
    for (int s = 0; s < stations; ++s) {
        double x = 0, y = 0;
        place(s, x, y);
        carnet.Add(std::make_unique<CPointGen>("S" + std::to_string(s + 1), x, y, 50.0), kKindPoint);
    }
    auto reading = [](double xs, double ys, double x, double y, double v0, double& ah, double& dh) {
        ah = WrapGrads(RadiansToGrads(std::atan2(x - xs, y - ys)) - v0);
        dh = std::hypot(x - xs, y - ys);
    };
    for (int s = 0; s < stations; ++s) {
        double xs = 0, ys = 0;
        place(s, xs, ys);
        const double v0 = WrapGrads(s * 37.77);
        carnet.Add(std::make_unique<CStation>("S" + std::to_string(s + 1), 1.6, v0), kKindStation);
        double xn = 0, yn = 0, ah = 0, dh = 0;
        place((s + 1) % stations, xn, yn);
        reading(xs, ys, xn, yn, v0, ah, dh);
        carnet.Add(
            std::make_unique<CReference>("S" + std::to_string((s + 1) % stations + 1), 1.3, ah, 100.0, dh),
            kKindReference);
        for (int i = 1; i < perStation; ++i) {
            // Every tenth sighting reads a point of the station before: seen twice.
            const bool again = s > 0 && i % 10 == 0;
            const int owner = again ? s - 1 : s, rank = again ? i - 5 : i;
            const long long number = static_cast<long long>(owner) * perStation + rank;
            const double bearing = number * 1.61803, distance = 5.0 + (number % 45);
            double xo = 0, yo = 0;
            place(owner, xo, yo);
            const double x = xo + distance * SinGrads(bearing), y = yo + distance * CosGrads(bearing);
            reading(xs, ys, x, y, v0, ah, dh);
            const double av = 99.5;
            carnet.Add(
                std::make_unique<CMesure>("P" + std::to_string(number), 1.3, ah, av, dh / SinGrads(av)),
                kKindMesure);
        }
    }
    return carnet;
}

void BM_RadiateWholeJob(benchmark::State& state) {
    const int stations = static_cast<int>(state.range(0)), perStation = 100;
    CCarnet carnet = MakeRadiationJob(stations, perStation);
    TemporaryJob job(carnet, "rayon");
    SilentFrontEnd frontEnd;
    CCalcRayon rayon;
    rayon.SetInputs({job.GeoBase(), job.Params(), "", "calcul des points rayonnés"});
    rayon.SetGeoBase(job.GeoBase());
    if (!rayon.Open(frontEnd)) state.SkipWithError("la GéoBase ne s'ouvre pas");
    rayon.SetType(RadiationType::Toutes);
    const std::string listing = job.GeoBase() + ".cpr";
    double computing = 0, listingWriting = 0; // seconds, the two halves of the run
    double first = 0;                         // the first run of the process, which takes its memory
    for (auto _ : state) {
        const auto start = std::chrono::steady_clock::now();
        rayon.Calculate();
        const auto computed = std::chrono::steady_clock::now();
        rayon.Close(false, true, listing);
        const auto written = std::chrono::steady_clock::now();
        computing += std::chrono::duration<double>(computed - start).count();
        listingWriting += std::chrono::duration<double>(written - computed).count();
        if (first == 0) first = std::chrono::duration<double>(written - start).count();
        state.PauseTiming();
        std::filesystem::remove(listing);
        state.ResumeTiming();
    }
    std::size_t sightings = 0;
    for (const RadiatedStation& station : rayon.Results())
        sightings += station.points.size() + station.checks.size();
    state.counters["visees"] = static_cast<double>(sightings);
    state.counters["points"] = static_cast<double>(rayon.NewPoints().size());
    state.counters["non_utilisees"] = rayon.NotUsed();
    state.counters["calcul_ms"] = computing * 1e3 / static_cast<double>(state.iterations());
    state.counters["listing_ms"] = listingWriting * 1e3 / static_cast<double>(state.iterations());
    state.counters["premier_ms"] = first * 1e3;
}
BENCHMARK(BM_RadiateWholeJob)->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond)->Iterations(3);

} // namespace

} // namespace pyr::bench
