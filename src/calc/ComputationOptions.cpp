#include "calc/ComputationOptions.h"

namespace pyr {

namespace {
constexpr const char* kHelpListing =
    "écrire le listing sans le demander (« Fin + Listing »), dans FICHIER s'il "
    "est donné";
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

} // namespace pyr
