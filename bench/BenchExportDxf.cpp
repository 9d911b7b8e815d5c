// Exporting a survey of a million points as a DXF drawing: every point a POINT on the layer of its code,
// with its identifier beside it (and, with the delivered settings, its altitude too), the drawing
// assembled in memory behind its header and tables, written whole and flushed to the disk.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "fieldbook/ExportDxf.h"

#include <benchmark/benchmark.h>
#include <chrono>
#include <filesystem>
#include <string>
#include <system_error>
#include <unistd.h>

namespace pyr::bench {

namespace {

constexpr int kMillionPoints = 1000000;

const CCarnet& Survey() {
    static const CCarnet survey = MakePointSurvey(kMillionPoints);
    return survey;
}

void Run(benchmark::State& state, const DxfExportSettings& settings) {
    const CCarnet& survey = Survey();
    const std::filesystem::path folder =
        std::filesystem::temp_directory_path() / ("pyralis-bench-dxf-" + std::to_string(getpid()));
    std::filesystem::create_directories(folder);
    CDlgConfigDxf dialog;
    dialog.Settings() = settings;
    const std::string settingsFile = (folder / "Export_Dxf.ini").string();
    dialog.Save(settingsFile);
    SilentFrontEnd frontEnd;
    PointExportJob job;
    job.carnet = &survey;
    job.paramFile = settingsFile;
    job.path = (folder / "levé.dxf").string();
    job.parent = &frontEnd;
    double firstMs = -1.0;
    for (auto _ : state) {
        const auto start = std::chrono::steady_clock::now();
        if (!CDlgConfigDxf::Export(job)) state.SkipWithError("export refused");
        const std::chrono::duration<double, std::milli> elapsed = std::chrono::steady_clock::now() - start;
        if (firstMs < 0.0) firstMs = elapsed.count();
    }
    // The first export of the process: its memory not yet touched, as when a person exports once.
    state.counters["premier_ms"] = firstMs;
    std::error_code ignored;
    state.counters["Mo"] = static_cast<double>(std::filesystem::file_size(job.path, ignored)) / 1e6;
    state.counters["messages"] = frontEnd.messages;
    state.SetItemsProcessed(state.iterations() * survey.GetSize());
    std::filesystem::remove_all(folder, ignored);
}

// The identifier alone beside each point.
void BM_ExportDxfOfAMillionPoints(benchmark::State& state) {
    Run(state, {.writeAltitude = false});
}
BENCHMARK(BM_ExportDxfOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

// The delivered settings: identifier and altitude.
void BM_ExportDxfOfAMillionPointsWithAltitudes(benchmark::State& state) {
    Run(state, {});
}
BENCHMARK(BM_ExportDxfOfAMillionPointsWithAltitudes)
    ->Unit(benchmark::kMillisecond)
    ->UseRealTime()
    ->Iterations(3);

} // namespace

} // namespace pyr::bench
