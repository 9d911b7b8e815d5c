#pragma once

#include "ui/FrontEnd.h"

#include <deque>
#include <string>
#include <vector>

namespace pyr::ui {

// The front end of the tests: answers and file choices given in advance, everything shown recorded.
// A question with no answer left takes its default; a file choice with no file left takes the path it
// offers (nothing when it offers none). Every dialog gets `dialogArguments` as its command line.
class ScriptedFrontEnd : public FrontEnd {
public:
    struct Message {
        std::string text;
        std::string caption;
        int icon;
    };

    std::deque<Answer> answers;
    std::deque<std::optional<std::string>> files;

    std::vector<Message> messages;
    std::vector<std::string> questions;
    std::vector<FileChoice> fileChoices;
    std::vector<std::string> lines;
    // The files shown to the person, in order.
    std::vector<std::string> shownFiles;

    // The words applied to every dialog run, as a command line would give them, and the name of the
    // command they are given to (for the help and the messages).
    std::vector<std::string> dialogArguments;
    std::string command = "commande";
    // The caption of every dialog run, in the order they were opened, and how each ended (same order).
    std::vector<std::string> dialogs;
    std::vector<DialogResult> results;

    void MessageBox(std::string_view text, std::string_view caption, int icon) override;
    Answer Ask(std::string_view text, std::string_view caption, Buttons buttons, Answer byDefault,
               int icon = kIconQuestion) override;
    std::optional<std::string> ChooseFile(const FileChoice& choice) override;
    void TextLine(std::string_view line) override { lines.emplace_back(line); }
    DialogResult DoModal(Dialog& dialog) override;
    void ShowFile(const std::string& path) override { shownFiles.push_back(path); }

    // All text-window lines joined with '\n', for searching in a test.
    std::string AllLines() const;
};

// Installs a front end as the application's one for the life of a scope.
class ScopedApplicationFrontEnd {
public:
    explicit ScopedApplicationFrontEnd(FrontEnd& frontEnd) { SetApplicationFrontEnd(&frontEnd); }
    ~ScopedApplicationFrontEnd() { SetApplicationFrontEnd(nullptr); }
    ScopedApplicationFrontEnd(const ScopedApplicationFrontEnd&) = delete;
    ScopedApplicationFrontEnd& operator=(const ScopedApplicationFrontEnd&) = delete;
};

} // namespace pyr::ui
