#include "host/CommandTable.h"

#include "core/Strings.h"
#include "host/CommandHandlers.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "hostrt/HostRuntime.h"

#include <array>

namespace pyr::host {

namespace {

constexpr std::array<CommandEntry, 37> kCommands{{
    {"PyrCalTopo15", "PyrCalTopo15", nullptr, OnShowToolbar},
    {"PyraCalcOpt", "CalcOpt", "options des calculs topométriques.", OnCalcOpt},
    {"PyraLGeodim", "LGeodim", "transformation carnet Trimble GDM -> GéoBase", OnReadFieldBook},
    {"PyraLNikPsi", "LNikPsi", "transformation carnet Nikon/Psion -> GéoBase", OnReadFieldBook},
    {"PyraLNikAtl", "LNikAtl", "transformation carnet Nikon/Atlas -> GéoBase", OnReadFieldBook},
    {"PyraLNikKps", "LNikKps", "transformation carnet Nikon/Kheops -> GéoBase", OnReadFieldBook},
    {"PyraLSokkia", "LSokkia", "transformation carnet Sokkia -> GéoBase", OnReadFieldBook},
    {"PyraLQuenda", "LQuenda", "transformation carnet Quendal-Pc -> GéoBase", OnReadFieldBook},
    {"PyraLSeparat", "LSeparat", "transformation carnet Séparateur -> GéoBase", OnReadFieldBook},
    {"PyraLColonne", "LColonne", "transformation carnet Colonné -> GéoBase", OnReadFieldBook},
    {"PyraLTopcon", "LTopcon", "transformation carnet Topcon GT7 -> GéoBase", OnReadFieldBook},
    {"PyraLecWild", "LecWild", "transformation carnet Wild -> GéoBase", OnReadFieldBook},
    {"PyraLZeiss1", "LZeiss1", "transformation carnet Trimble Zeiss -> GéoBase", OnReadFieldBook},
    {"PyraEPoints", "EPoints", "transformation GéoBase -> fichier de points", OnExport},
    {"PyraEGeoBase", "EGeoBase", "transformation GéoBase -> GéoBase", OnExport},
    {"PyraESeparat", "ESeparat", "transformation GéoBase -> format séparateur", OnExport},
    {"PyraEColonne", "EColonne", "transformation GéoBase -> format colonné", OnExport},
    {"PyraEQuendal", "EQuendal", "transformation GéoBase -> carnet Quendal-Pc", OnExport},
    {"PyraELeica", "ELeica", "transformation GéoBase -> format Leica", OnExport},
    {"PyraESpectra", "ESpectra", "transformation GéoBase -> format Trimble GDM", OnExport},
    {"PyraESokkia", "ESokkia", "transformation GéoBase -> format Sokkia", OnExport},
    {"PyraGeoEdit", "GeoEdit", "éditeur de GéoBases", OnGeoEdit},
    {"PyraGeoEdit2", "GeoEdit2", "éditeur de GéoBases", OnGeoEdit},
    {"PyraCalInter", "CalInter", "calcul d'un point par intersections de visées", OnCalInter},
    {"PyraCalRelev", "CalRelev", "calcul d'un point par relèvement", OnCalRelev},
    {"PyraCalRecou", "CalRecou", "calcul d'un point par recoupement", OnCalRecou},
    {"PyraCalExcen", "CalExcen", "calcul d'une station excentrée", OnCalExcen},
    {"PyraCalTrian", "CalTrian", "calcul d'un point par triangulation", OnPending},
    {"PyraCalculV0", "CalculV0", "calcul du V0 d'une station", OnCalculV0},
    {"PyraCalChem", "CalChem", "calcul des cheminements polygonaux", OnCalChem},
    {"PyraCalRayon", "CalRayon", "calcul des points rayonnés", OnCalRayon},
    {"PyraCalBloc", "CalBloc", "calcul de compensation en bloc", OnPending},
    {"PyraCalNivSm", "CalNivSm", "calcul d'un cheminement altimétrique simple", OnCalNivSm},
    {"PyraCalNivSt", "CalNivSt", "calcul d'un cheminement par double station", OnCalNivSt},
    // The codification commands break the "Pyra" + local name rule of the global names.
    {"PyraAsmCode", "CalAsmCode", "fusion d'un fichier de codification", OnPending},
    {"PyraTabCode", "CalTabCode", "gestion d'un table de codes", OnTabCode},
    {"PyraDesCode", "CalDesCode", "traitement d'un levé codé", OnPending},
}};

class CommandTitles : public CPyrCommandTitles {
public:
    std::string Title(std::string_view globalName) const override {
        for (const CommandEntry& command : kCommands)
            if (EqualIgnoringCase(command.globalName, globalName)) return command.title ? command.title : "";
        return {};
    }
    bool Available(std::string_view globalName) const override {
        for (const CommandEntry& command : kCommands)
            if (EqualIgnoringCase(command.globalName, globalName)) return CommandAvailable(command);
        return false;
    }
};

CommandTitles g_titles;

} // namespace

std::span<const CommandEntry> CommandTable() {
    return kCommands;
}

bool RegisterCommands() {
    bool allAdded = true;
    for (const CommandEntry& command : kCommands)
        allAdded &= acedRegCmds()->addCommand(kCommandGroup, command.globalName, command.localName,
                                              ACRX_CMD_MODAL, [&command] { command.handler(command); });
    acrxServiceDictionary()->atPut(kCommandTitlesName, &g_titles);
    return allAdded;
}

void UnregisterCommands() {
    acedRegCmds()->removeGroup(kCommandGroup);
    if (acrxServiceDictionary()->at(kCommandTitlesName) == &g_titles)
        acrxServiceDictionary()->remove(kCommandTitlesName);
}

} // namespace pyr::host
