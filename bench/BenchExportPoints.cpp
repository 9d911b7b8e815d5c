// Exporting a survey of a million points through the export dialog's OK, in the two formats that carry
// the whole GéoBase: a copy of the GéoBase saved (its scope filtered, walking from the last element), and
// the Quendal-Pc field book, every digit kept. Each run replaces the file of the run before.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "TemporaryJob.h"
#include "fieldbook/ExportPoints.h"

#include <benchmark/benchmark.h>

namespace pyr::bench {

namespace {

void Run(benchmark::State& state, ExportFormat format) {
    CCarnet survey = MakePointSurvey(static_cast<int>(state.range(0)));
    TemporaryJob job(survey, "export");
    survey.SetPathName(job.GeoBase());
    SilentFrontEnd frontEnd;
    CDlgExportPoints dialog(&survey, nullptr, static_cast<int>(format));
    dialog.SetInputs({job.GeoBase(), job.Params(), job.Folder() + "/", "export"});
    dialog.OnInitDialog();
    dialog.askOverwrite = [](ui::FrontEnd&, CDlgOverWrite&) { return OverwriteChoice::Replace; };
    for (auto _ : state)
        if (dialog.OnOK(frontEnd) != ui::DialogResult::Ok) state.SkipWithError("exportation refusée");
    state.counters["elements"] = dialog.Written();
    state.SetItemsProcessed(state.iterations() * dialog.Written());
}

void BM_ExportGeoBaseOfAMillionPoints(benchmark::State& state) {
    Run(state, ExportFormat::GeoBase);
}
BENCHMARK(BM_ExportGeoBaseOfAMillionPoints)->Arg(1000000)->Unit(benchmark::kMillisecond)->Iterations(3);

void BM_ExportQuendalOfAMillionPoints(benchmark::State& state) {
    Run(state, ExportFormat::Quendal);
}
BENCHMARK(BM_ExportQuendalOfAMillionPoints)->Arg(1000000)->Unit(benchmark::kMillisecond)->Iterations(3);

} // namespace

} // namespace pyr::bench
