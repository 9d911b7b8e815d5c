// Any bytes read as an SDR2x or SDR33 field book, under settings chosen by the first byte. Nothing may
// crash, and what the reader builds is a GéoBase like any other: written and read back, it holds as many
// elements, each of the same kind.
#include "FuzzRoundTrip.h"

#include <cstdint>

// The settings of "Sokkia.ini" that change what the reader makes of a record are those of every instrument
// reader.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    return pyr::fuzz::FuzzFieldBookReader("fuzz_sokkia", pyr::FieldBookFormat::Sokkia,
                                          pyr::fuzz::ChooseReaderSettings, data, size);
}
