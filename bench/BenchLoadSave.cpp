// Reading and writing a GéoBase of a million elements, and the memory that it takes once read.
#include "JobGenerator.h"
#include "MemoryUse.h"

#include <benchmark/benchmark.h>
#include <cstdint>
#include <filesystem>
#include <malloc.h>
#include <optional>
#include <stdexcept>
#include <string>

namespace pyr::bench {

namespace {

constexpr int kMillion = 1'000'000;

// The job of a million elements, built once, and its file.
struct MillionJob {
    MillionJob() : carnet(MakeJobOfSize(kMillion)), file(folder.File("million.geo")) {
        if (!carnet.Save(file)) throw std::runtime_error("impossible d'écrire " + file);
        fileBytes = static_cast<std::int64_t>(std::filesystem::file_size(file));
    }
    TemporaryFolder folder;
    CCarnet carnet;
    std::string file;
    std::int64_t fileBytes = 0;
};

MillionJob& Million() {
    static MillionJob job;
    return job;
}

void CountPerIteration(benchmark::State& state, std::int64_t bytes) {
    state.SetItemsProcessed(state.iterations() * kMillion);
    state.SetBytesProcessed(state.iterations() * bytes);
}

// The memory that a fresh store takes once the million-element file is read, in bytes per element:
// tas_o_elem as the allocator counts it (the heap), rss_o_elem as the system does (resident pages);
// the *_index counters once the first look-up has built the index. Its time is that of a first
// reading in a process, into memory that the system has still to provide.
void BM_Memory_1M(benchmark::State& state) {
    MillionJob& job = Million();
    for (auto _ : state) {
        state.PauseTiming();
        malloc_trim(0);
        const double heapBefore = static_cast<double>(HeapInUse());
        const double residentBefore = static_cast<double>(ResidentBytes());
        auto carnet = std::make_unique<CCarnet>();
        state.ResumeTiming();

        carnet->Load(nullptr, job.file);

        state.PauseTiming();
        malloc_trim(0);
        const double heapLoaded = static_cast<double>(HeapInUse());
        const double residentLoaded = static_cast<double>(ResidentBytes());
        if (carnet->GetSize() != kMillion || carnet->findMat("A1") < 0)
            state.SkipWithError("la GéoBase relue n'a pas le bon contenu");
        const double heapIndexed = static_cast<double>(HeapInUse());
        const double residentIndexed = static_cast<double>(ResidentBytes());
        state.counters["tas_o_elem"] = (heapLoaded - heapBefore) / kMillion;
        state.counters["tas_o_elem_index"] = (heapIndexed - heapBefore) / kMillion;
        state.counters["rss_o_elem"] = (residentLoaded - residentBefore) / kMillion;
        state.counters["rss_o_elem_index"] = (residentIndexed - residentBefore) / kMillion;
        carnet.reset();
        state.ResumeTiming();
    }
}
BENCHMARK(BM_Memory_1M)->Iterations(1)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_Save_1M(benchmark::State& state) {
    MillionJob& job = Million();
    const std::string target = job.folder.File("save.geo");
    for (auto _ : state)
        if (!job.carnet.Save(target)) state.SkipWithError("échec de l'écriture");
    CountPerIteration(state, job.fileBytes);
}
BENCHMARK(BM_Save_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

void Load(benchmark::State& state, bool cold) {
    MillionJob& job = Million();
    std::optional<CCarnet> carnet;
    for (auto _ : state) {
        // Freeing the previous store is not part of reading.
        state.PauseTiming();
        carnet.reset();
        if (cold) malloc_trim(0);
        carnet.emplace();
        state.ResumeTiming();
        if (!carnet->Load(nullptr, job.file) || carnet->GetSize() != kMillion)
            state.SkipWithError("échec de la lecture");
    }
    CountPerIteration(state, job.fileBytes);
}
void BM_Load_1M(benchmark::State& state) {
    Load(state, false);
}
BENCHMARK(BM_Load_1M)->Unit(benchmark::kMillisecond)->UseRealTime();
void BM_Load_1M_Cold(benchmark::State& state) {
    Load(state, true);
}
BENCHMARK(BM_Load_1M_Cold)->Unit(benchmark::kMillisecond)->UseRealTime();

// What opening a job and saving it costs a person: read, then write back atomically. With `cold`, the
// memory freed by the previous store goes back to the system first, as in a program just started that
// opens its first job: every page of the new store is then a page fault.
void LoadAndSave(benchmark::State& state, bool cold) {
    MillionJob& job = Million();
    const std::string target = job.folder.File("copie.geo");
    std::optional<CCarnet> carnet;
    for (auto _ : state) {
        state.PauseTiming();
        carnet.reset();
        if (cold) malloc_trim(0);
        carnet.emplace();
        state.ResumeTiming();
        if (!carnet->Load(nullptr, job.file) || !carnet->Save(target))
            state.SkipWithError("échec de la lecture ou de l'écriture");
    }
    CountPerIteration(state, 2 * job.fileBytes);
}
void BM_LoadAndSave_1M(benchmark::State& state) {
    LoadAndSave(state, false);
}
BENCHMARK(BM_LoadAndSave_1M)->Unit(benchmark::kMillisecond)->UseRealTime();
void BM_LoadAndSave_1M_Cold(benchmark::State& state) {
    LoadAndSave(state, true);
}
BENCHMARK(BM_LoadAndSave_1M_Cold)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
