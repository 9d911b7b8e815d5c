// Exporting a survey of a million points to the coordinate files that total stations load: GSI-16 in
// millimetres, a GDM area file to the millimetre, SDR33 to the 0.1 mm, each with the settings delivered.
// The survey is built once; each run replaces the file of the run before.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "fieldbook/ExportGdm.h"
#include "fieldbook/ExportLeica.h"
#include "fieldbook/ExportSokkia.h"

#include <benchmark/benchmark.h>
#include <filesystem>
#include <fstream>
#include <unistd.h>

namespace pyr::bench {

namespace {

const CCarnet& Survey() {
    static const CCarnet survey = MakePointSurvey(1000000);
    return survey;
}

// A folder of its own for the settings file and the file written, removed at the end.
class ExportFolder {
public:
    explicit ExportFolder(const char* name)
        : m_folder(std::filesystem::temp_directory_path() /
                   ("pyralis-bench-" + std::string(name) + "-" + std::to_string(getpid()))) {
        std::filesystem::create_directories(m_folder);
    }
    ~ExportFolder() {
        std::error_code ignored;
        std::filesystem::remove_all(m_folder, ignored);
    }
    ExportFolder(const ExportFolder&) = delete;
    ExportFolder& operator=(const ExportFolder&) = delete;

    std::string Path(const char* name) const { return (m_folder / name).string(); }

private:
    std::filesystem::path m_folder;
};

void Run(benchmark::State& state, bool (*write)(const PointExportJob&), const char* settings) {
    const CCarnet& survey = Survey();
    ExportFolder folder("export-instruments");
    SilentFrontEnd frontEnd;
    PointExportJob job;
    job.carnet = &survey;
    job.paramFile = folder.Path("export.ini");
    job.path = folder.Path("points.out");
    job.parent = &frontEnd;
    std::ofstream(job.paramFile) << "[Exportation]\n" << settings;
    for (auto _ : state)
        if (!write(job)) state.SkipWithError("exportation refusée");
    const auto bytes = static_cast<std::int64_t>(std::filesystem::file_size(job.path));
    state.counters["points"] = survey.GetSize();
    state.counters["Mo"] = static_cast<double>(bytes) / 1e6;
    state.SetItemsProcessed(state.iterations() * survey.GetSize());
    state.SetBytesProcessed(state.iterations() * bytes);
}

void BM_ExportLeicaOfAMillionPoints(benchmark::State& state) {
    Run(state, CDlgConfigLeica::Export, "FormatGsi=16\nUniteLongueurs=0\nCode=1\n");
}
BENCHMARK(BM_ExportLeicaOfAMillionPoints)->Unit(benchmark::kMillisecond)->Iterations(3);

void BM_ExportGdmOfAMillionPoints(benchmark::State& state) {
    Run(state, dll_ExportSpectra, "Decimales=3\nLabelUnites=1\nCode=1\n");
}
BENCHMARK(BM_ExportGdmOfAMillionPoints)->Unit(benchmark::kMillisecond)->Iterations(3);

void BM_ExportSokkiaOfAMillionPoints(benchmark::State& state) {
    Run(state, DlgCfgSok::Export, "Format=SDR33\nDecimales=4\nCode=1\n");
}
BENCHMARK(BM_ExportSokkiaOfAMillionPoints)->Unit(benchmark::kMillisecond)->Iterations(3);

} // namespace

} // namespace pyr::bench
