#pragma once

#include "fieldbook/ConfigSepRecords.h"

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

    void Split(std::string_view line) override;
    std::string_view Field(const FieldSpec& spec, std::size_t index) const override;
    std::string_view After(const FieldSpec& spec, std::size_t index) const override;
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
// "Parametrage" of the parameter file describes (docs/format-separateur-colonne.md).
class CDlgConfigSep {
public:
    // Reads the field book `carnet` by its layout into `records`: stations, sightings, points, field
    // codes (kind 1009) and comments as the file holds them, unchecked, angles in grads, lengths in
    // metres, values not given left undefined. Lines that cannot be used are reported in `txt` with their
    // number and skipped. False when the file cannot be read (the message shown on `parent`).
    static bool Import(const CParamDriver& layout, const std::string& carnet, CCarnet& records,
                       CPyrTxtWnd* txt, ui::FrontEnd* parent);
    // The same from the text of a field book (UTF-8).
    static void ImportText(const CParamDriver& layout, std::string_view text, CCarnet& records,
                           CPyrTxtWnd* txt);
};

} // namespace pyr
