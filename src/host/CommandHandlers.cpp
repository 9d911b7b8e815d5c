#include "host/CommandHandlers.h"

#include "calc/CalcChemDriver.h"
#include "calc/CalcExcentDriver.h"
#include "calc/CalcIntersDriver.h"
#include "calc/CalcNivDriver.h"
#include "calc/CalcRayonDriver.h"
#include "calc/CalculV0Driver.h"
#include "calc/ResectionDriver.h"
#include "core/Strings.h"
#include "editor/GeoEditor.h"
#include "fieldbook/ExportCommand.h"
#include "fieldbook/ReadingCommand.h"
#include "host/CommandFlow.h"
#include "host/HostTexts.h"
#include "host/ServicesLookup.h"
#include "settings/OptionPages.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <optional>

namespace pyr::host {

namespace {

// The dialog of a command that this version does not have yet: it says so.
class CDlgPending : public ui::Dialog {
public:
    explicit CDlgPending(const CommandEntry& command) : m_command(command) {}

    ui::DialogResult Run(ui::FrontEnd& frontEnd) override {
        frontEnd.MessageBox(Sprintf(kMsgNotAvailable, m_command.localName, m_command.title), ui::kCaption,
                            ui::kIconInformation);
        return ui::DialogResult::Failed;
    }

private:
    const CommandEntry& m_command;
};

void RunPending(const CommandEntry& command) {
    RunCommandDialog(command.title, [&command] { return std::make_unique<CDlgPending>(command); });
}

} // namespace

void OnShowToolbar(const CommandEntry&) {
    CPyrMainServices* services = MainServices();
    if (!services) return;
    services->ShowToolbar(kToolbarGroup, true);
    if (ui::FrontEnd* parent = services->GetParentWindow())
        CPyrTxtWnd(*parent).Print(kMsgToolbarShown, kToolbarGroup);
}

void OnGeoEdit(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CGeoEditor>(); });
}

void OnCalcOpt(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<COptionPSheet>(); });
}

void OnCalculV0(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalculV0Driver>(); });
}

void OnCalInter(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalcIntersDriver>(); });
}

void OnCalRelev(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalcRelevDriver>(); });
}

void OnCalRecou(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalcRecoupDriver>(); });
}

void OnCalExcen(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalcExcentDriver>(); });
}

void OnCalRayon(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalcRayonDriver>(); });
}

void OnCalChem(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalcChemDriver>(); });
}

void OnCalNivSm(const CommandEntry& command) {
    RunCommandDialog(command.title, [] { return std::make_unique<CCalcNivDriver>(LevellingMethod::Simple); });
}

void OnCalNivSt(const CommandEntry& command) {
    RunCommandDialog(command.title,
                     [] { return std::make_unique<CCalcNivDriver>(LevellingMethod::DoubleStation); });
}

void OnReadFieldBook(const CommandEntry& command) {
    const std::optional<FieldBookFormat> format = FindFieldBookFormat(command.localName);
    if (!format) {
        RunPending(command);
        return;
    }
    RunCommandDialog(command.title, [format] { return std::make_unique<CFieldBookCommand>(*format); });
}

void OnExport(const CommandEntry& command) {
    const std::optional<int> format = ExportCommandFormat(command.localName);
    RunCommandDialog(command.title, [format] { return std::make_unique<CExportCommand>(format); });
}

void OnTabCode(const CommandEntry& command) {
    if (!ScaleServices()) return;
    RunPending(command);
}

void OnPending(const CommandEntry& command) {
    RunPending(command);
}

bool CommandAvailable(const CommandEntry& command) {
    if (command.handler == OnPending || command.handler == OnTabCode) return false;
    if (command.handler == OnReadFieldBook) return FindFieldBookFormat(command.localName).has_value();
    return true;
}

} // namespace pyr::host
