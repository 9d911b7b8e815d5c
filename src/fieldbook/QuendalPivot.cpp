#include "fieldbook/QuendalPivot.h"

#include "fieldbook/ConfigQdl.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/ParamDriver.h"
#include "fieldbook/QuendalReader.h"
#include "geobase/Carnet.h"
#include "ui/PyrTxtWnd.h"

#include <cstdio>

namespace pyr {

bool CQuendalPivot::Read(const std::string& path, CCarnet& result) {
    Print(fb::kCreating);
    CCarnet records;
    if (!m_importer || !Driver() || !m_importer(*Driver(), path, records, TextWindow(), Parent()))
        return false;

    const std::string temporary = TemporaryBesideCarnet(path);
    if (!CDlgConfigQdl::Export(records, temporary, "w", {}, Parent())) return false;

    CQuendalReader quendal;
    quendal.SetChoices(Choices());
    quendal.SetCodeTable(CodeTable());
    quendal.SetTextWindow(TextWindow());
    quendal.SetParent(Parent());
    quendal.SetAnnounced(false);
    CCarnet geoBase;
    const bool read = quendal.Read(temporary, geoBase);
    std::remove(temporary.c_str());
    if (!read) return false;
    result.Append(std::move(geoBase));
    if (TextWindow()) TextWindow()->Print(fb::kFinished, result.GetSize());
    return true;
}

} // namespace pyr
