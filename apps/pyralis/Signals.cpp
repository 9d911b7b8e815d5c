#include "Signals.h"

#include "core/SafeFile.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <fcntl.h>
#include <sys/wait.h>
#include <termios.h>
#include <unistd.h>

namespace {

struct termios g_terminal;
volatile sig_atomic_t g_terminalKnown = 0;
// Ctrl-C at the prompt writes a byte here: a line editor that waits for a key waits for this too, so that
// an interrupt is never missed between a check and a read.
int g_interruptPipe[2] = {-1, -1};
volatile sig_atomic_t g_resized = 0;
volatile sig_atomic_t g_child = 0; // the process of the running command, while the prompt waits for it

constexpr int kEndingSignals[] = {SIGINT, SIGTERM, SIGHUP};

// Without SA_RESTART: a read that waits for a key returns, so that the line editor learns of Ctrl-C at
// once.
void Handle(int signal, void (*handler)(int)) {
    struct sigaction action = {};
    action.sa_handler = handler;
    sigemptyset(&action.sa_mask);
    sigaction(signal, &action, nullptr);
}

bool Ignored(int signal) {
    struct sigaction current = {};
    return sigaction(signal, nullptr, &current) == 0 && current.sa_handler == SIG_IGN;
}

// Async-signal-safe calls only.
void End(int signal) {
    if (g_child > 0) kill(static_cast<pid_t>(g_child), signal);
    pyr::RemovePendingTemporaryFiles();
    if (g_terminalKnown) tcsetattr(STDIN_FILENO, TCSADRAIN, &g_terminal);
    _exit(128 + signal);
}

void NoteInterrupt(int) {
    const int saved = errno;
    const char byte = 1;
    if (write(g_interruptPipe[1], &byte, 1) < 0) {
    } // full: an interrupt is already waiting
    errno = saved;
}

void NoteResize(int) {
    g_resized = 1;
}

} // namespace

void RememberTerminal() {
    if (isatty(STDIN_FILENO) && tcgetattr(STDIN_FILENO, &g_terminal) == 0) g_terminalKnown = 1;
}

void RestoreTerminal() {
    if (g_terminalKnown) tcsetattr(STDIN_FILENO, TCSADRAIN, &g_terminal);
}

void EndOnSignals() {
    // A signal ignored when the program started (a job run in the background, nohup) stays ignored.
    for (int signal : kEndingSignals)
        if (!Ignored(signal)) Handle(signal, End);
}

void InterruptOnSignals() {
    if (g_interruptPipe[0] < 0 && pipe2(g_interruptPipe, O_NONBLOCK | O_CLOEXEC) != 0) return;
    Handle(SIGINT, NoteInterrupt);
    Handle(SIGTERM, End);
    Handle(SIGHUP, End);
    Handle(SIGWINCH, NoteResize);
}

int InterruptDescriptor() {
    return g_interruptPipe[0];
}

bool TakeInterrupt() {
    if (g_interruptPipe[0] < 0) return false;
    bool interrupted = false;
    char bytes[16];
    while (read(g_interruptPipe[0], bytes, sizeof bytes) > 0)
        interrupted = true;
    return interrupted;
}

bool TakeResize() {
    const bool resized = g_resized != 0;
    g_resized = 0;
    return resized;
}

ChildOutcome RunInChild(const std::function<int()>& command) {
    std::fflush(nullptr); // what is buffered is written once, not by both processes
    // Blocked until each process has its handlers: a Ctrl-C in between reaches the right one.
    sigset_t ending, before;
    sigemptyset(&ending);
    for (int signal : kEndingSignals)
        sigaddset(&ending, signal);
    sigprocmask(SIG_BLOCK, &ending, &before);
    const pid_t child = fork();
    if (child == 0) {
        g_child = 0;
        for (int signal : kEndingSignals)
            Handle(signal, End);
        sigprocmask(SIG_SETMASK, &before, nullptr);
        const int status = command();
        std::fflush(nullptr);
        _exit(status);
    }
    if (child < 0) {
        sigprocmask(SIG_SETMASK, &before, nullptr);
        return {command(), 0, false};
    }
    struct sigaction ignore = {}, prompt = {};
    ignore.sa_handler = SIG_IGN;
    sigaction(SIGINT, &ignore, &prompt);
    g_child = child;
    sigprocmask(SIG_SETMASK, &before, nullptr);
    int raw = 0;
    while (waitpid(child, &raw, 0) < 0 && errno == EINTR) {
    }
    g_child = 0;
    sigaction(SIGINT, &prompt, nullptr);
    TakeInterrupt();
    RestoreTerminal();

    ChildOutcome outcome;
    outcome.run = true;
    if (WIFSIGNALED(raw)) {
        outcome.signal = WTERMSIG(raw);
    } else if (WIFEXITED(raw)) {
        // A command's own status is small; 128 and above is the status of a signal's ending.
        const int status = WEXITSTATUS(raw);
        if (status > 128)
            outcome.signal = status - 128;
        else
            outcome.status = status;
    }
    return outcome;
}
