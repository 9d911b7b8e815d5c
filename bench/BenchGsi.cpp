// Converting a Wild / Leica GSI-16 field book of a million lines into a GéoBase: the reading alone (from
// memory), and the whole conversion as a reading command does it (the file read, converted, the GéoBase
// written).
#include "FieldBookBench.h"
#include "fieldbook/LectWild.h"
#include "geobase/Carnet.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace pyr::bench {

namespace {

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
                text += Word("84..10", std::to_string(651000000 + m_random.Next(100000000)));
                text += Word("85..10", std::to_string(6862000000 + m_random.Next(100000000)));
                text += Word("86..10", std::to_string(50000 + m_random.Next(10000)));
                text += Word("88..10", std::to_string(1400 + m_random.Next(300)));
            } else {
                text += Word("*11" + Block(line), std::to_string(point++));
                text += Word("21.322", std::to_string(m_random.Next(40000000)));
                text += Word("22.322", std::to_string(9000000 + m_random.Next(2000000)));
                text += Word("31..00", std::to_string(1000 + m_random.Next(500000)));
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
    BookRandom m_random{20240611};
};

struct MillionLines {
    MillionLines() : text(GsiBookGenerator().Make(kMillionLines)), book("levé.gsi", text) {}
    std::string text;
    GeneratedFieldBook book;
};

MillionLines& Million() {
    static MillionLines lines;
    return lines;
}

// Every line is an element, and one in ten sightings has its code in front of it.
constexpr ElementRange kExpected{kMillionLines, kMillionLines + kMillionLines / (kSightingsPerStation + 1) +
                                                    kMillionLines / 10 + 1};

// The reader alone: the text in memory to the elements of a store.
void BM_GsiRead_1M(benchmark::State& state) {
    const MillionLines& million = Million();
    for (auto _ : state) {
        CCarnet carnet;
        CLectWild reader;
        reader.ReadText(million.text, carnet);
        if (!CheckElementCount(state, carnet.GetSize(), kExpected)) break;
    }
    state.SetItemsProcessed(state.iterations() * kMillionLines);
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(million.text.size()));
}
BENCHMARK(BM_GsiRead_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_GsiConvertToGeoBase_1M(benchmark::State& state) {
    MeasureConversion(
        state, Million().book, [] { return std::make_unique<CLectWild>(); }, kMillionLines, kExpected);
}
BENCHMARK(BM_GsiConvertToGeoBase_1M)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

} // namespace pyr::bench
