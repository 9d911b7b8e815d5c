#include "OnDemandTableModel.h"

#include <algorithm>
#include <utility>

namespace pyr::bureau {

OnDemandTableModel::OnDemandTableModel(const ui::Form& form, int id, QStringList headings, QObject* parent)
    : QAbstractTableModel(parent), m_form(form), m_id(id), m_headings(std::move(headings)) {}

bool OnDemandTableModel::Update(long revision) {
    if (m_known && revision == m_revision) return false;
    beginResetModel();
    m_known = true;
    m_revision = revision;
    m_rows = std::max(0, m_form.OnDemandRows(m_id));
    for (Line& line : m_lines)
        line.rank = -1;
    endResetModel();
    return true;
}

int OnDemandTableModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : m_rows;
}

int OnDemandTableModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(m_headings.size());
}

const OnDemandTableModel::Line& OnDemandTableModel::LineAt(int rank) const {
    Line& line = m_lines[static_cast<std::size_t>(rank % kKept)];
    if (line.rank == rank) return line;
    line.rank = rank;
    line.cells = QString::fromStdString(m_form.OnDemandRow(m_id, rank)).split('\t');
    line.numbers.assign(static_cast<std::size_t>(line.cells.size()), false);
    for (qsizetype cell = 0; cell < line.cells.size(); ++cell) {
        bool number = false;
        line.cells[cell].trimmed().toDouble(&number);
        line.numbers[static_cast<std::size_t>(cell)] = number;
    }
    return line;
}

QVariant OnDemandTableModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || index.row() >= m_rows || index.column() >= m_headings.size()) return {};
    if (role != Qt::DisplayRole && role != Qt::TextAlignmentRole) return {};
    const Line& line = LineAt(index.row());
    const auto cell = static_cast<std::size_t>(index.column());
    if (role == Qt::TextAlignmentRole) {
        const bool number = cell < line.numbers.size() && line.numbers[cell];
        return QVariant::fromValue(Qt::AlignVCenter | (number ? Qt::AlignRight : Qt::AlignLeft));
    }
    // A line with fewer cells than headings leaves the last ones empty.
    return cell < static_cast<std::size_t>(line.cells.size()) ? line.cells[index.column()] : QString();
}

QVariant OnDemandTableModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (role != Qt::DisplayRole) return {};
    if (orientation == Qt::Vertical) return section + 1;
    return section < m_headings.size() ? m_headings[section] : QVariant();
}

} // namespace pyr::bureau
