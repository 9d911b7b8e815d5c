#pragma once

#include "fieldbook/ConfigSepRecords.h"

#include <string>
#include <string_view>

namespace pyr {

// The fields of a line of a columnar field book: each at its columns, counted in characters from 1 (an
// accented letter is one column, whether the file is UTF-8 or Windows-1252). A line that stops before a
// field leaves it empty; a field "to the end of the line" takes all that follows.
class CColumnarFields : public CRecordFields {
public:
    void Split(std::string_view line) override;
    std::string_view Field(const FieldSpec& spec, std::size_t index) const override;
    std::string_view After(const FieldSpec& spec, std::size_t index) const override;
    std::size_t Extra(std::size_t) const override { return 0; }

private:
    // Where the character of that rank (from 0) starts in the line; the line's length past its end.
    std::size_t Offset(int column) const;

    std::string_view m_line;
    bool m_ascii = true;
};

// The configuration of columnar field books ("Colonné", "*.col"), whose layout the section "Parametrage"
// of the parameter file describes (docs/format-separateur-colonne.md).
class CDlgConfigCol {
public:
    // Reads the field book `carnet` by its layout into `records`, as CDlgConfigSep::Import does for
    // delimited files. False when the file cannot be read (the message shown on `parent`).
    static bool Import(const CParamDriver& layout, const std::string& carnet, CCarnet& records,
                       CPyrTxtWnd* txt, ui::FrontEnd* parent);
    // The same from the text of a field book (UTF-8).
    static void ImportText(const CParamDriver& layout, std::string_view text, CCarnet& records,
                           CPyrTxtWnd* txt);
};

} // namespace pyr
