// Converting a Trimble (Zeiss) M5 field book of a million lines into a GéoBase, as a reading command does
// it: the file read, converted, the GéoBase written.
#include "MemoryUse.h"
#include "fieldbook/LectZeiss.h"
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
constexpr int kSightingsPerStation = 200;

// An M5 field book as the instrument writes it: a station line (its coordinates) every 200 lines, then
// sightings of a slope distance, a Hz and a zenith angle with their units, one in ten with a code.
class M5BookGenerator {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 121);
        char line[160];
        long long point = 1000;
        int station = 0;
        for (int address = 1; address <= lines; ++address) {
            if ((address - 1) % (kSightingsPerStation + 1) == 0) {
                const std::string name = "ST" + std::to_string(++station);
                std::snprintf(
                    line, sizeof line,
                    "For M5|Adr %05d|PI1 %19s%-5s   |X  %14.3f m   |Y  %14.3f m   |Z  %14.3f m   | ",
                    address % 100000, name.c_str(), "S", 6862000.0 + Next(100000000) / 1000.0,
                    651000.0 + Next(100000000) / 1000.0, 500.0 + Next(10000) / 100.0);
            } else {
                const std::string name = std::to_string(point++);
                std::snprintf(
                    line, sizeof line,
                    "For M5|Adr %05d|PI1 %19s%-5s   |SD %14.3f m   |Hz %14.4f gon |V1 %14.4f gon | ",
                    address % 100000, name.c_str(), address % 10 == 0 ? "ARB" : "",
                    1.0 + Next(500000) / 1000.0, Next(4000000) / 10000.0, 90.0 + Next(200000) / 10000.0);
            }
            text += line;
            text += "\r\n";
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
    MillionLines() : text(M5BookGenerator().Make(kMillion)), file(folder.File("levé.m5")) {
        std::ofstream out(file, std::ios::binary);
        out << text;
        if (!out) throw std::runtime_error("impossible d'écrire " + file);
    }
    TemporaryFolder folder;
    std::string text;
    std::string file;
};

// The conversion: the field book read from its file, the new GéoBase written beside it.
void BM_ZeissConvertToGeoBase_1M(benchmark::State& state) {
    static MillionLines book;
    const std::string geobase = book.folder.File("levé.geo");
    for (auto _ : state) {
        CCarnet carnet;
        CLectZeiss reader;
        if (!reader.Read(book.file, carnet)) state.SkipWithError("carnet illisible");
        std::FILE* out = std::fopen(geobase.c_str(), "w");
        if (!out || !carnet.Write(out, true)) state.SkipWithError("GéoBase impossible à écrire");
        if (out) std::fclose(out);
        state.PauseTiming();
        // Every line is an element (a station also gives its point), one in ten sightings has its code.
        const int expected = kMillion + kMillion / (kSightingsPerStation + 1) + kMillion / 10 + 2;
        if (carnet.GetSize() < kMillion || carnet.GetSize() > expected)
            state.SkipWithError(
                ("la GéoBase n'a pas le bon contenu : " + std::to_string(carnet.GetSize())).c_str());
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * kMillion);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(book.text.size()));
    state.counters["Mo_geo"] = static_cast<double>(std::filesystem::file_size(geobase)) / 1e6;
}
BENCHMARK(BM_ZeissConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
