#pragma once

#include "geobase/Carnet.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// The fields of the elements of a GéoBase as the editor shows and edits them: one column each in the
// list view, one line each on a property page. A field is read as text (numbers at the decimals the
// options ask for, an undefined value as an empty text) and written from text, the edit giving a new
// element or the French reason it is refused. The kind names for the views are KindLabel (Kinds.h).
namespace pyr {

// A stable key for each field: column layouts and searches name fields by it (FieldKeyName).
enum class FieldKey {
    Matricule, // the identifier: point, station, traverse or instrument name
    Texte,     // a comment's text
    Commande,  // a command's word
    HI,
    V0,
    HP,
    AH,
    AV,
    DI,
    Lecture,
    Distance,
    X,
    Y,
    Z,
    InvariantXY,
    InvariantZ,
    Stations,
    Ferme,
    CollVerticale,
    ConstPrisme,
    SigmaAh,
    SigmaAv,
    SigmaDi,
    SigmaPpm,
    Code,
    Parametres,
};

enum class FieldType {
    Text,        // any text on one line
    Identifier,  // a point identifier, normalised
    Number,      // a real value, at FieldDecimals
    Flag,        // "Oui" / "Non"
    StationList, // the stations of a traverse: "S1, S2(2), S3"
};

struct FieldInfo {
    FieldKey key;
    std::string_view label; // the column's heading: "Matricule", "HI", "Fermé"...
    FieldType type;
    std::string_view unit; // "m", "gr", "mm/km", or empty
};

// The fields of an element of that kind, in the order of the columns; empty for an unknown kind.
const std::vector<FieldInfo>& KindFields(int kind);
// The field of that key for the kind, or null when the kind has none.
const FieldInfo* FindField(int kind, FieldKey key);

// The key as a word that stays the same from version to version ("x", "ah", "stations"), and back.
std::string_view FieldKeyName(FieldKey key);
std::optional<FieldKey> FieldKeyFromName(std::string_view name);

// How many decimals the numbers of that field are shown with, from the decimals settings of the
// element classes; -1 for a field that is not a number.
int FieldDecimals(int kind, FieldKey key);

// The value of a numeric field of an element of that kind (1 or 0 for a flag); kUndefined when the
// field holds none or the kind has no such field.
double FieldNumber(const CElement& element, int kind, FieldKey key);

// The text of a field of the element at that index: what a cell of the list view shows. Empty for
// an undefined value, a field the kind lacks, or an index outside the GéoBase.
std::string FieldText(const CCarnet& carnet, int index, FieldKey key);

// Reads a number typed by a person: a decimal point or a French decimal comma, blanks between the
// groups of digits ("651 200,25"), an optional sign. False for anything else.
bool ParseTypedNumber(std::string_view text, double& value);

// The outcome of an edit: a new element of the same kind, or the French reason of the refusal.
struct FieldChange {
    std::unique_ptr<CElement> element;
    std::string error;
    explicit operator bool() const { return element != nullptr; }
};

struct FieldEdit {
    FieldKey key;
    std::string text;
};

// A copy of the element at `index` with one field set from its text, or the reason it is refused;
// the GéoBase itself is never changed. An empty text makes an optional number undefined.
FieldChange SetFieldFromText(const CCarnet& carnet, int index, FieldKey key, std::string_view text);
// Several fields set together, as a property page applies them: checked as a whole once every field is
// set, so that X and Y may be emptied together. The first refusal is given.
FieldChange SetFieldsFromText(const CCarnet& carnet, int index, const std::vector<FieldEdit>& edits);

} // namespace pyr
