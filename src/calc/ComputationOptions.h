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

// The stations a computation takes, as the orientation of stations chooses them (CalculV0Sta.h).
enum class V0CalculationType;
struct StationChoiceRequests {
    std::optional<V0CalculationType> type;
    std::optional<std::string> station; // "S1" or "S1(2)"
    std::optional<std::string> list;    // a selection of stations
};
// Declares "--type unique|liste|toutes".
void DeclareTypeOption(ui::DialogOptions& options, StationChoiceRequests& requests, const char* help);
// Declares "--station NOM", which makes the type "unique".
void DeclareStationOption(ui::DialogOptions& options, StationChoiceRequests& requests, const char* help);
// Declares "--liste SELECTION", which makes the type "liste".
void DeclareListOption(ui::DialogOptions& options, StationChoiceRequests& requests, const char* help);

} // namespace pyr
