// Converting a Topcon GTS-7 field book of a million lines into a GéoBase, as the reading command does it:
// the file read, converted, the new GéoBase written beside it.
#include "FieldBookBench.h"
#include "fieldbook/LectTopcon.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace pyr::bench {

namespace {

constexpr int kLines = kMillionLines;
constexpr int kLinesPerStation = 400; // STN, XYZ, then 199 sightings of two lines

// A field book in metres and ddd.mmss: a station with its coordinates every 400 lines, then side shots
// (SS with a code one time in ten) each followed by its slope distance line.
std::string MakeTopconBook() {
    std::string text;
    text.reserve(static_cast<std::size_t>(kLines) * 36);
    text += "JOB     BENCH,\r\nUNITS   M,D\r\n";
    BookRandom random(20240611);
    const auto next = [&random](std::uint64_t range) {
        return static_cast<std::uint64_t>(random.Next(static_cast<long long>(range)));
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

// Half the lines are sightings; stations, points and one code in ten sightings come beside them.
void BM_TopconConvertToGeoBase_1M(benchmark::State& state) {
    static const GeneratedFieldBook book("levé.gts7", MakeTopconBook());
    MeasureConversion(state, book, MakeTopconReader, kLines, {kLines / 2});
}
BENCHMARK(BM_TopconConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
