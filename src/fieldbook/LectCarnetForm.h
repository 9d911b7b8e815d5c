#pragma once

#include "fieldbook/LectCarnet.h"
#include "ui/Form.h"

namespace pyr {

// The window of the reading dialog: the field book, the GéoBase to create (hidden when the elements go
// into the editor's GéoBase), the format's parameter file (none for Quendal-Pc), each with its browse
// button; the code table, usable while its interpretation is ticked; the field instrument, chosen while
// its writing is ticked. "Paramètres..." opens the format's settings in a dialog of their own; OK runs the
// checks in their order and, when one fails, leaves the dialog open with the focus on the field it names.
class CLectCarnetForm : public ui::Form {
public:
    enum Id : int {
        kCarnetLabel = 3,
        kCarnet,
        kBrowseCarnet,
        kGeoBaseLabel,
        kGeoBase,
        kBrowseGeoBase,
        kParamFileLabel,
        kParamFile,
        kBrowseParamFile,
        kInterpret,
        kCodeTableLabel,
        kCodeTable,
        kBrowseCodeTable,
        kWriteInstrument,
        kInstrumentLabel,
        kInstrument,
        kEditParams,
    };

    explicit CLectCarnetForm(CLectCarnet& dialog) : m_dialog(dialog) {}

    ui::DialogModel& Model() override { return m_dialog; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

    // The edit of a field the checks name.
    static int FieldControl(CLectCarnet::Field field);

private:
    void EditParams(ui::FrontEnd& frontEnd);

    CLectCarnet& m_dialog;
};

} // namespace pyr
