#pragma once

#include "ui/Dialog.h"

#include <string>

// What every computation is asked on a command line besides its own choices: to write its results into the
// GéoBase and save it ("--enregistrer"), and to write its listing without the question ("--listing
// [FICHIER]", as "Fin + Listing" does).
namespace pyr {

struct ComputationRequests {
    bool save = false;
    bool listing = false;
    std::string listingPath; // "" for the listing's own name
};

// Declares "--enregistrer" with its help line, and "--listing [FICHIER]".
void DeclareComputationOptions(ui::DialogOptions& options, ComputationRequests& requests,
                               const char* saveHelp);

} // namespace pyr
