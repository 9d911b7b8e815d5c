#include "FieldBookBench.h"

#include "fieldbook/FieldBookReader.h"
#include "geobase/Carnet.h"

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <stdexcept>

namespace pyr::bench {

GeneratedFieldBook::GeneratedFieldBook(const std::string& fileName, const std::string& text)
    : m_file(m_folder.File(fileName)), m_geobase(m_folder.File("levé.geo")), m_bytes(text.size()) {
    std::ofstream out(m_file, std::ios::binary);
    out << text;
    if (!out) throw std::runtime_error("impossible d'écrire " + m_file);
}

bool CheckElementCount(benchmark::State& state, int count, ElementRange expected) {
    if (count >= expected.least && count <= expected.most) return true;
    state.SkipWithError(("la GéoBase n'a pas le bon contenu : " + std::to_string(count)).c_str());
    return false;
}

void MeasureConversion(benchmark::State& state, const GeneratedFieldBook& book,
                       const ReaderFactory& makeReader, int lines, ElementRange expected) {
    for (auto _ : state) {
        CCarnet carnet;
        const auto reader = makeReader();
        if (!reader || !reader->Read(book.File(), carnet)) {
            state.SkipWithError("carnet illisible");
            break;
        }
        std::FILE* out = std::fopen(book.GeoBase().c_str(), "w");
        const bool written = out && carnet.Write(out, true);
        if (out) std::fclose(out);
        if (!written) {
            state.SkipWithError("GéoBase impossible à écrire");
            break;
        }
        if (!CheckElementCount(state, carnet.GetSize(), expected)) break;
    }
    state.SetItemsProcessed(state.iterations() * lines);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(book.Bytes()));
    std::error_code unknown;
    const auto geoBytes = std::filesystem::file_size(book.GeoBase(), unknown);
    if (!unknown) state.counters["Mo_geo"] = static_cast<double>(geoBytes) / 1e6;
}

} // namespace pyr::bench
