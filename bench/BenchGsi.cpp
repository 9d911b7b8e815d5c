// Converting a Wild / Leica GSI-16 field book of a million lines into a GéoBase: the reading alone (from
// memory), and the whole conversion as a reading command does it (the file read, converted, the GéoBase
// written).
#include "MemoryUse.h"
#include "fieldbook/LectWild.h"
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

// A field book as a total station writes it in GSI-16: a station block (84, 85, 86, 88) every 200
// lines, then sightings of seven words (point, Hz, V, slope distance, ppm and prism constant, reflector
// and instrument heights), one in ten with a code (71).
class GsiBookGenerator {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 200);
        long long point = 1000;
        int station = 0;
        for (int line = 0; line < lines; ++line) {
            if (line % (kSightingsPerStation + 1) == 0) {
                ++station;
                text += Word("*110001", "ST" + std::to_string(station));
                text += Word("84..10", std::to_string(651000000 + Next(100000000)));
                text += Word("85..10", std::to_string(6862000000 + Next(100000000)));
                text += Word("86..10", std::to_string(50000 + Next(10000)));
                text += Word("88..10", std::to_string(1400 + Next(300)));
            } else {
                text += Word("*11" + Block(line), std::to_string(point++));
                text += Word("21.322", std::to_string(Next(40000000)));
                text += Word("22.322", std::to_string(9000000 + Next(2000000)));
                text += Word("31..00", std::to_string(1000 + Next(500000)));
                text += Word("51....", "000000000000+000");
                text += Word("87..10", "1300");
                if (line % 10 == 0) text += Word("71....", "ARB");
                text += Word("88..10", "1550");
            }
            text += "\r\n";
        }
        return text;
    }

private:
    static std::string Block(int line) {
        std::string number = std::to_string(line % 10000);
        return std::string(4 - number.size(), '0') + number;
    }
    static std::string Word(const std::string& header, const std::string& data) {
        std::string word = header[0] == '*' ? header.substr(1) : header;
        word += '+';
        word += std::string(16 - data.size(), '0') + data + ' ';
        return header[0] == '*' ? '*' + word : word;
    }
    long long Next(long long range) {
        m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
        return static_cast<long long>((m_state >> 33) % static_cast<std::uint64_t>(range));
    }
    std::uint64_t m_state = 20240611;
};

struct MillionLines {
    MillionLines() : text(GsiBookGenerator().Make(kMillion)), file(folder.File("levé.gsi")) {
        std::ofstream out(file, std::ios::binary);
        out << text;
        if (!out) throw std::runtime_error("impossible d'écrire " + file);
    }
    TemporaryFolder folder;
    std::string text;
    std::string file;
};

MillionLines& Million() {
    static MillionLines book;
    return book;
}

void Check(benchmark::State& state, const CCarnet& carnet) {
    // Every line is an element, and one in ten sightings has its code in front of it.
    const int expected = kMillion + kMillion / (kSightingsPerStation + 1) + kMillion / 10 + 1;
    if (carnet.GetSize() < kMillion || carnet.GetSize() > expected)
        state.SkipWithError(("la GéoBase n'a pas le bon contenu : " + std::to_string(carnet.GetSize())).c_str());
}

void Count(benchmark::State& state, std::size_t bytes) {
    state.SetItemsProcessed(state.iterations() * kMillion);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(bytes));
}

// The reader alone: the text in memory to the elements of a store.
void BM_GsiRead_1M(benchmark::State& state) {
    MillionLines& book = Million();
    for (auto _ : state) {
        CCarnet carnet;
        CLectWild reader;
        reader.ReadText(book.text, carnet);
        state.PauseTiming();
        Check(state, carnet);
        state.ResumeTiming();
    }
    Count(state, book.text.size());
}
BENCHMARK(BM_GsiRead_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

// The conversion: the field book read from its file, the new GéoBase written beside it.
void BM_GsiConvertToGeoBase_1M(benchmark::State& state) {
    MillionLines& book = Million();
    const std::string geobase = book.folder.File("levé.geo");
    for (auto _ : state) {
        CCarnet carnet;
        CLectWild reader;
        if (!reader.Read(book.file, carnet)) state.SkipWithError("carnet illisible");
        std::FILE* out = std::fopen(geobase.c_str(), "w");
        if (!out || !carnet.Write(out, true)) state.SkipWithError("GéoBase impossible à écrire");
        if (out) std::fclose(out);
        state.PauseTiming();
        Check(state, carnet);
        state.ResumeTiming();
    }
    Count(state, book.text.size());
    state.counters["Mo_geo"] = static_cast<double>(std::filesystem::file_size(geobase)) / 1e6;
}
BENCHMARK(BM_GsiConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
