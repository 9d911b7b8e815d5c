// Any bytes read as a Wild / Leica GSI field book, under settings chosen by the first byte. Nothing may
// crash, and what the reader builds is a GéoBase like any other: written and read back, it holds as many
// elements, each of the same kind.
#include "FuzzRoundTrip.h"
#include "fieldbook/ParamDriver.h"

#include <cstdint>

namespace {

using namespace pyr;

// The settings of "Wild.ini" that change what the reader makes of a block.
void Choose(CParamDriver& driver, std::uint8_t choice) {
    static const char* const conventions[] = {"auto", "84", "41"};
    static const char* const references[] = {"aucune", "premiere", "codes"};
    static const char* const angles[] = {"grades", "degres", "dms", "mils"};
    driver.SetText(kKeyConventionStation, conventions[choice % 3]);
    driver.SetText(kKeyReferences, references[(choice / 3) % 3]);
    driver.SetText(kKeyCodesReference, "REF,99");
    driver.SetText(kKeyUniteAngles, angles[(choice / 9) % 4]);
    driver.SetText(kKeyUniteDistances, choice & 0x40 ? "pieds" : "metres");
    driver.SetText(kKeyOrdreCoordonnees, choice & 0x80 ? "YX" : "XY");
    driver.SetText(kKeyPointsCalcules, choice & 0x20 ? "1" : "0");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    return pyr::fuzz::FuzzFieldBookReader("fuzz_gsi", pyr::FieldBookFormat::Wild, Choose, data, size);
}
