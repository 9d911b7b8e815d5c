#pragma once

#include "fieldbook/ConfigSepRecords.h"
#include "fieldbook/FieldBookReader.h"

#include <functional>
#include <string>

namespace pyr {

class CParamDriver;

// Reads a delimited or columnar field book into a list of records, by the layout of its settings file
// (CParamDriver::Layout): the elements it holds, unchecked, their field codes as uninterpreted commands
// (kind 1009). It may hand them to `drain` by batches as it reads; those left in `records` when it returns
// follow them. False when the file cannot be read; the importer says why.
using RecordImporter =
    std::function<bool(const CParamDriver& layout, const std::string& carnet, CCarnet& records,
                       CPyrTxtWnd* txt, ui::FrontEnd* parent, const RecordDrain& drain)>;

// The reading of the delimited and columnar field books, through a Quendal-Pc field book: the records
// imported are written as a Quendal-Pc file beside the field book ("%s%s%s.tmp") as they come, which the
// Quendal reader then reads with the same choices and code table, and which is deleted after use.
class CQuendalPivot : public CFieldBookReader {
public:
    explicit CQuendalPivot(RecordImporter importer) : m_importer(std::move(importer)) {}

    bool Read(const std::string& path, CCarnet& result) override;

protected:
    void ReadLine(std::string_view, int) override {}

private:
    RecordImporter m_importer;
};

} // namespace pyr
