#include "fieldbook/FieldBookReaders.h"

#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/LectGeodim.h"
#include "fieldbook/LectNikon.h"
#include "fieldbook/LectSokkia.h"
#include "fieldbook/LectTopcon.h"
#include "fieldbook/LectWild.h"
#include "fieldbook/LectZeiss.h"
#include "fieldbook/QuendalPivot.h"
#include "fieldbook/QuendalReader.h"

namespace pyr {

namespace {

// The importers of the delimited and columnar layouts.
RecordImporter DelimitedImporter() {
    return &CDlgConfigSep::Import;
}
RecordImporter ColumnarImporter() {
    return &CDlgConfigCol::Import;
}

std::unique_ptr<CFieldBookReader> Pivot(RecordImporter importer) {
    if (!importer) return nullptr;
    return std::make_unique<CQuendalPivot>(std::move(importer));
}

} // namespace

std::unique_ptr<CFieldBookReader> MakeFieldBookReader(FieldBookFormat format) {
    switch (format) {
    case FieldBookFormat::Geotronics:
        return MakeGeodimReader();
    case FieldBookFormat::NikonAtlas:
    case FieldBookFormat::NikonKheops:
    case FieldBookFormat::NikonPsion:
        return MakeNikonReader();
    case FieldBookFormat::Sokkia:
        return MakeSokkiaReader();
    case FieldBookFormat::TopconGT7:
        return MakeTopconReader();
    case FieldBookFormat::Zeiss:
        return MakeZeissReader();
    case FieldBookFormat::Quendal:
        return std::make_unique<CQuendalReader>();
    case FieldBookFormat::Wild:
        return std::make_unique<CLectWild>();
    case FieldBookFormat::Separateur:
        return Pivot(DelimitedImporter());
    case FieldBookFormat::Colonne:
        return Pivot(ColumnarImporter());
    }
    return nullptr;
}

} // namespace pyr
