#pragma once

#include "ui/Dialog.h"

#include <functional>
#include <memory>

namespace pyr::host {

using DialogFactory = std::function<std::unique_ptr<ui::Dialog>()>;

// The flow that every command follows around its dialog: the title goes to the main services, the
// command context is opened, the dialog is built and handed the last GéoBase, the current parameter
// path and the installation folder, run modally on the services' parent window, and the context is
// closed. The handler does not look at how the dialog ended; the result is returned for the host.
ui::DialogResult RunCommandDialog(const char* title, const DialogFactory& makeDialog);

} // namespace pyr::host
