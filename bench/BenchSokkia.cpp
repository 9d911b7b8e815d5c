// Converting an SDR33 field book of a million lines into a GéoBase as a reading command does it: the
// file read, converted, the GéoBase written beside it.
#include "MemoryUse.h"
#include "fieldbook/LectSokkia.h"
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

constexpr int kLines = 1'000'000;
constexpr int kSightingsPerStation = 200;

// An SDR33 book: a header, then a station (02) and its target height (03) every 200 lines, then
// observations (09F1) with a description on one in ten; the fields on 16 characters.
class SdrBookGenerator {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 102);
        text += "00NMSDR33 V04-04.02     22-Nov-26 10:15 211111\r\n";
        long long point = 1000;
        int station = 0;
        for (int line = 1; line < lines; ++line) {
            if (line % (kSightingsPerStation + 2) == 1) {
                ++station;
                const std::string name = "ST" + std::to_string(station);
                text += "02TP" + Id(name) + Real(6862000 + Next(100000), 3) + Real(651000 + Next(100000), 3) +
                        Real(50 + Next(100), 3) + Real(1.4 + Next(300) / 1000.0, 3) + Field("") + "\r\n";
            } else if (line % (kSightingsPerStation + 2) == 2) {
                text += "03NM" + Real(1.3, 3) + "\r\n";
            } else {
                text += "09F1" + Id("ST" + std::to_string(station)) + Id(std::to_string(point++)) +
                        Real(1 + Next(500000) / 1000.0, 3) + Real(90 + Next(2000000) / 100000.0, 5) +
                        Real(Next(40000000) / 100000.0, 5) + Field(line % 10 == 0 ? "ARB" : "") + "\r\n";
            }
        }
        return text;
    }

private:
    static std::string Field(const std::string& text) { return text + std::string(16 - text.size(), ' '); }
    static std::string Id(const std::string& id) { return std::string(16 - id.size(), ' ') + id; }
    static std::string Real(double value, int decimals) {
        char buffer[32];
        std::snprintf(buffer, sizeof buffer, "%-16.*f", decimals, value);
        return buffer;
    }
    long long Next(long long range) {
        m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
        return static_cast<long long>((m_state >> 33) % static_cast<std::uint64_t>(range));
    }
    std::uint64_t m_state = 20261122;
};

struct MillionLines {
    MillionLines() : text(SdrBookGenerator().Make(kLines)), file(folder.File("levé.sdr")) {
        std::ofstream out(file, std::ios::binary);
        out << text;
        if (!out) throw std::runtime_error("impossible d'écrire " + file);
    }
    TemporaryFolder folder;
    std::string text;
    std::string file;
};

void BM_SokkiaConvertToGeoBase_1M(benchmark::State& state) {
    static MillionLines book;
    const std::string geobase = book.folder.File("levé.geo");
    for (auto _ : state) {
        CCarnet carnet;
        CLectSokkia reader;
        if (!reader.Read(book.file, carnet)) state.SkipWithError("carnet illisible");
        std::FILE* out = std::fopen(geobase.c_str(), "w");
        if (!out || !carnet.Write(out, true)) state.SkipWithError("GéoBase impossible à écrire");
        if (out) std::fclose(out);
        state.PauseTiming();
        // Every line but the target heights makes an element; stations add their point, one sighting
        // in ten its code.
        if (carnet.GetSize() < kLines * 9 / 10 || carnet.GetSize() > kLines + kLines / 10 + kLines / 100)
            state.SkipWithError(
                ("la GéoBase n'a pas le bon contenu : " + std::to_string(carnet.GetSize())).c_str());
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * kLines);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(book.text.size()));
    state.counters["Mo_geo"] = static_cast<double>(std::filesystem::file_size(geobase)) / 1e6;
}
BENCHMARK(BM_SokkiaConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
