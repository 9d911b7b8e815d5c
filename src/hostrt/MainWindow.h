#pragma once

// The host's main window: the front end through which the host meets its user. Modules take it as the
// parent of their dialogs and message boxes (through the main services).
namespace pyr::ui {
class FrontEnd;
}

// The host program's front end, or null before the host has set one.
pyr::ui::FrontEnd* adsw_acadMainWnd();

namespace pyr {

// Set by the host program before it loads any module; null takes it back.
void SetMainWindow(ui::FrontEnd* frontEnd);

} // namespace pyr
