#pragma once

#include "calc/StationReduction.h"
#include "ui/DialogModel.h"

#include <string>

namespace pyr {

class CCarnet;
class CPyrTxtWnd;

// The GéoBase editor's first face: opens a GéoBase and shows its elements in the text window, one a
// line, numbered from 1, with their kind and their values. Opening a GéoBase records it as the last
// one used. Its menu entry "Ré&duction des reprises" (here "--reduction") reduces the stations first,
// and the GéoBase is saved when that changed it.
class CGeoEditor : public ui::DialogModel {
public:
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;

private:
    // The reduction of the stations on the open GéoBase: false when the GéoBase could not be saved.
    bool ReduceStations(CCarnet& carnet, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd);

    bool m_reduce = false;
    CReduction_Station m_reduction;
};

// The line of the element at `index`: "000001  Station       S1  1.562  -999999".
std::string EditorLine(const CCarnet& carnet, int index);

} // namespace pyr
