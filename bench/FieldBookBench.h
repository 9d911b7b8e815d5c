#pragma once

// What the benchmarks of the field-book readers share: the random numbers of their generated books, the
// book written once to a temporary folder, and the conversion measured as a reading command does it (the
// file read and converted, the new GéoBase written beside it, its size checked).
#include "FieldBookGenerator.h"
#include "MemoryUse.h"
#include "fieldbook/FieldBookReader.h"

#include <benchmark/benchmark.h>
#include <cstdint>
#include <functional>
#include <limits>
#include <memory>
#include <string>

namespace pyr::bench {

inline constexpr int kMillionLines = 1'000'000;

using books::BookRandom;

// A generated field book in a temporary folder of its own, with the path of the GéoBase made from it.
class GeneratedFieldBook {
public:
    // Writes `text` to `fileName` in the folder; throws when the file cannot be written.
    GeneratedFieldBook(const std::string& fileName, const std::string& text);

    const std::string& File() const { return m_file; }
    const std::string& GeoBase() const { return m_geobase; }
    std::size_t Bytes() const { return m_bytes; }

private:
    TemporaryFolder m_folder;
    std::string m_file;
    std::string m_geobase;
    std::size_t m_bytes = 0;
};

// How many elements a right conversion gives.
struct ElementRange {
    int least = 0;
    int most = std::numeric_limits<int>::max();
};

// False, the benchmark ended with an error naming the count, when `count` elements is outside `expected`.
bool CheckElementCount(benchmark::State& state, int count, ElementRange expected);

using ReaderFactory = std::function<std::unique_ptr<CFieldBookReader>()>;

// One measured conversion per iteration: a reader from `makeReader` reads the book's file, the GéoBase
// is written; an unreadable book, an unwritable GéoBase or a count of elements outside `expected` ends
// the benchmark with an error. Counts `lines` lines and the book's bytes per iteration, and the size of
// the GéoBase written ("Mo_geo").
void MeasureConversion(benchmark::State& state, const GeneratedFieldBook& book,
                       const ReaderFactory& makeReader, int lines, ElementRange expected);

} // namespace pyr::bench
