// pyralis-bureau: the desktop host. It loads the module PyrCalTopo15.arx as a CAD host would and gives
// its commands a window: the toolbar "Calculs Topo", the menus, the drawing of the current GéoBase, the
// text window and the command line. Without a display it can still draw the window, or a command's
// dialog, into a PNG file (--capture).
#include "Capture.h"
#include "MainWindow.h"
#include "ModuleHost.h"
#include "QtFrontEnd.h"
#include "hostrt/MainWindow.h"
#include "ui/FrontEnd.h"

#include <CLI/CLI.hpp>
#include <QApplication>
#include <QLibraryInfo>
#include <QTranslator>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

namespace {

constexpr int kStatusFailed = 1;

constexpr const char* kMsgNoDisplay =
    "pyralis-bureau : aucun écran n'est disponible (DISPLAY et WAYLAND_DISPLAY sont vides).\n"
    "Lancez-le depuis une session graphique, ou dessinez la fenêtre dans une image :\n"
    "  pyralis-bureau --capture FICHIER.png [--geobase GEOBASE] [--dialogue COMMANDE]\n";

struct Options {
    std::string params;
    std::string geoBase;
    std::string capture;
    std::string dialog;
    std::string button;
};

// The folder of this program: the host's support path, where its modules lie.
std::string ProgramFolder() {
    std::error_code error;
    const std::filesystem::path self = std::filesystem::read_symlink("/proc/self/exe", error);
    return error ? std::string(".") : self.parent_path().string();
}

bool HasDisplay() {
    for (const char* variable : {"DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM"}) {
        const char* value = std::getenv(variable);
        if (value && *value) return true;
    }
    return false;
}

// Qt's remarks on the platform without a display (no runtime folder, no window sizes to pass on) say
// nothing to a surveyor: they are left out; the others go where Qt sends them.
QtMessageHandler g_qtMessages = nullptr;
void FilterQtMessages(QtMsgType type, const QMessageLogContext& context, const QString& message) {
    if (message.contains("propagateSizeHints") || message.startsWith("QStandardPaths: XDG_RUNTIME_DIR"))
        return;
    g_qtMessages(type, context, message);
}

// Qt's own words (file dialogs, the standard buttons) in French when the translation is installed.
void TranslateQt(QApplication& application) {
    auto* translator = new QTranslator(&application);
    if (translator->load("qtbase_fr", QLibraryInfo::path(QLibraryInfo::TranslationsPath)))
        QApplication::installTranslator(translator);
}

int Capture(pyr::bureau::MainWindow& window, pyr::bureau::QtFrontEnd& frontEnd, const Options& options) {
    if (!options.dialog.empty()) {
        window.RunCommand(QString::fromStdString(options.dialog));
        if (!frontEnd.CaptureFailure().empty()) {
            std::fprintf(stderr, "pyralis-bureau : %s\n", frontEnd.CaptureFailure().c_str());
            return kStatusFailed;
        }
        if (!frontEnd.Captured()) {
            std::fprintf(stderr, "pyralis-bureau : la commande %s n'a pas ouvert de boîte de dialogue.\n",
                         options.dialog.c_str());
            return kStatusFailed;
        }
        return 0;
    }
    window.show();
    QApplication::processEvents();
    if (!pyr::bureau::SaveCapture(window, QString::fromStdString(options.capture))) {
        std::fprintf(stderr, "pyralis-bureau : l'image <%s> n'a pas pu être écrite.\n",
                     options.capture.c_str());
        return kStatusFailed;
    }
    return 0;
}

} // namespace

int main(int argc, char** argv) {
    Options options;
    CLI::App app("pyralis-bureau : la fenêtre de PYRALIS Calculs Topo.", "pyralis-bureau");
    app.add_option("--params", options.params, "le fichier de paramètres (ou une racine du registre)")
        ->option_text("CHEMIN");
    app.add_option("--geobase", options.geoBase, "la GéoBase à dessiner (la dernière utilisée sinon)")
        ->option_text("GEOBASE");
    app.add_option(
           "--capture", options.capture,
           "dessine la fenêtre (ou la boîte de dialogue de --dialogue) dans une image PNG, sans écran")
        ->option_text("FICHIER.png");
    app.add_option("--dialogue", options.dialog, "avec --capture : la commande dont la boîte est dessinée")
        ->option_text("COMMANDE");
    app.add_option("--bouton", options.button,
                   "avec --dialogue : le bouton de la boîte (son nom) qui ouvre la boîte à dessiner")
        ->option_text("NOM");
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
        return app.exit(error);
    }
    if ((!options.dialog.empty() && options.capture.empty()) ||
        (!options.button.empty() && options.dialog.empty())) {
        std::fputs("pyralis-bureau : --dialogue ne va qu'avec --capture, et --bouton qu'avec --dialogue.\n",
                   stderr);
        return 2;
    }
    const bool capture = !options.capture.empty();
    if (capture && !HasDisplay()) setenv("QT_QPA_PLATFORM", "offscreen", 1);
    if (!HasDisplay()) {
        std::fputs(kMsgNoDisplay, stderr);
        return kStatusFailed;
    }
    if (!options.params.empty()) setenv("PYRALIS_PARAMS", options.params.c_str(), 1);

    g_qtMessages = qInstallMessageHandler(FilterQtMessages);
    QApplication application(argc, argv);
    QApplication::setApplicationName("pyralis-bureau");
    TranslateQt(application);

    pyr::bureau::QtFrontEnd frontEnd;
    if (capture) {
        if (options.dialog.empty())
            frontEnd.SetUnattended(true);
        else
            frontEnd.SetCapture(options.capture, options.geoBase, options.button);
    }
    pyr::ui::SetApplicationFrontEnd(&frontEnd);
    pyr::SetMainWindow(&frontEnd);

    int status = 0;
    {
        pyr::bureau::ModuleHost module;
        if (!module.Load(ProgramFolder())) {
            frontEnd.MessageBox(module.Failure(), pyr::ui::kCaption, pyr::ui::kIconError);
            status = kStatusFailed;
        } else {
            pyr::bureau::MainWindow window(module, frontEnd);
            window.ShowGeoBase(QString::fromStdString(options.geoBase));
            if (capture) {
                status = Capture(window, frontEnd, options);
            } else {
                window.show();
                status = QApplication::exec();
            }
            frontEnd.SetParent(nullptr);
            frontEnd.SetTextWindow(nullptr);
        }
    }
    pyr::SetMainWindow(nullptr);
    pyr::ui::SetApplicationFrontEnd(nullptr);
    return status;
}
