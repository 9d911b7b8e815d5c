#pragma once

#include "calc/SightingComputation.h"
#include "ui/Form.h"

#include <string>
#include <vector>

namespace pyr {

// The window of a computation from chosen sightings: the subject (a point or a station) chosen in a
// combo, its sightings in two lists moved by four arrows (the subject computed again on every move), the
// two switches, the results in a frame (a value and its EMQ on each line), the status line, the button
// that writes the result, and "Fin + Listing", which takes the focus after every move. Each computation
// names its subject, its result lines and its writing.
class CSightingComputationForm : public ui::Form {
public:
    enum Id : int {
        kLabelSubject = 3,
        kSubject,
        kLabelAvailable,
        kAvailable,
        kAddOne,
        kAddAll,
        kRemoveOne,
        kRemoveAll,
        kLabelSelected,
        kSelected,
        kPlani,
        kAlti,
        kResults,
        kStatus,
        kWrite,
        // The result lines: four controls each (label, value, "EMQ", error), from here on.
        kFirstResult = 20,
        // A computation's own controls, from here on.
        kFirstOwn = 100,
    };
    // The ids of the controls of result line `line`.
    static int ResultLabel(int line) { return kFirstResult + 4 * line; }
    static int ResultValue(int line) { return ResultLabel(line) + 1; }
    static int ResultEmq(int line) { return ResultLabel(line) + 3; }

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

protected:
    // `dialog` gives the command's inputs when the window opens; `model` is the dialog shown. The
    // labels name the subject ("&Point :") and the writing ("É&crire le point").
    CSightingComputationForm(const ui::DialogModel& dialog, CSightingComputation& model,
                             const char* subjectLabel, const char* writeLabel)
        : m_dialog(dialog), m_model(model), m_subjectLabel(subjectLabel), m_writeLabel(writeLabel) {}

    // One line of the results: its label ("X =") and name, its value and its error ("" when unknown);
    // a line without `emq` has no error field.
    struct ResultLine {
        std::string label;
        const char* name;
        std::string value;
        std::string emq;
        bool withEmq = true;
    };

    // ---- What each computation shows
    // The result lines, in the order of the axes the surveyor reads.
    virtual std::vector<ResultLine> ResultLines() const = 0;
    // A computation's own controls (ids from kFirstOwn), their states and the actions on them.
    virtual void AddOwnControls(std::vector<ui::Control>&) const {}
    virtual ui::ControlState OwnState(int) const { return {}; }
    virtual void OwnAct(ui::FrontEnd&, int, const ui::Event&) {}

    // After a move between the lists, "Fin + Listing" takes the focus when it can end the dialog.
    void Moved();

private:
    const ui::DialogModel& m_dialog;
    CSightingComputation& m_model;
    const char* m_subjectLabel;
    const char* m_writeLabel;
    bool m_written = false; // a result was written into the GéoBase
};

} // namespace pyr
