#pragma once

#include "fieldbook/PointExport.h"
#include "geobase/Carnet.h"
#include "settings/ParamStore.h"
#include "ui/Dialog.h"

#include <array>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pyr {

class CPyrTxtWnd;

// The eight formats of an export, in the order of the format list: the list index is the stored number.
enum class ExportFormat { GeoBase, Separateur, Colonne, Quendal, Leica, Gdm, Sokkia, Dxf };
inline constexpr int kExportFormatCount = 8;

struct ExportFormatInfo {
    ExportFormat format;
    const char* listText;  // "Fichier texte avec séparateur"
    const char* extension; // "txt"
    bool suffix;           // the derived name takes "_2" (it would otherwise be the GéoBase itself)
    const char* filter;    // the browse filter
    const char* browseExtension;
    const char* settingsKey;     // the key of its settings file; null for a format without, or without a key
    const char* defaultSettings; // the delivered settings file; null for a format without one
};
const ExportFormatInfo& ExportFormatOf(int number);
// The element formats (GéoBase, Quendal-Pc) carry observations as well as points.
bool IsElementFormat(int number);

// How the person answered that the file to create exists.
enum class OverwriteChoice { Replace, Complete, Cancel };

// The question asked when the file to create exists: its texts and its three buttons, "Compléter"
// never for a DXF drawing (a drawing is not completed, it is replaced or another is chosen).
class CDlgOverWrite : public ui::Dialog {
public:
    explicit CDlgOverWrite(bool completeAllowed) : m_completeAllowed(completeAllowed) {}

    std::string Caption() const override;
    bool CompleteAllowed() const { return m_completeAllowed; }
    // The three lines of text.
    std::array<std::string, 3> Lines() const;
    // At a terminal: the question that stands for the buttons.
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    std::unique_ptr<ui::Form> MakeForm() override;

    void Choose(OverwriteChoice choice) { m_choice = choice; }
    OverwriteChoice Choice() const { return m_choice; }

private:
    bool m_completeAllowed;
    OverwriteChoice m_choice = OverwriteChoice::Cancel;
};

// The export dialog: writes the points, or the points and observations, of a GéoBase (the one in memory
// of its caller, else one it loads) to a file of one of eight formats, with the settings of section
// "ExportationPoints".
class CDlgExportPoints : public ui::DialogModel {
public:
    enum Scope { kSelected = 0, kAll = 1, kRange = 2 };
    // The parts of a change notice.
    static constexpr int kPartFields = 1; // a text field
    static constexpr int kPartLayout = 2; // the format, and what shows or hides with it

    // `carnet`: the caller's GéoBase, or null (the source field is then shown and loaded at OK).
    // `selection`: the editor's references (kObservationReference), or null. `imposedFormat`: the
    // command's format, which "DernierFormat" then does not override. The parameter file and the
    // installation folder are the command's inputs.
    explicit CDlgExportPoints(const CCarnet* carnet = nullptr, const std::vector<int>* selection = nullptr,
                              std::optional<int> imposedFormat = std::nullopt);
    // The caller's GéoBase and selection, when they come after the dialog was made.
    void SetCarnet(const CCarnet* carnet) { m_carnet = carnet; }
    void SetSelection(const std::vector<int>* selection);

    std::string Caption() const override;

    // ---- Opening: the settings read (the command's inputs set), the names derived
    void OnInitDialog();

    // ---- What the dialog shows
    static std::vector<std::string> FormatList();
    int Format() const { return m_format; }
    // The command imposes its format: the list shows it and cannot change it.
    bool FormatImposed() const { return m_imposedFormat.has_value(); }
    bool ElementFormat() const { return IsElementFormat(m_format); }
    bool SourceVisible() const { return m_carnet == nullptr; }
    bool SelectedEnabled() const { return m_selection != nullptr && !m_selection->empty(); }
    std::string GroupTitle() const;
    std::string SelectedText() const;
    std::string AllText() const;
    // The two boxes of the element formats.
    bool ElementBoxesVisible() const { return ElementFormat(); }
    bool WriteCarnetEnabled() const { return m_scope != kRange; }
    // The format has a settings file: the field and its button show.
    bool ParamFileVisible() const;
    bool SelectionHoldsObservations() const { return m_hasObservations; }
    bool SelectionHoldsPoints() const { return m_hasPoints; }

    // ---- The fields
    const std::string& Output() const { return m_output; }
    void SetOutput(std::string path);
    const std::string& Source() const { return m_source; }
    // A source chosen names the file to create again.
    void SetSource(std::string path);
    bool WritePoints() const { return m_writePoints; }
    void SetWritePoints(bool on);
    bool WriteCarnet() const { return m_writeCarnet; }
    void SetWriteCarnet(bool on);
    int ScopeChoice() const { return m_scope; }
    void SetScope(int scope);
    const std::string& From() const { return m_from; }
    // A "from" identifier typed switches the scope to the range.
    void SetFrom(std::string mat);
    const std::string& To() const { return m_to; }
    void SetTo(std::string mat);
    bool ViewFile() const { return m_view; }
    void SetViewFile(bool on);
    // A format chosen names the file to create again, from the source.
    void SetFormat(int number);
    const std::string& ParamFile() const { return m_paramFiles[static_cast<std::size_t>(m_format)]; }
    void SetParamFile(std::string path);

    // The name of the file to create derived from a GéoBase's path for a format: "job.geo" gives
    // "job_2.geo", "job.txt", "job_2.sdr" or "job.dxf" beside it; an empty path gives an empty name.
    static std::string DerivedOutput(const std::string& source, int format);

    // ---- Actions
    bool BrowseOutput(ui::FrontEnd& frontEnd);
    bool BrowseSource(ui::FrontEnd& frontEnd);
    bool BrowseParamFile(ui::FrontEnd& frontEnd);
    // Who answers when the file to create exists: a window shows CDlgOverWrite, a command line answers
    // from its options or asks. Unset, the dialog is run by the front end.
    std::function<OverwriteChoice(ui::FrontEnd&, CDlgOverWrite&)> askOverwrite;
    // OK: Ok when the export was done, Cancel when the person gave it up at the overwrite question;
    // Failed when there is nothing to export, a field is wrong or the writing failed (a message said
    // why): the dialog then stays open.
    ui::DialogResult OnOK(ui::FrontEnd& frontEnd);

    // Whether there is anything to export: the first check of OK.
    bool HasSomethingToExport() const;
    // What OK wrote in an element format: the number of elements.
    int Written() const { return m_written; }

private:
    void ReadSettings();
    bool WriteSettings(ui::FrontEnd& frontEnd) const;
    void DeriveOutput();
    const std::string& SourcePath() const;
    // Whether the job's scope holds an element of the kinds written.
    bool ScopeHoldsSomething(const PointExportJob& job) const;
    // The export proper, once the file mode is settled.
    bool ExportGeoBase(const CCarnet& carnet, const PointExportJob& job, ui::FrontEnd& frontEnd,
                       CPyrTxtWnd& txt);
    bool ExportQuendal(const PointExportJob& job);
    bool ExportPoints(const PointExportJob& job);

    CParamFile Params() const { return CParamFile(Inputs().paramPath); }

    const CCarnet* m_carnet;
    const std::vector<int>* m_selection = nullptr;
    std::optional<int> m_imposedFormat;
    bool m_hasObservations = false;
    bool m_hasPoints = false;

    std::string m_output;
    bool m_writePoints = true;
    bool m_writeCarnet = true;
    int m_scope = kAll;
    std::string m_from;
    std::string m_to;
    std::string m_source;
    bool m_view = false;
    int m_format = 1;
    std::array<std::string, kExportFormatCount> m_paramFiles;
    int m_written = 0;
};

} // namespace pyr
