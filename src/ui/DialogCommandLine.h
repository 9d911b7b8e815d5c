#pragma once

#include "ui/Dialog.h"

#include <string>
#include <string_view>
#include <vector>

// The one mechanism that drives a dialog from a command line: the dialog's declared options, plus
// "--geobase FICHIER" (the GéoBase instead of the last one used) and "--help", parsed with their
// values and applied to the dialog in the order they were given, after the words that are no option
// (the positional arguments the dialog declares: "pyralis LecWild CARNET").
namespace pyr::ui {

struct CommandLineOutcome {
    enum class Kind {
        Run,    // every option applied: run the dialog
        Help,   // "--help" was asked: `text` is the help, nothing was applied
        Usage,  // the words do not parse (unknown option, missing value): `text` says why
        Refused // the dialog refused a value: `text` is its reason; what came before was applied
    };
    Kind kind = Kind::Run;
    std::string text;
};

// `command` is the name the command was called by (for the help and the messages); `arguments` the
// words after it.
CommandLineOutcome ApplyCommandLine(Dialog& dialog, std::string_view command,
                                    const std::vector<std::string>& arguments);

// The French help of a command: its name, the dialog's title, every option with its value and its line.
std::string DialogHelp(Dialog& dialog, std::string_view command);

} // namespace pyr::ui
