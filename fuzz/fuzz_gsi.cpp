// Any bytes read as a Wild / Leica GSI field book, under settings chosen by the first byte. Nothing may
// crash, and what the reader builds is a GéoBase like any other: written and read back, it holds as many
// elements, each of the same kind.
#include "FuzzRoundTrip.h"

#include <cstdint>

namespace {

using namespace pyr;

// The settings of "Wild.ini" that change what the reader makes of a block: those of every instrument
// reader, and how a station block is told.
void Choose(CParamDriver& driver, std::uint8_t choice) {
    static const char* const conventions[] = {"auto", "84", "41"};
    fuzz::ChooseReaderSettings(driver, choice);
    driver.SetText(kKeyConventionStation, conventions[(choice / 12) % 3]);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    return pyr::fuzz::FuzzFieldBookReader("fuzz_gsi", pyr::FieldBookFormat::Wild, Choose, data, size);
}
