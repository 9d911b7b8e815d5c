// Converting a field book of a million lines into a GéoBase, in each of the eleven formats, as the reading
// command does it: the file read and converted (the delimited and columnar books through the Quendal-Pc
// pivot file, with their delivered layout), the new GéoBase written beside it. And the GSI reader alone,
// from memory.
#include "FieldBookBench.h"
#include "fieldbook/FieldBookReaders.h"
#include "fieldbook/LectWild.h"
#include "fieldbook/ParamDriver.h"
#include "geobase/Carnet.h"

#include <cstdint>
#include <map>
#include <string>

namespace pyr::bench {

namespace {

const GeneratedFieldBook& BookOf(FieldBookFormat format) {
    static std::map<FieldBookFormat, GeneratedFieldBook> books;
    auto found = books.find(format);
    if (found == books.end())
        found = books
                    .try_emplace(format, std::string("levé.") + books::BookExtension(format),
                                 books::MakeFieldBook(format, kMillionLines))
                    .first;
    return found->second;
}

// Every generated book gives an element for most of its lines (the GDM and GTS-7 books spread a sighting
// over several), and the codes and station points add to them.
constexpr ElementRange kExpected{kMillionLines / 5, 2 * kMillionLines};

void BM_ConvertToGeoBase_1M(benchmark::State& state, FieldBookFormat format) {
    const CParamDriver layout("", "", format); // the delivered settings of the format
    MeasureConversion(
        state, BookOf(format),
        [&] {
            auto reader = MakeFieldBookReader(format);
            if (reader) reader->SetDriver(&layout);
            return reader;
        },
        kMillionLines, kExpected);
}

[[maybe_unused]] const bool kRegistered = [] {
    for (const FieldBookFormatInfo& info : FieldBookFormats())
        benchmark::RegisterBenchmark((std::string("BM_ConvertToGeoBase_1M/") + info.command).c_str(),
                                     BM_ConvertToGeoBase_1M, info.format)
            ->Unit(benchmark::kMillisecond)
            ->UseRealTime();
    return true;
}();

// The reader alone: the text in memory to the elements of a store.
void BM_GsiRead_1M(benchmark::State& state) {
    static const std::string text = books::MakeFieldBook(FieldBookFormat::Wild, kMillionLines);
    for (auto _ : state) {
        CCarnet carnet;
        CLectWild reader;
        reader.ReadText(text, carnet);
        if (!CheckElementCount(state, carnet.GetSize(), kExpected)) break;
    }
    state.SetItemsProcessed(state.iterations() * kMillionLines);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(text.size()));
}
BENCHMARK(BM_GsiRead_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
