#pragma once

#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookUnits.h"

#include <map>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pyr {

namespace ui {
class FrontEnd;
}

// The section of a format's parameter file that holds its settings.
inline constexpr const char* kSectionParametrage = "Parametrage";

// ---- Keys of the instrument formats ("Wild.ini", "Sokkia.ini" ...): what a field book does not say
inline constexpr const char* kKeyUniteAngles = "UniteAngles";           // grades, degres, dms, mils
inline constexpr const char* kKeyUniteDistances = "UniteDistances";     // metres, pieds
inline constexpr const char* kKeyOrdreCoordonnees = "OrdreCoordonnees"; // XY (est, nord) or YX
inline constexpr const char* kKeyReferences = "References";             // aucune, premiere, codes
inline constexpr const char* kKeyCodesReference = "CodesReference";     // codes of reference sightings
// Wild / Leica GSI only
inline constexpr const char* kKeyConventionStation = "ConventionStation"; // auto, 84, 41
inline constexpr const char* kKeyCodesStation = "CodesStation";           // codes of a 41 block
// Whether the coordinates that the instrument computed for a measured point (words 81, 82, 83 beside the
// observations) are kept as points of the GéoBase: 0 or 1.
inline constexpr const char* kKeyPointsCalcules = "PointsCalcules";

// ---- Keys of the delimited ("*.sep") and columnar ("*.col") layouts
inline constexpr const char* kKeySeparateur = "Separateur"; // the text between fields; TAB, ESPACE
inline constexpr const char* kKeySeparateurDecimal = "SeparateurDecimal"; // "." or ","
inline constexpr const char* kKeyLignesEntete = "LignesEntete";           // lines skipped at the start
inline constexpr const char* kKeyTypeStation = "TypeStation";
inline constexpr const char* kKeyTypeReference = "TypeReference";
inline constexpr const char* kKeyTypeMesure = "TypeMesure";
inline constexpr const char* kKeyTypePoint = "TypePoint";
inline constexpr const char* kKeyTypeCode = "TypeCode";
inline constexpr const char* kKeyTypeCommentaire = "TypeCommentaire";
inline constexpr const char* kKeyChampsStation = "ChampsStation";
inline constexpr const char* kKeyChampsVisee = "ChampsVisee";
inline constexpr const char* kKeyChampsPoint = "ChampsPoint";

enum class CoordinateOrder {
    EastNorth, // X (easting) first, as a GéoBase writes them
    NorthEast  // the northing first: it goes into Y
};

// How a format that does not mark its reference sightings has them told apart.
enum class ReferenceMarking {
    None,  // every sighting is measured
    First, // the first sighting after each station is its reference
    Codes  // the sightings whose code is one of "CodesReference"
};

// Wild / Leica GSI: how a station is written.
enum class StationConvention {
    Auto,       // either way
    Words84,    // a block holding the station's words 84, 85, 86 (87, 88)
    CodeBlock41 // a code block 41 whose code is one of "CodesStation", 42 the station, 43 its height
};

// The fields of a record of a delimited or columnar field book.
enum class RecordField { Type, Matricule, HI, V0, HP, AH, AV, DI, X, Y, Z, Code, Ignore };

struct FieldPlace {
    RecordField field;
    int first = 0; // columnar: the first column (from 1); 0 in a delimited layout
    int last = 0;  // columnar: the last column, 0 for "to the end of the line"
    bool operator==(const FieldPlace&) const = default;
};

// What a delimited or columnar settings file says of its records.
struct RecordLayout {
    bool columnar = false;
    std::string separator = ";"; // between the fields of a delimited line
    char decimal = '.';
    int headerLines = 0;
    // The type words of the records; a record whose type is none of them is reported.
    std::string typeStation, typeReference, typeMesure, typePoint, typeCode, typeComment;
    // The fields of each kind of record, in their order (delimited) or with their columns (columnar). A
    // kind without fields is not read. When no list holds a TYPE field, every line is a point.
    std::vector<FieldPlace> station, sighting, point;
};

// The instrument-transfer parameter set of a format: the reader's own settings that a field book does
// not declare, kept in the section "Parametrage" of the format's parameter file ("Wild.ini",
// "Param_Export.sep" ...). Built from the installation folder, the parameter file and the format; loaded
// from the file, checked, and refused with a French message when a value is not one the reader knows.
class CParamDriver {
public:
    // One key of the section: its default, and the words it may hold (none: any text), or for a count
    // its largest value.
    struct Key {
        const char* name;
        const char* defaultValue;
        std::vector<const char*> words;
        int maximum = -1; // a count from 0 to this, when not negative
    };

    CParamDriver(std::string installDir, std::string paramFile, FieldBookFormat format);

    FieldBookFormat Format() const { return m_format; }
    const std::string& FileName() const { return m_file; }
    void SetFileName(std::string path) { m_file = std::move(path); }
    // The keys of the format, in the order they are written.
    std::span<const Key> Keys() const;

    // Reads the section from the file and checks it; false, the reason shown on the front end, when the
    // file cannot be read or a value is wrong. Absent keys take their defaults.
    bool Load(ui::FrontEnd* parent);
    bool Load(const std::string& path, ui::FrontEnd* parent);
    // The reason why the values held are wrong, or "".
    std::string Validate() const;
    // Writes every key to the file (a new file gets the defaults).
    bool Save() const;
    // The "editor" of the set: the file shown to the person. A file that does not exist yet is made as a
    // copy of the installation's file of the format, or with the defaults when there is none.
    void Edit(ui::FrontEnd& frontEnd);

    // ---- Values (after Load, else the defaults)
    const std::string& Text(std::string_view key) const;
    void SetText(std::string_view key, std::string value);
    AngleUnit Angles() const;
    DistanceUnit Distances() const;
    CoordinateOrder Order() const;
    ReferenceMarking References() const;
    std::vector<std::string> ReferenceCodes() const;
    StationConvention Stations() const;
    std::vector<std::string> StationCodes() const;
    // Delimited and columnar formats only.
    RecordLayout Layout() const;

private:
    std::string m_installDir;
    std::string m_file;
    FieldBookFormat m_format;
    std::map<std::string, std::string, std::less<>> m_values;
};

// What every instrument reader takes from its parameter set; the defaults are those of a reader without
// one.
struct InstrumentSettings {
    AngleUnit angles = AngleUnit::Grads;
    DistanceUnit distances = DistanceUnit::Metres;
    CoordinateOrder order = CoordinateOrder::EastNorth;
    ReferenceMarking marking = ReferenceMarking::None;
    std::vector<std::string> referenceCodes;
    bool keepComputed = false; // "PointsCalcules": the instrument's coordinates of measured points kept

    // Whether the settings make a reference of a sighting that the field book does not mark as one: the
    // first after its station, or one whose code is a reference code.
    bool MarksReference(bool firstSighting, std::string_view code) const;
};

// The settings of `driver`; the defaults, with the coordinates in `order`, when the reader has no
// parameter set.
InstrumentSettings ReadInstrumentSettings(const CParamDriver* driver,
                                          CoordinateOrder order = CoordinateOrder::EastNorth);

// Reads a list of fields, "TYPE,MATRICULE,X,Y,Z,CODE" (delimited) or "TYPE:1-2,MATRICULE:4-15,CODE:17-"
// (columnar); the French reason in `error` when it is wrong.
bool ParseFieldList(std::string_view text, bool columnar, std::vector<FieldPlace>& fields,
                    std::string& error);

// The items of a list separated by commas, blanks trimmed, empty ones dropped.
std::vector<std::string> SplitList(std::string_view text);

} // namespace pyr
