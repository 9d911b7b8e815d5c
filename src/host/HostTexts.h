#pragma once

// The names under which the module meets its host and its services, and the texts it shows.
namespace pyr::host {

inline constexpr const char* kAppName = "PyrCalTopo15";
inline constexpr const char* kModuleFile = "PyrCalTopo15.arx";
inline constexpr const char* kCommandGroup = "PYRALIS_FONCTIONS_2D_CALTOPO";
inline constexpr const char* kMainServicesName = "PyralisMainServices r17.2";
inline constexpr const char* kMainServicesModule = "Pyr2000Srv.arx";
inline constexpr const char* kScaleServicesName = "PyralisEchelleServices r17.2";
inline constexpr const char* kScaleServicesModule = "PyrSrvEchelle15.arx";
inline constexpr const char* kToolbarGroup = "Calculs Topo";
inline constexpr const char* kCommandsDictionary = "ACAD_REGISTERED_COMMANDS";
// The service under which the module tells its host the title of each of its commands.
inline constexpr const char* kCommandTitlesName = "PyrCalTopo15 Titres des commandes";

// Where the services module may lie, relative to the host's folders, after its bare name.
inline constexpr const char* kProgramsSibling = "..\\Programmes\\";
inline constexpr const char* kProgramsChild = "Programmes\\";

// Aborts: the module cannot run without its services.
inline constexpr const char* kMsgModuleNotFound = "Impossible de trouver le module <%s>!!!";
inline constexpr const char* kMsgModuleNotLoaded = "Impossible de charger le module <%s>!!!";
inline constexpr const char* kMsgNoService = "Pas de service <%s>\nenregistré par le module <%s>!!!";

inline constexpr const char* kMsgNotAvailable =
    "La commande %s (%s) n'est pas encore disponible dans cette version de PYRALIS Calculs Topo.";
inline constexpr const char* kMsgToolbarShown = "Barre d'outils « %s » affichée.";

} // namespace pyr::host
