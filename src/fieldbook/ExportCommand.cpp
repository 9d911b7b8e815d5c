#include "fieldbook/ExportCommand.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/ExportTexts.h"
#include "geobase/Selection.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <map>

namespace pyr {

namespace {

constexpr const char* kGeoBaseHelp = "la GéoBase à exporter, au lieu de la dernière utilisée";

} // namespace

std::optional<int> ExportCommandFormat(std::string_view localName) {
    static const std::map<std::string, int, std::less<>> formats = {
        {"EGeoBase", 0}, {"ESeparat", 1}, {"EColonne", 2}, {"EQuendal", 3},
        {"ELeica", 4},   {"ESpectra", 5}, {"ESokkia", 6}};
    const auto found = formats.find(localName);
    if (found == formats.end()) return std::nullopt;
    return found->second;
}

void DeclareExportOptions(ui::DialogOptions& options, ExportRequests& requests, bool formatImposed,
                          bool inEditor) {
    options.Value("sortie", "FICHIER", exp::kHelpOutput, [&requests](const std::string& path) {
        requests.output = path;
        return std::string();
    });
    if (!formatImposed)
        options.Value("format", "N", exp::kHelpFormat, [&requests](const std::string& text) {
            long long number = -1;
            if (!ParseInt(text, number) || number < 0 || number >= kExportFormatCount)
                return Sprintf(exp::kBadFormat, text.c_str());
            requests.format = static_cast<int>(number);
            return std::string();
        });
    if (!inEditor) {
        options.Switch("tous-les-points", exp::kHelpAll, [&requests] {
            requests.scope = CDlgExportPoints::kAll;
            return std::string();
        });
        options.Value("selection", "SEL", exp::kHelpSelection, [&requests](const std::string& text) {
            std::string why;
            if (!CSelection::Parse(text, &why)) return Sprintf(exp::kBadSelection, text.c_str(), why.c_str());
            requests.selection = text;
            requests.scope = CDlgExportPoints::kSelected;
            return std::string();
        });
    }
    options.Value("de", "A", exp::kHelpFrom, [&requests](const std::string& mat) {
        requests.from = mat;
        requests.scope = CDlgExportPoints::kRange;
        return std::string();
    });
    options.Value("a", "B", exp::kHelpTo, [&requests](const std::string& mat) {
        requests.to = mat;
        return std::string();
    });
    options.Value("parametres", "FICHIER", exp::kHelpParamFile, [&requests](const std::string& path) {
        requests.paramFile = path;
        return std::string();
    });
    options.ZeroOrOne("points", exp::kHelpPoints, [&requests](bool on) { requests.writePoints = on; });
    options.ZeroOrOne("carnet", exp::kHelpCarnet, [&requests](bool on) { requests.writeCarnet = on; });
    options.ZeroOrOne("visualiser", exp::kHelpView, [&requests](bool on) { requests.view = on; });
    options.Switch("remplacer", exp::kHelpReplace, [&requests] {
        if (requests.overwrite == OverwriteChoice::Complete) return std::string(exp::kBothModes);
        requests.overwrite = OverwriteChoice::Replace;
        return std::string();
    });
    options.Switch("completer", exp::kHelpComplete, [&requests] {
        if (requests.overwrite == OverwriteChoice::Replace) return std::string(exp::kBothModes);
        requests.overwrite = OverwriteChoice::Complete;
        return std::string();
    });
}

std::optional<std::vector<int>> SelectionReferences(const CCarnet& carnet, std::string_view text,
                                                    std::string* why) {
    const std::optional<CSelection> selection = CSelection::Parse(text, why);
    if (!selection) return std::nullopt;
    std::vector<int> references;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const std::string& mat = carnet.GetAt(i)->mat();
        if (mat.empty() || !selection->Contains(mat)) continue;
        references.push_back(carnet.GetType(i) == kKindPoint ? i : i + kObservationReference);
    }
    return references;
}

ui::DialogResult RunExport(CDlgExportPoints& dialog, const ExportRequests& requests, ui::FrontEnd& frontEnd,
                           const CCarnet* carnet) {
    // A selection names elements of the GéoBase: it is read before the dialog opens.
    CCarnet loaded;
    std::vector<int> references;
    if (requests.selection) {
        if (!carnet) {
            CPyrTxtWnd txt(frontEnd);
            if (!loaded.Load(&txt, dialog.GeoBase(), {}, 0, &frontEnd)) return ui::DialogResult::Failed;
            carnet = &loaded;
        }
        references = SelectionReferences(*carnet, *requests.selection).value_or(std::vector<int>{});
    }
    dialog.SetCarnet(carnet);
    dialog.SetSelection(requests.selection ? &references : nullptr);
    dialog.OnInitDialog();

    if (requests.format) dialog.SetFormat(*requests.format);
    if (requests.output) dialog.SetOutput(*requests.output);
    if (requests.paramFile) dialog.SetParamFile(*requests.paramFile);
    if (requests.writePoints) dialog.SetWritePoints(*requests.writePoints);
    if (requests.writeCarnet) dialog.SetWriteCarnet(*requests.writeCarnet);
    if (requests.view) dialog.SetViewFile(*requests.view);
    if (requests.from) dialog.SetFrom(*requests.from);
    if (requests.to) dialog.SetTo(*requests.to);
    if (requests.scope) dialog.SetScope(*requests.scope);
    // A selection that names no element: there is nothing to export.
    if (requests.scope == CDlgExportPoints::kSelected &&
        dialog.ScopeChoice() != CDlgExportPoints::kSelected) {
        frontEnd.MessageBox(exp::kMsgNothingToExport, ui::kCaption, ui::kIconWarning);
        return ui::DialogResult::Failed;
    }

    dialog.askOverwrite = [&requests](ui::FrontEnd& asked, CDlgOverWrite& question) {
        if (requests.overwrite == OverwriteChoice::Complete && !question.CompleteAllowed()) {
            asked.MessageBox(exp::kNoCompleteDxf, ui::kCaption, ui::kIconWarning);
            return OverwriteChoice::Cancel;
        }
        if (requests.overwrite) return *requests.overwrite;
        question.Run(asked);
        return question.Choice();
    };
    const ui::DialogResult result = dialog.OnOK(frontEnd);
    dialog.askOverwrite = nullptr;
    dialog.SetSelection(nullptr);
    dialog.SetCarnet(nullptr);
    return result;
}

std::string CExportCommand::GeoBaseHelp() const {
    return kGeoBaseHelp;
}

void CExportCommand::DeclareOptions(ui::DialogOptions& options) {
    DeclareExportOptions(options, m_requests, m_imposed);
}

ui::DialogResult CExportCommand::Run(ui::FrontEnd& frontEnd) {
    m_dialog.SetInputs(Inputs());
    return RunExport(m_dialog, m_requests, frontEnd, m_carnet);
}

void CExportCommand::OpenDialog() {
    m_dialog.SetInputs(Inputs());
    m_dialog.SetCarnet(m_carnet);
    m_dialog.OnInitDialog();
}

} // namespace pyr
