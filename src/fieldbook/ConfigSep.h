#pragma once

#include "fieldbook/ConfigSepRecords.h"
#include "fieldbook/PointExport.h"

#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The fields of a line of a delimited field book. Fields are separated by the separator text of the
// layout; a separator of blanks ("ESPACE") takes any run of blanks and tabs, so that columns aligned with
// blanks read as fields. A field may be written in double quotes, as spreadsheets do when a text holds the
// separator: the quotes are dropped and a doubled quote inside stands for one. Blanks around a field, in
// quotes or not, do not count.
class CDelimitedFields : public CRecordFields {
public:
    explicit CDelimitedFields(std::string separator);
    explicit CDelimitedFields(const RecordLayout& layout) : CDelimitedFields(layout.separator) {}

    void Split(std::string_view line) override;
    std::string_view Field(const FieldPlace& place, std::size_t index) const override;
    std::string_view After(const FieldPlace& place, std::size_t index) const override;
    std::size_t Extra(std::size_t count) const override;

    std::size_t Count() const { return m_fields.size(); }

private:
    struct Piece {
        std::string_view text; // unquoted, trimmed
        std::size_t start;     // where the field starts in the line
    };
    // Reads the field from `position`; returns where the next one starts, or npos after the last.
    std::size_t ReadField(std::size_t position);
    std::size_t FindSeparator(std::size_t from) const;

    std::string m_separator;
    bool m_blanks; // the separator is any run of blanks
    std::string_view m_line;
    std::vector<Piece> m_fields;
    std::string m_scratch; // the unquoted texts, reserved to the line's length so that views stay valid
};

// The configuration of delimited field books ("Séparateur", "*.sep"), whose layout the section
// "Parametrage" of the parameter file describes (docs/format-separateur-colonne.md); the same file lays
// out an export of points.
class CDlgConfigSep : public CLayoutImport<CDelimitedFields> {
public:
    // Writes the points of the job as a delimited field book laid out by the settings file job.paramFile,
    // which reads them back (ExportLayout.h). False, nothing written, when the settings file cannot serve or
    // the file cannot be written, the message shown on the job's front end.
    static bool Export(const PointExportJob& job);
};

} // namespace pyr
