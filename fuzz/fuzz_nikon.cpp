// Any bytes read as a Nikon comma field book (raw V2.00 or DTM), under settings chosen by the first byte.
// Nothing may crash, and what the reader builds is a GéoBase like any other: written and read back, it
// holds as many elements, each of the same kind.
#include "FuzzRoundTrip.h"
#include "fieldbook/ParamDriver.h"

#include <cstdint>

namespace {

using namespace pyr;

// The settings of "NikAtlas.ini" that change what the reader makes of a record.
void Choose(CParamDriver& driver, std::uint8_t choice) {
    static const char* const references[] = {"aucune", "premiere", "codes"};
    static const char* const angles[] = {"grades", "degres", "dms", "mils"};
    driver.SetText(kKeyReferences, references[choice % 3]);
    driver.SetText(kKeyCodesReference, "REF,99");
    driver.SetText(kKeyUniteAngles, angles[(choice / 3) % 4]);
    driver.SetText(kKeyUniteDistances, choice & 0x40 ? "pieds" : "metres");
    driver.SetText(kKeyOrdreCoordonnees, choice & 0x80 ? "YX" : "XY");
    driver.SetText(kKeyPointsCalcules, choice & 0x20 ? "1" : "0");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    return pyr::fuzz::FuzzFieldBookReader("fuzz_nikon", pyr::FieldBookFormat::NikonAtlas, Choose, data, size);
}
