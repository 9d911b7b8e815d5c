// Converting a Trimble GDM (Geodimeter) job file of a million lines into a GéoBase, as a reading command
// does it: the file read, its records copied to the temporary file and read back, the GéoBase written.
#include "MemoryUse.h"
#include "fieldbook/LectGeodim.h"
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

// A job file in degrees, minutes, seconds: a station block (2, 3, 62) every 200 sightings, each sighting a
// point block of its number, Hz, V and slope distance, one in ten with a code (4).
class GdmBookGenerator {
public:
    std::string Make(int lines, int& sightings) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 14);
        text += "50=BENCH\r\n23=3111\r\n";
        int line = 2, station = 0;
        long long point = 1000;
        sightings = 0;
        while (line < lines) {
            if (sightings % kSightingsPerStation == 0) {
                text += "2=ST" + std::to_string(++station) + "\r\n3=1.55" + std::to_string(Next(10)) +
                        "\r\n62=" + std::to_string(point) + "\r\n";
                line += 3;
            }
            text += "5=" + std::to_string(point++) + "\r\n";
            if (sightings % 10 == 0) {
                text += "4=ARB\r\n";
                ++line;
            }
            text += "7=" + Dms(360) + "\r\n8=" + Dms(20, 80) + "\r\n9=" + std::to_string(1 + Next(500)) +
                    "." + std::to_string(100 + Next(900)) + "\r\n";
            line += 4;
            ++sightings;
        }
        return text;
    }

private:
    std::string Dms(int range, int from = 0) {
        char text[32];
        std::snprintf(text, sizeof text, "%d.%02d%02d", from + static_cast<int>(Next(range)),
                      static_cast<int>(Next(60)), static_cast<int>(Next(60)));
        return text;
    }
    long long Next(long long range) {
        m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
        return static_cast<long long>((m_state >> 33) % static_cast<std::uint64_t>(range));
    }
    std::uint64_t m_state = 20240612;
};

struct MillionLines {
    MillionLines() : text(GdmBookGenerator().Make(kMillion, sightings)), file(folder.File("levé.job")) {
        std::ofstream out(file, std::ios::binary);
        out << text;
        if (!out) throw std::runtime_error("impossible d'écrire " + file);
    }
    TemporaryFolder folder;
    int sightings = 0;
    std::string text;
    std::string file;
};

MillionLines& Million() {
    static MillionLines book;
    return book;
}

void BM_GeodimConvertToGeoBase_1M(benchmark::State& state) {
    MillionLines& book = Million();
    const std::string geobase = book.folder.File("levé.geo");
    for (auto _ : state) {
        CCarnet carnet;
        auto reader = MakeGeodimReader();
        if (!reader->Read(book.file, carnet)) state.SkipWithError("carnet illisible");
        std::FILE* out = std::fopen(geobase.c_str(), "w");
        if (!out || !carnet.Write(out, true)) state.SkipWithError("GéoBase impossible à écrire");
        if (out) std::fclose(out);
        state.PauseTiming();
        // Every sighting, its station's and the codes in front of one in ten.
        if (carnet.GetSize() < book.sightings || carnet.GetSize() > book.sightings * 2)
            state.SkipWithError(
                ("la GéoBase n'a pas le bon contenu : " + std::to_string(carnet.GetSize())).c_str());
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * kMillion);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(book.text.size()));
    state.counters["Mo_geo"] = static_cast<double>(std::filesystem::file_size(geobase)) / 1e6;
}
BENCHMARK(BM_GeodimConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
