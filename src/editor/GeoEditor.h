#pragma once

#include "calc/StationReductionDriver.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/LectCarnet.h"
#include "ui/Dialog.h"

#include <optional>
#include <string>

namespace pyr {

class CCarnet;
class CPyrTxtWnd;

// The GéoBase editor's first face: opens a GéoBase (named as the positional word, with "--geobase", or
// chosen) and shows its elements in the text window, one a line, numbered from 1, with their kind and
// their values. Opening a GéoBase records it as the last one used. Its menu entry "Ré&duction des
// reprises" (here "--reduction") reduces the stations first, and the GéoBase is saved when that changed
// it. Its menu "&Lecture" (here "--lecture FORMAT CARNET") reads a field book into the open GéoBase, which
// is then saved; a GéoBase named that does not exist yet is created by the reading.
class CGeoEditor : public ui::Dialog {
public:
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;

private:
    struct Reading {
        FieldBookFormat format;
        std::string carnet;
    };

    // The reduction of the stations on the open GéoBase: false when the GéoBase could not be saved.
    bool ReduceStations(CCarnet& carnet, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd);
    // The reading of a field book into the open GéoBase (or, when the person wants a new one, into a new
    // GéoBase named after the field book), then saved; its new elements are shown.
    ui::DialogResult ReadFieldBook(CCarnet& carnet, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd);

    bool m_reduce = false;
    CReductionDriver m_reduction; // its options are declared among the editor's
    std::optional<Reading> m_reading;
    ReadingRequests m_readingRequests;
};

// The line of the element at `index`: "000001  Station       S1  1.562  -999999".
std::string EditorLine(const CCarnet& carnet, int index);

} // namespace pyr
