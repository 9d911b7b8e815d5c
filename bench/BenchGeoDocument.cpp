// The editor's document on a GéoBase of a million elements: an edit undone, then an identifier looked
// up, as the editor's lists and search do right after (the store's index rebuilt once the elements moved).
#include "JobGenerator.h"
#include "editor/GeoDocument.h"

#include <benchmark/benchmark.h>

namespace pyr::bench {

namespace {

constexpr int kElements = 1'000'000;

// The job loaded into a document, its index built as after the load.
CGeoDocument& MillionElementDocument() {
    static CGeoDocument document = [] {
        CGeoDocument opened;
        opened.Store() = MakeJobOfSize(kElements);
        opened.Store().findMat("A1");
        return opened;
    }();
    return document;
}

// A point moved, the move undone, a point looked up.
void BM_DocumentUndoAPointMoved(benchmark::State& state) {
    CGeoDocument& document = MillionElementDocument();
    const int point = document.Carnet().findMat("A1");
    for (auto _ : state) {
        ElementReplacements moved;
        auto copy = document.Carnet().copyElement(point);
        static_cast<CPointGen&>(*copy).setPt(651000.0, 6862000.0);
        moved.push_back({point, std::move(copy)});
        document.Replace("", std::move(moved));
        document.Undo();
        benchmark::DoNotOptimize(document.Carnet().findMat("A2"));
    }
}
BENCHMARK(BM_DocumentUndoAPointMoved)->Unit(benchmark::kMillisecond);

// An element near the start removed, the removal undone, a point looked up: the million elements after
// it moved twice, and the index with them.
void BM_DocumentUndoARemoval(benchmark::State& state) {
    CGeoDocument& document = MillionElementDocument();
    // A sighting of a point sighted before: the order of the identifiers stays, the index is kept.
    int sighting = 0;
    while (document.Carnet().SameMat(sighting).size() < 2 ||
           document.Carnet().SameMat(sighting).front() == sighting)
        ++sighting;
    for (auto _ : state) {
        document.Remove({sighting});
        document.Undo();
        benchmark::DoNotOptimize(document.Carnet().findMat("A2"));
    }
}
BENCHMARK(BM_DocumentUndoARemoval)->Unit(benchmark::kMillisecond);

// A hundred thousand elements found by a search removed together, and the removal undone: one pass over
// the store each way, not one per element.
void BM_DocumentUndoARemovalOfManyElements(benchmark::State& state) {
    CGeoDocument& document = MillionElementDocument();
    std::vector<int> found;
    for (int index = 5; index < document.Carnet().GetSize(); index += 10)
        found.push_back(index);
    for (auto _ : state) {
        document.Remove(found);
        document.Undo();
    }
    state.counters["supprimes"] = static_cast<double>(found.size());
}
BENCHMARK(BM_DocumentUndoARemovalOfManyElements)->Unit(benchmark::kMillisecond);

} // namespace

} // namespace pyr::bench
