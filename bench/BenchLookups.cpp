// Look-ups by identifier when every station, point and sighting of a job is processed: the time must
// grow with the size of the job, not with its square.
#include "JobGenerator.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <benchmark/benchmark.h>

namespace pyr::bench {

namespace {

// From a small job to one of a million elements (about 26 elements a station).
void StationCounts(benchmark::internal::Benchmark* b) {
    for (int stations : {2500, 5000, 10000, 20000, 40000})
        b->Arg(stations);
    b->Complexity(benchmark::oN);
}

// Every station set-up by its name, every point, every reprise, the station of every sighting.
void BM_FindAllStations(benchmark::State& state) {
    const CCarnet carnet = MakeJob(static_cast<int>(state.range(0)));
    const JobContents job = Contents(carnet);
    carnet.findMat("A1"); // the index is built by the first look-up
    const std::size_t expected =
        job.reprises.size() + job.pointNames.size() + job.reprises.size() + job.sightings.size();

    std::string name;
    for (auto _ : state) {
        std::size_t found = 0;
        for (const std::string& station : job.stationNames)
            for (int i = carnet.Find(kKindStation, station); i >= 0;
                 i = carnet.Find(kKindStation, station, i + 1))
                ++found;
        for (const std::string& point : job.pointNames)
            found += carnet.findMat(point) >= 0;
        for (const auto& [station, reprise] : job.reprises)
            found += carnet.findStaRep(station, reprise) >= 0;
        for (int sighting : job.sightings)
            found += carnet.findRepAt(sighting, name) >= 0;
        benchmark::DoNotOptimize(found);
        if (found != expected) state.SkipWithError("un élément n'a pas été trouvé");
    }
    state.SetComplexityN(state.range(0));
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(expected));
}
BENCHMARK(BM_FindAllStations)->Apply(StationCounts)->Unit(benchmark::kMicrosecond);

// An edit renames a point: the next look-up builds the index again, from the whole store.
void BM_IndexRebuild(benchmark::State& state) {
    CCarnet carnet = MakeJob(static_cast<int>(state.range(0)));
    const int point = carnet.Find(kKindPoint, "");
    const std::string name = carnet.matAt(point);
    for (auto _ : state) {
        carnet.GetAt(point)->setMat(name + "B");
        carnet.GetAt(point)->setMat(name);
        benchmark::DoNotOptimize(carnet.findMat(name));
    }
    state.SetComplexityN(state.range(0));
    state.SetItemsProcessed(state.iterations() * carnet.GetSize());
}
BENCHMARK(BM_IndexRebuild)->Apply(StationCounts)->Unit(benchmark::kMicrosecond);

// A field book read station by station, each addition followed by the look-ups that validation makes:
// the index follows the appends instead of being built again.
void BM_AppendThenFind(benchmark::State& state) {
    const int stationCount = static_cast<int>(state.range(0));
    std::string name;
    for (auto _ : state) {
        CCarnet carnet;
        JobGenerator generator;
        generator.AddControlPoints(carnet, stationCount / 2 + 6);
        std::size_t found = 0;
        for (int s = 0; s < stationCount; ++s) {
            const int station = generator.AddStation(carnet);
            const std::string& stationName = carnet.GetAt(station)->mat();
            const int lastPoint = carnet.Find(kKindPoint, "", carnet.GetSize() - 1, -1);
            found += carnet.findMat(carnet.matAt(lastPoint)) >= 0;
            found += carnet.Find(kKindStation, stationName) >= 0;
            found += carnet.findStaRep(stationName, carnet.RepriseAt(station)) == station;
            found += carnet.findRepAt(carnet.GetSize() - 1, name) == station;
        }
        benchmark::DoNotOptimize(found);
        if (found != 4 * static_cast<std::size_t>(stationCount))
            state.SkipWithError("un élément ajouté n'a pas été trouvé");
        state.PauseTiming(); // freeing the store is not part of the work
        carnet.RemoveAll();
        state.ResumeTiming();
    }
    state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_AppendThenFind)->Apply(StationCounts)->Unit(benchmark::kMillisecond);

} // namespace

} // namespace pyr::bench
