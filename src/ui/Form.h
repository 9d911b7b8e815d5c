#pragma once

#include "ui/DialogModel.h"

#include <optional>
#include <string>
#include <vector>

// A dialog as a window shows it, without any toolkit: the template of its controls (what they are, their
// labels and accelerators, their place in a grid), the state of each control read from the model, and the
// person's actions on them sent back to the model. A desktop front end builds its widgets from the
// template, shows the states again after every change notice and forwards the actions; the module is
// reached through these virtual calls only, so the front end needs none of the module's symbols.
namespace pyr {
class GeoScene;
}

namespace pyr::ui {

class FrontEnd;

enum class ControlKind {
    Label,     // a static text; "&Point :" gives the accelerator to its buddy
    Field,     // a text shown, not typed (a result)
    Edit,      // a text typed by the person, sent when it is committed (Enter, or the focus leaving it)
    Check,     // a check box
    Radio,     // a radio button; the radios of one parent are exclusive
    Combo,     // a drop-down list
    EditCombo, // a drop-down list in which a name can also be typed
    List,      // a list box, or a table when the control has columns
    CheckList, // a list whose lines are checked or not
    Button,
    Status, // a status line
    Group,  // a frame with a title; the controls whose parent it is go inside, in their own grid
    Page,   // a page of a property sheet; the dialog is then a sheet of its pages
    Drawing // the graphic view of a GéoBase: the form's Scene(), the elements of `selection` shown
            // selected with their sightings; a click on a point or a station selects its element
};

// The parent of the buttons that close the dialog, set in a row at its foot (OK, Cancel, "Fin + Listing").
inline constexpr int kButtonRow = -1;
// The two actions every dialog has: Enter presses the default button, Escape and the window's close box
// press Cancel.
inline constexpr int kIdOk = 1;
inline constexpr int kIdCancel = 2;

struct Control {
    int id = 0; // unique in the dialog, above 2 but for OK and Cancel
    ControlKind kind = ControlKind::Label;
    std::string name{}; // a stable name in the code ("ajouterUne"): the widget's name for tests and captures
    // A label, a button, a check box, a group or page title, with "&" before its accelerator.
    std::string text{};
    int parent = 0; // 0 the dialog itself, a Group or Page id, or kButtonRow
    int row = 0, column = 0, rowSpan = 1, columnSpan = 1; // the place in the parent's grid
    int buddy = 0;                      // a label: the control its accelerator gives the focus to
    bool isDefault = false;             // a button: the one Enter presses
    std::vector<std::string> columns{}; // a list shown as a table: the column headings
    int width = 0;                      // an edit, a field or a list: the characters it shows at least
    int lines = 0;                      // a list: the lines it shows at least
    // A list whose lines the form gives only as they are shown (OnDemandRows, OnDemandRow), not in its
    // state: a table of a million lines.
    bool onDemand = false;
    bool multiple = false; // a list: several lines may be selected at once
};

struct ControlState {
    bool enabled = true;
    bool visible = true;
    bool checked = false;             // a check box or a radio
    std::string text{};               // an edit, a field, a status line; a label or button whose text changes
    std::vector<std::string> items{}; // the lines of a combo or a list; columns separated by '\t'
    std::vector<std::string> tips{};  // the tooltip of each line, when it has one
    std::vector<bool> checks{};       // a check list: each line checked or not
    int current = -1;                 // the line chosen or highlighted, -1 for none
    // A list of several: the lines selected, in increasing order. A drawing: the elements selected.
    std::vector<int> selection{};
    // A list on demand, a drawing: changes whenever its lines, or its scene, changed and must be asked
    // for again.
    long revision = 0;
};

enum class EventKind {
    Click,     // a button pressed
    Check,     // a check box or a radio set (`on`)
    Text,      // an edit committed, or a name typed in an EditCombo (`text`)
    Select,    // a line chosen or highlighted in a combo or a list (`rank`, -1 for none)
    Activate,  // a line of a list double-clicked (`rank`)
    CheckLine, // a line of a check list checked or not (`rank`, `on`)
    Page       // a page of a sheet shown (`rank`)
};

struct Event {
    EventKind kind = EventKind::Click;
    int rank = -1;
    bool on = false;
    std::string text{};
    // Select in a list of several: every line selected, in increasing order (`rank` the current one);
    // in a drawing: the element picked, alone (`rank` too, -1 for a click on nothing).
    std::vector<int> ranks{};
};

class Form {
public:
    virtual ~Form() = default;

    // The model shown: the front end listens to its change notices.
    virtual DialogModel& Model() = 0;
    virtual std::string Caption() { return Model().Caption(); }
    // The dialog's template, in the order of the keyboard's tabbing.
    virtual std::vector<Control> Controls() const = 0;
    // What the dialog does as it opens (offering and loading the GéoBase, reading the settings). False
    // when it must not open: a message has said why, or the person cancelled.
    virtual bool Open(FrontEnd& frontEnd) = 0;
    // The state of a control now.
    virtual ControlState State(int id) const = 0;
    // An action of the person on a control.
    virtual void Act(FrontEnd& frontEnd, int id, const Event& event) = 0;

    // A list on demand: its number of lines, and the line of that rank (columns separated by '\t'),
    // asked for as they come into view.
    virtual int OnDemandRows(int /*id*/) const { return 0; }
    virtual std::string OnDemandRow(int /*id*/, int /*rank*/) const { return {}; }
    // A drawing: what it shows, null for nothing. Valid until the control's revision changes.
    virtual const GeoScene* Scene(int /*id*/) const { return nullptr; }

    // Set by the action that closes the dialog.
    std::optional<DialogResult> Ended() const { return m_ended; }
    // The control that takes the focus after the last action, 0 for the one that had it.
    int FocusRequest() {
        const int id = m_focus;
        m_focus = 0;
        return id;
    }

protected:
    void End(DialogResult result) { m_ended = result; }
    void Focus(int id) { m_focus = id; }

private:
    std::optional<DialogResult> m_ended;
    int m_focus = 0;
};

} // namespace pyr::ui
