#include "MainWindow.h"

#include "CommandIcons.h"
#include "CommandLine.h"
#include "GeoView.h"
#include "QtFrontEnd.h"
#include "TextWindow.h"
#include "core/SafeFile.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "settings/ConfigPaths.h"

#include <QAction>
#include <QApplication>
#include <QDockWidget>
#include <QFile>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QMenuBar>
#include <QMessageBox>
#include <QStatusBar>
#include <QTextStream>
#include <QToolBar>
#include <QVBoxLayout>
#include <filesystem>

namespace pyr::bureau {

namespace {

QString Utf8(const std::string& text) {
    return QString::fromStdString(text);
}

// The menu of the commands, by group: each command's local name, in the module's order within its group.
struct MenuGroup {
    const char* title;
    std::vector<const char*> commands;
};

const std::vector<MenuGroup>& MenuGroups() {
    static const std::vector<MenuGroup> groups = {
        {"&Options", {"CalcOpt", "PyrCalTopo15"}},
        {"&Lecture de carnets",
         {"LGeodim", "LNikPsi", "LNikAtl", "LNikKps", "LSokkia", "LQuenda", "LSeparat", "LColonne", "LTopcon",
          "LecWild", "LZeiss1"}},
        {"&Exports",
         {"EPoints", "EGeoBase", "ESeparat", "EColonne", "EQuendal", "ELeica", "ESpectra", "ESokkia"}},
        {"É&diteur", {"GeoEdit", "GeoEdit2"}},
        {"&Calculs",
         {"CalculV0", "CalInter", "CalRelev", "CalRecou", "CalExcen", "CalTrian", "CalRayon", "CalChem",
          "CalBloc"}},
        {"&Nivellement", {"CalNivSm", "CalNivSt"}},
        {"Co&dification", {"CalAsmCode", "CalTabCode", "CalDesCode"}},
    };
    return groups;
}

// A command's title as a menu shows it: its first letter in capitals ("Calcul du V0 d'une station").
QString MenuText(const CommandInfo& command) {
    if (command.title.empty()) return QString("Barre d'outils « %1 »").arg(host::kToolbarGroup);
    QString text = Utf8(command.title);
    if (text.endsWith('.')) text.chop(1);
    text[0] = text[0].toUpper();
    return text;
}

QString HistoryPath() {
    return Utf8(PyralisConfigFolder()) + "/historique-bureau.txt";
}

} // namespace

MainWindow::MainWindow(ModuleHost& module, QtFrontEnd& frontEnd, QWidget* parent)
    : QMainWindow(parent), m_module(module), m_frontEnd(frontEnd) {
    setObjectName("fenetrePrincipale");
    m_commands = m_module.Commands();
    m_view = new GeoView(this);
    m_view->setObjectName("dessin");
    setCentralWidget(m_view);
    BuildActions();
    BuildMenus();
    BuildToolbar();
    BuildDocks();
    BuildStatusBar();
    m_frontEnd.SetParent(this);
    m_frontEnd.SetTextWindow(m_text);
    LoadHistory();
    UpdateTitle();
    m_text->AddLine(QString("PYRALIS Calculs Topo : %1 commandes ; « ? » en donne la liste, Entrée répète la "
                            "dernière.")
                        .arg(m_commands.size()));
    resize(1280, 860);
}

QAction* MainWindow::CommandAction(const std::string& localName) const {
    const auto found = m_actions.find(localName);
    return found == m_actions.end() ? nullptr : found->second;
}

void MainWindow::BuildActions() {
    for (const CommandInfo& command : m_commands) {
        auto* action = new QAction(CommandIcon(command.localName), MenuText(command), this);
        action->setObjectName(Utf8(command.localName));
        QString tip = command.title.empty() ? MenuText(command) : Utf8(command.title);
        tip += QString(" (%1)").arg(Utf8(command.localName));
        if (!command.available) tip += " - pas encore disponible";
        action->setToolTip(tip);
        action->setStatusTip(tip);
        action->setEnabled(command.available);
        const QString name = Utf8(command.localName);
        connect(action, &QAction::triggered, this, [this, name] {
            m_line->Remember(name);
            RunCommand(name);
        });
        m_actions[command.localName] = action;
    }
}

void MainWindow::BuildMenus() {
    QMenu* file = menuBar()->addMenu("&Fichier");
    QAction* open = file->addAction("&Dessiner une GéoBase...", this, &MainWindow::ChooseGeoBase);
    open->setShortcut(QKeySequence::Open);
    file->addSeparator();
    QAction* quit = file->addAction("&Quitter", this, &QWidget::close);
    quit->setShortcut(QKeySequence("Ctrl+Q"));

    QMenu* commands = menuBar()->addMenu("Calculs &Topo");
    for (const MenuGroup& group : MenuGroups()) {
        QMenu* menu = commands->addMenu(group.title);
        for (const char* name : group.commands)
            if (QAction* action = CommandAction(name)) menu->addAction(action);
    }

    QMenu* view = menuBar()->addMenu("&Affichage");
    QAction* fit = view->addAction("&Tout voir", m_view, &GeoView::FitAll);
    fit->setShortcut(QKeySequence("Home"));
    m_toolbar = new QToolBar(host::kToolbarGroup, this);
    view->addAction(m_toolbar->toggleViewAction());

    QMenu* help = menuBar()->addMenu("A&ide");
    help->addAction("Liste des &commandes", this, [this] { RunCommand("?"); });
    help->addAction("À &propos", this, [this] {
        QMessageBox::about(
            this, "PYRALIS",
            "PYRALIS Calculs Topo\n\nCalculs topométriques pour les géomètres : lecture des carnets "
            "de terrain, GéoBases, V0 de stations, intersections, listings.");
    });
}

void MainWindow::BuildToolbar() {
    m_toolbar->setObjectName("barreCalculsTopo");
    m_toolbar->setIconSize(QSize(24, 24));
    for (const CommandInfo& command : m_commands) {
        // Separators between the groups, as the menu has them.
        if (command.localName == "LGeodim" || command.localName == "EPoints" ||
            command.localName == "GeoEdit" || command.localName == "CalInter" ||
            command.localName == "CalAsmCode")
            m_toolbar->addSeparator();
        m_toolbar->addAction(CommandAction(command.localName));
    }
    addToolBar(Qt::TopToolBarArea, m_toolbar);
}

void MainWindow::BuildDocks() {
    auto* dock = new QDockWidget("Fenêtre de texte", this);
    dock->setObjectName("dockTexte");
    dock->setFeatures(QDockWidget::DockWidgetMovable | QDockWidget::DockWidgetFloatable);
    auto* panel = new QWidget(dock);
    auto* layout = new QVBoxLayout(panel);
    layout->setContentsMargins(2, 2, 2, 2);
    layout->setSpacing(2);
    m_text = new TextWindow(panel);
    layout->addWidget(m_text, 1);
    auto* prompt = new QHBoxLayout;
    auto* label = new QLabel("Commande : ", panel);
    m_line = new CommandLine(panel);
    label->setBuddy(m_line);
    prompt->addWidget(label);
    prompt->addWidget(m_line, 1);
    layout->addLayout(prompt);
    dock->setWidget(panel);
    addDockWidget(Qt::BottomDockWidgetArea, dock);
    resizeDocks({dock}, {200}, Qt::Vertical);

    QStringList names;
    for (const CommandInfo& command : m_commands)
        names << Utf8(command.localName) << Utf8(command.globalName);
    names << "AIDE"
          << "FIN";
    m_line->SetNames(names);
    connect(m_line, &CommandLine::CommandEntered, this, &MainWindow::RunCommand);
}

void MainWindow::BuildStatusBar() {
    m_geoBaseLabel = new QLabel(this);
    m_coordinates = new QLabel(this);
    m_coordinates->setMinimumWidth(m_coordinates->fontMetrics().averageCharWidth() * 36);
    statusBar()->addWidget(m_geoBaseLabel, 1);
    statusBar()->addPermanentWidget(m_coordinates);
    connect(m_view, &GeoView::CursorMoved, this, [this](double x, double y) {
        m_coordinates->setText(QString("X = %1   Y = %2").arg(x, 0, 'f', 3).arg(y, 0, 'f', 3));
    });
    connect(m_view, &GeoView::Picked, this, [this](const QString& description) {
        statusBar()->showMessage(description);
        m_text->AddLine(description);
    });
}

void MainWindow::RunCommand(const QString& typed) {
    const QStringList words = typed.split(' ', Qt::SkipEmptyParts);
    if (words.isEmpty() || m_running) return;
    const QString name = words.front();
    m_text->AddLine("Commande : " + typed);
    const QString upper = name.toUpper();
    if (upper == "FIN" || upper == "QUITTER") {
        close();
        return;
    }
    if (upper == "?" || upper == "AIDE") {
        for (const CommandInfo& command : m_commands)
            m_text->AddLine(QString("%1 %2 %3")
                                .arg(Utf8(command.globalName), -14)
                                .arg(Utf8(command.localName), -12)
                                .arg(command.title.empty() ? MenuText(command) : Utf8(command.title)));
        return;
    }
    if (!m_module.IsCommand(name.toStdString())) {
        m_text->AddLine(QString("Commande inconnue « %1 » ; « ? » en donne la liste.").arg(name));
        return;
    }
    SaveHistory();
    if (words.size() > 1)
        m_text->AddLine(
            "Les options d'une commande sont celles de pyralis ; ici, sa boîte de dialogue les donne.");
    m_running = true;
    m_frontEnd.ResetFailures();
    m_module.Run(name.toStdString());
    m_running = false;
    AfterCommand();
}

void MainWindow::AfterCommand() {
    if (host::CPyrMainServices* services = m_module.Services())
        m_toolbar->setVisible(services->IsToolbarVisible(host::kToolbarGroup));
    // The GéoBase the command used, or the one drawn when it was written again.
    const QString last = Utf8(m_module.LastGeoBase());
    const QString path = last.isEmpty() ? m_geoBase : last;
    if (path.isEmpty()) return;
    const QDateTime written = QFileInfo(path).lastModified();
    if (path != m_geoBase || written != m_geoBaseTime) ShowGeoBase(path);
}

bool MainWindow::ShowGeoBase(const QString& path) {
    const QString shown = path.isEmpty() ? Utf8(m_module.LastGeoBase()) : path;
    if (shown.isEmpty()) return false;
    m_geoBase = shown;
    m_geoBaseTime = QFileInfo(shown).lastModified();
    const bool drawn = m_view->Show(shown.toStdString());
    UpdateTitle();
    return drawn;
}

void MainWindow::ChooseGeoBase() {
    ui::FileChoice choice;
    choice.title = "Choisissez la GéoBase à dessiner :";
    choice.filter = "GéoBase PYRALIS (*.geo)|*.geo||";
    choice.defaultExtension = "geo";
    choice.startPath = m_geoBase.toStdString();
    if (const std::optional<std::string> path = m_frontEnd.ChooseFile(choice)) ShowGeoBase(Utf8(*path));
}

void MainWindow::UpdateTitle() {
    if (m_geoBase.isEmpty()) {
        setWindowTitle("PYRALIS Calculs Topo");
        m_geoBaseLabel->setText("Aucune GéoBase");
        return;
    }
    setWindowTitle(QString("PYRALIS Calculs Topo - %1").arg(QFileInfo(m_geoBase).fileName()));
    m_geoBaseLabel->setText(QString("GéoBase : %1").arg(m_geoBase));
}

void MainWindow::LoadHistory() {
    QFile file(HistoryPath());
    if (!file.open(QIODevice::ReadOnly | QIODevice::Text)) return;
    QStringList history;
    QTextStream in(&file);
    while (!in.atEnd()) {
        const QString line = in.readLine().trimmed();
        if (!line.isEmpty()) history << line;
    }
    m_line->SetHistory(history);
}

void MainWindow::SaveHistory() {
    // Replaced whole, as every file the program writes; a failure is told once in the text window.
    std::string text;
    for (const QString& line : m_line->History())
        text += line.toStdString() + '\n';
    const std::string path = HistoryPath().toStdString();
    std::error_code ignored;
    std::filesystem::create_directories(std::filesystem::path(path).parent_path(), ignored);
    const int error = ReplaceFileContents(path, text);
    if (error != 0 && !m_historyReported) {
        m_text->AddLine(Utf8("Historique des commandes non enregistré : " + FileWriteFailure(path, error)));
        m_historyReported = true;
    }
}

} // namespace pyr::bureau
