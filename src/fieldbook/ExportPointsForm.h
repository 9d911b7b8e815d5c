#pragma once

#include "fieldbook/ExportCommand.h"
#include "fieldbook/ExportPoints.h"
#include "ui/Form.h"

namespace pyr {

// The window of the export: the GéoBase to export (hidden when the caller's GéoBase is exported), the
// format and its settings file, the file to create, each with its browse button; the scope group, whose
// wording follows the format, with the identifier range; the two boxes of the element formats; the
// viewing of the file. OK exports and closes; when there is nothing to export, a field is wrong or the
// writing failed, the dialog stays open.
class CDlgExportPointsForm : public ui::Form {
public:
    enum Id : int {
        kSourceLabel = 3,
        kSource,
        kBrowseSource,
        kFormatLabel,
        kFormat,
        kParamLabel,
        kParamFile,
        kBrowseParamFile,
        kOutputLabel,
        kOutput,
        kBrowseOutput,
        kScopeGroup,
        kSelected,
        kAll,
        kRange,
        kFrom,
        kToLabel,
        kTo,
        kWritePoints,
        kWriteCarnet,
        kViewFile,
    };

    explicit CDlgExportPointsForm(CExportCommand& command) : m_command(command), m_dialog(command.Export()) {}

    ui::DialogModel& Model() override { return m_dialog; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    CExportCommand& m_command;
    CDlgExportPoints& m_dialog;
};

// The window of the overwrite question: its three lines and "Remplacer", "Compléter" (disabled for a
// drawing), "Annuler".
class CDlgOverWriteForm : public ui::Form {
public:
    enum Id : int { kLine1 = 3, kLine2, kLine3, kReplace, kComplete };

    explicit CDlgOverWriteForm(CDlgOverWrite& dialog) : m_dialog(dialog) {}

    ui::DialogModel& Model() override { return m_dialog; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd&) override { return true; }
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    CDlgOverWrite& m_dialog;
};

} // namespace pyr
