#pragma once

#include "ui/Form.h"

#include <QAbstractTableModel>
#include <QStringList>
#include <array>
#include <vector>

namespace pyr::bureau {

// The lines of a form's list on demand, for a table view: a line is asked of the form only when the view
// draws it, and the few last lines asked are kept split into their cells, so that a table of a million
// lines costs what its visible lines cost. A number is aligned on the right, as in every table here.
class OnDemandTableModel : public QAbstractTableModel {
    Q_OBJECT
public:
    OnDemandTableModel(const ui::Form& form, int id, QStringList headings, QObject* parent = nullptr);

    // Takes the list's revision: when it differs from the one shown, the number of lines is asked again,
    // the lines kept are forgotten and the view is told to start again. True when it did.
    bool Update(long revision);

    int rowCount(const QModelIndex& parent = QModelIndex()) const override;
    int columnCount(const QModelIndex& parent = QModelIndex()) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

private:
    struct Line {
        int rank = -1; // -1: nothing kept here
        QStringList cells;
        std::vector<bool> numbers; // each cell reads as a number
    };
    const Line& LineAt(int rank) const;

    const ui::Form& m_form;
    int m_id;
    QStringList m_headings;
    int m_rows = 0;
    long m_revision = 0;
    bool m_known = false; // a revision was taken
    // The lines kept, each at its rank modulo their number: the lines seen at once, fewer than this, never
    // push each other out.
    static constexpr int kKept = 256;
    mutable std::array<Line, kKept> m_lines;
};

} // namespace pyr::bureau
