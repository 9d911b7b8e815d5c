// Reading and writing a GéoBase of a million elements, and the memory that it takes once read.
#include "JobGenerator.h"
#include "MemoryUse.h"

#include <benchmark/benchmark.h>
#include <cstdint>
#include <filesystem>
#include <malloc.h>
#include <optional>
#include <spawn.h>
#include <stdexcept>
#include <string>
#include <sys/wait.h>

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

void BM_Load_1M(benchmark::State& state) {
    MillionJob& job = Million();
    std::optional<CCarnet> carnet;
    for (auto _ : state) {
        // Freeing the previous store is not part of reading.
        state.PauseTiming();
        carnet.reset();
        carnet.emplace();
        state.ResumeTiming();
        if (!carnet->Load(nullptr, job.file) || carnet->GetSize() != kMillion)
            state.SkipWithError("échec de la lecture");
    }
    CountPerIteration(state, job.fileBytes);
}
BENCHMARK(BM_Load_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

// Reading then saving, in the same process as the previous iterations: the memory of the store
// freed at each iteration serves the next one.
void BM_LoadAndSave_1M(benchmark::State& state) {
    MillionJob& job = Million();
    const std::string target = job.folder.File("copie.geo");
    std::optional<CCarnet> carnet;
    for (auto _ : state) {
        state.PauseTiming();
        carnet.reset();
        carnet.emplace();
        state.ResumeTiming();
        if (!carnet->Load(nullptr, job.file) || !carnet->Save(target))
            state.SkipWithError("échec de la lecture ou de l'écriture");
    }
    CountPerIteration(state, 2 * job.fileBytes);
}
BENCHMARK(BM_LoadAndSave_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

// What opening a job and saving it costs a person: a program just started reads the job and saves
// it, every page of its store new to it. The time includes starting the program (about a
// millisecond).
void BM_LoadAndSave_1M_FreshProcess(benchmark::State& state) {
    MillionJob& job = Million();
    const std::string target = job.folder.File("copie.geo");
    const std::string program =
        (std::filesystem::read_symlink("/proc/self/exe").parent_path() / "pyr_load_save_once").string();
    for (auto _ : state) {
        char* argv[] = {const_cast<char*>(program.c_str()), const_cast<char*>(job.file.c_str()),
                        const_cast<char*>(target.c_str()), nullptr};
        pid_t child = 0;
        int status = 0;
        if (posix_spawn(&child, program.c_str(), nullptr, nullptr, argv, environ) != 0 ||
            waitpid(child, &status, 0) != child || !WIFEXITED(status) || WEXITSTATUS(status) != 0)
            state.SkipWithError("échec du programme de lecture et d'écriture");
    }
    CountPerIteration(state, 2 * job.fileBytes);
}
BENCHMARK(BM_LoadAndSave_1M_FreshProcess)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
