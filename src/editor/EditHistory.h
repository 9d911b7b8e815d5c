#pragma once

#include "editor/ElementReplacement.h"
#include "geobase/Carnet.h"

#include <memory>
#include <string>
#include <vector>

// The undo history of a GéoBase being edited. An edit is a sequence of steps on the store, each of which
// keeps what undoes it: an element exchanged with its former state, an element inserted (taken out
// again to undo), an element removed (held, to be put back). Undoing replays the steps backwards, redoing
// forwards; no step copies an element, so a history of a million changed points costs one element each.
namespace pyr {

class EditStep {
public:
    // The element at `index` was exchanged with `other`, which now holds its former state.
    static EditStep Exchanged(int index, std::unique_ptr<CElement> other);
    // An element was inserted at `index`.
    static EditStep Inserted(int index);
    // The element `element` of kind `kind` was removed from `index`.
    static EditStep Removed(int index, std::unique_ptr<CElement> element, int kind);
    // Several elements were removed together (CCarnet::TakeMany).
    static EditStep RemovedMany(std::vector<CCarnet::Taken> taken);

    // Takes the step back, then makes it again: false, and nothing changed, when the store no longer
    // holds what the step expects (it was changed behind the history's back).
    bool Undo(CCarnet& carnet);
    bool Redo(CCarnet& carnet);

private:
    enum class Op { Exchange, Insert, Remove, RemoveMany };
    EditStep(Op op, int index, std::unique_ptr<CElement> element, int kind)
        : m_op(op), m_index(index), m_kind(kind), m_element(std::move(element)) {}
    bool Exchange(CCarnet& carnet) { return carnet.ExchangeAt(m_index, m_element); }
    bool PutBack(CCarnet& carnet);
    bool TakeOut(CCarnet& carnet);
    bool TakeManyOut(CCarnet& carnet);

    Op m_op;
    int m_index;
    int m_kind = 0;
    std::unique_ptr<CElement> m_element; // held while it is not in the store
    std::vector<CCarnet::Taken> m_taken; // the same for several elements
    std::vector<int> m_indices;          // theirs, to take them out again
};

struct Edit {
    std::string label; // what the editor's "Annuler" names: "Renumérotation de 12 points"
    std::vector<EditStep> steps;
    long serial = 0; // tells a saved state from another one
    // Whether it changes what the drawing of the GéoBase shows: a sighting's readings or a code do not,
    // a point moved or any element inserted or removed (the drawing names elements by index) does.
    bool drawn = true;
};

class EditHistory {
public:
    // Records an edit already made on the store; the edits undone until then are forgotten.
    void Record(Edit edit);
    bool CanUndo() const { return !m_done.empty(); }
    bool CanRedo() const { return !m_undone.empty(); }
    const std::string& UndoLabel() const;
    const std::string& RedoLabel() const;
    // Whether the edit the next undo (redo) takes back (makes again) changes the drawing.
    bool UndoChangesDrawing() const { return !m_done.empty() && m_done.back().drawn; }
    bool RedoChangesDrawing() const { return !m_undone.empty() && m_undone.back().drawn; }
    // False, with the edit dropped from the history, when the store did not take it back.
    bool Undo(CCarnet& carnet);
    bool Redo(CCarnet& carnet);
    void Clear();

    // The state the store is in: 0 for the one it was opened in.
    long State() const { return m_done.empty() ? 0 : m_done.back().serial; }

private:
    std::vector<Edit> m_done;
    std::vector<Edit> m_undone;
    long m_lastSerial = 0;
};

} // namespace pyr
