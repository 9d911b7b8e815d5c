#pragma once

#include "ui/ConsoleFrontEnd.h"

#include <string>
#include <string_view>
#include <vector>

struct editline;
struct historyW;

// The line editor of the terminal (libedit, emacs keys): arrows, the commands of this session and of the
// earlier ones (Up, Down, Ctrl-R), Tab to complete a command's name or a file's. Escape, or Ctrl-G,
// cancels the line; Ctrl-C cancels it too at the prompt (see InterruptOnSignals); Ctrl-D on an empty line
// ends the input. Reads standard input; shows the prompt and the line on standard error, where the
// console writes its questions.
class LineEditor : public pyr::ui::LineReader {
public:
    // `names`: what Tab completes as the first word of a command line. `historyFile`: where the commands
    // typed are kept from one session to the next (none when empty).
    LineEditor(std::vector<std::string> names, std::string historyFile);
    ~LineEditor() override;
    LineEditor(const LineEditor&) = delete;
    LineEditor& operator=(const LineEditor&) = delete;

    // Whether a person is there to edit lines: standard input and standard error are terminals.
    static bool Usable();

    pyr::ui::TypedLine ReadLine(std::string_view prompt, pyr::ui::LinePurpose purpose) override;

    // Adds a command line to the history and writes the history file. False (and Failure() says why, in
    // French) when the file could not be written.
    bool Remember(const std::string& line);
    const std::string& Failure() const { return m_failure; }

    // The names that complete `word` (the first word of a line), case ignored, in their own spelling.
    std::vector<std::string> Completions(std::string_view word) const;

private:
    static unsigned char CompleteCommand(editline* el, int key);
    static unsigned char CompleteFile(editline* el, int key);
    static unsigned char CancelLine(editline* el, int key);
    static int ReadKey(editline* el, wchar_t* key);
    static wchar_t* PromptOf(editline* el);
    editline* Make(bool commands);

    std::vector<std::string> m_names;
    std::string m_historyFile;
    std::string m_failure;
    historyW* m_history = nullptr;
    editline* m_commandLine = nullptr; // with the history and the completion of command names
    editline* m_answerLine = nullptr;  // answers and file names: no history
    std::wstring m_prompt;
    bool m_cancelled = false;
};
