#include "ui/ConsoleFrontEnd.h"

#include "ui/DialogCommandLine.h"

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <spawn.h>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

extern char** environ;

namespace pyr::ui {

namespace {

const char* IconWord(int icon) {
    switch (icon) {
    case kIconError:
        return "Erreur";
    case kIconWarning:
        return "Attention";
    case kIconInformation:
        return "Information";
    case kIconQuestion:
        return "Question";
    default:
        return nullptr;
    }
}

const char* AnswerWord(Answer answer) {
    switch (answer) {
    case Answer::Yes:
        return "Oui";
    case Answer::No:
        return "Non";
    default:
        return "Annuler";
    }
}

constexpr char kEscape = '\x1b';

// A line of the input stream. A line that starts with Escape is a cancelled one, so that a script can
// press the key as a person does.
TypedLine ReadStreamLine(std::FILE* in) {
    TypedLine typed;
    int c;
    while ((c = std::fgetc(in)) != EOF && c != '\n')
        typed.text += static_cast<char>(c);
    if (c == EOF && typed.text.empty()) return typed;
    typed.kind =
        !typed.text.empty() && typed.text[0] == kEscape ? TypedLine::Kind::Cancel : TypedLine::Kind::Line;
    return typed;
}

// The words of a command held in an environment variable ("emacs -nw"), split at blanks: no shell
// reads it, so a path with spaces or quotes reaches the program as one argument.
std::vector<std::string> CommandWords(const char* command) {
    std::vector<std::string> words;
    std::string word;
    for (const char* c = command; *c; ++c) {
        if (std::isspace(static_cast<unsigned char>(*c))) {
            if (!word.empty()) words.push_back(std::move(word));
            word.clear();
        } else {
            word += *c;
        }
    }
    if (!word.empty()) words.push_back(std::move(word));
    return words;
}

std::vector<char*> Argv(std::vector<std::string>& words) {
    std::vector<char*> argv;
    for (auto& word : words)
        argv.push_back(word.data());
    argv.push_back(nullptr);
    return argv;
}

// Runs the editor on the file and waits for the person to close it. False when it cannot be started.
// While the editor has the terminal, Ctrl-C is its own (an editor takes it for a key): here it would
// cancel the command and leave the editor running behind the prompt.
bool RunEditor(const char* command, const std::string& path) {
    std::vector<std::string> words = CommandWords(command);
    if (words.empty()) return false;
    words.push_back(path);
    std::vector<char*> argv = Argv(words);
    posix_spawnattr_t attributes;
    posix_spawnattr_init(&attributes);
    sigset_t interrupt;
    sigemptyset(&interrupt);
    sigaddset(&interrupt, SIGINT);
    posix_spawnattr_setsigdefault(&attributes, &interrupt);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGDEF);
    struct sigaction ignore = {}, before = {};
    ignore.sa_handler = SIG_IGN;
    sigaction(SIGINT, &ignore, &before);
    pid_t pid;
    const bool started = posix_spawnp(&pid, argv[0], nullptr, &attributes, argv.data(), environ) == 0;
    posix_spawnattr_destroy(&attributes);
    int status = 0;
    while (started && waitpid(pid, &status, 0) < 0 && errno == EINTR) {
    }
    sigaction(SIGINT, &before, nullptr);
    return started;
}

// Hands the file to the desktop's viewer without waiting for it: an intermediate process starts it and
// ends at once, so that the viewer belongs to no one here and leaves no zombie behind.
bool OpenWithDesktop(const std::string& path) {
    std::vector<std::string> words;
    words.emplace_back("xdg-open");
    words.push_back(path);
    std::vector<char*> argv = Argv(words);
    pid_t intermediate = fork();
    if (intermediate < 0) return false;
    if (intermediate == 0) {
        pid_t viewer;
        _exit(posix_spawnp(&viewer, argv[0], nullptr, nullptr, argv.data(), environ) == 0 ? 0 : 127);
    }
    int status = 0;
    while (waitpid(intermediate, &status, 0) < 0 && errno == EINTR) {
    }
    return WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

} // namespace

ConsoleFrontEnd::ConsoleFrontEnd(std::FILE* in, std::FILE* out, std::FILE* err)
    : m_in(in), m_out(out), m_err(err), m_interactive(in && isatty(fileno(in))) {}

void ConsoleFrontEnd::MessageBox(std::string_view text, std::string_view caption, int icon) {
    const char* word = IconWord(icon);
    std::fprintf(Err(), "%.*s%s%s : %.*s\n", static_cast<int>(caption.size()), caption.data(),
                 word ? " - " : "", word ? word : "", static_cast<int>(text.size()), text.data());
    std::fflush(m_err);
}

Answer ConsoleFrontEnd::Ask(std::string_view text, std::string_view caption, Buttons buttons,
                            Answer byDefault, int) {
    const bool cancel = buttons == Buttons::YesNoCancel;
    std::fprintf(Err(), "%.*s : %.*s\n", static_cast<int>(caption.size()), caption.data(),
                 static_cast<int>(text.size()), text.data());
    if (!m_interactive) {
        Answer answer = m_batchAnswer.value_or(byDefault);
        if (answer == Answer::Cancel && !cancel) answer = byDefault;
        std::fprintf(Err(), "Réponse : %s\n", AnswerWord(answer));
        std::fflush(m_err);
        return answer;
    }
    char prompt[64];
    std::snprintf(prompt, sizeof prompt, "(o)ui / (n)on%s [%s] ? ", cancel ? " / (a)nnuler" : "",
                  AnswerWord(byDefault));
    while (true) {
        const TypedLine typed = Read(prompt, LinePurpose::Answer);
        if (typed.kind != TypedLine::Kind::Line) {
            // A key, not an answer, was typed: say which answer it gave.
            const Answer answer = typed.kind == TypedLine::Kind::End ? byDefault
                                  : cancel                           ? Answer::Cancel
                                                                     : Answer::No;
            std::fprintf(Err(), "Réponse : %s\n", AnswerWord(answer));
            std::fflush(m_err);
            return answer;
        }
        if (typed.text.empty()) return byDefault;
        char c = static_cast<char>(std::tolower(static_cast<unsigned char>(typed.text[0])));
        if (c == 'o' || c == 'y') return Answer::Yes;
        if (c == 'n') return Answer::No;
        if (cancel && c == 'a') return Answer::Cancel;
    }
}

std::optional<std::string> ConsoleFrontEnd::ChooseFile(const FileChoice& choice) {
    if (!m_interactive) {
        if (choice.startPath.empty()) return std::nullopt;
        std::fprintf(Err(), "%s %s\n", choice.title.c_str(), choice.startPath.c_str());
        return choice.startPath;
    }
    const TypedLine typed = Read(choice.title + " [" + choice.startPath + "] ", LinePurpose::File);
    if (typed.kind == TypedLine::Kind::Line && !typed.text.empty()) return typed.text;
    std::optional<std::string> chosen;
    if (typed.kind != TypedLine::Kind::Cancel && !choice.startPath.empty()) chosen = choice.startPath;
    if (typed.kind != TypedLine::Kind::Line) {
        std::fprintf(Err(), "Réponse : %s\n", chosen ? chosen->c_str() : "aucun fichier");
        std::fflush(m_err);
    }
    return chosen;
}

TypedLine ConsoleFrontEnd::Prompt(std::string_view prompt) {
    return Read(prompt, LinePurpose::Command);
}

TypedLine ConsoleFrontEnd::Read(std::string_view prompt, LinePurpose purpose) {
    std::FILE* err = Err();
    if (m_reader) return m_reader->ReadLine(prompt, purpose);
    std::fprintf(err, "%.*s", static_cast<int>(prompt.size()), prompt.data());
    std::fflush(err);
    return ReadStreamLine(m_in);
}

void ConsoleFrontEnd::TextLine(std::string_view line) {
    std::fprintf(m_out, "%.*s\n", static_cast<int>(line.size()), line.data());
}

void ConsoleFrontEnd::ShowFile(const std::string& path) {
    if (m_interactive) {
        const char* visual = std::getenv("VISUAL");
        const char* editor = std::getenv("EDITOR");
        const char* command = visual && *visual ? visual : editor && *editor ? editor : nullptr;
        if (command ? RunEditor(command, path) : OpenWithDesktop(path)) return;
    }
    std::fprintf(Err(), "Fichier à consulter : %s\n", path.c_str());
    std::fflush(m_err);
}

void ConsoleFrontEnd::SetCommand(std::string name, std::vector<std::string> arguments) {
    m_command = std::move(name);
    m_arguments = std::move(arguments);
    m_status = 0;
    ResetFailures();
}

DialogResult ConsoleFrontEnd::DoModal(Dialog& dialog) {
    CommandLineOutcome outcome = ApplyCommandLine(dialog, m_command, m_arguments);
    DialogResult result = DialogResult::Failed;
    int status = 0;
    switch (outcome.kind) {
    case CommandLineOutcome::Kind::Help:
        std::fprintf(m_out, "%s\n", outcome.text.c_str());
        std::fflush(m_out);
        result = DialogResult::Cancel;
        break;
    case CommandLineOutcome::Kind::Usage:
        std::fprintf(Err(), "pyralis %s : %s\n", m_command.c_str(), outcome.text.c_str());
        std::fflush(m_err);
        status = 2;
        break;
    case CommandLineOutcome::Kind::Refused:
        MessageBox(outcome.text, kCaption, kIconWarning);
        status = 1;
        break;
    case CommandLineOutcome::Kind::Run:
        result = dialog.Run(*this);
        if (result == DialogResult::Failed) status = 1;
        break;
    }
    m_status = std::max(m_status, status);
    return result;
}

namespace {
FrontEnd* g_applicationFrontEnd = nullptr;
}

FrontEnd& ApplicationFrontEnd() {
    static ConsoleFrontEnd console;
    return g_applicationFrontEnd ? *g_applicationFrontEnd : console;
}

void SetApplicationFrontEnd(FrontEnd* frontEnd) {
    g_applicationFrontEnd = frontEnd;
}

} // namespace pyr::ui
