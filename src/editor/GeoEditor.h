#pragma once

#include "calc/ChangeRepDriver.h"
#include "calc/StationReductionDriver.h"
#include "fieldbook/ExportCommand.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/LectCarnet.h"
#include "geobase/Carnet.h"
#include "ui/Dialog.h"

#include <memory>
#include <optional>
#include <string>

namespace pyr {

class CPyrTxtWnd;

// The GéoBase editor's first face: opens a GéoBase (named as the positional word, with "--geobase", or
// chosen) and shows its elements in the text window, one a line, numbered from 1, with their kind and
// their values. Opening a GéoBase records it as the last one used. Its menu entry "Ré&duction des
// reprises" (here "--reduction") reduces the stations first, and the GéoBase is saved when that changed
// it. Its button "Changement de &repère..." (here "--changement-repere" with "--repere1" and "--repere2")
// moves the points into another frame, and the GéoBase is saved when that changed it. Its menu "&Lecture"
// (here "--lecture FORMAT CARNET") reads a field book into the open GéoBase, which is then saved; a GéoBase
// named that does not exist yet is created by the reading. Its entry "&Exportation de points..." (here
// "--exportation" with the options of the exports, the selection being the editor's "--selection") writes
// the open GéoBase, or the elements selected, to a file. As a window (GeoEditorForm.h), the same actions
// are buttons on the GéoBase open, whose elements are listed.
class CGeoEditor : public ui::Dialog {
public:
    // The part of a change notice: the GéoBase open, or its elements, changed.
    static constexpr int kPartGeoBase = 1;

    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    std::unique_ptr<ui::Form> MakeForm() override;

    // ---- The actions of the window
    // Opens the GéoBase named, else the one the person chooses, and records it as the last one used:
    // Ok; Cancel when none was chosen; Failed when it cannot be read (a message said why).
    ui::DialogResult OpenGeoBase(ui::FrontEnd& frontEnd);
    const CCarnet& Carnet() const { return m_carnet; }
    // "Ré&duction des reprises": the reduction's dialog run by the front end on the open GéoBase, saved
    // when the reduction changed it. False when it could not be saved.
    bool ReduceStations(ui::FrontEnd& frontEnd);
    // "Changement de &repère...": the change of frame's dialog run by the front end on the open GéoBase,
    // saved when it changed it. Failed when it was refused or could not be saved.
    ui::DialogResult ChangeFrame(ui::FrontEnd& frontEnd);
    // The elements the changes of frame rewrote, oldest first, each with a copy of its state that the
    // GéoBase does not hold (ElementChange): what the editor's undo takes back, one exchange each.
    const ElementChanges& TrackedChanges() const { return m_tracked; }
    // "&Lecture": a field book of that format read into the open GéoBase through the reading dialog, run
    // by the front end (or, when the person wants a new GéoBase, into one named after the field book),
    // then saved.
    ui::DialogResult ReadFieldBook(ui::FrontEnd& frontEnd, FieldBookFormat format);
    // "&Exportation de points...": the export dialog, run by the front end on the open GéoBase.
    ui::DialogResult ExportPoints(ui::FrontEnd& frontEnd);

private:
    struct Reading {
        FieldBookFormat format;
        std::optional<std::string> carnet; // named on a command line; else chosen in the reading dialog
    };

    // The GéoBase named, else the one the person chooses; nothing when none is.
    std::optional<std::string> ChosenGeoBase(ui::FrontEnd& frontEnd) const;
    // Opens that GéoBase and records it as the last one used, unless it is no GéoBase.
    bool Load(const std::string& path, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd);
    // The reduction of the stations on the open GéoBase: false when the GéoBase could not be saved. A
    // command line runs the reduction as its options say; a window shows its dialog.
    bool ReduceStations(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow);
    // The change of frame on the open GéoBase: a command line runs it as its options say; a window shows
    // its dialog.
    ui::DialogResult ChangeFrame(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow);
    // The reading of a field book into the open GéoBase (or, when the person wants a new one, into a new
    // GéoBase named after the field book), then saved; its new elements are shown. A command line gives
    // the reading dialog its options; a window shows it.
    ui::DialogResult ReadFieldBook(const Reading& reading, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd,
                                   bool asWindow);
    // The export of the open GéoBase: a command line runs it as its options say; a window shows it.
    ui::DialogResult ExportPoints(ui::FrontEnd& frontEnd, bool asWindow);

    CCarnet m_carnet; // the GéoBase open
    bool m_reduce = false;
    CReductionDriver m_reduction; // its options are declared among the editor's
    bool m_changeFrame = false;
    CChangeRepDriver m_frameChange;          // its options too
    ElementChanges m_tracked{LargeBlocks()}; // on the GéoBase open: forgotten when another one is opened
    std::optional<Reading> m_reading;
    ReadingRequests m_readingRequests;
    bool m_export = false;
    ExportRequests m_exportRequests;
    CExportCommand m_exporter{std::nullopt};
};

// The line of the element at `index`: "000001  Station       S1  1.562  -999999".
std::string EditorLine(const CCarnet& carnet, int index);
// The same as a row of a table, its number, kind and values separated by tabs.
std::string EditorRow(const CCarnet& carnet, int index);

} // namespace pyr
