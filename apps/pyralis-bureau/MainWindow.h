#pragma once

#include "ModuleHost.h"

#include <QDateTime>
#include <QMainWindow>
#include <QString>
#include <map>
#include <string>
#include <vector>

class QAction;
class QLabel;
class QToolBar;

namespace pyr::bureau {

class CommandLine;
class GeoView;
class QtFrontEnd;
class TextWindow;

// The main window of the desktop host, as a CAD program shows a module: the toolbar "Calculs Topo" with
// every command, a menu with the same commands by group, the drawing of the current GéoBase in the
// middle, the text window and the command line "Commande : " at the foot, and a status bar.
class MainWindow : public QMainWindow {
    Q_OBJECT
public:
    MainWindow(ModuleHost& module, QtFrontEnd& frontEnd, QWidget* parent = nullptr);

    // Runs a command by its global or local name, as typed at the command line.
    void RunCommand(const QString& name);
    // Shows a GéoBase in the drawing; "" shows the last one used. False when it could not be read.
    bool ShowGeoBase(const QString& path);
    // The GéoBase drawn.
    const QString& GeoBasePath() const { return m_geoBase; }

    GeoView* View() const { return m_view; }
    TextWindow* Text() const { return m_text; }
    CommandLine* Line() const { return m_line; }
    QToolBar* Toolbar() const { return m_toolbar; }
    // The action of a command, by its local name (null for none).
    QAction* CommandAction(const std::string& localName) const;

private:
    void BuildActions();
    void BuildMenus();
    void BuildToolbar();
    void BuildDocks();
    void BuildStatusBar();
    void AfterCommand();
    void ChooseGeoBase();
    void UpdateTitle();
    void LoadHistory();
    void SaveHistory();

    ModuleHost& m_module;
    QtFrontEnd& m_frontEnd;
    std::vector<CommandInfo> m_commands;
    std::map<std::string, QAction*> m_actions; // by local name
    GeoView* m_view = nullptr;
    TextWindow* m_text = nullptr;
    CommandLine* m_line = nullptr;
    QToolBar* m_toolbar = nullptr;
    QLabel* m_coordinates = nullptr;
    QLabel* m_geoBaseLabel = nullptr;
    QString m_geoBase;
    QDateTime m_geoBaseTime; // when the GéoBase drawn was last written, to draw it again after a command
    bool m_running = false;
    bool m_historyReported = false;
};

} // namespace pyr::bureau
