#pragma once

#include <optional>
#include <string>
#include <vector>

// The words of the command line of pyralis, sorted: the host's own options wherever they stand, the
// command's name, and the words that go to the command's dialog.
struct HostOptions {
    std::optional<std::string> params; // --params CHEMIN
    std::optional<bool> answer;        // --oui (true) / --non (false)
    bool interactive = false;          // --interactif
    bool help = false;                 // --help before any command
    std::string command;
    std::vector<std::string> commandWords;
    std::string error; // French, when the words make no sense
};

HostOptions ParseHostOptions(const std::vector<std::string>& words);

// A line typed at the "Commande : " prompt, cut into words: blanks separate them, double quotes keep
// blanks inside one.
std::vector<std::string> SplitCommandLine(const std::string& line);
