#pragma once

#include <QString>

class QWidget;

namespace pyr::bureau {

// Saves a window as a PNG picture, with a title bar above it that shows its caption as the desktop would
// (a window drawn without a display has no frame of its own). False when the file could not be written.
bool SaveCapture(QWidget& window, const QString& path);

} // namespace pyr::bureau
