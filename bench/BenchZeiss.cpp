// Converting a Trimble (Zeiss) M5 field book of a million lines into a GéoBase, as a reading command does
// it: the file read, converted, the GéoBase written.
#include "FieldBookBench.h"
#include "fieldbook/LectZeiss.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace pyr::bench {

namespace {

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
                    address % 100000, name.c_str(), "S", 6862000.0 + m_random.Next(100000000) / 1000.0,
                    651000.0 + m_random.Next(100000000) / 1000.0, 500.0 + m_random.Next(10000) / 100.0);
            } else {
                const std::string name = std::to_string(point++);
                std::snprintf(
                    line, sizeof line,
                    "For M5|Adr %05d|PI1 %19s%-5s   |SD %14.3f m   |Hz %14.4f gon |V1 %14.4f gon | ",
                    address % 100000, name.c_str(), address % 10 == 0 ? "ARB" : "",
                    1.0 + m_random.Next(500000) / 1000.0, m_random.Next(4000000) / 10000.0,
                    90.0 + m_random.Next(200000) / 10000.0);
            }
            text += line;
            text += "\r\n";
        }
        return text;
    }

private:
    BookRandom m_random{20240611};
};

// Every line is an element (a station also gives its point), one in ten sightings has its code.
void BM_ZeissConvertToGeoBase_1M(benchmark::State& state) {
    static const GeneratedFieldBook book("levé.m5", M5BookGenerator().Make(kMillionLines));
    MeasureConversion(
        state, book, MakeZeissReader, kMillionLines,
        {kMillionLines, kMillionLines + kMillionLines / (kSightingsPerStation + 1) + kMillionLines / 10 + 2});
}
BENCHMARK(BM_ZeissConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
