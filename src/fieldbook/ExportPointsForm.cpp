#include "fieldbook/ExportPointsForm.h"

#include "fieldbook/ExportTexts.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

namespace pyr {

using ui::ControlKind;
using ui::Ctl;

namespace {

constexpr int kPathWidth = 50;

// A file: its label, its edit and its browse button, on a row of the grid.
void AddFile(std::vector<ui::Control>& controls, int label, const char* name, const char* text, int row) {
    controls.push_back(
        Ctl(label, ControlKind::Label, std::string(name) + "Label", text).At(row, 0).Buddy(label + 1));
    controls.push_back(Ctl(label + 1, ControlKind::Edit, name).At(row, 1).Width(kPathWidth));
    controls.push_back(
        Ctl(label + 2, ControlKind::Button, std::string(name) + "Parcourir", "...").At(row, 2));
}

} // namespace

std::vector<ui::Control> CDlgExportPointsForm::Controls() const {
    std::vector<ui::Control> controls;
    AddFile(controls, kSourceLabel, "geobase", exp::kLabelSource, 0);
    controls.push_back(
        Ctl(kFormatLabel, ControlKind::Label, "formatLabel", exp::kLabelFormat).At(1, 0).Buddy(kFormat));
    controls.push_back(Ctl(kFormat, ControlKind::Combo, "format").At(1, 1));
    AddFile(controls, kParamLabel, "parametres", exp::kLabelParamFile, 2);
    AddFile(controls, kOutputLabel, "sortie", exp::kLabelOutput, 3);

    controls.push_back(Ctl(kScopeGroup, ControlKind::Group, "etendue", exp::kGroupPoints).At(4, 0, 1, 3));
    controls.push_back(Ctl(kSelected, ControlKind::Radio, "selectionnes", exp::kOnlySelectedPoints)
                           .In(kScopeGroup)
                           .At(0, 0, 1, 4));
    controls.push_back(Ctl(kAll, ControlKind::Radio, "tous", exp::kAllPoints).In(kScopeGroup).At(1, 0, 1, 4));
    controls.push_back(
        Ctl(kRange, ControlKind::Radio, "plage", exp::kRange).In(kScopeGroup).At(2, 0).Buddy(kFrom));
    controls.push_back(Ctl(kFrom, ControlKind::Edit, "de").In(kScopeGroup).At(2, 1).Width(14));
    controls.push_back(
        Ctl(kToLabel, ControlKind::Label, "aLabel", exp::kRangeTo).In(kScopeGroup).At(2, 2).Buddy(kTo));
    controls.push_back(Ctl(kTo, ControlKind::Edit, "a").In(kScopeGroup).At(2, 3).Width(14));

    controls.push_back(Ctl(kWritePoints, ControlKind::Check, "ecrirePoints", exp::kWritePoints).At(5, 1));
    controls.push_back(Ctl(kWriteCarnet, ControlKind::Check, "ecrireCarnet", exp::kWriteCarnet).At(6, 1));
    controls.push_back(Ctl(kViewFile, ControlKind::Check, "visualiser", exp::kViewFile).At(7, 1));

    controls.push_back(Ctl(ui::kIdOk, ControlKind::Button, "ok", "OK").In(ui::kButtonRow).Default());
    controls.push_back(
        Ctl(ui::kIdCancel, ControlKind::Button, "annuler", "Annuler").In(ui::kButtonRow).At(0, 1));
    return controls;
}

bool CDlgExportPointsForm::Open(ui::FrontEnd&) {
    m_command.OpenDialog();
    return true;
}

ui::ControlState CDlgExportPointsForm::State(int id) const {
    ui::ControlState state;
    switch (id) {
    case kSource:
        state.text = m_dialog.Source();
        [[fallthrough]];
    case kSourceLabel:
    case kBrowseSource:
        state.visible = m_dialog.SourceVisible();
        break;
    case kFormat:
        state.items = CDlgExportPoints::FormatList();
        state.current = m_dialog.Format();
        state.enabled = !m_dialog.FormatImposed();
        break;
    case kParamFile:
        state.text = m_dialog.ParamFile();
        [[fallthrough]];
    case kParamLabel:
    case kBrowseParamFile:
        state.visible = m_dialog.ParamFileVisible();
        break;
    case kOutput:
        state.text = m_dialog.Output();
        break;
    case kScopeGroup:
        state.text = m_dialog.GroupTitle();
        break;
    case kSelected:
        state.text = m_dialog.SelectedText();
        state.checked = m_dialog.ScopeChoice() == CDlgExportPoints::kSelected;
        state.enabled = m_dialog.SelectedEnabled();
        break;
    case kAll:
        state.text = m_dialog.AllText();
        state.checked = m_dialog.ScopeChoice() == CDlgExportPoints::kAll;
        break;
    case kRange:
        state.checked = m_dialog.ScopeChoice() == CDlgExportPoints::kRange;
        break;
    case kFrom:
        state.text = m_dialog.From();
        break;
    case kTo:
        state.text = m_dialog.To();
        break;
    case kWritePoints:
        state.checked = m_dialog.WritePoints();
        state.visible = m_dialog.ElementBoxesVisible();
        break;
    case kWriteCarnet:
        state.checked = m_dialog.WriteCarnet();
        state.visible = m_dialog.ElementBoxesVisible();
        state.enabled = m_dialog.WriteCarnetEnabled();
        break;
    case kViewFile:
        state.checked = m_dialog.ViewFile();
        break;
    default:
        break;
    }
    return state;
}

void CDlgExportPointsForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    const bool typed = event.kind == ui::EventKind::Text;
    switch (id) {
    case kSource:
        if (typed && event.text != m_dialog.Source()) m_dialog.SetSource(event.text);
        break;
    case kBrowseSource:
        m_dialog.BrowseSource(frontEnd);
        break;
    case kFormat:
        if (event.kind == ui::EventKind::Select) m_dialog.SetFormat(event.rank);
        break;
    case kParamFile:
        if (typed) m_dialog.SetParamFile(event.text);
        break;
    case kBrowseParamFile:
        m_dialog.BrowseParamFile(frontEnd);
        break;
    case kOutput:
        if (typed) m_dialog.SetOutput(event.text);
        break;
    case kBrowseOutput:
        m_dialog.BrowseOutput(frontEnd);
        break;
    case kSelected:
    case kAll:
    case kRange:
        if (event.on) m_dialog.SetScope(id - kSelected);
        break;
    case kFrom:
        if (typed) m_dialog.SetFrom(event.text);
        break;
    case kTo:
        if (typed) m_dialog.SetTo(event.text);
        break;
    case kWritePoints:
        m_dialog.SetWritePoints(event.on);
        break;
    case kWriteCarnet:
        m_dialog.SetWriteCarnet(event.on);
        break;
    case kViewFile:
        m_dialog.SetViewFile(event.on);
        break;
    case ui::kIdOk: {
        const ui::DialogResult result = m_dialog.OnOK(frontEnd);
        // Nothing to export, a field to correct or a failed writing: the dialog stays open.
        if (result == ui::DialogResult::Ok) End(ui::DialogResult::Ok);
        break;
    }
    case ui::kIdCancel:
        End(ui::DialogResult::Cancel);
        break;
    default:
        break;
    }
}

std::unique_ptr<ui::Form> CExportCommand::MakeForm() {
    return std::make_unique<CDlgExportPointsForm>(*this);
}

// ---------------------------------------------------------------- the overwrite question

std::vector<ui::Control> CDlgOverWriteForm::Controls() const {
    const std::array<std::string, 3> lines = m_dialog.Lines();
    std::vector<ui::Control> controls;
    for (int i = 0; i < 3; ++i)
        controls.push_back(Ctl(kLine1 + i, ControlKind::Label, "ligne" + std::to_string(i + 1),
                               lines[static_cast<std::size_t>(i)])
                               .At(i, 0));
    controls.push_back(
        Ctl(kReplace, ControlKind::Button, "remplacer", exp::kReplace).In(ui::kButtonRow).Default());
    controls.push_back(
        Ctl(kComplete, ControlKind::Button, "completer", exp::kComplete).In(ui::kButtonRow).At(0, 1));
    controls.push_back(
        Ctl(ui::kIdCancel, ControlKind::Button, "annuler", exp::kCancel).In(ui::kButtonRow).At(0, 2));
    return controls;
}

ui::ControlState CDlgOverWriteForm::State(int id) const {
    ui::ControlState state;
    if (id == kComplete) state.enabled = m_dialog.CompleteAllowed();
    return state;
}

void CDlgOverWriteForm::Act(ui::FrontEnd&, int id, const ui::Event&) {
    if (id == kReplace) {
        m_dialog.Choose(OverwriteChoice::Replace);
        End(ui::DialogResult::Ok);
    } else if (id == kComplete && m_dialog.CompleteAllowed()) {
        m_dialog.Choose(OverwriteChoice::Complete);
        End(ui::DialogResult::Ok);
    } else if (id == ui::kIdCancel) {
        m_dialog.Choose(OverwriteChoice::Cancel);
        End(ui::DialogResult::Cancel);
    }
}

std::unique_ptr<ui::Form> CDlgOverWrite::MakeForm() {
    return std::make_unique<CDlgOverWriteForm>(*this);
}

} // namespace pyr
