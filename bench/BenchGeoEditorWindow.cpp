// The editor's window on a GéoBase of a million elements, as the person uses it once the file is read:
// a page of the table shown where the person scrolled, the view of the points made, an identifier
// searched, and an edit undone with every control of the window shown again. Each under 100 ms.
#include "JobGenerator.h"
#include "SilentFrontEnd.h"
#include "TemporaryJob.h"
#include "editor/GeoEditorForm.h"

#include <benchmark/benchmark.h>

namespace pyr::bench {

namespace {

constexpr int kElements = 1'000'000;
constexpr int kPage = 40; // the lines a table shows at once

struct OpenWindow {
    CCarnet job = MakeJobOfSize(kElements);
    TemporaryJob folder{job, "editeur"};
    SilentFrontEnd frontEnd;
    CGeoEditor editor;
    std::unique_ptr<ui::Form> form;

    OpenWindow() {
        editor.SetInputs({folder.GeoBase(), folder.Params(), "", "éditeur de GéoBases"});
        editor.SetGeoBase(folder.GeoBase());
        form = editor.MakeForm();
        form->Open(frontEnd);
    }
    // What the window asks after a change: every control's state and the lines of the table's page.
    void ShowAgain(int firstLine) {
        for (const ui::Control& control : form->Controls())
            benchmark::DoNotOptimize(form->State(control.id));
        const int table = CGeoEditorForm::TableOf(static_cast<CGeoEditorForm&>(*form).ViewShown());
        for (int line = firstLine; line < firstLine + kPage; ++line)
            benchmark::DoNotOptimize(form->OnDemandRow(table, line));
    }
};

OpenWindow& Window() {
    static OpenWindow window;
    return window;
}

void BM_EditorScrollsItsTable(benchmark::State& state) {
    OpenWindow& window = Window();
    int first = 0;
    for (auto _ : state) {
        first = (first + 123'457) % (kElements - kPage);
        for (int line = first; line < first + kPage; ++line)
            benchmark::DoNotOptimize(window.form->OnDemandRow(CGeoEditorForm::TableOf(0), line));
    }
}
BENCHMARK(BM_EditorScrollsItsTable)->Unit(benchmark::kMicrosecond);

// The view of the points made again after an edit, and its first page shown.
void BM_EditorShowsThePointsAfterAnEdit(benchmark::State& state) {
    OpenWindow& window = Window();
    window.form->Act(window.frontEnd, CGeoEditorForm::kView, {ui::EventKind::Select, 2, false, {}});
    for (auto _ : state) {
        window.form->Act(window.frontEnd, CGeoEditorForm::TableOf(2), {ui::EventKind::Select, 10, false, {}});
        window.form->Act(window.frontEnd, CGeoEditorForm::kFieldEdit0 + 3,
                         {ui::EventKind::Text, -1, false, "12.5"});
        window.ShowAgain(0);
        state.PauseTiming();
        window.editor.Document().Undo();
        state.ResumeTiming();
    }
    window.form->Act(window.frontEnd, CGeoEditorForm::kView, {ui::EventKind::Select, 0, false, {}});
}
BENCHMARK(BM_EditorShowsThePointsAfterAnEdit)->Unit(benchmark::kMillisecond);

void BM_EditorSearchesAnIdentifier(benchmark::State& state) {
    OpenWindow& window = Window();
    window.form->Act(window.frontEnd, CGeoEditorForm::kSearchIds, {ui::EventKind::Text, -1, false, "A17"});
    for (auto _ : state) {
        window.form->Act(window.frontEnd, CGeoEditorForm::kSearchAll, {});
        window.ShowAgain(0);
    }
    state.counters["trouves"] = static_cast<double>(window.editor.Document().Selection().size());
}
BENCHMARK(BM_EditorSearchesAnIdentifier)->Unit(benchmark::kMillisecond);

// A point's Z changed on its page, then the change undone with the window shown again, drawing aside.
void BM_EditorUndoesAnEdit(benchmark::State& state) {
    OpenWindow& window = Window();
    const int point = window.editor.Carnet().findMat("A1");
    window.editor.Document().Select({point});
    for (auto _ : state) {
        state.PauseTiming();
        window.editor.Document().Select({point});
        window.form->Act(window.frontEnd, CGeoEditorForm::kFieldEdit0 + 3,
                         {ui::EventKind::Text, -1, false, "12.5"});
        state.ResumeTiming();
        window.form->Act(window.frontEnd, CGeoEditorForm::kUndo, {});
        window.ShowAgain(point);
    }
}
BENCHMARK(BM_EditorUndoesAnEdit)->Unit(benchmark::kMillisecond);

// The drawing made again after an edit: the scene of a million elements.
void BM_EditorRedrawsItsSceneAfterAnEdit(benchmark::State& state) {
    OpenWindow& window = Window();
    const int point = window.editor.Carnet().findMat("A1");
    for (auto _ : state) {
        state.PauseTiming();
        window.editor.Document().Select({point});
        window.form->Act(window.frontEnd, CGeoEditorForm::kFieldEdit0 + 3,
                         {ui::EventKind::Text, -1, false, "12.5"});
        window.form->Act(window.frontEnd, CGeoEditorForm::kUndo, {});
        state.ResumeTiming();
        benchmark::DoNotOptimize(window.form->Scene(CGeoEditorForm::kDrawing));
    }
}
BENCHMARK(BM_EditorRedrawsItsSceneAfterAnEdit)->Unit(benchmark::kMillisecond);

// A sighting's distance changed, then the change undone, the drawing asked for as the window does: what it
// shows did not change, so it is not made again.
void BM_EditorUndoesASightingsEditWithItsDrawing(benchmark::State& state) {
    OpenWindow& window = Window();
    const int sighting = window.editor.Carnet().Find(kKindMesure, "");
    benchmark::DoNotOptimize(window.form->Scene(CGeoEditorForm::kDrawing));
    for (auto _ : state) {
        state.PauseTiming();
        window.editor.Document().Select({sighting});
        window.form->Act(window.frontEnd, CGeoEditorForm::kFieldEdit0 + 4,
                         {ui::EventKind::Text, -1, false, "123.4567"});
        state.ResumeTiming();
        window.form->Act(window.frontEnd, CGeoEditorForm::kUndo, {});
        window.ShowAgain(sighting);
        benchmark::DoNotOptimize(window.form->Scene(CGeoEditorForm::kDrawing));
    }
}
BENCHMARK(BM_EditorUndoesASightingsEditWithItsDrawing)->Unit(benchmark::kMillisecond);

} // namespace

} // namespace pyr::bench
