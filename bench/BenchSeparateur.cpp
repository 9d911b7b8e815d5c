// Converting a delimited field book of a million lines into a GéoBase, as the reading command does it with
// the delivered layout (";" between the fields, grads and metres): the records imported, written as a
// Quendal-Pc field book beside it and read back, the GéoBase written.
#include "FieldBookBench.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookReaders.h"
#include "fieldbook/ParamDriver.h"

#include <cstdio>
#include <string>

namespace pyr::bench {

namespace {

constexpr int kSightingsPerStation = 200;

// A book in the default layout: for every station its known coordinates (PT) and the station itself
// (ST), then a backsight (RF) and side shots (MS), one in ten with a code.
class DelimitedBookGenerator {
public:
    std::string Make(int lines) {
        std::string text;
        text.reserve(static_cast<std::size_t>(lines) * 48);
        char buffer[128];
        long long point = 1000;
        int station = 0;
        for (int line = 0; line < lines; ++line) {
            const int place = line % (kSightingsPerStation + 2);
            int size = 0;
            if (place == 0) {
                ++station;
                size = std::snprintf(buffer, sizeof buffer, "PT;ST%d;%.3f;%.3f;%.3f;\r\n", station,
                                     651000.0 + m_random.Next(100000000) / 1000.0,
                                     6862000.0 + m_random.Next(100000000) / 1000.0,
                                     50.0 + m_random.Next(10000) / 100.0);
            } else if (place == 1) {
                size = std::snprintf(buffer, sizeof buffer, "ST;ST%d;%.3f;\r\n", station,
                                     1.4 + m_random.Next(300) / 1000.0);
            } else {
                const bool backsight = place == 2;
                const std::string name =
                    backsight ? "ST" + std::to_string(station + 1) : std::to_string(point++);
                size = std::snprintf(buffer, sizeof buffer, "%s;%s;1.300;%.4f;%.4f;%.3f;%s\r\n",
                                     backsight ? "RF" : "MS", name.c_str(), m_random.Next(4000000) / 10000.0,
                                     90.0 + m_random.Next(200000) / 10000.0,
                                     1.0 + m_random.Next(500000) / 1000.0, line % 10 == 0 ? "ARB" : "");
            }
            text.append(buffer, static_cast<std::size_t>(size));
        }
        return text;
    }

private:
    BookRandom m_random{20261122};
};

// Every line is an element, one sighting in ten adds its code.
void BM_SeparateurConvertToGeoBase_1M(benchmark::State& state) {
    static const GeneratedFieldBook book("levé.csv", DelimitedBookGenerator().Make(kMillionLines));
    static const CParamDriver layout("", "", FieldBookFormat::Separateur); // the delivered defaults
    MeasureConversion(state, book,
                      [] {
                          auto reader = MakeFieldBookReader(FieldBookFormat::Separateur);
                          if (reader) reader->SetDriver(&layout);
                          return reader;
                      },
                      kMillionLines, {kMillionLines, kMillionLines + kMillionLines / 10 + 1});
}
BENCHMARK(BM_SeparateurConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
