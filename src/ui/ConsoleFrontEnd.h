#pragma once

#include "ui/FrontEnd.h"

#include <cstdio>
#include <optional>
#include <string>
#include <vector>

namespace pyr::ui {

// What a person typed at a question or at the prompt: a line (Enter), the end of input (Ctrl-D on an empty
// line, or the end of a file read), or a cancelled line (Escape, or Ctrl-C at the prompt).
struct TypedLine {
    enum class Kind { Line, End, Cancel };
    Kind kind = Kind::End;
    std::string text; // UTF-8, without its end, for a line
};

// What the line is for: a line editor keeps the commands in its history and completes their names, and
// completes file names in a file choice.
enum class LinePurpose { Command, Answer, File };

// How a console reads from a person: a line editor at a terminal. Without one, the console reads its input
// stream, where a line that starts with the Escape character counts as Escape.
class LineReader {
public:
    virtual ~LineReader() = default;
    // Shows the prompt and reads one line.
    virtual TypedLine ReadLine(std::string_view prompt, LinePurpose purpose) = 0;
};

// The terminal: messages to standard error, text-window lines to standard output. Questions are asked
// at the terminal when standard input is one; otherwise (batch) they take the answer given in advance
// (--oui / --non) or their default, and say which answer was taken. A dialog takes its options from the
// words of the command line. At a question, Enter or the end of input (Ctrl-D) takes the default; Escape
// answers Cancel to a yes/no/cancel question, No to a yes/no one, and chooses no file. A file is shown in the
// person's editor ($VISUAL, else $EDITOR, else the desktop's viewer through xdg-open) only when a person is
// there; a batch run names the file instead.
class ConsoleFrontEnd : public FrontEnd {
public:
    ConsoleFrontEnd(std::FILE* in = stdin, std::FILE* out = stdout, std::FILE* err = stderr);

    void SetBatchAnswer(std::optional<Answer> answer) { m_batchAnswer = answer; }
    void SetInteractive(bool interactive) { m_interactive = interactive; }
    // The line editor that reads the person's lines instead of the input stream; nullptr for the stream.
    void SetLineReader(LineReader* reader) { m_reader = reader; }

    // The command being run and the words after its name: DoModal applies them to the dialog.
    void SetCommand(std::string name, std::vector<std::string> arguments);
    // What the last command came to: 0 it ran (closed with OK or cancelled), 1 refused or failed (a
    // message said why, a failure was reported), 2 bad usage; the worst of its dialogs when it runs
    // several. SetCommand resets it to 0.
    int Status() const { return m_status == 0 && Failures() > 0 ? 1 : m_status; }
    // Shows the prompt on the error stream and reads the command line typed.
    TypedLine Prompt(std::string_view prompt);

    void MessageBox(std::string_view text, std::string_view caption, int icon) override;
    Answer Ask(std::string_view text, std::string_view caption, Buttons buttons, Answer byDefault,
               int icon = kIconQuestion) override;
    std::optional<std::string> ChooseFile(const FileChoice& choice) override;
    void TextLine(std::string_view line) override;
    DialogResult DoModal(Dialog& dialog) override;
    void ShowFile(const std::string& path) override;

private:
    TypedLine Read(std::string_view prompt, LinePurpose purpose);

    // The error stream, after what the text window wrote: both keep their order when they go to one
    // place (a terminal, a log).
    std::FILE* Err() {
        std::fflush(m_out);
        return m_err;
    }

    std::FILE* m_in;
    std::FILE* m_out;
    std::FILE* m_err;
    bool m_interactive;
    LineReader* m_reader = nullptr;
    std::optional<Answer> m_batchAnswer;
    std::string m_command;
    std::vector<std::string> m_arguments;
    int m_status = 0;
};

} // namespace pyr::ui
