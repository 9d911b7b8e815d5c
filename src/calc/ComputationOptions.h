#pragma once

#include "ui/Dialog.h"

#include <optional>
#include <string>

// What every computation is asked on a command line besides its own choices: its two switches ("--plani
// 0|1", "--alti 0|1"), to write its results into the GéoBase and save it ("--enregistrer"), and to write
// its listing without the question ("--listing [FICHIER]", as "Fin + Listing" does).
namespace pyr {

struct ComputationRequests {
    bool save = false;
    bool listing = false;
    std::string listingPath;         // "" for the listing's own name
    std::optional<bool> plani, alti; // unset: as the last time
};

// Declares "--enregistrer" with its help line, and "--listing [FICHIER]".
void DeclareComputationOptions(ui::DialogOptions& options, ComputationRequests& requests,
                               const char* saveHelp);
// Declares "--plani 0|1" and "--alti 0|1".
void DeclareSwitchOptions(ui::DialogOptions& options, ComputationRequests& requests);

} // namespace pyr
