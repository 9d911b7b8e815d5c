// Exporting a survey of a million points as a delimited and as a columnar field book, through settings
// files laid out as the delivered ones (";" between the fields, metres; the columns of the delivered
// layout): the points gathered, every line laid out, the file written whole and flushed to the disk.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/ParamDriver.h"

#include <benchmark/benchmark.h>
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

void Run(benchmark::State& state, FieldBookFormat format, bool (*exportPoints)(const PointExportJob&)) {
    const CCarnet& survey = Survey();
    const std::filesystem::path folder =
        std::filesystem::temp_directory_path() / ("pyralis-bench-export-" + std::to_string(getpid()));
    std::filesystem::create_directories(folder);
    // The settings file written with the layout's defaults: those of the delivered files.
    const CParamDriver settings("", (folder / "export.param").string(), format);
    settings.Save();
    SilentFrontEnd frontEnd;
    PointExportJob job;
    job.carnet = &survey;
    job.paramFile = settings.FileName();
    job.path = (folder / "points.txt").string();
    job.parent = &frontEnd;
    for (auto _ : state)
        if (!exportPoints(job)) state.SkipWithError("export refused");
    std::error_code ignored;
    state.counters["Mo"] = static_cast<double>(std::filesystem::file_size(job.path, ignored)) / 1e6;
    state.counters["messages"] = frontEnd.messages;
    state.SetItemsProcessed(state.iterations() * survey.GetSize());
    std::filesystem::remove_all(folder, ignored);
}

void BM_ExportSeparateurOfAMillionPoints(benchmark::State& state) {
    Run(state, FieldBookFormat::Separateur, CDlgConfigSep::Export);
}
BENCHMARK(BM_ExportSeparateurOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void BM_ExportColonneOfAMillionPoints(benchmark::State& state) {
    Run(state, FieldBookFormat::Colonne, CDlgConfigCol::Export);
}
BENCHMARK(BM_ExportColonneOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

} // namespace

} // namespace pyr::bench
