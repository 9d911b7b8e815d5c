#pragma once

#include "calc/ChangeRepDriver.h"
#include "calc/StationReductionDriver.h"
#include "editor/ElementFields.h"
#include "editor/GeoDocument.h"
#include "editor/GeoSearch.h"
#include "editor/Renumbering.h"
#include "fieldbook/ExportCommand.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/LectCarnet.h"
#include "geobase/Carnet.h"
#include "ui/Dialog.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pyr {

class CPyrTxtWnd;

// The GéoBase editor: the GéoBases open (several at once, one of them current, each a CGeoDocument with
// its selection and its history of edits), the edits of their elements, the search, the renumbering of
// points and the renaming of a station, the duplicate points, and the dialogs its menus open on the
// current GéoBase: the reduction of the stations ("Ré&duction des reprises"), the change of frame
// ("Changement de &repère..."), the reading of a field book ("&Lecture") and "&Exportation de points...".
// The dialogs that compute save the GéoBase at once, as a computation does; the edits are saved when the
// person says so, and closing a modified GéoBase asks.
//
// As a command (GeoEditBatch.cpp), it opens a GéoBase (named as the positional word, with "--geobase", or
// chosen), runs the actions its options ask for, saves it when they changed it, and shows its elements
// in the text window when no action was asked for. As a window (GeoEditorForm.h), its lists, property
// page, drawing and buttons.
class CGeoEditor : public ui::Dialog {
public:
    // The parts of a change notice: the current GéoBase's elements, its selection, its history, its
    // file (the parts of CGeoDocument), and the GéoBases open or which one is current.
    static constexpr int kPartGeoBase = CGeoDocument::kPartElements;
    static constexpr int kPartSelection = CGeoDocument::kPartSelection;
    static constexpr int kPartHistory = CGeoDocument::kPartHistory;
    static constexpr int kPartFile = CGeoDocument::kPartFile;
    static constexpr int kPartDocuments = 16;

    CGeoEditor();
    ~CGeoEditor() override;
    CGeoEditor(const CGeoEditor&) = delete;
    CGeoEditor& operator=(const CGeoEditor&) = delete;

    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    std::unique_ptr<ui::Form> MakeForm() override;

    // ---- The GéoBases open
    // Opens the GéoBase named, else the one the person chooses, as the current one, and records it as
    // the last one used (a GéoBase already open becomes the current one): Ok; Cancel when none was
    // chosen; Failed when it cannot be read (a message said why).
    ui::DialogResult OpenGeoBase(ui::FrontEnd& frontEnd);
    // Another GéoBase, chosen by the person, opened beside the others.
    ui::DialogResult OpenAnother(ui::FrontEnd& frontEnd);
    // Closes the current GéoBase, asking first when it was modified; false when it stays open.
    bool CloseCurrent(ui::FrontEnd& frontEnd);
    // Whether every GéoBase may be closed (each modified one asked about in turn).
    bool CanCloseAll(ui::FrontEnd& frontEnd);
    int DocumentCount() const { return static_cast<int>(m_documents.size()); }
    int CurrentDocument() const { return m_current; }
    const CGeoDocument& DocumentAt(int rank) const { return *m_documents.at(static_cast<std::size_t>(rank)); }
    void SetCurrentDocument(int rank);
    // The current GéoBase (an empty one when none is open).
    CGeoDocument& Document();
    const CGeoDocument& Document() const;
    const CCarnet& Carnet() const { return Document().Carnet(); }
    bool Save(ui::FrontEnd& frontEnd);
    bool SaveAs(ui::FrontEnd& frontEnd);

    // ---- The edits of the current GéoBase, each undoable; refusals said in the person's words
    // A field of the element at `index` set from its text.
    bool SetField(ui::FrontEnd& frontEnd, int index, FieldKey key, std::string_view text);
    // A comment line inserted before `index` (at the end for the element count), and selected.
    bool InsertComment(int index, std::string text);
    // The elements selected removed (a point removed leaves the sightings of it: they are observations).
    bool RemoveSelected();
    // The element selected moved one place up or down, and still selected.
    bool MoveSelected(int by);
    // The element selected turned into a comment, or a comment back into its element.
    bool ToggleSelected(ui::FrontEnd& frontEnd);
    bool Renumber(ui::FrontEnd& frontEnd, const RenumberRequest& request);
    bool RenameStation(ui::FrontEnd& frontEnd, std::string_view oldName, std::string_view newName);
    // The point elements (1006) of the identifiers of a selection ("100-150, A1") removed.
    bool RemovePoints(ui::FrontEnd& frontEnd, const std::string& selection);

    // ---- The search: every element found selected, or the next one; the count found, -1 when the
    // criteria are not correct (a message said why).
    int SearchAll(ui::FrontEnd& frontEnd, const SearchCriteria& criteria);
    int SearchNext(ui::FrontEnd& frontEnd, const SearchCriteria& criteria, bool forward);

    // ---- The dialogs of the menus, on the current GéoBase
    // "Ré&duction des reprises": the reduction's dialog run by the front end, saved when the reduction
    // changed the GéoBase. False when it could not be saved.
    bool ReduceStations(ui::FrontEnd& frontEnd);
    // "Changement de &repère...": the change of frame's dialog run by the front end, saved when it changed
    // the GéoBase; the elements it rewrote are one edit of the history, which the undo takes back.
    // Failed when it was refused or could not be saved.
    ui::DialogResult ChangeFrame(ui::FrontEnd& frontEnd);
    // "&Lecture": a field book of that format read into the current GéoBase through the reading dialog,
    // run by the front end (or, when the person wants a new GéoBase, into one named after the field
    // book, opened beside the others), then saved.
    ui::DialogResult ReadFieldBook(ui::FrontEnd& frontEnd, FieldBookFormat format);
    // "&Exportation de points...": the export dialog, run by the front end on the current GéoBase.
    ui::DialogResult ExportPoints(ui::FrontEnd& frontEnd);
    // The change of projection: every point with a planimetry converted from the projection of the job
    // ("Projection" of the options' corrections, or `from` when given) into `to`, all or none, then
    // saved; one edit of the history. False when refused (said why) or not saved.
    bool ChangeProjection(ui::FrontEnd& frontEnd, const std::string& to, std::string from = {});
    // The projection the job's options give.
    std::string JobProjection() const;
    // The duplicate points of the current GéoBase within the tolerance of the options
    // ("TolerancePointDouble"): said in the text window, their points selected, the later point of each
    // couple given the code of the options ("CodePointDouble") as one edit, and their listing ("*.ptd")
    // offered as the listings' options say, or written to `listing` when it is named. The number of
    // couples; -1 when the tolerance of the options is not one (said why).
    int FindDuplicates(ui::FrontEnd& frontEnd, bool askListing, const std::string& listing = {});

private:
    struct Reading {
        FieldBookFormat format;
        std::optional<std::string> carnet; // named on a command line; else chosen in the reading dialog
    };
    // The edits a command line asks for.
    struct BatchEdits {
        std::vector<std::pair<std::string, std::string>> renames;
        bool renumber = false;
        RenumberRequest renumbering;
        std::optional<std::string> remove;
        std::optional<SearchCriteria> search;
        SearchCriteria criteria;               // --code, --genre, --valeur: given before or after --chercher
        std::optional<std::string> projection; // --changement-projection, and its --projection-depart
        std::optional<std::string> duplicates; // --points-doubles [LISTING]
        std::string projectionFrom;

        bool Edits() const { return !renames.empty() || renumber || remove || duplicates; }
    };

    // The GéoBase named, else the one the person chooses; nothing when none is.
    std::optional<std::string> ChosenGeoBase(ui::FrontEnd& frontEnd) const;
    // Opens that GéoBase as the current one (read again when it is open) and records it as the last one
    // used, unless it is no GéoBase.
    bool Load(const std::string& path, ui::FrontEnd& frontEnd);
    // A new document, current, listened to.
    CGeoDocument& Adopt(std::unique_ptr<CGeoDocument> document);
    // Saves the current GéoBase after a dialog changed it, the former file backed up.
    bool SaveAfterDialog(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd);
    // The reduction of the stations on the current GéoBase: false when it could not be saved. A command
    // line runs the reduction as its options say; a window shows its dialog.
    bool ReduceStations(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow);
    // The change of frame on the current GéoBase: a command line runs it as its options say; a window
    // shows its dialog.
    ui::DialogResult ChangeFrame(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow);
    // The reading of a field book into the current GéoBase (or, when the person wants a new one, into a
    // new GéoBase named after the field book), then saved; its new elements are shown. A command line
    // gives the reading dialog its options; a window shows it.
    ui::DialogResult ReadFieldBook(const Reading& reading, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd,
                                   bool asWindow);
    // The export of the current GéoBase: a command line runs it as its options say; a window shows it.
    ui::DialogResult ExportPoints(ui::FrontEnd& frontEnd, bool asWindow);
    // The edits of a command line on the current GéoBase, saved when they changed it.
    ui::DialogResult RunBatchEdits(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd);

    std::vector<std::unique_ptr<CGeoDocument>> m_documents;
    std::vector<int> m_listeners; // one for each document
    int m_current = -1;
    CGeoDocument m_none; // the current one when no GéoBase is open
    bool m_reduce = false;
    CReductionDriver m_reduction; // its options are declared among the editor's
    bool m_changeFrame = false;
    CChangeRepDriver m_frameChange; // its options too
    std::optional<Reading> m_reading;
    ReadingRequests m_readingRequests;
    bool m_export = false;
    ExportRequests m_exportRequests;
    CExportCommand m_exporter{std::nullopt};
    BatchEdits m_batch;
};

// The line of the element at `index`: "000001  Station       S1  1.562  -999999".
std::string EditorLine(const CCarnet& carnet, int index);
// The same as a row of a table, its number, kind and values separated by tabs.
std::string EditorRow(const CCarnet& carnet, int index);

} // namespace pyr
