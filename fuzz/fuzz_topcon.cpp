// Any bytes read as a field book of this format. Nothing may crash, and what the reader builds is a
// GéoBase like any other: written and read back, it holds as many elements, each of the same kind.
#include "FuzzRoundTrip.h"
#include "fieldbook/FieldBookReaders.h"
#include "fieldbook/ParamDriver.h"
#include "geobase/Carnet.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <cstdint>
#include <string_view>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace pyr;
    auto reader = MakeFieldBookReader(FieldBookFormat::TopconGT7);
    if (!reader) return 0;
    ui::ScriptedFrontEnd frontEnd;
    ui::ScopedApplicationFrontEnd scope(frontEnd);
    CPyrTxtWnd txt(frontEnd);
    CParamDriver driver("", "", FieldBookFormat::TopconGT7);
    ReadingChoices choices;
    reader->SetChoices(choices);
    reader->SetDriver(&driver);
    reader->SetTextWindow(&txt);
    reader->SetParent(&frontEnd);
    CCarnet read;
    reader->ReadText(std::string_view(reinterpret_cast<const char*>(data), size), read);
    fuzz::CheckRoundTrip("fuzz_topcon", read, txt, frontEnd);
    return 0;
}
