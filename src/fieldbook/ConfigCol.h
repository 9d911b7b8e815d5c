#pragma once

#include "fieldbook/ConfigSepRecords.h"
#include "fieldbook/PointExport.h"

#include <string>
#include <string_view>

namespace pyr {

// The fields of a line of a columnar field book: each at its columns, counted in characters from 1 (an
// accented letter is one column, whether the file is UTF-8 or Windows-1252). A line that stops before a
// field leaves it empty; a field "to the end of the line" takes all that follows.
class CColumnarFields : public CRecordFields {
public:
    CColumnarFields() = default;
    explicit CColumnarFields(const RecordLayout&) {} // every field carries its columns
    void Split(std::string_view line) override;
    std::string_view Field(const FieldPlace& place, std::size_t index) const override;
    std::string_view After(const FieldPlace& place, std::size_t index) const override;
    std::size_t Extra(std::size_t) const override { return 0; }

private:
    // Where the character of that rank (from 0) starts in the line; the line's length past its end.
    std::size_t Offset(int column) const;

    std::string_view m_line;
    bool m_ascii = true;
};

// The configuration of columnar field books ("Colonné", "*.col"), whose layout the section "Parametrage"
// of the parameter file describes (docs/format-separateur-colonne.md); the same file lays out an export
// of points.
class CDlgConfigCol : public CLayoutImport<CColumnarFields> {
public:
    // Writes the points of the job as a columnar field book laid out by the settings file job.paramFile,
    // which reads them back (ExportLayout.h). False, nothing written, when the settings file cannot serve or
    // the file cannot be written, the message shown on the job's front end.
    static bool Export(const PointExportJob& job);
};

} // namespace pyr
