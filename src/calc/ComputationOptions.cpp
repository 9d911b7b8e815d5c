#include "calc/ComputationOptions.h"

namespace pyr {

namespace {
constexpr const char* kHelpListing =
    "écrire le listing sans le demander (« Fin + Listing »), dans FICHIER s'il "
    "est donné";
constexpr const char* kHelpPlani =
    "calculer la planimétrie (1) ou non (0) ; par défaut, comme la dernière fois";
constexpr const char* kHelpAlti = "calculer l'altimétrie (1) ou non (0) ; par défaut, comme la dernière fois";
} // namespace

void DeclareComputationOptions(ui::DialogOptions& options, ComputationRequests& requests,
                               const char* saveHelp) {
    options.Switch("enregistrer", saveHelp, [&requests] {
        requests.save = true;
        return std::string();
    });
    options.OptionalValue("listing", "FICHIER", kHelpListing, [&requests](const std::string& path) {
        requests.listing = true;
        requests.listingPath = path;
        return std::string();
    });
}

void DeclareSwitchOptions(ui::DialogOptions& options, ComputationRequests& requests) {
    options.ZeroOrOne("plani", kHelpPlani, [&requests](bool on) { requests.plani = on; });
    options.ZeroOrOne("alti", kHelpAlti, [&requests](bool on) { requests.alti = on; });
}

} // namespace pyr
