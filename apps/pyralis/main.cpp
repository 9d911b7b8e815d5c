// pyralis: the command-line host. It loads the module PyrCalTopo15.arx as a CAD host would, lists its
// commands, runs one by its global or local name, or gives a person a "Commande : " prompt.
#include "HostOptions.h"
#include "LineEditor.h"
#include "Signals.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "hostrt/HostRuntime.h"
#include "settings/ConfigPaths.h"
#include "ui/ConsoleFrontEnd.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

using pyr::host::CPyrCommandTitles;
using pyr::ui::TypedLine;

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
    "  --help            cette aide ; « pyralis COMMANDE --help » donne les options de la commande\n"
    "\n"
    "À l'invite « Commande : » :\n"
    "  Entrée sur une ligne vide   répète la dernière commande, avec ses options\n"
    "  Haut, Bas, Ctrl-R           rappellent les commandes tapées, gardées d'une session à l'autre\n"
    "  Tab                         complète le nom d'une commande, puis les noms de fichiers\n"
    "  Échap, Ctrl-C               annulent la ligne tapée\n"
    "  ?, AIDE                     la liste des commandes\n"
    "  FIN, Ctrl-D                 terminent pyralis\n"
    "Pendant une commande :\n"
    "  Ctrl-C                      annule la commande et revient à l'invite ; aucun fichier n'est laissé\n"
    "                              à moitié écrit\n"
    "  Entrée, Ctrl-D              donnent à une question sa réponse par défaut (entre crochets)\n"
    "  Échap                       annule la question : Annuler, ou Non quand elle n'offre que Oui et\n"
    "                              Non ; aucun fichier pour un choix de fichier\n"
    "\n"
    "Sans invite, Ctrl-C (ou le signal SIGTERM) arrête pyralis avec le code 130 (143) ; les fichiers en\n"
    "cours d'écriture restent tels qu'ils étaient.\n";

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

// The names that Tab completes at the prompt: the commands' global and local names, the prompt's words.
std::vector<std::string> PromptNames() {
    std::vector<std::string> names;
    for (const AcEdCommand& command : acedRegCmds()->commands()) {
        if (command.group != pyr::host::kCommandGroup) continue;
        names.push_back(command.globalName);
        names.push_back(command.localName);
    }
    names.insert(names.end(), {"AIDE", "FIN"});
    return names;
}

std::string HistoryFile() {
    return pyr::PyralisConfigFolder() + "/historique.txt";
}

// A command run from the prompt at a terminal runs in a process of its own, so that Ctrl-C can stop it at
// any moment, in a question or in a computation, and give the prompt back.
void RunFromPrompt(pyr::ui::ConsoleFrontEnd& console, const std::string& name,
                   std::vector<std::string> words) {
    const ChildOutcome outcome = RunInChild([&] { return RunCommand(console, name, std::move(words)); });
    if (outcome.signal == SIGINT)
        std::fputs("\n*Annulé*\n", stderr);
    else if (outcome.signal != 0)
        std::fprintf(stderr, "\n*Interrompu* : la commande %s s'est arrêtée sur le signal %d.\n",
                     name.c_str(), outcome.signal);
}

// The line without the blanks around it (a completed name ends with one): kept and repeated as typed.
std::string Trimmed(const std::string& line) {
    const std::size_t first = line.find_first_not_of(" \t\r");
    if (first == std::string::npos) return std::string();
    return line.substr(first, line.find_last_not_of(" \t\r") - first + 1);
}

bool IsCommand(const std::string& name) {
    return acedRegCmds()->lookupCmd(name) != nullptr;
}

void Prompt(pyr::ui::ConsoleFrontEnd& console, LineEditor* editor) {
    std::string last; // the last command line run, that Enter on an empty line runs again
    bool historyReported = false;
    while (true) {
        const TypedLine typed = console.Prompt("Commande : ");
        if (typed.kind == TypedLine::Kind::End) break;
        if (typed.kind == TypedLine::Kind::Cancel) {
            std::fputs("*Annulé*\n", stderr);
            continue;
        }
        std::string line = Trimmed(typed.text);
        std::vector<std::string> words = SplitCommandLine(line);
        if (words.empty()) {
            if (last.empty()) continue;
            line = last;
            words = SplitCommandLine(line);
            std::fprintf(stderr, "%s\n", line.c_str());
        }
        const std::string name = words.front();
        if (name == "FIN" || name == "fin" || name == "QUITTER" || name == "quitter") return;
        if (editor && !editor->Remember(line) && !historyReported) {
            std::fprintf(stderr, "%s\n", editor->Failure().c_str());
            historyReported = true;
        }
        if (name == "?" || name == "AIDE" || name == "aide") {
            ListCommands();
            continue;
        }
        if (IsCommand(name)) last = line;
        words.erase(words.begin());
        if (editor && IsCommand(name))
            RunFromPrompt(console, name, std::move(words));
        else
            RunCommand(console, name, std::move(words));
    }
    if (!editor) std::fputc('\n', stderr);
}

} // namespace

int main(int argc, char** argv) {
    // A file grown past the size limit of the session (ulimit -f) must fail its write, as a full disk
    // does, rather than end the program: the safe writers then leave every file as it was.
    std::signal(SIGXFSZ, SIG_IGN);
    RememberTerminal();
    EndOnSignals();
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

    // A person at the terminal answers the questions, and types at the prompt, through the line editor.
    std::unique_ptr<LineEditor> editor;
    if (LineEditor::Usable()) {
        editor = std::make_unique<LineEditor>(PromptNames(), HistoryFile());
        console.SetLineReader(editor.get());
    }

    int status = 0;
    if (!options.command.empty()) {
        status = RunCommand(console, options.command, options.commandWords);
    } else {
        ListCommands();
        if (options.interactive || isatty(fileno(stdin))) {
            if (editor) InterruptOnSignals();
            Prompt(console, editor.get());
            EndOnSignals();
        }
    }
    console.SetLineReader(nullptr);
    editor.reset();

    acrxDynamicLinker()->sendDocumentMessage(AcRx::kUnloadDwgMsg, &drawing);
    acrxDynamicLinker()->unloadAll();
    pyr::SetMainWindow(nullptr);
    return status;
}
