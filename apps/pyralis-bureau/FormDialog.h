#pragma once

#include "ui/Form.h"

#include <QDialog>
#include <map>
#include <optional>
#include <string>
#include <vector>

class QAbstractItemView;
class QButtonGroup;
class QHBoxLayout;
class QGridLayout;
class QTabWidget;

namespace pyr::bureau {

// A dialog built from a form's template: a grid of widgets for the dialog, each group and each page of
// a sheet, the closing buttons in a row at its foot. It shows the controls' states again after every
// action and every change notice of the model, and sends the person's actions to the form; the form
// decides when it closes.
//
// A list on demand is a table view over a model that asks the form for the lines it draws; it and a
// drawing take the room that the dialog gains when it is enlarged, where other dialogs keep their
// controls together at the top.
class FormDialog : public QDialog {
    Q_OBJECT
public:
    FormDialog(ui::Form& form, ui::FrontEnd& frontEnd, QWidget* parent = nullptr);
    ~FormDialog() override;

    // How the form ended the dialog; Cancel while it is open.
    ui::DialogResult Result() const { return m_result; }
    // The widget of a control, found by its id (null for none).
    QWidget* Widget(int id) const;
    // Shows every control's state again.
    void Refresh();

protected:
    void reject() override; // Escape and the close box: the form's Cancel
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    struct Shown {
        ui::Control control;
        QWidget* widget = nullptr;
        std::vector<std::string> items; // the lines shown, to rebuild a list only when they change
        std::vector<std::string> tips;
        std::optional<long> revision; // a drawing: the revision shown
        int current = -1;             // a list on demand: the form's current line, last shown
    };

    void Build();
    QWidget* Make(const ui::Control& control);
    void Connect(Shown& shown);
    void Place(const ui::Control& control, QWidget* widget);
    void Show(Shown& shown, const ui::ControlState& state);
    void ShowLines(Shown& shown, const ui::ControlState& state);
    void ShowOnDemand(Shown& shown, const ui::ControlState& state);
    void ShowDrawing(Shown& shown, const ui::ControlState& state);
    void ShowSelection(QAbstractItemView& view, const std::vector<int>& ranks);
    void Stretch(const ui::Control& control);
    void Act(int id, const ui::Event& event);
    QGridLayout* GridOf(int parent);

    ui::Form& m_form;
    ui::FrontEnd& m_frontEnd;
    std::vector<Shown> m_controls;
    std::map<int, std::size_t> m_byId;
    std::map<int, QGridLayout*> m_grids;        // of the dialog (0), of each group and page
    std::map<int, QButtonGroup*> m_radioGroups; // one per parent
    QTabWidget* m_pages = nullptr;
    QHBoxLayout* m_buttonRow = nullptr;
    int m_listener = 0;
    bool m_refreshing = false;
    bool m_refreshQueued = false;
    ui::DialogResult m_result = ui::DialogResult::Cancel;
};

} // namespace pyr::bureau
