// Converting a Trimble GDM (Geodimeter) job file of a million lines into a GéoBase, as a reading command
// does it: the file read, its records copied to the temporary file and read back, the GéoBase written.
#include "FieldBookBench.h"
#include "fieldbook/LectGeodim.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace pyr::bench {

namespace {

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
                text += "2=ST" + std::to_string(++station) + "\r\n3=1.55" +
                        std::to_string(m_random.Next(10)) + "\r\n62=" + std::to_string(point) + "\r\n";
                line += 3;
            }
            text += "5=" + std::to_string(point++) + "\r\n";
            if (sightings % 10 == 0) {
                text += "4=ARB\r\n";
                ++line;
            }
            text += "7=" + Dms(360) + "\r\n8=" + Dms(20, 80) +
                    "\r\n9=" + std::to_string(1 + m_random.Next(500)) + "." +
                    std::to_string(100 + m_random.Next(900)) + "\r\n";
            line += 4;
            ++sightings;
        }
        return text;
    }

private:
    std::string Dms(int range, int from = 0) {
        char text[32];
        std::snprintf(text, sizeof text, "%d.%02d%02d", from + static_cast<int>(m_random.Next(range)),
                      static_cast<int>(m_random.Next(60)), static_cast<int>(m_random.Next(60)));
        return text;
    }
    BookRandom m_random{20240612};
};

// Every sighting, its station's and the codes in front of one in ten.
void BM_GeodimConvertToGeoBase_1M(benchmark::State& state) {
    static int sightings = 0;
    static const GeneratedFieldBook book("levé.job", GdmBookGenerator().Make(kMillionLines, sightings));
    MeasureConversion(state, book, MakeGeodimReader, kMillionLines, {sightings, sightings * 2});
}
BENCHMARK(BM_GeodimConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
