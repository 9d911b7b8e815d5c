#include "calc/ComputationOptions.h"

#include "calc/SightingComputation.h"
#include "core/Numbers.h"
#include "core/Undefined.h"

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

ui::DialogResult RunComputation(ui::Dialog& face, CSightingComputation& model, ui::FrontEnd& frontEnd,
                                const ComputationRequests& requests, const std::function<bool()>& compute) {
    model.SetInputs(face.Inputs());
    if (face.GeoBaseNamed()) model.SetGeoBase(face.GeoBase());
    if (!model.Open(frontEnd)) return model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed;
    if (requests.plani) model.SetPlani(*requests.plani);
    if (requests.alti) model.SetAlti(*requests.alti);
    bool ok = compute();
    if (requests.save && model.Modified() && !model.Save()) ok = false;
    model.Close(requests.listing, requests.listingPath);
    return ok ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::string Dashed(const std::string& text) {
    return text.empty() ? std::string("-") : text;
}

std::string DashedMetres(double metres) {
    return IsKnown(metres) ? FormatFixedShown(metres, 4) : std::string("-");
}

} // namespace pyr
