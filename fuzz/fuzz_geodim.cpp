// Any bytes read as a Trimble GDM (Geodimeter) label file, under settings chosen by the first byte.
// Nothing may crash, and what the reader builds is a GéoBase like any other: written and read back, it
// holds as many elements, each of the same kind.
#include "FuzzRoundTrip.h"
#include "fieldbook/LectGeodim.h"
#include "fieldbook/ParamDriver.h"
#include "geobase/Carnet.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <cstdint>
#include <string_view>

namespace {

using namespace pyr;

// The settings of "Geodim.ini" that change what the reader makes of a block.
void Choose(CParamDriver& driver, std::uint8_t choice) {
    static const char* const references[] = {"aucune", "premiere", "codes"};
    static const char* const angles[] = {"grades", "degres", "dms", "mils"};
    driver.SetText(kKeyReferences, references[choice % 3]);
    driver.SetText(kKeyCodesReference, "REF,99");
    driver.SetText(kKeyUniteAngles, angles[(choice / 3) % 4]);
    driver.SetText(kKeyUniteDistances, choice & 0x40 ? "pieds" : "metres");
    driver.SetText(kKeyPointsCalcules, choice & 0x80 ? "1" : "0");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const std::string_view bytes(reinterpret_cast<const char*>(data) + 1, size - 1);

    ui::ScriptedFrontEnd frontEnd;
    ui::ScopedApplicationFrontEnd scope(frontEnd);
    CPyrTxtWnd txt(frontEnd);
    CParamDriver driver("", "", FieldBookFormat::Geotronics);
    Choose(driver, data[0]);
    ReadingChoices choices;
    CLectGeodim reader;
    reader.SetChoices(choices);
    reader.SetDriver(&driver);
    reader.SetTextWindow(&txt);
    reader.SetParent(&frontEnd);
    CCarnet read;
    reader.ReadText(bytes, read);
    fuzz::CheckRoundTrip("fuzz_geodim", read, txt, frontEnd);
    return 0;
}
