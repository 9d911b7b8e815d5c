#pragma once

#include <QPlainTextEdit>

namespace pyr::bureau {

// The text window: the reports of the loadings, readings and computations, one line after the other, in
// a fixed-width font so that the columns of the listings stay aligned.
class TextWindow : public QPlainTextEdit {
    Q_OBJECT
public:
    explicit TextWindow(QWidget* parent = nullptr);

    void AddLine(const QString& line);
};

} // namespace pyr::bureau
