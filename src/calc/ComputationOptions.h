#pragma once

#include "ui/Dialog.h"

#include <functional>
#include <optional>
#include <string>

// What every computation is asked on a command line besides its own choices: its two switches ("--plani
// 0|1", "--alti 0|1"), to write its results into the GéoBase and save it ("--enregistrer"), and to write
// its listing without the question ("--listing [FICHIER]", as "Fin + Listing" does); and how such a
// command line runs a computation and prints its fields.
namespace pyr {

class CSightingComputation;

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

// Runs a computation as its command line asks: the model takes the command's inputs and opens, its
// switches are set, `compute` does the command's own work (false when what was asked could not be
// computed), the GéoBase is saved when "--enregistrer" asks it (without the question of the closing), and
// the model closes, with its listing when "--listing" asks it.
ui::DialogResult RunComputation(ui::Dialog& face, CSightingComputation& model, ui::FrontEnd& frontEnd,
                                const ComputationRequests& requests, const std::function<bool()>& compute);

// A field of a dialog as the text window shows it: "-" when it is empty.
std::string Dashed(const std::string& text);
// A linear residual to the tenth of a millimetre, a zero without its sign; "-" when unknown.
std::string DashedMetres(double metres);

} // namespace pyr
