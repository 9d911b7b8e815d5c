#pragma once

#include <QLineEdit>
#include <QStringList>

class QCompleter;
class QStringListModel;

namespace pyr::bureau {

// The command line at the foot of the window, as in a CAD program: a command typed by its global or
// local name (completed as it is typed), Up and Down recall the commands typed before, Enter on an
// empty line repeats the last command, Escape clears the line.
class CommandLine : public QLineEdit {
    Q_OBJECT
public:
    explicit CommandLine(QWidget* parent = nullptr);

    // The names the completion offers.
    void SetNames(const QStringList& names);
    // The commands typed before, the oldest first (kept from one session to the next by the window).
    void SetHistory(QStringList history);
    const QStringList& History() const { return m_history; }
    const QString& Last() const { return m_last; }
    // Records a command run by another way (the toolbar, the menu), so that Enter repeats it.
    void Remember(const QString& command);

signals:
    // A command to run: what was typed, or the last command again.
    void CommandEntered(const QString& command);

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    void Enter();

    QStringListModel* m_names = nullptr;
    QCompleter* m_completer = nullptr;
    QStringList m_history;
    QString m_last;
    int m_recalled = -1; // the rank in the history of the command shown, -1 for the line being typed
};

} // namespace pyr::bureau
