#pragma once

// Field books of any length in every format the reading commands convert, made of the same random
// numbers on every machine and every run: the benchmarks time their conversion, the whole-process script
// converts them with the program itself, and the tests keep the GéoBase each one gives.
#include "fieldbook/FieldBookFormats.h"

#include <cstdint>
#include <string>

namespace pyr::books {

// The same numbers on every machine and every run, so that two runs measure the same field book.
class BookRandom {
public:
    explicit BookRandom(std::uint64_t seed) : m_state(seed) {}
    // A whole number in [0, range).
    long long Next(long long range) {
        m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
        return static_cast<long long>((m_state >> 33) % static_cast<std::uint64_t>(range));
    }

private:
    std::uint64_t m_state;
};

// How many sightings a generated book has per station.
inline constexpr int kSightingsPerStation = 200;

// A field book of about `lines` lines in `format`, as the instrument (or the surveyor's spreadsheet)
// writes it: a station every 200 sightings, one sighting in ten with a code.
std::string MakeFieldBook(FieldBookFormat format, int lines);

// The extension a book of that format usually has, without its dot ("gsi").
const char* BookExtension(FieldBookFormat format);

// The layout file (".sep", ".col") that reads the generated delimited or columnar book; empty for the
// formats without one.
std::string BookLayout(FieldBookFormat format);

} // namespace pyr::books
