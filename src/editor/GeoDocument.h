#pragma once

#include "calc/ChangeRep.h"
#include "editor/EditHistory.h"
#include "editor/ElementReplacement.h"
#include "geobase/Carnet.h"
#include "ui/DialogModel.h"

#include <memory>
#include <string>
#include <vector>

namespace pyr {

namespace ui {
class FrontEnd;
}

// A GéoBase open in the editor: its elements, the elements selected (shared by its lists and its drawing),
// the history of its edits, undone and redone at any depth, and whether it differs from its file. Every
// edit goes through the actions below and is one step of the history; each one tells its listeners what
// changed. Deleting a point deletes that element only: the sightings of it are observations and stay.
class CGeoDocument : public ui::DialogModel {
public:
    // The parts a change notice names.
    static constexpr int kPartElements = 1;  // elements changed, inserted, removed or moved
    static constexpr int kPartSelection = 2; // the selection
    static constexpr int kPartHistory = 4;   // what may be undone or redone, modified or not
    static constexpr int kPartFile = 8;      // opened, saved under another name

    // ---- The file
    // Reads the GéoBase at `path` (problems reported in the text window); false when it could not be
    // read, the document then left as it was.
    bool Open(ui::FrontEnd& frontEnd, const std::string& path);
    // Writes the GéoBase to its file, or to `path` (which it then is); false, with the reason said, when
    // it could not be written.
    bool Save(ui::FrontEnd& frontEnd);
    bool SaveAs(ui::FrontEnd& frontEnd, const std::string& path);
    // Before the document is closed: when it was modified, asks whether to save it. False when the
    // person cancelled or the save failed: the document must stay open.
    bool CanClose(ui::FrontEnd& frontEnd);
    const std::string& Path() const { return m_path; }
    bool Modified() const { return m_history.State() != m_savedState; }
    // Changes whenever what the drawing of the GéoBase shows may have changed: the drawing of a million
    // elements is not made again for a sighting's distance or a code.
    long DrawingRevision() const { return m_drawingRevision; }
    const CCarnet& Carnet() const { return m_carnet; }
    // The GéoBase for a dialog that changes it in place (the change of frame, the reading of a field
    // book): what it changed comes back through RecordChanges, or the history is cleared.
    CCarnet& Store() { return m_carnet; }

    // ---- The selection: element indices, in increasing order, each once
    void Select(std::vector<int> indices);
    const std::vector<int>& Selection() const { return m_selection; }

    // ---- Edits; each false, the document unchanged, when it cannot be made
    // Puts each replacement's element in place of the element at its index (same kind).
    bool Replace(std::string label, ElementReplacements replacements);
    // Inserts an element before `index` (at the end for the element count).
    bool Insert(int index, std::unique_ptr<CElement> element, int kind);
    // Removes the elements at those indices.
    bool Remove(const std::vector<int>& indices);
    // Moves the element at `from` so that it stands at `to`.
    bool Move(int from, int to);
    // Turns the element into a comment that keeps its line, or a comment back into its element; what
    // was done, or why not, is said in the text window.
    bool Disable(ui::FrontEnd& frontEnd, int index);
    bool Enable(ui::FrontEnd& frontEnd, int index);
    // The records of a change made by another dialog on this GéoBase (the change of frame), kept as one
    // edit of the history.
    void RecordChanges(std::string label, ElementChanges changes);

    // ---- The history
    bool CanUndo() const { return m_history.CanUndo(); }
    bool CanRedo() const { return m_history.CanRedo(); }
    const std::string& UndoLabel() const { return m_history.UndoLabel(); }
    const std::string& RedoLabel() const { return m_history.RedoLabel(); }
    bool Undo();
    bool Redo();
    // After a change that the history cannot take back: nothing to undo any more, and the GéoBase
    // modified.
    void ForgetHistory();

private:
    bool Toggle(ui::FrontEnd& frontEnd, int index, bool disable);
    // The edit made, kept in the history and told; an edit that inserted, removed or moved elements
    // leaves nothing selected, the indices no longer naming the same elements.
    void Recorded(Edit edit, bool structural);

    CCarnet m_carnet;
    std::string m_path;
    std::vector<int> m_selection;
    EditHistory m_history;
    long m_savedState = 0;
    long m_drawingRevision = 0;
};

} // namespace pyr
