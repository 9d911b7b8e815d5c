#include "editor/EditHistory.h"

#include <algorithm>

namespace pyr {

EditStep EditStep::Exchanged(int index, std::unique_ptr<CElement> other) {
    return EditStep(Op::Exchange, index, std::move(other), 0);
}

EditStep EditStep::Inserted(int index) {
    return EditStep(Op::Insert, index, nullptr, 0);
}

EditStep EditStep::Removed(int index, std::unique_ptr<CElement> element, int kind) {
    return EditStep(Op::Remove, index, std::move(element), kind);
}

EditStep EditStep::RemovedMany(std::vector<CCarnet::Taken> taken) {
    EditStep step(Op::RemoveMany, -1, nullptr, 0);
    step.m_indices.reserve(taken.size());
    for (const CCarnet::Taken& each : taken)
        step.m_indices.push_back(each.index);
    step.m_taken = std::move(taken);
    return step;
}

bool EditStep::TakeManyOut(CCarnet& carnet) {
    if (m_indices.empty() || !carnet.IsValidIndex(m_indices.back())) return false;
    m_taken = carnet.TakeMany(m_indices);
    return true;
}

bool EditStep::PutBack(CCarnet& carnet) {
    if (!m_element || m_index > carnet.GetSize()) return false;
    if (carnet.InsertAt(m_index, std::move(m_element), m_kind) < 0) return false;
    return true;
}

bool EditStep::TakeOut(CCarnet& carnet) {
    m_element = carnet.TakeAt(m_index, m_kind);
    return m_element != nullptr;
}

bool EditStep::Undo(CCarnet& carnet) {
    switch (m_op) {
    case Op::Exchange:
        return Exchange(carnet);
    case Op::Insert:
        return TakeOut(carnet);
    case Op::RemoveMany:
        return carnet.PutBackMany(m_taken);
    case Op::Remove:
        break;
    }
    return PutBack(carnet);
}

bool EditStep::Redo(CCarnet& carnet) {
    switch (m_op) {
    case Op::Exchange:
        return Exchange(carnet);
    case Op::Insert:
        return PutBack(carnet);
    case Op::RemoveMany:
        return TakeManyOut(carnet);
    case Op::Remove:
        break;
    }
    return TakeOut(carnet);
}

void EditHistory::Record(Edit edit) {
    edit.serial = ++m_lastSerial;
    m_done.push_back(std::move(edit));
    m_undone.clear();
}

const std::string& EditHistory::UndoLabel() const {
    static const std::string none;
    return m_done.empty() ? none : m_done.back().label;
}

const std::string& EditHistory::RedoLabel() const {
    static const std::string none;
    return m_undone.empty() ? none : m_undone.back().label;
}

bool EditHistory::Undo(CCarnet& carnet) {
    if (m_done.empty()) return false;
    Edit edit = std::move(m_done.back());
    m_done.pop_back();
    for (auto step = edit.steps.rbegin(); step != edit.steps.rend(); ++step)
        if (!step->Undo(carnet)) {
            m_undone.clear(); // what follows it can no longer be redone either
            return false;
        }
    m_undone.push_back(std::move(edit));
    return true;
}

bool EditHistory::Redo(CCarnet& carnet) {
    if (m_undone.empty()) return false;
    Edit edit = std::move(m_undone.back());
    m_undone.pop_back();
    for (EditStep& step : edit.steps)
        if (!step.Redo(carnet)) {
            m_undone.clear();
            return false;
        }
    m_done.push_back(std::move(edit));
    return true;
}

void EditHistory::Clear() {
    m_done.clear();
    m_undone.clear();
}

} // namespace pyr
