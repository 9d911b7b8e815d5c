#include "host/CommandFlow.h"

#include "host/CommandContext.h"
#include "host/ServicesLookup.h"
#include "settings/LastGeoBase.h"
#include "ui/FrontEnd.h"

namespace pyr::host {

ui::DialogResult RunCommandDialog(const char* title, const DialogFactory& makeDialog) {
    CPyrMainServices* services = MainServices();
    if (!services) return ui::DialogResult::Failed;
    const std::string caption = title ? title : "";
    services->SetCommandTitle(caption);

    CCmdContext context;
    context.Open();
    ui::FrontEnd* parent = services->GetParentWindow();
    // Whatever the module shows without a parent (parameter-file messages) goes to the same place.
    ui::SetApplicationFrontEnd(parent);
    ui::FrontEnd& frontEnd = parent ? *parent : ui::ApplicationFrontEnd();

    std::unique_ptr<ui::Dialog> dialog = makeDialog();
    const std::string paramPath = services->GetParamFilePath();
    dialog->SetInputs({ReadLastGeoBase(paramPath), paramPath, services->GetConfigFolder(), caption});
    const ui::DialogResult result = frontEnd.DoModal(*dialog);

    context.Close();
    return result;
}

} // namespace pyr::host
