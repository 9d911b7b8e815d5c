#pragma once

#include "ui/FrontEnd.h"

#include <QString>
#include <functional>
#include <optional>
#include <string>

class QWidget;

namespace pyr::bureau {

class TextWindow;

// The Qt face of the seam to a person: message boxes captioned "PYRALIS", questions with their default,
// the file dialogs of the system's filters, the text window, and every dialog shown from its form.
//
// In capture mode (a window drawn without a display, for the documents and the tests) nobody is there:
// messages go to the error output, questions take their default, file choices take the file offered,
// and the first dialog that has a form is drawn into the capture file and closed as if cancelled.
class QtFrontEnd : public ui::FrontEnd {
public:
    QtFrontEnd() = default;

    // The window that parents the dialogs and message boxes, and the text window of the lines.
    void SetParent(QWidget* parent) { m_parent = parent; }
    void SetTextWindow(TextWindow* textWindow) { m_textWindow = textWindow; }
    // Nobody at the window (a capture): messages go to the error output, questions take their default.
    void SetUnattended(bool unattended) { m_unattended = unattended; }
    // Capture of a dialog: the first dialog with a form is saved as a PNG in `path` (a sheet, page after
    // page: "x.png", "x-2.png" ...), on `geoBase` when one is given, and closed. With `button`, the
    // button of that name is pressed first and the dialog it opens is the one saved.
    void SetCapture(std::string path, std::string geoBase, std::string button = {}) {
        m_unattended = true;
        m_capture = std::move(path);
        m_geoBase = std::move(geoBase);
        m_button = std::move(button);
    }
    bool Captured() const { return m_captured; }
    const std::string& CaptureFailure() const { return m_captureFailure; }

    void MessageBox(std::string_view text, std::string_view caption, int icon) override;
    ui::Answer Ask(std::string_view text, std::string_view caption, ui::Buttons buttons, ui::Answer byDefault,
                   int icon = ui::kIconQuestion) override;
    std::optional<std::string> ChooseFile(const ui::FileChoice& choice) override;
    void TextLine(std::string_view line) override;
    ui::DialogResult DoModal(ui::Dialog& dialog) override;
    void ShowFile(const std::string& path) override;

private:
    bool Unattended() const { return m_unattended; }
    ui::DialogResult Capture(class FormDialog& window);

    QWidget* m_parent = nullptr;
    TextWindow* m_textWindow = nullptr;
    bool m_unattended = false;
    std::string m_capture;
    std::string m_geoBase;
    bool m_geoBaseGiven = false;
    std::string m_button;
    bool m_buttonPressed = false;
    bool m_captured = false;
    std::string m_captureFailure;
};

// A filter of the system ("GéoBase PYRALIS (*.geo)|*.geo||") as a Qt file dialog takes it
// ("GéoBase PYRALIS (*.geo)"; several, separated by ";;").
QString QtFilter(std::string_view filter);

} // namespace pyr::bureau
