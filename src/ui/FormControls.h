#pragma once

#include "ui/Form.h"

#include <string>
#include <utility>
#include <vector>

// The controls of a window's template, written one to a line: what it is, then where it stands and what
// it needs.
//   Ctl(kPoint, ControlKind::EditCombo, "point").At(0, 1).Width(12)
namespace pyr::ui {

class Ctl {
public:
    Ctl(int id, ControlKind kind, std::string name, std::string text = {}) {
        m_control.id = id;
        m_control.kind = kind;
        m_control.name = std::move(name);
        m_control.text = std::move(text);
    }
    // The place in the parent's grid.
    Ctl& At(int row, int column, int rowSpan = 1, int columnSpan = 1) {
        m_control.row = row, m_control.column = column;
        m_control.rowSpan = rowSpan, m_control.columnSpan = columnSpan;
        return *this;
    }
    Ctl& In(int parent) {
        m_control.parent = parent;
        return *this;
    }
    Ctl& Buddy(int id) {
        m_control.buddy = id;
        return *this;
    }
    Ctl& Default() {
        m_control.isDefault = true;
        return *this;
    }
    Ctl& Columns(std::vector<std::string> columns) {
        m_control.columns = std::move(columns);
        return *this;
    }
    Ctl& Width(int characters) {
        m_control.width = characters;
        return *this;
    }
    Ctl& Lines(int lines) {
        m_control.lines = lines;
        return *this;
    }
    Ctl& OnDemand() {
        m_control.onDemand = true;
        return *this;
    }
    Ctl& Multiple() {
        m_control.multiple = true;
        return *this;
    }
    operator Control() const { return m_control; }

private:
    Control m_control;
};

} // namespace pyr::ui
