#pragma once

#include <functional>

// What pyralis does when it is interrupted. Every file it writes is replaced whole or not at all, so a
// command stopped at any moment leaves the files as they were, once the temporary files of its writers are
// removed.

// Notes the terminal's settings (when standard input is one), given back whatever ends the program: a line
// editor may have changed them.
void RememberTerminal();
void RestoreTerminal();

// A run without the prompt, and a command run from the prompt: SIGINT, SIGTERM and SIGHUP remove the
// temporary files of the writers still open, give the terminal back and end the process with 128 plus the
// signal's number (130, 143, 129).
void EndOnSignals();

// The prompt: Ctrl-C (SIGINT) only cancels the line being typed, which the line editor learns through
// TakeInterrupt; SIGTERM and SIGHUP end the running command first, then the program.
void InterruptOnSignals();
// Whether SIGINT came since the last call, which clears it.
bool TakeInterrupt();
// What becomes readable when SIGINT comes at the prompt (poll it with the terminal); -1 without the prompt.
int InterruptDescriptor();
// Whether the terminal changed its size since the last call, which clears it.
bool TakeResize();

// How a command run in a child process ended.
struct ChildOutcome {
    int status = 0;   // the command's status when it ended by itself
    int signal = 0;   // the signal that ended it (SIGINT when the person pressed Ctrl-C), else 0
    bool run = false; // false when no child could be made: the command was run here
};

// Runs `command` in a child process and waits for it; the child ends with the status that `command` returns.
// Ctrl-C ends the child alone (EndOnSignals in the child); this process ignores it while it waits, then
// gives the terminal its settings back. Without a child (fork refused), `command` runs here.
ChildOutcome RunInChild(const std::function<int()>& command);
