#include "hostrt/MainWindow.h"

namespace {
pyr::ui::FrontEnd* g_mainWindow = nullptr;
}

pyr::ui::FrontEnd* adsw_acadMainWnd() {
    return g_mainWindow;
}

namespace pyr {

void SetMainWindow(ui::FrontEnd* frontEnd) {
    g_mainWindow = frontEnd;
}

} // namespace pyr
