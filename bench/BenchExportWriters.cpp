// Exporting a survey of a million points through the writer of each point format, with its settings file
// as delivered: the delimited and columnar field books, the GSI-16 blocks in millimetres, a GDM area file
// to the millimetre, SDR33 records to the 0.1 mm, and the DXF drawing (the identifier alone beside each
// point, then with the altitude as delivered). Each file is written whole and flushed to the disk, and
// replaces the one of the run before. The first export of the process is reported on its own
// ("premier_ms"): a person exports once, in a process whose memory has not yet held the file.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/ExportDxf.h"
#include "fieldbook/ExportGdm.h"
#include "fieldbook/ExportLeica.h"
#include "fieldbook/ExportSokkia.h"
#include "fieldbook/ParamDriver.h"

#include <benchmark/benchmark.h>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <functional>
#include <string>
#include <system_error>
#include <unistd.h>

namespace pyr::bench {

namespace {

const CCarnet& Survey() {
    static const CCarnet survey = MakePointSurvey(1000000);
    return survey;
}

using Writer = bool (*)(const PointExportJob&);
// Writes the settings file of the format at that path.
using Settings = std::function<void(const std::string&)>;

void Run(benchmark::State& state, Writer write, const Settings& settings) {
    const CCarnet& survey = Survey();
    const std::filesystem::path folder =
        std::filesystem::temp_directory_path() / ("pyralis-bench-export-" + std::to_string(getpid()));
    std::filesystem::create_directories(folder);
    SilentFrontEnd frontEnd;
    PointExportJob job;
    job.carnet = &survey;
    job.paramFile = (folder / "export.ini").string();
    job.path = (folder / "points.out").string();
    job.parent = &frontEnd;
    settings(job.paramFile);
    double firstMs = -1.0;
    for (auto _ : state) {
        const auto start = std::chrono::steady_clock::now();
        if (!write(job)) state.SkipWithError("exportation refusée");
        const std::chrono::duration<double, std::milli> elapsed = std::chrono::steady_clock::now() - start;
        if (firstMs < 0.0) firstMs = elapsed.count();
    }
    std::error_code ignored;
    state.counters["premier_ms"] = firstMs;
    state.counters["Mo"] = static_cast<double>(std::filesystem::file_size(job.path, ignored)) / 1e6;
    state.counters["messages"] = frontEnd.messages;
    state.SetItemsProcessed(state.iterations() * survey.GetSize());
    std::filesystem::remove_all(folder, ignored);
}

// A settings file of the instrument formats, section "Exportation".
Settings Keys(const char* keys) {
    return [keys](const std::string& path) { std::ofstream(path) << "[Exportation]\n" << keys; };
}

// The layout's defaults: those of the delivered delimited and columnar files.
Settings Layout(FieldBookFormat format) {
    return [format](const std::string& path) { CParamDriver("", path, format).Save(); };
}

Settings Drawing(DxfExportSettings values) {
    return [values](const std::string& path) {
        CDlgConfigDxf dialog;
        dialog.Settings() = values;
        dialog.Save(path);
    };
}

void BM_ExportSeparateurOfAMillionPoints(benchmark::State& state) {
    Run(state, CDlgConfigSep::Export, Layout(FieldBookFormat::Separateur));
}
BENCHMARK(BM_ExportSeparateurOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void BM_ExportColonneOfAMillionPoints(benchmark::State& state) {
    Run(state, CDlgConfigCol::Export, Layout(FieldBookFormat::Colonne));
}
BENCHMARK(BM_ExportColonneOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void BM_ExportLeicaOfAMillionPoints(benchmark::State& state) {
    Run(state, CDlgConfigLeica::Export, Keys("FormatGsi=16\nUniteLongueurs=0\nCode=1\n"));
}
BENCHMARK(BM_ExportLeicaOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void BM_ExportGdmOfAMillionPoints(benchmark::State& state) {
    Run(state, dll_ExportSpectra, Keys("Decimales=3\nLabelUnites=1\nCode=1\n"));
}
BENCHMARK(BM_ExportGdmOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void BM_ExportSokkiaOfAMillionPoints(benchmark::State& state) {
    Run(state, DlgCfgSok::Export, Keys("Format=SDR33\nDecimales=4\nCode=1\n"));
}
BENCHMARK(BM_ExportSokkiaOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void BM_ExportDxfOfAMillionPoints(benchmark::State& state) {
    Run(state, CDlgConfigDxf::Export, Drawing({.writeAltitude = false}));
}
BENCHMARK(BM_ExportDxfOfAMillionPoints)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void BM_ExportDxfOfAMillionPointsWithAltitudes(benchmark::State& state) {
    Run(state, CDlgConfigDxf::Export, Drawing({}));
}
BENCHMARK(BM_ExportDxfOfAMillionPointsWithAltitudes)
    ->Unit(benchmark::kMillisecond)
    ->UseRealTime()
    ->Iterations(3);

} // namespace

} // namespace pyr::bench
