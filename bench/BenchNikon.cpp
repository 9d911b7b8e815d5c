// Converting a Nikon raw V2.00 field book of a million lines into a GéoBase, as a reading command does
// it: the file read, converted, the GéoBase written.
#include "MemoryUse.h"
#include "fieldbook/LectNikon.h"
#include "geobase/Carnet.h"

#include <benchmark/benchmark.h>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>

namespace pyr::bench {

namespace {

constexpr int kMillion = 1'000'000;
constexpr int kShotsPerStation = 200;

// A field book as the instrument downloads it, in grads and metres: a station and its backsight every
// 200 lines, then side shots (point, target height, slope distance, Hz, V, time, code).
class NikonBookGenerator {
public:
    std::string Make(int lines) {
        std::string text =
            "CO,Nikon RAW data format V2.00\r\nCO,Dist Units: Metres\r\nCO,Angle Units: Gons\r\n"
            "CO,Zero VA: Zenith\r\nCO,Coord Order: NEZ\r\n";
        text.reserve(static_cast<std::size_t>(lines) * 56);
        long long point = 1000;
        int station = 0;
        char buffer[160];
        for (int line = 5; line < lines; ++line) {
            const int place = line % (kShotsPerStation + 2);
            int size = 0;
            if (place == 0) {
                ++station;
                size = std::snprintf(buffer, sizeof buffer, "ST,S%d,,S%d,,%.3f,%.4f,%.4f\r\n", station,
                                     station + 1, 1.4 + Next(300) / 1000.0, Next(4000000) / 10000.0,
                                     Next(4000000) / 10000.0);
            } else if (place == 1) {
                size = std::snprintf(buffer, sizeof buffer, "F1,,1.300,%.3f,%.4f,%.4f,10:00:00\r\n",
                                     10.0 + Next(500000) / 1000.0, Next(4000000) / 10000.0,
                                     90.0 + Next(200000) / 10000.0);
            } else {
                size = std::snprintf(
                    buffer, sizeof buffer, "SS,%lld,1.300,%.3f,%.4f,%.4f,10:%02d:%02d,%s\r\n", point++,
                    1.0 + Next(500000) / 1000.0, Next(4000000) / 10000.0, 90.0 + Next(200000) / 10000.0,
                    line % 60, (line / 60) % 60, line % 10 == 0 ? "ARB" : "");
            }
            text.append(buffer, static_cast<std::size_t>(size));
        }
        return text;
    }

private:
    long long Next(long long range) {
        m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
        return static_cast<long long>((m_state >> 33) % static_cast<std::uint64_t>(range));
    }
    std::uint64_t m_state = 20240611;
};

struct MillionLines {
    MillionLines() : text(NikonBookGenerator().Make(kMillion)), file(folder.File("levé.raw")) {
        std::ofstream out(file, std::ios::binary);
        out << text;
        if (!out) throw std::runtime_error("impossible d'écrire " + file);
    }
    TemporaryFolder folder;
    std::string text;
    std::string file;
};

// The conversion: the field book read from its file, the new GéoBase written beside it.
void BM_NikonConvertToGeoBase_1M(benchmark::State& state) {
    static MillionLines book;
    const std::string geobase = book.folder.File("levé.geo");
    for (auto _ : state) {
        CCarnet carnet;
        auto reader = MakeNikonReader();
        if (!reader->Read(book.file, carnet)) state.SkipWithError("carnet illisible");
        std::FILE* out = std::fopen(geobase.c_str(), "w");
        if (!out || !carnet.Write(out, true)) state.SkipWithError("GéoBase impossible à écrire");
        if (out) std::fclose(out);
        state.PauseTiming();
        // Every record is an element (a station adds the comment of its backsight, one shot in ten its
        // code): short of a million, a line was refused.
        if (carnet.GetSize() < kMillion)
            state.SkipWithError(
                ("la GéoBase n'a pas le bon contenu : " + std::to_string(carnet.GetSize())).c_str());
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * kMillion);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(book.text.size()));
    state.counters["Mo_geo"] = static_cast<double>(std::filesystem::file_size(geobase)) / 1e6;
}
BENCHMARK(BM_NikonConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
