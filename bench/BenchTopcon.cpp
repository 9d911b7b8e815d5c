// Converting a Topcon GTS-7 field book of a million lines into a GéoBase, as the reading command does it:
// the file read, converted, the new GéoBase written beside it.
#include "MemoryUse.h"
#include "fieldbook/LectTopcon.h"
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
constexpr int kLinesPerStation = 400; // STN, XYZ, then 199 sightings of two lines

// A field book in metres and ddd.mmss: a station with its coordinates every 400 lines, then side shots
// (SS with a code one time in ten) each followed by its slope distance line.
std::string MakeTopconBook() {
    std::string text;
    text.reserve(static_cast<std::size_t>(kLines) * 36);
    text += "JOB     BENCH,\r\nUNITS   M,D\r\n";
    std::uint64_t state = 20240611;
    const auto next = [&state](std::uint64_t range) {
        state = state * 6364136223846793005ULL + 1442695040888963407ULL;
        return (state >> 33) % range;
    };
    // ddd.mmss with its tenths of a second, from a count of tenths of a second.
    const auto dms = [](std::uint64_t tenths) {
        char out[24];
        std::snprintf(
            out, sizeof out, "%llu.%02llu%02llu%llu", static_cast<unsigned long long>(tenths / 36000),
            static_cast<unsigned long long>(tenths / 600 % 60),
            static_cast<unsigned long long>(tenths / 10 % 60), static_cast<unsigned long long>(tenths % 10));
        return std::string(out);
    };
    char line[96];
    long long point = 1000;
    int station = 0;
    for (int written = 2; written < kLines; written += 2) {
        if ((written - 2) % kLinesPerStation == 0) {
            std::snprintf(line, sizeof line, "STN     ST%d,1.%03d,\r\nXYZ     %.3f,%.3f,%.3f\r\n", ++station,
                          static_cast<int>(next(600)),
                          651000.0 + static_cast<double>(next(100000000)) / 1000.0,
                          6862000.0 + static_cast<double>(next(100000000)) / 1000.0,
                          50.0 + static_cast<double>(next(10000)) / 1000.0);
        } else {
            const long long id = point++;
            std::snprintf(line, sizeof line, "SS      %lld,1.300,%s\r\nSD      %s,%s,%.4f\r\n", id,
                          id % 10 == 0 ? "ARB" : "", dms(next(360 * 36000)).c_str(),
                          dms(80 * 36000 + next(20 * 36000)).c_str(),
                          1.0 + static_cast<double>(next(5000000)) / 1e4);
        }
        text += line;
    }
    return text;
}

struct TopconBook {
    TopconBook() : file(folder.File("levé.gts7")), geobase(folder.File("levé.geo")) {
        const std::string text = MakeTopconBook();
        bytes = text.size();
        std::ofstream out(file, std::ios::binary);
        out << text;
        if (!out) throw std::runtime_error("impossible d'écrire " + file);
    }
    TemporaryFolder folder;
    std::string file, geobase;
    std::size_t bytes = 0;
};

void BM_TopconConvertToGeoBase_1M(benchmark::State& state) {
    static const TopconBook book;
    for (auto _ : state) {
        CCarnet carnet;
        CLectTopcon reader;
        if (!reader.Read(book.file, carnet)) state.SkipWithError("carnet illisible");
        std::FILE* out = std::fopen(book.geobase.c_str(), "w");
        if (!out || !carnet.Write(out, true)) state.SkipWithError("GéoBase impossible à écrire");
        if (out) std::fclose(out);
        // Half the lines are sightings; stations, points and one code in ten sightings come beside them.
        if (carnet.GetSize() < kLines / 2)
            state.SkipWithError(
                ("la GéoBase n'a pas le bon contenu : " + std::to_string(carnet.GetSize())).c_str());
    }
    state.SetItemsProcessed(state.iterations() * kLines);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(book.bytes));
    state.counters["Mo_geo"] = static_cast<double>(std::filesystem::file_size(book.geobase)) / 1e6;
}
BENCHMARK(BM_TopconConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
