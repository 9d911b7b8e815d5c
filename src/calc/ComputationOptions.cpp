#include "calc/ComputationOptions.h"

#include "calc/CalculV0Sta.h"
#include "calc/CalculV0Texts.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Selection.h"

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

void DeclareTypeOption(ui::DialogOptions& options, StationChoiceRequests& requests, const char* help) {
    options.Value("type", "unique|liste|toutes", help, [&requests](const std::string& word) {
        using Type = V0CalculationType;
        const struct {
            const char* word;
            Type type;
        } types[] = {{"unique", Type::Unique}, {"liste", Type::Liste}, {"toutes", Type::Toutes}};
        for (const auto& [name, type] : types)
            if (EqualIgnoringCase(word, name)) {
                requests.type = type;
                return std::string();
            }
        return Sprintf(v0::kBadType, word.c_str());
    });
}

void DeclareStationOption(ui::DialogOptions& options, StationChoiceRequests& requests, const char* help) {
    options.Value("station", "NOM", help, [&requests](const std::string& designation) {
        std::string name;
        int reprise = 0;
        if (!CCarnet::extrStaRep(designation, name, reprise) || name.empty())
            return Sprintf(v0::kBadStation, designation.c_str());
        requests.station = designation;
        requests.type = V0CalculationType::Unique;
        return std::string();
    });
}

void DeclareListOption(ui::DialogOptions& options, StationChoiceRequests& requests, const char* help) {
    options.Value("liste", "SELECTION", help, [&requests](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        requests.list = selection;
        requests.type = V0CalculationType::Liste;
        return std::string();
    });
}

} // namespace pyr
