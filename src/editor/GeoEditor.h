#pragma once

#include "ui/DialogModel.h"

#include <string>

namespace pyr {

class CCarnet;

// The GéoBase editor's first face: opens a GéoBase and shows its elements in the text window, one a
// line, numbered from 1, with their kind and their values. Opening a GéoBase records it as the last
// one used.
class CGeoEditor : public ui::DialogModel {
public:
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
};

// The line of the element at `index`: "000001  Station       S1  1.562  -999999".
std::string EditorLine(const CCarnet& carnet, int index);

} // namespace pyr
