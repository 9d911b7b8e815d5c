#include "FormDialog.h"

#include "GeoView.h"
#include "OnDemandTableModel.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QFontMetrics>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QItemSelectionModel>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QSignalBlocker>
#include <QStyle>
#include <QTabWidget>
#include <QTableView>
#include <QTimer>
#include <QTreeWidget>
#include <QVBoxLayout>
#include <algorithm>
#include <set>
#include <utility>

namespace pyr::bureau {

using ui::ControlKind;
using ui::EventKind;

namespace {

QString Text(const std::string& text) {
    return QString::fromStdString(text);
}

// The width of `characters` average characters of the widget's font.
int CharactersWide(const QWidget* widget, int characters) {
    return QFontMetrics(widget->font()).averageCharWidth() * characters;
}

void SetLines(QListWidget* list, const std::vector<std::string>& items) {
    list->clear();
    for (const std::string& item : items)
        list->addItem(Text(item));
}

void SetRows(QTreeWidget* table, const std::vector<std::string>& items,
             const std::vector<std::string>& tips) {
    table->clear();
    QList<QTreeWidgetItem*> rows;
    rows.reserve(static_cast<qsizetype>(items.size()));
    for (std::size_t rank = 0; rank < items.size(); ++rank) {
        auto* row = new QTreeWidgetItem(Text(items[rank]).split('\t'));
        if (rank < tips.size())
            for (int column = 0; column < row->columnCount(); ++column)
                row->setToolTip(column, Text(tips[rank]));
        rows.append(row);
    }
    table->addTopLevelItems(rows);
    for (int column = 0; column < table->columnCount(); ++column)
        table->resizeColumnToContents(column);
}

// A drawing's least size, in pixels: room for a few stations and their names.
constexpr int kDrawingWidth = 360;
constexpr int kDrawingHeight = 240;
// A list on demand sizes its columns on this many lines, not on its million.
constexpr int kRowsMeasured = 50;

// The lines selected, as runs of consecutive ranks (first, last): a million lines selected are one run,
// and the view's selection compares with the form's without listing either.
using Runs = std::vector<std::pair<int, int>>;

Runs Merged(Runs runs) {
    std::sort(runs.begin(), runs.end());
    Runs merged;
    for (const auto& [first, last] : runs) {
        if (!merged.empty() && first <= merged.back().second + 1)
            merged.back().second = std::max(merged.back().second, last);
        else
            merged.emplace_back(first, last);
    }
    return merged;
}

Runs RunsOf(const std::vector<int>& ranks) {
    Runs runs;
    for (int rank : ranks) {
        if (rank < 0) continue;
        if (!runs.empty() && rank == runs.back().second + 1)
            runs.back().second = rank;
        else
            runs.emplace_back(rank, rank);
    }
    return std::is_sorted(ranks.begin(), ranks.end()) ? runs : Merged(std::move(runs));
}

// The rows a view has selected; its ranges may touch or overlap, after a line added with Ctrl.
Runs SelectedRuns(const QItemSelectionModel& model) {
    Runs runs;
    for (const QItemSelectionRange& range : model.selection())
        if (!range.parent().isValid()) runs.emplace_back(range.top(), range.bottom());
    return Merged(std::move(runs));
}

std::vector<int> RanksOf(const Runs& runs) {
    std::vector<int> ranks;
    for (const auto& [first, last] : runs)
        for (int rank = first; rank <= last; ++rank)
            ranks.push_back(rank);
    return ranks;
}

// Widens the columns of a table on demand to their headings and the first lines, never narrows them: the
// columns do not jump as the lines change. The last column takes what remains.
void FitColumns(QTableView& table) {
    const QAbstractItemModel& lines = *table.model();
    const QFontMetrics metrics(table.font());
    const int rows = std::min(lines.rowCount(), kRowsMeasured);
    // The room a cell's text takes in the view: its margins and the focus frame's.
    const int margins =
        2 * (table.style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, &table) + 1) + 6;
    for (int column = 0; column + 1 < lines.columnCount(); ++column) {
        int wanted = table.horizontalHeader()->sectionSizeHint(column);
        for (int row = 0; row < rows; ++row)
            wanted = std::max(wanted, metrics.horizontalAdvance(lines.index(row, column).data().toString()) +
                                          margins);
        if (wanted > table.columnWidth(column)) table.setColumnWidth(column, wanted);
    }
}

} // namespace

FormDialog::FormDialog(ui::Form& form, ui::FrontEnd& frontEnd, QWidget* parent)
    : QDialog(parent), m_form(form), m_frontEnd(frontEnd) {
    setWindowTitle(Text(m_form.Caption()));
    setObjectName("dialogue");
    Build();
    // A change of the model outside an action (a question answered, a file chosen) is shown once the
    // action that caused it is over.
    m_listener = m_form.Model().Listen([this](int) {
        if (m_refreshQueued) return;
        m_refreshQueued = true;
        QTimer::singleShot(0, this, [this] {
            m_refreshQueued = false;
            Refresh();
        });
    });
    Refresh();
}

FormDialog::~FormDialog() {
    m_form.Model().StopListening(m_listener);
}

QWidget* FormDialog::Widget(int id) const {
    const auto found = m_byId.find(id);
    return found == m_byId.end() ? nullptr : m_controls[found->second].widget;
}

QGridLayout* FormDialog::GridOf(int parent) {
    const auto found = m_grids.find(parent);
    return found == m_grids.end() ? m_grids.at(0) : found->second;
}

void FormDialog::Build() {
    auto* layout = new QVBoxLayout(this);
    auto* body = new QWidget(this);
    auto* grid = new QGridLayout(body);
    grid->setContentsMargins(0, 0, 0, 0);
    m_grids[0] = grid;
    layout->addWidget(body);

    const std::vector<ui::Control> controls = m_form.Controls();
    bool hasPages = false;
    for (const ui::Control& control : controls)
        hasPages |= control.kind == ControlKind::Page;
    if (hasPages) {
        m_pages = new QTabWidget(this);
        m_pages->setObjectName("pages");
        layout->addWidget(m_pages);
        connect(m_pages, &QTabWidget::currentChanged, this, [this](int rank) {
            if (!m_refreshing) Act(0, {EventKind::Page, rank, false, {}});
        });
    }
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    m_buttonRow = foot;
    layout->addLayout(foot);

    m_controls.reserve(controls.size());
    for (const ui::Control& control : controls) {
        QWidget* widget = Make(control);
        m_byId[control.id] = m_controls.size();
        m_controls.push_back({control, widget, {}, {}, {}, -1});
        Place(control, widget);
    }
    // A list on demand and a drawing take the room the dialog gains, with the groups that hold them.
    std::set<QGridLayout*> stretched;
    bool bodyStretches = false, pagesStretch = false;
    for (const Shown& shown : m_controls) {
        const ui::Control* control = &shown.control;
        const bool stretches = control->kind == ControlKind::Drawing ||
                               (control->kind == ControlKind::List && control->onDemand);
        while (stretches && control->parent != ui::kButtonRow) {
            QGridLayout* parentGrid = GridOf(control->parent);
            parentGrid->setRowStretch(control->row, 1);
            parentGrid->setColumnStretch(control->column, 1);
            stretched.insert(parentGrid);
            const auto holder = m_byId.find(control->parent);
            if (control->parent == 0 || holder == m_byId.end()) {
                bodyStretches = true;
                break;
            }
            control = &m_controls[holder->second].control;
            if (control->kind == ControlKind::Page) {
                pagesStretch = true;
                break;
            }
        }
    }
    if (bodyStretches) layout->setStretchFactor(body, 1);
    if (pagesStretch) layout->setStretchFactor(m_pages, 1);

    for (Shown& shown : m_controls) {
        if (shown.control.kind == ControlKind::Label && shown.control.buddy != 0)
            if (QWidget* buddy = Widget(shown.control.buddy)) {
                static_cast<QLabel*>(shown.widget)->setBuddy(buddy);
                // Beside a list, the label stands at the list's first line.
                const ControlKind kind = m_controls[m_byId.at(shown.control.buddy)].control.kind;
                if ((kind == ControlKind::List || kind == ControlKind::CheckList) &&
                    shown.control.parent != ui::kButtonRow)
                    GridOf(shown.control.parent)->setAlignment(shown.widget, Qt::AlignTop | Qt::AlignLeft);
            }
        Connect(shown);
    }
    // Nothing else stretched into empty space: the grids keep their rows together at the top.
    for (const auto& [parent, parentGrid] : m_grids)
        if (!stretched.contains(parentGrid)) parentGrid->setRowStretch(parentGrid->rowCount(), 1);
    if (body->layout()->isEmpty()) body->hide();
}

QWidget* FormDialog::Make(const ui::Control& control) {
    QWidget* widget = nullptr;
    const QString text = Text(control.text);
    switch (control.kind) {
    case ControlKind::Label:
        widget = new QLabel(text);
        break;
    case ControlKind::Field: {
        auto* field = new QLineEdit;
        field->setReadOnly(true);
        field->setFocusPolicy(Qt::ClickFocus);
        widget = field;
        break;
    }
    case ControlKind::Edit:
        widget = new QLineEdit;
        break;
    case ControlKind::Check:
        widget = new QCheckBox(text);
        break;
    case ControlKind::Radio: {
        auto* radio = new QRadioButton(text);
        QButtonGroup*& group = m_radioGroups[control.parent];
        if (!group) group = new QButtonGroup(this);
        group->addButton(radio);
        widget = radio;
        break;
    }
    case ControlKind::Combo:
    case ControlKind::EditCombo: {
        auto* combo = new QComboBox;
        combo->setEditable(control.kind == ControlKind::EditCombo);
        combo->setInsertPolicy(QComboBox::NoInsert);
        combo->setMaxVisibleItems(20);
        widget = combo;
        break;
    }
    case ControlKind::List:
        if (control.onDemand) {
            // No widget and no stored height per line: the view asks the model for the lines it draws,
            // and finds a line's place by its rank alone.
            auto* table = new QTableView;
            QStringList headings;
            for (const std::string& column : control.columns)
                headings << Text(column);
            if (headings.isEmpty()) {
                headings << QString();
                table->horizontalHeader()->hide();
            }
            table->setModel(new OnDemandTableModel(m_form, control.id, headings, table));
            table->setSelectionBehavior(QAbstractItemView::SelectRows);
            table->setSelectionMode(control.multiple ? QAbstractItemView::ExtendedSelection
                                                     : QAbstractItemView::SingleSelection);
            table->setShowGrid(false);
            table->setAlternatingRowColors(true);
            table->setWordWrap(false);
            table->setCornerButtonEnabled(false);
            table->setHorizontalScrollMode(QAbstractItemView::ScrollPerPixel);
            QHeaderView* rows = table->verticalHeader();
            rows->setSectionResizeMode(QHeaderView::Fixed);
            rows->setDefaultSectionSize(QFontMetrics(table->font()).height() + 4);
            rows->hide();
            QHeaderView* columns = table->horizontalHeader();
            columns->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
            columns->setHighlightSections(false);
            columns->setStretchLastSection(true);
            widget = table;
        } else if (!control.columns.empty()) {
            auto* table = new QTreeWidget;
            QStringList headings;
            for (const std::string& column : control.columns)
                headings << Text(column);
            table->setHeaderLabels(headings);
            // Each column as wide as its heading until rows come: no heading cut, no empty width.
            for (int column = 0; column < table->columnCount(); ++column)
                table->resizeColumnToContents(column);
            table->setRootIsDecorated(false);
            table->setUniformRowHeights(true);
            table->setAlternatingRowColors(true);
            if (control.multiple) table->setSelectionMode(QAbstractItemView::ExtendedSelection);
            widget = table;
        } else {
            auto* list = new QListWidget;
            list->setUniformItemSizes(true);
            if (control.multiple) list->setSelectionMode(QAbstractItemView::ExtendedSelection);
            widget = list;
        }
        break;
    case ControlKind::CheckList:
        widget = new QListWidget;
        break;
    case ControlKind::Button: {
        auto* button = new QPushButton(text);
        button->setDefault(control.isDefault);
        widget = button;
        break;
    }
    case ControlKind::Status: {
        auto* status = new QLabel;
        status->setFrameShape(QFrame::StyledPanel);
        status->setFrameShadow(QFrame::Sunken);
        status->setWordWrap(true);
        status->setMinimumHeight(QFontMetrics(status->font()).height() + 8);
        widget = status;
        break;
    }
    case ControlKind::Group: {
        auto* group = new QGroupBox(text);
        m_grids[control.id] = new QGridLayout(group);
        widget = group;
        break;
    }
    case ControlKind::Page: {
        auto* page = new QWidget;
        m_grids[control.id] = new QGridLayout(page);
        widget = page;
        break;
    }
    case ControlKind::Drawing: {
        auto* view = new GeoView;
        view->setMinimumSize(kDrawingWidth, kDrawingHeight);
        view->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
        widget = view;
        break;
    }
    }
    widget->setObjectName(control.name.empty() ? QString("c%1").arg(control.id) : Text(control.name));
    if (control.width > 0) widget->setMinimumWidth(CharactersWide(widget, control.width));
    if (control.lines > 0)
        widget->setMinimumHeight(QFontMetrics(widget->font()).lineSpacing() * (control.lines + 1) + 6);
    return widget;
}

void FormDialog::Place(const ui::Control& control, QWidget* widget) {
    if (control.kind == ControlKind::Page) {
        m_pages->addTab(widget, Text(control.text));
        return;
    }
    if (control.parent == ui::kButtonRow) {
        m_buttonRow->addWidget(widget);
        return;
    }
    QGridLayout* grid = GridOf(control.parent);
    Qt::Alignment alignment;
    if (control.kind == ControlKind::Label) alignment = Qt::AlignVCenter | Qt::AlignLeft;
    grid->addWidget(widget, control.row, control.column, control.rowSpan, control.columnSpan, alignment);
}

void FormDialog::Connect(Shown& shown) {
    const int id = shown.control.id;
    QWidget* widget = shown.widget;
    switch (shown.control.kind) {
    case ControlKind::Edit: {
        auto* edit = static_cast<QLineEdit*>(widget);
        connect(edit, &QLineEdit::editingFinished, this, [this, id, edit] {
            if (m_refreshing || !edit->isModified()) return;
            edit->setModified(false);
            Act(id, {EventKind::Text, -1, false, edit->text().toStdString()});
        });
        break;
    }
    case ControlKind::Check:
    case ControlKind::Radio: {
        // A radio turned off by the one turned on says nothing of its own.
        const bool radio = shown.control.kind == ControlKind::Radio;
        connect(static_cast<QAbstractButton*>(widget), &QAbstractButton::toggled, this,
                [this, id, radio](bool on) {
                    if (!m_refreshing && (on || !radio)) Act(id, {EventKind::Check, -1, on, {}});
                });
        break;
    }
    case ControlKind::Combo:
    case ControlKind::EditCombo: {
        auto* combo = static_cast<QComboBox*>(widget);
        connect(combo, &QComboBox::activated, this, [this, id](int rank) {
            if (!m_refreshing) Act(id, {EventKind::Select, rank, false, {}});
        });
        // Enter in a name typed into the list chooses that name (or sends it, when the list does not
        // hold it), rather than pressing the dialog's default button.
        if (QLineEdit* typed = combo->lineEdit()) typed->installEventFilter(this);
        break;
    }
    case ControlKind::List:
        if (shown.control.multiple) {
            // Each change of the lines selected sends them all, the current line as the rank.
            auto* view = static_cast<QAbstractItemView*>(widget);
            connect(view->selectionModel(), &QItemSelectionModel::selectionChanged, this, [this, id, view] {
                if (m_refreshing) return;
                std::vector<int> ranks = RanksOf(SelectedRuns(*view->selectionModel()));
                Act(id, {EventKind::Select, view->currentIndex().row(), false, {}, std::move(ranks)});
            });
        }
        if (auto* table = qobject_cast<QTableView*>(widget)) {
            if (!shown.control.multiple)
                connect(table->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
                        [this, id](const QModelIndex& current) {
                            if (!m_refreshing) Act(id, {EventKind::Select, current.row(), false, {}});
                        });
            connect(table, &QTableView::doubleClicked, this, [this, id](const QModelIndex& index) {
                Act(id, {EventKind::Activate, index.row(), false, {}});
            });
        } else if (auto* table = qobject_cast<QTreeWidget*>(widget)) {
            if (!shown.control.multiple)
                connect(table, &QTreeWidget::currentItemChanged, this,
                        [this, id, table](QTreeWidgetItem* item) {
                            if (!m_refreshing)
                                Act(id, {EventKind::Select, table->indexOfTopLevelItem(item), false, {}});
                        });
            connect(table, &QTreeWidget::itemDoubleClicked, this, [this, id, table](QTreeWidgetItem* item) {
                Act(id, {EventKind::Activate, table->indexOfTopLevelItem(item), false, {}});
            });
        } else {
            auto* list = static_cast<QListWidget*>(widget);
            if (!shown.control.multiple)
                connect(list, &QListWidget::currentRowChanged, this, [this, id](int rank) {
                    if (!m_refreshing) Act(id, {EventKind::Select, rank, false, {}});
                });
            connect(list, &QListWidget::itemDoubleClicked, this, [this, id, list](QListWidgetItem* item) {
                Act(id, {EventKind::Activate, list->row(item), false, {}});
            });
        }
        break;
    case ControlKind::CheckList: {
        auto* list = static_cast<QListWidget*>(widget);
        connect(list, &QListWidget::itemChanged, this, [this, id, list](QListWidgetItem* item) {
            if (!m_refreshing)
                Act(id, {EventKind::CheckLine, list->row(item), item->checkState() == Qt::Checked, {}});
        });
        connect(list, &QListWidget::currentRowChanged, this, [this, id](int rank) {
            if (!m_refreshing) Act(id, {EventKind::Select, rank, false, {}});
        });
        break;
    }
    case ControlKind::Button:
        connect(static_cast<QPushButton*>(widget), &QPushButton::clicked, this, [this, id] {
            Act(id, {EventKind::Click, -1, false, {}});
        });
        break;
    case ControlKind::Drawing:
        // A click on nothing chooses nothing.
        connect(static_cast<GeoView*>(widget), &GeoView::ElementPicked, this, [this, id](int element) {
            if (m_refreshing) return;
            std::vector<int> ranks;
            if (element >= 0) ranks.push_back(element);
            Act(id, {EventKind::Select, element, false, {}, std::move(ranks)});
        });
        break;
    default:
        break;
    }
}

void FormDialog::Act(int id, const ui::Event& event) {
    m_form.Act(m_frontEnd, id, event);
    if (const std::optional<ui::DialogResult> ended = m_form.Ended()) {
        m_result = *ended;
        done(*ended == ui::DialogResult::Ok ? QDialog::Accepted : QDialog::Rejected);
        return;
    }
    Refresh();
    if (const int focus = m_form.FocusRequest())
        if (QWidget* widget = Widget(focus)) widget->setFocus(Qt::OtherFocusReason);
}

void FormDialog::reject() {
    Act(ui::kIdCancel, {EventKind::Click, -1, false, {}});
}

bool FormDialog::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress) return QDialog::eventFilter(watched, event);
    const int key = static_cast<QKeyEvent*>(event)->key();
    auto* combo = qobject_cast<QComboBox*>(watched->parent());
    if ((key != Qt::Key_Return && key != Qt::Key_Enter) || !combo)
        return QDialog::eventFilter(watched, event);
    for (const Shown& shown : m_controls) {
        if (shown.widget != combo) continue;
        const int rank = combo->findText(combo->currentText(), Qt::MatchFixedString);
        if (rank >= 0)
            Act(shown.control.id, {EventKind::Select, rank, false, {}});
        else
            Act(shown.control.id, {EventKind::Text, -1, false, combo->currentText().toStdString()});
        return true;
    }
    return QDialog::eventFilter(watched, event);
}

void FormDialog::Refresh() {
    m_refreshing = true;
    // The caption follows the model ("Calcul du point 101 par intersection").
    setWindowTitle(Text(m_form.Caption()));
    for (Shown& shown : m_controls)
        Show(shown, m_form.State(shown.control.id));
    m_refreshing = false;
}

void FormDialog::Show(Shown& shown, const ui::ControlState& state) {
    QWidget* widget = shown.widget;
    const ui::Control& control = shown.control;
    if (control.kind == ControlKind::Page) {
        m_pages->setTabEnabled(m_pages->indexOf(widget), state.enabled);
        return;
    }
    widget->setEnabled(state.enabled);
    widget->setVisible(state.visible);
    const QString text = Text(state.text);
    switch (control.kind) {
    case ControlKind::Label:
        if (!state.text.empty()) static_cast<QLabel*>(widget)->setText(text);
        break;
    case ControlKind::Status:
        static_cast<QLabel*>(widget)->setText(text);
        break;
    case ControlKind::Field:
    case ControlKind::Edit: {
        auto* edit = static_cast<QLineEdit*>(widget);
        // A text being typed stays as the person types it until committed.
        if (edit->text() != text && !(control.kind == ControlKind::Edit && edit->isModified()))
            edit->setText(text);
        // A result is a number, aligned on the right as in a table; a name or a path reads from the left.
        if (control.kind == ControlKind::Field) {
            bool number = false;
            text.trimmed().toDouble(&number);
            edit->setAlignment(number || text.isEmpty() ? Qt::AlignRight : Qt::AlignLeft);
        }
        break;
    }
    case ControlKind::Check:
    case ControlKind::Radio:
        static_cast<QAbstractButton*>(widget)->setChecked(state.checked);
        if (!state.text.empty()) static_cast<QAbstractButton*>(widget)->setText(text);
        break;
    case ControlKind::Button:
        if (!state.text.empty()) static_cast<QAbstractButton*>(widget)->setText(text);
        break;
    case ControlKind::Group:
        if (!state.text.empty()) static_cast<QGroupBox*>(widget)->setTitle(text);
        break;
    case ControlKind::List:
        if (control.onDemand)
            ShowOnDemand(shown, state);
        else
            ShowLines(shown, state);
        break;
    case ControlKind::Combo:
    case ControlKind::EditCombo:
    case ControlKind::CheckList:
        ShowLines(shown, state);
        break;
    case ControlKind::Drawing:
        ShowDrawing(shown, state);
        break;
    case ControlKind::Page:
        break;
    }
}

void FormDialog::ShowLines(Shown& shown, const ui::ControlState& state) {
    const bool changed = shown.items != state.items || shown.tips != state.tips;
    const QSignalBlocker blocker(shown.widget);
    if (auto* combo = qobject_cast<QComboBox*>(shown.widget)) {
        if (changed) {
            const QString typed = combo->currentText();
            combo->clear();
            QStringList items;
            items.reserve(static_cast<qsizetype>(state.items.size()));
            for (const std::string& item : state.items)
                items << Text(item);
            combo->addItems(items);
            if (combo->isEditable()) combo->setEditText(typed);
        }
        if (combo->currentIndex() != state.current || changed) combo->setCurrentIndex(state.current);
    } else if (auto* table = qobject_cast<QTreeWidget*>(shown.widget)) {
        if (changed) SetRows(table, state.items, state.tips);
        QTreeWidgetItem* current = state.current >= 0 ? table->topLevelItem(state.current) : nullptr;
        if (table->currentItem() != current) table->setCurrentItem(current);
        if (!current) table->clearSelection();
    } else if (auto* list = qobject_cast<QListWidget*>(shown.widget)) {
        if (changed) SetLines(list, state.items);
        const bool checkList = shown.control.kind == ControlKind::CheckList;
        for (int row = 0; row < list->count(); ++row) {
            QListWidgetItem* item = list->item(row);
            const auto rank = static_cast<std::size_t>(row);
            if (changed && rank < state.tips.size()) item->setToolTip(Text(state.tips[rank]));
            if (checkList) {
                item->setFlags(item->flags() | Qt::ItemIsUserCheckable);
                const bool on = rank < state.checks.size() && state.checks[rank];
                item->setCheckState(on ? Qt::Checked : Qt::Unchecked);
            }
        }
        if (list->currentRow() != state.current) list->setCurrentRow(state.current);
        if (state.current < 0) list->clearSelection();
    }
    if (shown.control.multiple)
        if (auto* view = qobject_cast<QAbstractItemView*>(shown.widget))
            ShowSelection(*view, state.selection);
    shown.items = state.items;
    shown.tips = state.tips;
}

void FormDialog::ShowSelection(QAbstractItemView& view, const std::vector<int>& ranks) {
    QItemSelectionModel& model = *view.selectionModel();
    const QAbstractItemModel& lines = *model.model();
    const int rows = lines.rowCount();
    Runs wanted = RunsOf(ranks);
    // Lines beyond the list's end are not there to select.
    while (!wanted.empty() && wanted.back().first >= rows)
        wanted.pop_back();
    if (!wanted.empty()) wanted.back().second = std::min(wanted.back().second, rows - 1);
    if (wanted == SelectedRuns(model)) return;
    QItemSelection selection;
    for (const auto& [first, last] : wanted)
        selection.select(lines.index(first, 0), lines.index(last, 0));
    model.select(selection, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
}

void FormDialog::ShowOnDemand(Shown& shown, const ui::ControlState& state) {
    auto& table = static_cast<QTableView&>(*shown.widget);
    auto& lines = static_cast<OnDemandTableModel&>(*table.model());
    if (lines.Update(state.revision)) FitColumns(table);
    QItemSelectionModel& selection = *table.selectionModel();
    const bool multiple = shown.control.multiple;
    const int current = state.current < lines.rowCount() ? state.current : -1;
    // A new current line from the form is brought into view; one the person chose is there already, and
    // the same one shown again after new lines leaves the person's scrolling alone.
    if (table.currentIndex().row() != current) {
        if (current < 0) {
            selection.clearCurrentIndex();
            if (!multiple) selection.clearSelection();
        } else {
            // The view scrolls to its current line by itself, unless told not to.
            const bool scroll = current != shown.current;
            table.setAutoScroll(scroll);
            selection.setCurrentIndex(lines.index(current, 0),
                                      multiple
                                          ? QItemSelectionModel::NoUpdate
                                          : QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
            table.setAutoScroll(true);
            if (scroll) table.scrollTo(lines.index(current, 0));
        }
    }
    shown.current = current;
    if (multiple) ShowSelection(table, state.selection);
}

void FormDialog::ShowDrawing(Shown& shown, const ui::ControlState& state) {
    auto& view = static_cast<GeoView&>(*shown.widget);
    if (shown.revision != state.revision) {
        shown.revision = state.revision;
        if (const GeoScene* scene = m_form.Scene(shown.control.id))
            view.ShowScene(*scene);
        else
            view.Clear();
    }
    view.SetSelectedElements(state.selection);
}

} // namespace pyr::bureau
