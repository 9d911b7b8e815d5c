#pragma once

#include <chrono>
#include <string>

namespace pyr {

namespace ui {
class FrontEnd;
}

// How long the conversion waits for the pre-formatting program before it reads on.
inline constexpr std::chrono::milliseconds kPreformatWait{2000};

// The pre-formatting of a field book by an external program (the Wild format's "Preformattage"): the
// program is run with the field book's path as its one argument, and is expected to write the
// pre-formatted field book beside it with the extension ".tmp".
struct PreformatOutcome {
    std::string fileToRead; // the ".tmp" made by the program, or the field book itself
    bool temporary = false; // whether fileToRead is the program's file, to delete once read
};

// Runs `program` on `carnet` (no shell: the path reaches it as one argument, whatever it holds) and waits
// for it at most `wait`; a program still running then is left to finish on its own. When no program is
// named, nothing is run. When the program does not exist or cannot be started, the message says so and
// the field book is read as it is.
PreformatOutcome Preformat(const std::string& carnet, const std::string& program, ui::FrontEnd& parent,
                           std::chrono::milliseconds wait = kPreformatWait);

} // namespace pyr
