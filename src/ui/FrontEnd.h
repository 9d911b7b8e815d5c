#pragma once

#include "ui/Dialog.h"

#include <optional>
#include <string>
#include <string_view>

// The one seam between the program and a person: message boxes, questions, file choices and the lines
// of the text window. The console, the scripted test double and later a desktop front end implement it.
// Printf-style texts use the C locale's decimal point: the host programs never change LC_NUMERIC.
namespace pyr::ui {

// Message box icons, with the values the system gives them (16 error, 48 warning ...).
enum Icon : int {
    kIconNone = 0,
    kIconError = 16,
    kIconQuestion = 32,
    kIconWarning = 48,
    kIconInformation = 64
};

inline constexpr std::string_view kCaption = "PYRALIS";

enum class Buttons { YesNo, YesNoCancel };
enum class Answer { Yes, No, Cancel };

struct FileChoice {
    bool save = false;            // a save dialog (else open)
    std::string title;            // "Sélectionnez le fichier carnet à traiter :"
    std::string filter;           // "GéoBase PYRALIS (*.geo)|*.geo||"
    std::string defaultExtension; // "geo", without the dot
    std::string startPath;        // the file or folder offered first
};

class FrontEnd {
public:
    virtual ~FrontEnd() = default;

    virtual void MessageBox(std::string_view text, std::string_view caption, int icon) = 0;
    virtual Answer Ask(std::string_view text, std::string_view caption, Buttons buttons, Answer byDefault,
                       int icon = kIconQuestion) = 0;
    // The chosen path, or nothing when the person cancels.
    virtual std::optional<std::string> ChooseFile(const FileChoice& choice) = 0;
    // One line of the text window, without its end.
    virtual void TextLine(std::string_view line) = 0;
    // Runs a dialog modally, as every command does with its dialog: the front end gives it what the
    // person asked for (its options, on a command line) and runs it until it is closed.
    virtual DialogResult DoModal(Dialog& dialog) = 0;
    // Shows a file to the person (a listing once written, a file they asked to see) in the platform's
    // viewer.
    virtual void ShowFile(const std::string& path) = 0;

    // A message that says something asked for could not be done (a GéoBase, a listing, a journal or the
    // settings not written; a field book without data): shown as a message box captioned "PYRALIS", and
    // the command running then ends on a failure status whatever its dialog comes to.
    void ReportFailure(std::string_view text, int icon = kIconWarning) {
        ++m_failures;
        MessageBox(text, kCaption, icon);
    }
    // The failures reported since the last ResetFailures (a host resets them before each command).
    int Failures() const { return m_failures; }
    void ResetFailures() { m_failures = 0; }

private:
    int m_failures = 0;
};

// The application's own front end: what a message without a parent window goes to. The console until a
// host installs another one; passing nullptr gives the console back.
FrontEnd& ApplicationFrontEnd();
void SetApplicationFrontEnd(FrontEnd* frontEnd);

} // namespace pyr::ui
