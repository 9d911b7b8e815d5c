// Converting a Nikon raw V2.00 field book of a million lines into a GéoBase, as a reading command does
// it: the file read, converted, the GéoBase written.
#include "FieldBookBench.h"
#include "fieldbook/LectNikon.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace pyr::bench {

namespace {

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
                                     station + 1, 1.4 + m_random.Next(300) / 1000.0,
                                     m_random.Next(4000000) / 10000.0, m_random.Next(4000000) / 10000.0);
            } else if (place == 1) {
                size = std::snprintf(buffer, sizeof buffer, "F1,,1.300,%.3f,%.4f,%.4f,10:00:00\r\n",
                                     10.0 + m_random.Next(500000) / 1000.0, m_random.Next(4000000) / 10000.0,
                                     90.0 + m_random.Next(200000) / 10000.0);
            } else {
                size =
                    std::snprintf(buffer, sizeof buffer, "SS,%lld,1.300,%.3f,%.4f,%.4f,10:%02d:%02d,%s\r\n",
                                  point++, 1.0 + m_random.Next(500000) / 1000.0,
                                  m_random.Next(4000000) / 10000.0, 90.0 + m_random.Next(200000) / 10000.0,
                                  line % 60, (line / 60) % 60, line % 10 == 0 ? "ARB" : "");
            }
            text.append(buffer, static_cast<std::size_t>(size));
        }
        return text;
    }

private:
    BookRandom m_random{20240611};
};

// Every record is an element (a station adds the comment of its backsight, one shot in ten its code):
// short of a million, a line was refused.
void BM_NikonConvertToGeoBase_1M(benchmark::State& state) {
    static const GeneratedFieldBook book("levé.raw", NikonBookGenerator().Make(kMillionLines));
    MeasureConversion(state, book, MakeNikonReader, kMillionLines, {kMillionLines});
}
BENCHMARK(BM_NikonConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
