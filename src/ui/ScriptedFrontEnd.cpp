#include "ui/ScriptedFrontEnd.h"

#include "ui/DialogCommandLine.h"

#include <algorithm>

namespace pyr::ui {

void ScriptedFrontEnd::MessageBox(std::string_view text, std::string_view caption, int icon) {
    messages.push_back({std::string(text), std::string(caption), icon});
}

Answer ScriptedFrontEnd::Ask(std::string_view text, std::string_view, Buttons, Answer byDefault, int) {
    questions.emplace_back(text);
    if (answers.empty()) return byDefault;
    Answer answer = answers.front();
    answers.pop_front();
    return answer;
}

std::optional<std::string> ScriptedFrontEnd::ChooseFile(const FileChoice& choice) {
    fileChoices.push_back(choice);
    if (files.empty())
        return choice.startPath.empty() ? std::nullopt : std::optional<std::string>(choice.startPath);
    auto file = files.front();
    files.pop_front();
    return file;
}

DialogResult ScriptedFrontEnd::DoModal(Dialog& dialog) {
    dialogs.push_back(dialog.Caption());
    // The slot is taken now so that a dialog opened from this one records its result after it.
    std::size_t slot = results.size();
    results.push_back(DialogResult::Failed);
    CommandLineOutcome outcome = ApplyCommandLine(dialog, command, dialogArguments);
    DialogResult result = DialogResult::Failed;
    switch (outcome.kind) {
    case CommandLineOutcome::Kind::Help: {
        std::size_t begin = 0;
        while (begin <= outcome.text.size()) {
            std::size_t end = std::min(outcome.text.find('\n', begin), outcome.text.size());
            lines.push_back(outcome.text.substr(begin, end - begin));
            begin = end + 1;
        }
        result = DialogResult::Cancel;
        break;
    }
    case CommandLineOutcome::Kind::Usage:
    case CommandLineOutcome::Kind::Refused:
        MessageBox(outcome.text, kCaption, kIconWarning);
        break;
    case CommandLineOutcome::Kind::Run:
        result = dialog.Run(*this);
        break;
    }
    results[slot] = result;
    return result;
}

std::string ScriptedFrontEnd::AllLines() const {
    std::string all;
    for (const auto& line : lines) {
        if (!all.empty()) all += '\n';
        all += line;
    }
    return all;
}

} // namespace pyr::ui
