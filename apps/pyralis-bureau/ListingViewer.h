#pragma once

#include <QString>

class QWidget;

namespace pyr::bureau {

// Shows a file the person asked to see, or a listing once written: a text file in a window of its own
// beside the main window (fixed-width font, the columns aligned), a rich-text listing in the desktop's
// program for that kind of file.
void ShowInViewer(const QString& path, QWidget* parent);

} // namespace pyr::bureau
