#pragma once

#include "fieldbook/FieldBookUnits.h"
#include "fieldbook/ParamDriver.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>

// What the delimited (CDlgConfigSep) and columnar (CDlgConfigCol) field books share: once a line is cut
// into its fields, the record it holds is recognised by its TYPE field (or, without one, every line is a
// point), its numbers are read in the units of the layout and brought to grads and metres, and it becomes
// one record of the list that the Quendal pivot writes out (QuendalPivot.h). Stations, sightings and
// points are not checked here: the Quendal reader checks them. A line that cannot be used is reported
// with its number and skipped; the reading goes on.
namespace pyr {

class CCarnet;
class CPyrTxtWnd;
namespace ui {
class FrontEnd;
}

// The names of the data, for "Erreur ligne %d : donnée manquante pour %s !".
namespace fb {
inline constexpr const char* kDatumStationName = "le nom de la station";
inline constexpr const char* kDatumPointName = "le matricule du point";
inline constexpr const char* kDatumFieldCode = "le code";
} // namespace fb

// The fields of one line: how a delimited or a columnar layout cuts it.
class CRecordFields {
public:
    virtual ~CRecordFields() = default;
    // Takes the next line; the views handed out stay valid until the next one.
    virtual void Split(std::string_view line) = 0;
    // The text of a field, `index` being its rank in its list, its blanks trimmed; empty when the line
    // stops before it.
    virtual std::string_view Field(const FieldPlace& place, std::size_t index) const = 0;
    // Everything after that field to the end of the line, blanks trimmed: the text of a code or of a
    // comment.
    virtual std::string_view After(const FieldPlace& place, std::size_t index) const = 0;
    // How many fields the line has past the `count` of a list, up to the last one holding something
    // (0 for a columnar line, whose columns past the last field are never read).
    virtual std::size_t Extra(std::size_t count) const = 0;
};

// The units in which a layout writes its numbers.
struct RecordUnits {
    AngleUnit angles = AngleUnit::Grads;
    DistanceUnit distances = DistanceUnit::Metres;
};

// Reads a field book's text (UTF-8) line by line into `records` (appended), reporting in `txt` (a last
// line cut by the transfer too, IsCutLastLine).
void ImportRecords(const RecordLayout& layout, RecordUnits units, std::string_view text,
                   CRecordFields& fields, CCarnet& records, CPyrTxtWnd* txt);

// The same from the parameter set of the format.
void ImportRecords(const CParamDriver& layout, std::string_view text, CRecordFields& fields, CCarnet& records,
                   CPyrTxtWnd* txt);

// Takes the records imported so far and leaves `records` empty: a big field book is handed over by batches
// as it is read, never held whole.
using RecordDrain = std::function<void(CCarnet& records)>;

// Reads the file `carnet` (UTF-8, or Windows-1252 when it is not valid UTF-8) the same way, by chunks.
// With a `drain`, the records are handed to it every few thousand (the rest stays in `records`). False
// when it cannot be read: "Impossible d'ouvrir le fichier carnet !" with the path and the reason is shown
// on `parent` (else the application's front end).
bool ImportRecordFile(const CParamDriver& layout, const std::string& carnet, CRecordFields& fields,
                      CCarnet& records, CPyrTxtWnd* txt, ui::FrontEnd* parent, const RecordDrain& drain = {});

// The import of a layout whose lines `Fields` cuts (made from the layout): CDlgConfigSep, CDlgConfigCol.
template <class Fields>
class CLayoutImport {
public:
    // Reads the field book `carnet` by its layout into `records`: stations, sightings, points, field
    // codes (kind 1009) and comments as the file holds them, unchecked, angles in grads, lengths in
    // metres, values not given left undefined. Lines that cannot be used are reported in `txt` with their
    // number and skipped. False when the file cannot be read (the message shown on `parent`).
    static bool Import(const CParamDriver& layout, const std::string& carnet, CCarnet& records,
                       CPyrTxtWnd* txt, ui::FrontEnd* parent, const RecordDrain& drain = {}) {
        Fields fields(layout.Layout());
        return ImportRecordFile(layout, carnet, fields, records, txt, parent, drain);
    }
    // The same from the text of a field book (UTF-8).
    static void ImportText(const CParamDriver& layout, std::string_view text, CCarnet& records,
                           CPyrTxtWnd* txt) {
        Fields fields(layout.Layout());
        ImportRecords(layout, text, fields, records, txt);
    }
};

} // namespace pyr
