#pragma once

#include "ui/FrontEnd.h"

#include <cstdio>
#include <optional>

namespace pyr::ui {

// The terminal: messages to standard error, text-window lines to standard output. Questions are asked
// at the terminal when standard input is one; otherwise (batch) they take the answer given in advance
// (--oui / --non) or their default, and say which answer was taken.
class ConsoleFrontEnd : public FrontEnd {
public:
    ConsoleFrontEnd(std::FILE* in = stdin, std::FILE* out = stdout, std::FILE* err = stderr);

    void SetBatchAnswer(std::optional<Answer> answer) { m_batchAnswer = answer; }
    void SetInteractive(bool interactive) { m_interactive = interactive; }

    void MessageBox(std::string_view text, std::string_view caption, int icon) override;
    Answer Ask(std::string_view text, std::string_view caption, Buttons buttons, Answer byDefault,
               int icon = kIconQuestion) override;
    std::optional<std::string> ChooseFile(const FileChoice& choice) override;
    void TextLine(std::string_view line) override;

private:
    std::FILE* m_in;
    std::FILE* m_out;
    std::FILE* m_err;
    bool m_interactive;
    std::optional<Answer> m_batchAnswer;
};

} // namespace pyr::ui
