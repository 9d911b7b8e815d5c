#include "TextWindow.h"

#include <QFontDatabase>
#include <QScrollBar>

namespace pyr::bureau {

namespace {
// The lines kept: enough for the reports of a whole day's work, not a memory that grows without end.
constexpr int kLinesKept = 20000;
} // namespace

TextWindow::TextWindow(QWidget* parent) : QPlainTextEdit(parent) {
    setObjectName("fenetreTexte");
    setReadOnly(true);
    setMaximumBlockCount(kLinesKept);
    setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    setLineWrapMode(QPlainTextEdit::NoWrap);
}

void TextWindow::AddLine(const QString& line) {
    appendPlainText(line);
    verticalScrollBar()->setValue(verticalScrollBar()->maximum());
}

} // namespace pyr::bureau
