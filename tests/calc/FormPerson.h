#pragma once

// A person at a window: the actions a desktop host sends to a form, and the states it reads back.
#include "ui/Form.h"
#include "ui/ScriptedFrontEnd.h"

#include <string>
#include <utility>

namespace pyr::test {

struct Person {
    ui::Form& form;
    ui::ScriptedFrontEnd& frontEnd;
    void Click(int id) { form.Act(frontEnd, id, {ui::EventKind::Click, -1, false, {}}); }
    void Check(int id, bool on) { form.Act(frontEnd, id, {ui::EventKind::Check, -1, on, {}}); }
    void Select(int id, int rank) { form.Act(frontEnd, id, {ui::EventKind::Select, rank, false, {}}); }
    void CheckLine(int id, int rank, bool on) {
        form.Act(frontEnd, id, {ui::EventKind::CheckLine, rank, on, {}});
    }
    void Type(int id, std::string text) {
        form.Act(frontEnd, id, {ui::EventKind::Text, -1, false, std::move(text)});
    }
    ui::ControlState operator[](int id) const { return form.State(id); }
};

} // namespace pyr::test
