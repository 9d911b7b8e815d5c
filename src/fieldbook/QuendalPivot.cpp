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
    if (!m_importer || !Driver()) return false;
    // The records go to the Quendal-Pc file by batches as the book is read: neither the book nor its
    // records are ever held whole beside the GéoBase made of them.
    const std::string temporary = TemporaryBesideCarnet(path);
    PointExportJob job;
    job.path = temporary;
    job.parent = Parent();
    ExportFile pivot(job);
    pivot.Text() = CDlgConfigQdl::Text(CCarnet(), {}, true);
    const auto drain = [&](CCarnet& records) {
        pivot.Text() += CDlgConfigQdl::Text(records, {}, false);
        pivot.Flush();
        records.RemoveAll();
    };
    CCarnet records;
    if (!m_importer(*Driver(), path, records, TextWindow(), Parent(), drain)) return false;
    drain(records);
    if (!pivot.Commit()) return false;

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
