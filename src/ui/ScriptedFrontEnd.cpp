#include "ui/ScriptedFrontEnd.h"

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
    if (files.empty()) return std::nullopt;
    auto file = files.front();
    files.pop_front();
    return file;
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
