#pragma once

#include "core/Undefined.h"
#include "settings/OptionInstruments.h"

#include <chrono>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

// The skeleton that every field-book reader shares. A reader of a format derives from CFieldBookReader
// and gives ReadLine (and, when it needs them, BeginReading and EndReading); the skeleton opens the file,
// announces the creation, writes the instrument first when asked, numbers the lines, shows the progress of
// a long conversion, and counts what was written. The reader builds its elements through the Add...
// operations below, which check them with the store's validation and normalise their identifiers, and it
// reports the lines it cannot use with the Line... operations, which never stop a conversion.
//
//     class CLecMyFormat : public CFieldBookReader { // fixed lines "ST <name 16> <hi 8>" ...
//         double m_hi = kUndefined;                   // a pending value
//         void BeginReading() override { m_hi = kUndefined; }
//         void ReadLine(std::string_view line, int number) override {
//             CheckLength(number, line, 28);          // reported, and the line is read all the same
//             if (!line.starts_with("ST")) return LineUnrecognised(number);
//             if (!ParseDouble(line.substr(19), m_hi)) return LineMissing(number, "la hauteur");
//             AddStation(std::string(Trimmed(line.substr(3, 16))), m_hi);
//         }
//     };
//
// A reader is made for its format in FieldBookReaders.cpp. Its settings come from Driver() (the format's
// parameter file, ParamDriver.h); its angles and lengths are brought to grads and metres with
// core/AngleUnits.h and FieldBookUnits.h.
namespace pyr {

class CAppareil;
class CElement;
class CCarnet;
class CMesure;
class CParamDriver;
class CPointGen;
class CPyrTxtWnd;
class CReference;
class CStation;
class CTableCode;
namespace ui {
class FrontEnd;
}

// What the reading dialog hands a reader.
struct ReadingChoices {
    std::string carnet;                         // the field book, as the person named it
    bool interpret = false;                     // codes interpreted through the code table
    bool writeInstrument = false;               // an instrument element at the head of the result
    std::string instrumentName;                 // the configuration of the field instrument
    std::vector<InstrumentOptions> instruments; // the instruments of the options
};

// The width to which the labels of header comments are padded before " = ".
inline constexpr int kHeaderLabelWidth = 20;

class CFieldBookReader {
public:
    CFieldBookReader();
    virtual ~CFieldBookReader();
    CFieldBookReader(const CFieldBookReader&) = delete;
    CFieldBookReader& operator=(const CFieldBookReader&) = delete;

    // ---- Set up by the conversion before reading
    void SetChoices(const ReadingChoices& choices) { m_choices = &choices; }
    // The code table (may be null: the codes are then kept as they stand).
    void SetCodeTable(const CTableCode* table) { m_table = table; }
    // The format's parameter set (null for a format without one).
    void SetDriver(const CParamDriver* driver) { m_driver = driver; }
    // Where the lines go (null: nothing is printed) and who shows the message boxes (null: the
    // application's front end).
    void SetTextWindow(CPyrTxtWnd* txt) { m_txt = txt; }
    void SetParent(ui::FrontEnd* parent) { m_parent = parent; }
    // Whether "Création de la GéoBase en cours ..." and the count of lines written are printed: not
    // when the reader serves another one (the Quendal reader behind the delimited formats).
    void SetAnnounced(bool announced) { m_announced = announced; }

    // Reads the field book at `path` into `result` (appended to what it holds). False when the file
    // cannot be opened: the message is shown and nothing is added.
    virtual bool Read(const std::string& path, CCarnet& result);
    // Reads a field book already in memory (UTF-8 or Windows-1252 bytes): the same steps but the opening.
    void ReadText(std::string_view bytes, CCarnet& result);

protected:
    // ---- What a format gives
    // The message when the file cannot be opened, the system error `code` telling why.
    virtual std::string OpenFailure(const std::string& path, int code) const;
    // Before the first line: every pending value back to kUndefined, the pending texts emptied.
    virtual void BeginReading() {}
    // One line, without its end, numbered from 1. A cut last line (IsCutLastLine) has been
    // reported before it is given.
    virtual void ReadLine(std::string_view line, int number) = 0;
    // After the last line: what is still pending is written.
    virtual void EndReading() {}

    // ---- Reports in the text window; a line reported is skipped, the reading goes on
    // A fixed-width line of another length: "Attention : ligne %d de longueur incorrecte (%d / %d) !".
    // True when the length is the expected one.
    bool CheckLength(int number, std::string_view line, int expected);
    // "Erreur ligne %d : donnée non reconnue !"
    void LineUnrecognised(int number);
    // "Erreur ligne %d : donnée manquante pour %s !" with the datum's name.
    void LineMissing(int number, std::string_view datum);
    // Any other sentence of a line, a format with one %d for the line number ("Erreur ligne %d : pas de
    // station pour cette hauteur d'instrument !").
    void LineError(const char* format, int number);
    // The sightings of a field book that does not say where the instrument stands, from this line on, go
    // to the station fb::kUnknownStation: the surveyor is told to rename it.
    void LineUnknownStation(int number);
    void Print(std::string_view text);

    // ---- Elements. Each normalises the identifier, rounds angles to 0.01 µgr and lengths to the
    // micrometre (the noise of unit conversions gone, every recorded digit kept), checks the element
    // through the store (which says in the text window why it refuses one) and appends it; the element
    // kept, or null.
    CStation* AddStation(std::string name, double hi = 0.0, double v0 = kUndefined, std::string code = {});
    CReference* AddReference(std::string point, double hp, double ah, double av, double di,
                             std::string code = {});
    CMesure* AddMesure(std::string point, double hp, double ah, double av, double di, std::string code = {});
    CPointGen* AddPoint(std::string name, double x, double y, double z, std::string code = {});
    // Header information (file name, version, dates, units, serial number ...): a comment
    // "label<blanks> = value".
    void AddHeaderComment(std::string_view label, std::string_view value);
    // A comment line as it stands.
    void AddComment(std::string text);
    // A field code: with interpretation on, split into its words and interpreted through the code table;
    // the command it stands for is appended with its kind. Otherwise, or when the table knows no such
    // code, the text is kept as it stands as an uninterpreted command (1009). An empty code adds nothing.
    // The command carries the point it was written for, when given. Returns the command added, or null.
    CElement* AddCode(std::string_view code, std::string_view point = {});
    // Splits a field holding a point's name followed by its code at the code position of the table's
    // separator; without a table the whole field is the name.
    void SplitNameAndCode(std::string_view field, std::string& name, std::string& code) const;

    // ---- What the reader may consult
    CCarnet& Result() { return *m_result; }
    const ReadingChoices& Choices() const;
    const CTableCode* CodeTable() const { return m_table; }
    const CParamDriver* Driver() const { return m_driver; }
    CPyrTxtWnd* TextWindow() const { return m_txt; }
    ui::FrontEnd* Parent() const { return m_parent; }
    // The field book being read ("" for text given in memory).
    const std::string& Path() const { return m_path; }

private:
    // The steps of a reading: before the first line, each line (`cut` when it is a last line that the
    // transfer seems to have cut; `offset` where it ends in the book of `size` bytes), after the last.
    void Start(CCarnet& result);
    void ReadOne(std::string_view line, int number, bool cut, std::uint64_t offset, std::uint64_t size);
    void Finish(CCarnet& result);
    void AddInstrument();
    void ShowProgress(int number, std::uint64_t offset, std::uint64_t size);

    const ReadingChoices* m_choices = nullptr;
    const CTableCode* m_table = nullptr;
    std::vector<std::string> m_words; // the words of the last code, kept for the next one
    const CParamDriver* m_driver = nullptr;
    CPyrTxtWnd* m_txt = nullptr;
    ui::FrontEnd* m_parent = nullptr;
    CCarnet* m_result = nullptr;
    std::string m_path;
    bool m_announced = true;
    std::chrono::steady_clock::time_point m_start;
    std::chrono::steady_clock::time_point m_lastProgress;
};

// Whether `line`, a line of `text` as ForEachLine gives it, is the last one and ends the text without a
// line end while it holds more than blanks and transmission controls. Such a line was most often cut by
// the transfer (a cable pulled, a download stopped): it is read all the same, and the surveyor is told to
// check it. A last line of only a Ctrl-Z or an EOT is the normal end of a transfer.
bool IsCutLastLine(std::string_view text, std::string_view line);

// The message of a field book that cannot be opened: the text of the format, the path and the reason in
// words of the system error `code`.
std::string CarnetOpenFailure(const std::string& path, int code);

// The instrument element of a configuration of the options: its name and constants.
std::unique_ptr<CAppareil> MakeInstrument(const InstrumentOptions& instrument);

} // namespace pyr
