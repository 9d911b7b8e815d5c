// pyralis: the command-line host. It loads the module PyrCalTopo15.arx as a CAD host would, lists its
// commands, runs one by its global or local name, or gives a person a "Commande : " prompt.
#include "HostOptions.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "hostrt/HostRuntime.h"
#include "ui/ConsoleFrontEnd.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

using pyr::host::CPyrCommandTitles;

constexpr const char* kUsage =
    "Usage : pyralis [--params CHEMIN] [--oui | --non] [COMMANDE [options]]\n"
    "\n"
    "Sans commande, pyralis donne la liste des commandes (nom global, nom local, titre), puis, devant un\n"
    "terminal, l'invite « Commande : ». Une commande s'appelle par son nom global ou local, sans souci des\n"
    "majuscules : pyralis CalInter, pyralis PyraCalInter.\n"
    "\n"
    "Options de pyralis, valables pour toute commande :\n"
    "  --params CHEMIN   le fichier de paramètres (ou une racine du registre, HKEY_CURRENT_USER ...)\n"
    "  --oui, --non      la réponse aux questions posées en traitement par lots\n"
    "  --interactif      l'invite « Commande : » même sans terminal\n"
    "  --help            cette aide ; « pyralis COMMANDE --help » donne les options de la commande\n";

constexpr int kStatusUsage = 2;
constexpr int kStatusFailed = 1;

// The folder of this program: the host's support path, where its modules lie.
std::string ProgramFolder() {
    std::error_code error;
    std::filesystem::path self = std::filesystem::read_symlink("/proc/self/exe", error);
    return error ? std::string(".") : self.parent_path().string();
}

const CPyrCommandTitles* Titles() {
    return static_cast<const CPyrCommandTitles*>(acrxServiceDictionary()->at(pyr::host::kCommandTitlesName));
}

void ListCommands() {
    const CPyrCommandTitles* titles = Titles();
    for (const AcEdCommand& command : acedRegCmds()->commands()) {
        if (command.group != pyr::host::kCommandGroup) continue;
        std::string title = titles ? titles->Title(command.globalName) : std::string();
        if (title.empty())
            title = std::string("(affiche la barre d'outils « ") + pyr::host::kToolbarGroup + " »)";
        std::printf("%-14s %-12s %s\n", command.globalName.c_str(), command.localName.c_str(), title.c_str());
    }
    std::fflush(stdout);
}

int RunCommand(pyr::ui::ConsoleFrontEnd& console, const std::string& name, std::vector<std::string> words) {
    if (!acedRegCmds()->lookupCmd(name)) {
        std::fprintf(stderr, "pyralis : commande inconnue « %s » ; « pyralis » seul en donne la liste.\n",
                     name.c_str());
        return kStatusUsage;
    }
    console.SetCommand(name, std::move(words));
    acedRegCmds()->runCommand(name);
    std::fflush(stdout);
    return console.Status();
}

void Prompt(pyr::ui::ConsoleFrontEnd& console) {
    while (std::optional<std::string> line = console.Prompt("Commande : ")) {
        std::vector<std::string> words = SplitCommandLine(*line);
        if (words.empty()) continue;
        const std::string name = words.front();
        if (name == "FIN" || name == "fin" || name == "QUITTER" || name == "quitter") return;
        if (name == "?" || name == "AIDE" || name == "aide") {
            ListCommands();
            continue;
        }
        words.erase(words.begin());
        RunCommand(console, name, std::move(words));
    }
    std::fputc('\n', stderr);
}

} // namespace

int main(int argc, char** argv) {
    // A file grown past the size limit of the session (ulimit -f) must fail its write, as a full disk
    // does, rather than end the program: the safe writers then leave every file as it was.
    std::signal(SIGXFSZ, SIG_IGN);
    const HostOptions options = ParseHostOptions(std::vector<std::string>(argv + 1, argv + argc));
    if (!options.error.empty()) {
        std::fprintf(stderr, "pyralis : %s\n\n%s", options.error.c_str(), kUsage);
        return kStatusUsage;
    }
    if (options.help) {
        std::fputs(kUsage, stdout);
        return 0;
    }
    // The parameter path goes where the services look for it.
    if (options.params) setenv("PYRALIS_PARAMS", options.params->c_str(), 1);

    pyr::ui::ConsoleFrontEnd console;
    if (options.answer) console.SetBatchAnswer(*options.answer ? pyr::ui::Answer::Yes : pyr::ui::Answer::No);
    if (options.interactive) console.SetInteractive(true);
    pyr::ui::SetApplicationFrontEnd(&console);
    pyr::SetMainWindow(&console);
    pyr::SetSupportPath({ProgramFolder()});

    std::string module;
    if (acedFindFile(pyr::host::kModuleFile, module) != RTNORM || !acrxDynamicLinker()->loadModule(module)) {
        std::fprintf(stderr, pyr::host::kMsgModuleNotLoaded, pyr::host::kModuleFile);
        std::fprintf(stderr, "\n%s\n", acrxDynamicLinker()->lastError().c_str());
        return kStatusFailed;
    }
    static int drawing = 0; // the one drawing of this host
    acrxDynamicLinker()->sendDocumentMessage(AcRx::kLoadDwgMsg, &drawing);

    int status = 0;
    if (!options.command.empty()) {
        status = RunCommand(console, options.command, options.commandWords);
    } else {
        ListCommands();
        if (options.interactive || isatty(fileno(stdin))) Prompt(console);
    }

    acrxDynamicLinker()->sendDocumentMessage(AcRx::kUnloadDwgMsg, &drawing);
    acrxDynamicLinker()->unloadAll();
    pyr::SetMainWindow(nullptr);
    return status;
}
