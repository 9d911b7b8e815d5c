#pragma once

#include "editor/GeoEditor.h"
#include "ui/Form.h"

#include <string>
#include <vector>

namespace pyr {

// The window of the GéoBase editor's first face: the GéoBase open, its elements one a line in a table, and
// the editor's actions as buttons: the reduction of the stations, the change of frame, the export of points,
// the reading of a field book of the format chosen, and "Fermer". Opening it opens the GéoBase (the one
// named, else the one chosen).
class CGeoEditorForm : public ui::Form {
public:
    enum Id : int {
        kGeoBaseLabel = 3,
        kGeoBase,
        kElementsLabel,
        kElements,
        kReduce,
        kFormatLabel,
        kFormat,
        kRead,
        kStatus,
        kChangeFrame,
        kExport,
    };

    explicit CGeoEditorForm(CGeoEditor& editor) : m_editor(editor) {}

    ui::DialogModel& Model() override { return m_editor; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    // The lines of the elements, made again only for what changed: the new elements at the end after a
    // reading into the same GéoBase, all of them after a reduction or another GéoBase.
    void Refresh(bool whole);

    CGeoEditor& m_editor;
    std::vector<std::string> m_lines;
    std::string m_path; // the GéoBase whose lines are held
    int m_format = 0;   // the format of the next reading, in the order of the reading menu
};

} // namespace pyr
