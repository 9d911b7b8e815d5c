#include "editor/GeoEditorForm.h"

#include "core/Strings.h"
#include "fieldbook/FieldBookFormats.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

namespace pyr {

namespace {

using ui::ControlKind;

// A menu entry as a line of a list: "Carnet &Wild, Leica" gives "Carnet Wild, Leica".
std::string WithoutAccelerator(std::string_view entry) {
    std::string line;
    for (char c : entry)
        if (c != '&') line += c;
    return line;
}

} // namespace

std::vector<ui::Control> CGeoEditorForm::Controls() const {
    std::vector<ui::Control> controls;
    ui::Control label = ui::Ctl(kGeoBaseLabel, ControlKind::Label, "geobaseLabel", "GéoBase :");
    label.buddy = kGeoBase;
    controls.push_back(label);
    ui::Control field = ui::Ctl(kGeoBase, ControlKind::Field, "geobase").At(0, 1, 1, 3);
    field.width = 60;
    controls.push_back(field);
    label = ui::Ctl(kElementsLabel, ControlKind::Label, "elementsLabel", "&Éléments :").At(1, 0, 1, 4);
    label.buddy = kElements;
    controls.push_back(label);
    ui::Control list = ui::Ctl(kElements, ControlKind::List, "elements").At(2, 0, 1, 4);
    list.columns = {"N°", "Élément", "Valeurs"};
    list.width = 100;
    list.lines = 20;
    controls.push_back(list);
    controls.push_back(
        ui::Ctl(kReduce, ControlKind::Button, "reduction", "Ré&duction des reprises").At(3, 0));
    controls.push_back(
        ui::Ctl(kChangeFrame, ControlKind::Button, "repere", "Changement de &repère...").At(4, 0));
    controls.push_back(
        ui::Ctl(kExport, ControlKind::Button, "exportation", "&Exportation de points...").At(4, 1));
    label = ui::Ctl(kFormatLabel, ControlKind::Label, "formatLabel", "F&ormat du carnet :").At(3, 1);
    label.buddy = kFormat;
    controls.push_back(label);
    controls.push_back(ui::Ctl(kFormat, ControlKind::Combo, "format").At(3, 2));
    controls.push_back(ui::Ctl(kRead, ControlKind::Button, "lecture", "&Lecture").At(3, 3));
    controls.push_back(ui::Ctl(kStatus, ControlKind::Status, "etat").At(5, 0, 1, 4));
    ui::Control close = ui::Ctl(ui::kIdCancel, ControlKind::Button, "fermer", "&Fermer");
    close.parent = ui::kButtonRow;
    controls.push_back(close);
    return controls;
}

bool CGeoEditorForm::Open(ui::FrontEnd& frontEnd) {
    const ui::DialogResult opened = m_editor.OpenGeoBase(frontEnd);
    if (opened != ui::DialogResult::Ok) {
        End(opened);
        return false;
    }
    Refresh(true);
    return true;
}

void CGeoEditorForm::Refresh(bool whole) {
    const CCarnet& carnet = m_editor.Carnet();
    if (whole || carnet.PathName() != m_path || carnet.GetSize() < static_cast<int>(m_lines.size())) {
        m_lines.clear();
        m_path = carnet.PathName();
    }
    m_lines.reserve(static_cast<std::size_t>(carnet.GetSize()));
    for (int i = static_cast<int>(m_lines.size()); i < carnet.GetSize(); ++i)
        m_lines.push_back(EditorRow(carnet, i));
}

ui::ControlState CGeoEditorForm::State(int id) const {
    ui::ControlState state;
    switch (id) {
    case kGeoBase:
        state.text = m_editor.Carnet().PathName();
        break;
    case kElements:
        state.items = m_lines;
        break;
    case kFormat:
        for (const auto& info : FieldBookFormats())
            state.items.push_back(WithoutAccelerator(info.menuEntry));
        state.current = m_format;
        break;
    case kStatus:
        state.text = Sprintf("%d élément(s)", m_editor.Carnet().GetSize());
        break;
    default:
        break;
    }
    return state;
}

void CGeoEditorForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    switch (id) {
    case kFormat:
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(FieldBookFormats().size()))
            m_format = event.rank;
        break;
    case kReduce:
        m_editor.ReduceStations(frontEnd);
        Refresh(true); // the reduction changes the values of the elements in place
        break;
    case kChangeFrame:
        m_editor.ChangeFrame(frontEnd);
        Refresh(true); // the points are rewritten in place
        break;
    case kExport:
        m_editor.ExportPoints(frontEnd); // the GéoBase stays as it is
        break;
    case kRead:
        m_editor.ReadFieldBook(frontEnd, FieldBookFormats()[static_cast<std::size_t>(m_format)].format);
        Refresh(false);
        break;
    case ui::kIdCancel:
        End(ui::DialogResult::Ok); // every action saved the GéoBase as it went
        break;
    default:
        break;
    }
}

std::unique_ptr<ui::Form> CGeoEditor::MakeForm() {
    return std::make_unique<CGeoEditorForm>(*this);
}

} // namespace pyr
