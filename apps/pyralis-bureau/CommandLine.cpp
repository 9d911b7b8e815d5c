#include "CommandLine.h"

#include <QAbstractItemView>
#include <QCompleter>
#include <QKeyEvent>
#include <QStringListModel>

namespace pyr::bureau {

namespace {
constexpr int kHistoryKept = 200;
} // namespace

CommandLine::CommandLine(QWidget* parent) : QLineEdit(parent) {
    setObjectName("ligneCommande");
    m_names = new QStringListModel(this);
    m_completer = new QCompleter(m_names, this);
    m_completer->setCaseSensitivity(Qt::CaseInsensitive);
    m_completer->setCompletionMode(QCompleter::PopupCompletion);
    setCompleter(m_completer);
    connect(this, &QLineEdit::returnPressed, this, &CommandLine::Enter);
}

void CommandLine::SetNames(const QStringList& names) {
    m_names->setStringList(names);
}

void CommandLine::SetHistory(QStringList history) {
    m_history = std::move(history);
    if (!m_history.isEmpty()) m_last = m_history.back();
}

void CommandLine::Remember(const QString& command) {
    m_last = command;
    if (m_history.isEmpty() || m_history.back() != command) m_history.append(command);
    while (m_history.size() > kHistoryKept)
        m_history.removeFirst();
    m_recalled = -1;
}

void CommandLine::Enter() {
    // The completion's list being open, Enter takes its line first.
    if (m_completer->popup()->isVisible()) return;
    const QString typed = text().trimmed();
    clear();
    if (typed.isEmpty() && m_last.isEmpty()) return;
    const QString command = typed.isEmpty() ? m_last : typed;
    Remember(command);
    emit CommandEntered(command);
}

void CommandLine::keyPressEvent(QKeyEvent* event) {
    const bool popup = m_completer->popup()->isVisible();
    if (!popup && (event->key() == Qt::Key_Up || event->key() == Qt::Key_Down)) {
        if (m_history.isEmpty()) return;
        const int count = static_cast<int>(m_history.size());
        if (event->key() == Qt::Key_Up)
            m_recalled = m_recalled < 0 ? count - 1 : std::max(0, m_recalled - 1);
        else
            m_recalled = m_recalled < 0 || m_recalled + 1 >= count ? -1 : m_recalled + 1;
        setText(m_recalled < 0 ? QString() : m_history[m_recalled]);
        return;
    }
    if (!popup && event->key() == Qt::Key_Escape) {
        clear();
        m_recalled = -1;
        return;
    }
    QLineEdit::keyPressEvent(event);
}

} // namespace pyr::bureau
