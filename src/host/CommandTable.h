#pragma once

#include <span>

namespace pyr::host {

struct CommandEntry;
// A command's handler is given its line of the table: commands that share a handler differ by their
// title (the export commands: the title selects the format).
using CommandHandler = void (*)(const CommandEntry& command);

struct CommandEntry {
    const char* globalName;
    const char* localName;
    const char* title; // null for the command that shows the toolbar again
    CommandHandler handler;
};

// The 37 commands, in the order they are registered (neither alphabetical nor the order of the
// handlers).
std::span<const CommandEntry> CommandTable();

// Adds every command of the table to the host's command stack, in the table's order, under the group
// "PYRALIS_FONCTIONS_2D_CALTOPO", and tells the host their titles. False when one could not be added.
bool RegisterCommands();
// Removes the group from the command stack and the titles from the service dictionary.
void UnregisterCommands();

} // namespace pyr::host
