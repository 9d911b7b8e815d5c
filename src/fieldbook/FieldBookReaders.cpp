#include "fieldbook/FieldBookReaders.h"

#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/LectWild.h"
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
    case FieldBookFormat::Quendal:
        return std::make_unique<CQuendalReader>();
    case FieldBookFormat::Wild:
        return std::make_unique<CLectWild>();
    case FieldBookFormat::Separateur:
        return Pivot(DelimitedImporter());
    case FieldBookFormat::Colonne:
        return Pivot(ColumnarImporter());
    default:
        return nullptr;
    }
}

} // namespace pyr
