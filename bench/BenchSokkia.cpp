// Converting an SDR33 field book of a million lines into a GéoBase as a reading command does it: the
// file read, converted, the GéoBase written beside it.
#include "FieldBookBench.h"
#include "fieldbook/LectSokkia.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace pyr::bench {

namespace {

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
                text += "02TP" + Id(name) + Real(6862000 + m_random.Next(100000), 3) +
                        Real(651000 + m_random.Next(100000), 3) + Real(50 + m_random.Next(100), 3) +
                        Real(1.4 + m_random.Next(300) / 1000.0, 3) + Field("") + "\r\n";
            } else if (line % (kSightingsPerStation + 2) == 2) {
                text += "03NM" + Real(1.3, 3) + "\r\n";
            } else {
                text += "09F1" + Id("ST" + std::to_string(station)) + Id(std::to_string(point++)) +
                        Real(1 + m_random.Next(500000) / 1000.0, 3) +
                        Real(90 + m_random.Next(2000000) / 100000.0, 5) +
                        Real(m_random.Next(40000000) / 100000.0, 5) + Field(line % 10 == 0 ? "ARB" : "") +
                        "\r\n";
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
    BookRandom m_random{20261122};
};

// Every line but the target heights makes an element; stations add their point, one sighting in ten its
// code.
void BM_SokkiaConvertToGeoBase_1M(benchmark::State& state) {
    static const GeneratedFieldBook book("levé.sdr", SdrBookGenerator().Make(kMillionLines));
    MeasureConversion(state, book, MakeSokkiaReader, kMillionLines,
                      {kMillionLines * 9 / 10, kMillionLines + kMillionLines / 10 + kMillionLines / 100});
}
BENCHMARK(BM_SokkiaConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
