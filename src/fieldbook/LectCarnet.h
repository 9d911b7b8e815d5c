#pragma once

#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/ParamDriver.h"
#include "settings/OptionInstruments.h"
#include "settings/ParamStore.h"
#include "ui/Dialog.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pyr {

class CTableCode;

// What a command line asks of a reading dialog; each value given replaces the dialog's.
struct ReadingRequests {
    std::optional<std::string> carnet;
    std::optional<std::string> geoBase; // the GéoBase to create
    std::optional<std::string> paramFile;
    std::optional<std::string> codeTable;
    std::optional<bool> interpret;
    std::optional<bool> writeInstrument;
    std::optional<std::string> instrument;
    bool editParams = false;
};

// The options of a reading: "CARNET" (the positional word, unless the caller names the field book
// otherwise), "--parametrage", "--interpretation", "--table", "--appareil", "--ecrire-appareil" and
// "--editer-parametres" (the two of the parameter file only for a format that has one, or when the format
// is not known yet). "--geobase", common to every dialog, names the GéoBase to create.
void DeclareReadingOptions(ui::DialogOptions& options, ReadingRequests& requests, bool withParamFile,
                           bool withCarnet = true);

// The reading dialog: the field book, the GéoBase to create (hidden when the elements go into the
// GéoBase open in the editor), the format's parameter file, the code table and its interpretation, the
// field instrument. Its OK checks the choices in their order, each failure naming the field the person is
// sent back to.
class CLectCarnet : public ui::Dialog {
public:
    // The fields a failed check sends the person back to.
    enum class Field { None, Carnet, GeoBase, ParamFile, CodeTable };

    CLectCarnet(FieldBookFormat format, const CParamFile& params, std::string installDir);

    // ---- Set before the dialog opens (steps of a conversion)
    void SetFormatName(std::string name) { m_formatName = std::move(name); }
    const std::string& FormatName() const { return m_formatName; }
    // True when the elements go to a new GéoBase, false when they are merged into the editor's.
    void SetCreateNew(bool createNew) { m_createNew = createNew; }
    bool CreateNew() const { return m_createNew; }
    // The "Carnet" key: the last field book read, which also names the GéoBase to create.
    void SetCarnetFromSettings(std::string path);
    void SetInstruments(std::vector<InstrumentOptions> instruments);
    // The code table of the conversion (checked at OK when the person names another one; null when the
    // editor has none).
    void SetCodeTableObject(const CTableCode* table) { m_table = table; }
    void SetTestHpNulle(bool test) { m_testHpNulle = test; }
    bool TestHpNulle() const { return m_testHpNulle; }

    // ---- The fields
    const std::string& Carnet() const { return m_carnet; }
    void SetCarnet(std::string path) { m_carnet = std::move(path); }
    const std::string& GeoBasePath() const { return m_geoBase; }
    void SetGeoBasePath(std::string path) { m_geoBase = std::move(path); }
    const std::string& ParamFile() const { return m_driver.FileName(); }
    void SetParamFile(std::string path) { m_driver.SetFileName(std::move(path)); }
    const std::string& CodeTablePath() const { return m_codeTable; }
    void SetCodeTablePath(std::string path) { m_codeTable = std::move(path); }
    bool Interpret() const { return m_interpret; }
    void SetInterpret(bool interpret) { m_interpret = interpret; }
    bool WriteInstrument() const { return m_writeInstrument; }
    void SetWriteInstrument(bool write) { m_writeInstrument = write; }
    // The instrument combo: the names of the instruments of the options, in their order; the one chosen
    // is "AppareilTerrain", or the first when none has that name.
    std::vector<std::string> InstrumentNames() const;
    const std::string& InstrumentName() const { return m_instrument; }
    void SetInstrumentName(std::string name) { m_instrument = std::move(name); }
    int InstrumentIndex() const;

    // ---- What the dialog shows
    std::string Caption() const override;
    bool GeoBaseFieldVisible() const { return m_createNew; }
    bool InstrumentEnabled() const { return m_writeInstrument; }
    bool CodeTableEnabled() const { return m_interpret; }
    virtual bool HasParamFile() const { return true; }

    // ---- Actions
    // The browse buttons. A field book chosen names the GéoBase to create again. False when the person
    // cancels the choice.
    bool BrowseCarnet(ui::FrontEnd& frontEnd);
    bool BrowseGeoBase(ui::FrontEnd& frontEnd);
    bool BrowseParamFile(ui::FrontEnd& frontEnd);
    bool BrowseCodeTable(ui::FrontEnd& frontEnd);
    // "Paramètres...": the parameter file shown to be edited, after the question to create it when it
    // does not exist. False when the person does not want it created.
    bool OnEditParams(ui::FrontEnd& frontEnd);
    // What "Paramètres..." does before the settings are edited: the question to create a file that does not
    // exist (false, the focus on the parameter file, when the person does not want it), and the layout of
    // the delimited and columnar formats kept for the loading of points.
    bool PrepareEditParams(ui::FrontEnd& frontEnd);
    // Shift + Ctrl + right click on a field: its file shown, when it exists.
    void ShowFieldFile(ui::FrontEnd& frontEnd, Field field);
    // OK: the checks in their order. Ok when all pass; Cancel when the person answers No to a question;
    // Failed when a file is missing or unreadable (a message said so). FocusField() then names the field.
    ui::DialogResult OnOK(ui::FrontEnd& frontEnd);
    Field FocusField() const { return m_focus; }

    // The values handed to the format's reader once OK passed.
    ReadingChoices Choices() const;
    CParamDriver& Driver() { return m_driver; }
    // The folder under which the installation's Config lies.
    const std::string& InstallDir() const { return m_installDir; }
    const CParamDriver& Driver() const { return m_driver; }
    // The code table resolved at OK: a bare file name is looked for in the installation's Config folder.
    std::string ResolvedCodeTable() const;
    // Whether the person chose to go on without interpretation because the table is missing.
    bool NoCodeTable() const { return m_noCodeTable; }

    // ---- Run from a command line (and the tests)
    void DeclareOptions(ui::DialogOptions& options) override;
    void SetRequests(ReadingRequests requests) { m_requests = std::move(requests); }
    // Applies what the command line asked; "" when accepted, else the French reason.
    std::string Apply(const ReadingRequests& requests);
    // Applies the requests, offers the field book to be confirmed when none was named, shows the
    // parameter file when asked, and presses OK.
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The dialog as a window: LectCarnetForm.h.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    ui::DialogResult Fail(ui::FrontEnd& frontEnd, const std::string& text, Field field);

    FieldBookFormat m_format;
    const CParamFile& m_params;
    std::string m_installDir;
    std::string m_formatName;
    bool m_createNew = true;
    std::string m_carnet;
    std::string m_geoBase;
    std::string m_codeTable;
    bool m_interpret = false;
    bool m_writeInstrument = false;
    bool m_testHpNulle = false;
    std::string m_instrument;
    std::vector<InstrumentOptions> m_instruments;
    CParamDriver m_driver;
    const CTableCode* m_table = nullptr;
    bool m_noCodeTable = false;
    Field m_focus = Field::None;
    ReadingRequests m_requests;
};

// The twin dialog of the Quendal-Pc field books: the same fields, without a parameter file.
class CLecQuendal : public CLectCarnet {
public:
    CLecQuendal(const CParamFile& params, std::string installDir)
        : CLectCarnet(FieldBookFormat::Quendal, params, std::move(installDir)) {}
    bool HasParamFile() const override { return false; }
};

// Whether a code-table path names the installation's default table ("Defaut.cod", whatever the case and
// the folder).
bool IsDefaultCodeTable(std::string_view path);

} // namespace pyr
