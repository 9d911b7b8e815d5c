#pragma once

#include "fieldbook/ExportPoints.h"
#include "ui/Dialog.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pyr {

// What a command line asks of the export dialog; each value given replaces the dialog's.
struct ExportRequests {
    std::optional<int> format;
    std::optional<std::string> output;
    std::optional<int> scope;
    std::optional<std::string> selection; // identifiers, "100-150, A1"
    std::optional<std::string> from;
    std::optional<std::string> to;
    std::optional<std::string> paramFile;
    std::optional<bool> writePoints;
    std::optional<bool> writeCarnet;
    std::optional<bool> view;
    std::optional<OverwriteChoice> overwrite; // --remplacer, --completer
};

// The export options: "--sortie", "--format" (unless the format is imposed), "--tous-les-points",
// "--selection", "--de", "--a", "--parametres", "--points", "--carnet", "--visualiser", "--remplacer" and
// "--completer". The GéoBase editor shares its own "--selection" and leaves "--tous-les-points" out (the
// whole GéoBase is what it exports by default).
void DeclareExportOptions(ui::DialogOptions& options, ExportRequests& requests, bool formatImposed,
                          bool inEditor = false);

// Runs the export dialog from a command line: the requests applied after the settings were read, the
// selection turned into the references of the elements it names (the points as points, the other
// elements as observations), the overwrite question answered by "--remplacer" / "--completer" or asked,
// then OK. `carnet`: the editor's GéoBase, or null (the GéoBase is then the command's, loaded first when
// a selection must be found in it).
ui::DialogResult RunExport(CDlgExportPoints& dialog, const ExportRequests& requests, ui::FrontEnd& frontEnd,
                           const CCarnet* carnet);

// The references of the elements whose identifier the selection names, in the GéoBase's order; nothing
// when the text is no selection (`why` then says why).
std::optional<std::vector<int>> SelectionReferences(const CCarnet& carnet, std::string_view text,
                                                    std::string* why = nullptr);

// An export command ("EPoints", "ESeparat" ...) run by the common flow of the commands: the export
// dialog with the command's format imposed, "EPoints" with the last format used.
class CExportCommand : public ui::Dialog {
public:
    explicit CExportCommand(std::optional<int> imposedFormat)
        : m_dialog(nullptr, nullptr, imposedFormat), m_imposed(imposedFormat.has_value()) {}

    ui::DialogModel& Model() override { return m_dialog; }
    std::string Caption() const override { return m_dialog.Caption(); }
    std::string GeoBaseHelp() const override;
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    std::unique_ptr<ui::Form> MakeForm() override;

    CDlgExportPoints& Export() { return m_dialog; }
    // The GéoBase in memory that is exported (the editor's), instead of the command's GéoBase.
    void SetCarnet(const CCarnet* carnet) { m_carnet = carnet; }
    // The window opening: the dialog given the command's inputs and the GéoBase, its settings read.
    void OpenDialog();

private:
    CDlgExportPoints m_dialog;
    bool m_imposed;
    const CCarnet* m_carnet = nullptr;
    ExportRequests m_requests;
};

// The format an export command imposes, told by its local name; nothing for "EPoints".
std::optional<int> ExportCommandFormat(std::string_view localName);

} // namespace pyr
