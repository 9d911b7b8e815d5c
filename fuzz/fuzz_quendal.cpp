// Any bytes read as a Quendal-Pc field book, with the codes interpreted by a small table or kept as they
// stand (the first byte chooses). Nothing may crash, and what the reader builds writes and reads back as a
// GéoBase unchanged.
#include "FuzzRoundTrip.h"
#include "fieldbook/QuendalReader.h"
#include "fieldbook/TableCode.h"

#include <cstdint>
#include <string_view>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace pyr;
    if (size == 0) return 0;
    static CTableCode table; // empty: every code is a command word or kept as it stands
    ReadingChoices choices;
    choices.interpret = (data[0] & 1) != 0;
    choices.writeInstrument = (data[0] & 2) != 0;
    choices.instruments = {InstrumentOptions{"Appareil Standard"}};
    choices.instrumentName = "Appareil Standard";
    CQuendalReader reader;
    reader.SetCodeTable(&table);
    fuzz::ReadAndCheckRoundTrip("fuzz_quendal", reader, choices,
                                std::string_view(reinterpret_cast<const char*>(data) + 1, size - 1));
    return 0;
}
