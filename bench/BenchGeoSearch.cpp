// The editor's search on a GéoBase of a million elements: one identifier among them (from the store's
// index), a code and a value (every element looked at once), and "Chercher suivant".
#include "editor/GeoSearch.h"
#include "geobase/Carnet.h"

#include <benchmark/benchmark.h>
#include <string>

namespace pyr::bench {

namespace {

constexpr int kElements = 1'000'000;

// Set-ups of a station and nineteen sightings, the points sighted written after them every tenth
// set-up: a million elements, a third of a million identifiers.
const CCarnet& MillionElementJob() {
    static const CCarnet carnet = [] {
        CCarnet job;
        int point = 0;
        for (int setUp = 0; job.GetSize() < kElements; ++setUp) {
            job.Add(std::make_unique<CStation>("S" + std::to_string(setUp), 1.5), kKindStation);
            for (int i = 0; i < 19 && job.GetSize() < kElements; ++i, ++point) {
                const std::string code = point % 7 == 0 ? "BORNE" : point % 3 == 0 ? "MUR" : "ARBRE";
                job.Add(std::make_unique<CMesure>(std::to_string(point % 300000), 1.3, (point % 4000) * 0.1,
                                                  100.0, 10.0 + (point % 1000) * 0.01, code),
                        kKindMesure);
            }
            if (setUp % 10 == 9)
                for (int i = 0; i < 5 && job.GetSize() < kElements; ++i)
                    job.Add(std::make_unique<CPointGen>(std::to_string(point - i), 1000.0 + i, 2000.0, 100.0 + i),
                            kKindPoint);
        }
        job.Find(0, "0"); // the index built once, as the editor's first look-up does
        return job;
    }();
    return carnet;
}

void BM_SearchIdentifier(benchmark::State& state) {
    const CCarnet& carnet = MillionElementJob();
    SearchCriteria criteria;
    criteria.identifiers = "123456";
    std::size_t found = 0;
    for (auto _ : state)
        found = Search(carnet, criteria).size();
    state.counters["trouves"] = static_cast<double>(found);
}
BENCHMARK(BM_SearchIdentifier)->Unit(benchmark::kMicrosecond);

void BM_SearchSelection(benchmark::State& state) {
    const CCarnet& carnet = MillionElementJob();
    SearchCriteria criteria;
    criteria.identifiers = "1000-1999, S12";
    std::size_t found = 0;
    for (auto _ : state)
        found = Search(carnet, criteria).size();
    state.counters["trouves"] = static_cast<double>(found);
}
BENCHMARK(BM_SearchSelection)->Unit(benchmark::kMillisecond);

void BM_SearchCode(benchmark::State& state) {
    const CCarnet& carnet = MillionElementJob();
    SearchCriteria criteria;
    criteria.code = "BORNE";
    std::size_t found = 0;
    for (auto _ : state)
        found = Search(carnet, criteria).size();
    state.counters["trouves"] = static_cast<double>(found);
}
BENCHMARK(BM_SearchCode)->Unit(benchmark::kMillisecond);

void BM_SearchValue(benchmark::State& state) {
    const CCarnet& carnet = MillionElementJob();
    SearchCriteria criteria;
    criteria.value = ValueCriterion{FieldKey::DI, CompareOp::Greater, 19.5};
    std::size_t found = 0;
    for (auto _ : state)
        found = Search(carnet, criteria).size();
    state.counters["trouves"] = static_cast<double>(found);
}
BENCHMARK(BM_SearchValue)->Unit(benchmark::kMillisecond);

// The next point coded "MUR" from the middle of the GéoBase: the worst case walks the whole of it.
void BM_FindNextCodeAbsent(benchmark::State& state) {
    const CCarnet& carnet = MillionElementJob();
    SearchCriteria criteria;
    criteria.code = "MUR";
    criteria.kinds = {kKindPoint};
    int found = 0;
    for (auto _ : state)
        found = FindNext(carnet, criteria, kElements / 2);
    state.counters["trouve"] = found;
}
BENCHMARK(BM_FindNextCodeAbsent)->Unit(benchmark::kMillisecond);

} // namespace

} // namespace pyr::bench
