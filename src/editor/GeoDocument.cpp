#include "editor/GeoDocument.h"

#include "calc/SessionTexts.h"
#include "core/Strings.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>

namespace pyr {

namespace {
constexpr const char* kLabelReplace = "Modification";
constexpr const char* kLabelInsert = "Insertion de l'élément # %d";
constexpr const char* kLabelRemove = "Suppression de %d élément(s)";
constexpr const char* kLabelMove = "Déplacement de l'élément # %d";
constexpr const char* kLabelDisable = "Désactivation de l'élément # %d";
constexpr const char* kLabelEnable = "Réactivation de l'élément # %d";
// Whether the drawing shows `before` and `after`, two states of an element of that kind, differently:
// a point's place, height and invariance, a set-up's height and V0 (its description), the identifiers
// that tie sightings to their points, a traverse's stations.
bool DrawnDifferently(const CElement& before, const CElement& after, int kind) {
    if (before.mat() != after.mat())
        return IsSightingKind(kind) || kind == kKindPoint || kind == kKindStation || kind == kKindChemin;
    switch (kind) {
    case kKindPoint: {
        const auto& a = static_cast<const CPointGen&>(before);
        const auto& b = static_cast<const CPointGen&>(after);
        return a.x() != b.x() || a.y() != b.y() || a.z() != b.z() || a.invariantXY() != b.invariantXY();
    }
    case kKindStation: {
        const auto& a = static_cast<const CStation&>(before);
        const auto& b = static_cast<const CStation&>(after);
        return a.hi() != b.hi() || a.v0() != b.v0();
    }
    case kKindChemin:
        return true;
    default:
        return false;
    }
}

} // namespace

bool CGeoDocument::Open(ui::FrontEnd& frontEnd, const std::string& path) {
    CPyrTxtWnd txt(frontEnd);
    CCarnet read;
    if (read.Load(&txt, path, {}, 0, &frontEnd) != 1) return false;
    m_carnet = std::move(read);
    m_path = path;
    m_selection.clear();
    m_history.Clear();
    m_savedState = m_history.State();
    ++m_drawingRevision;
    Notify(kPartElements | kPartSelection | kPartHistory | kPartFile);
    return true;
}

bool CGeoDocument::Save(ui::FrontEnd& frontEnd) {
    if (m_carnet.Save(m_path, &frontEnd) != 1) return false;
    m_savedState = m_history.State();
    Notify(kPartHistory);
    return true;
}

bool CGeoDocument::SaveAs(ui::FrontEnd& frontEnd, const std::string& path) {
    if (m_carnet.Save(path, &frontEnd) != 1) return false;
    m_path = path;
    m_savedState = m_history.State();
    Notify(kPartHistory | kPartFile);
    return true;
}

bool CGeoDocument::CanClose(ui::FrontEnd& frontEnd) {
    if (!Modified()) return true;
    switch (frontEnd.Ask(session::kQuestionSaveModified, ui::kCaption, ui::Buttons::YesNoCancel,
                         ui::Answer::Yes)) {
    case ui::Answer::Yes:
        return Save(frontEnd);
    case ui::Answer::No:
        return true;
    case ui::Answer::Cancel:
        break;
    }
    return false;
}

void CGeoDocument::Select(std::vector<int> indices) {
    std::erase_if(indices, [this](int index) { return !m_carnet.IsValidIndex(index); });
    std::sort(indices.begin(), indices.end());
    indices.erase(std::unique(indices.begin(), indices.end()), indices.end());
    if (indices == m_selection) return;
    m_selection = std::move(indices);
    Notify(kPartSelection);
}

void CGeoDocument::Recorded(Edit edit, bool structural) {
    if (structural) edit.drawn = true;
    if (edit.drawn) ++m_drawingRevision;
    m_history.Record(std::move(edit));
    int parts = kPartElements | kPartHistory;
    if (structural && !m_selection.empty()) {
        m_selection.clear();
        parts |= kPartSelection;
    }
    Notify(parts);
}

bool CGeoDocument::Replace(std::string label, ElementReplacements replacements) {
    // Checked whole before anything changes: all of them are made, or none.
    for (const ElementReplacement& r : replacements)
        if (!r.element || !m_carnet.IsValidIndex(r.index) ||
            !ElementFitsKind(*r.element, m_carnet.GetType(r.index)))
            return false;
    if (replacements.empty()) return false;
    Edit edit{label.empty() ? kLabelReplace : std::move(label), {}, 0, false};
    edit.steps.reserve(replacements.size());
    for (ElementReplacement& r : replacements) {
        edit.drawn =
            edit.drawn || DrawnDifferently(*m_carnet.GetAt(r.index), *r.element, m_carnet.GetType(r.index));
        m_carnet.ExchangeAt(r.index, r.element);
        edit.steps.push_back(EditStep::Exchanged(r.index, std::move(r.element)));
    }
    Recorded(std::move(edit), false);
    return true;
}

bool CGeoDocument::Insert(int index, std::unique_ptr<CElement> element, int kind) {
    if (index < 0 || index > m_carnet.GetSize()) return false;
    const int at = m_carnet.InsertAt(index, std::move(element), kind);
    if (at < 0) return false;
    Edit edit{Sprintf(kLabelInsert, at + 1), {}, 0, true};
    edit.steps.push_back(EditStep::Inserted(at));
    Recorded(std::move(edit), true);
    return true;
}

bool CGeoDocument::Remove(const std::vector<int>& indices) {
    std::vector<int> sorted = indices;
    std::sort(sorted.begin(), sorted.end());
    sorted.erase(std::unique(sorted.begin(), sorted.end()), sorted.end());
    if (sorted.empty() || !m_carnet.IsValidIndex(sorted.front()) || !m_carnet.IsValidIndex(sorted.back()))
        return false;
    Edit edit{Sprintf(kLabelRemove, static_cast<int>(sorted.size())), {}, 0, true};
    if (sorted.size() == 1) { // the store's index follows one removal without being built again
        int kind = 0;
        std::unique_ptr<CElement> element = m_carnet.TakeAt(sorted.front(), kind);
        edit.steps.push_back(EditStep::Removed(sorted.front(), std::move(element), kind));
    } else {
        edit.steps.push_back(EditStep::RemovedMany(m_carnet.TakeMany(sorted)));
    }
    Recorded(std::move(edit), true);
    return true;
}

bool CGeoDocument::Move(int from, int to) {
    if (!m_carnet.IsValidIndex(from) || !m_carnet.IsValidIndex(to) || from == to) return false;
    // Removed from its place and inserted at the other: the removal keeps a copy to put back on undo,
    // the element itself travelling with the insertion.
    int kind = 0;
    std::unique_ptr<CElement> copy = m_carnet.copyElement(from);
    std::unique_ptr<CElement> element = m_carnet.TakeAt(from, kind);
    m_carnet.InsertAt(to, std::move(element), kind);
    Edit edit{Sprintf(kLabelMove, from + 1), {}, 0, true};
    edit.steps.push_back(EditStep::Removed(from, std::move(copy), kind));
    edit.steps.push_back(EditStep::Inserted(to));
    Recorded(std::move(edit), true);
    return true;
}

bool CGeoDocument::Toggle(ui::FrontEnd& frontEnd, int index, bool disable) {
    if (!m_carnet.IsValidIndex(index)) return false;
    const int kind = m_carnet.GetType(index);
    std::unique_ptr<CElement> before = m_carnet.copyElement(index);
    CPyrTxtWnd txt(frontEnd);
    const bool changed = disable ? m_carnet.changeObjectIntoComment(&txt, index)
                                 : m_carnet.changeCommentIntoObject(&txt, index);
    if (!changed) return false;
    // The element of one kind removed, the one of the other kind inserted in its place.
    Edit edit{Sprintf(disable ? kLabelDisable : kLabelEnable, index + 1), {}, 0, true};
    edit.steps.push_back(EditStep::Removed(index, std::move(before), kind));
    edit.steps.push_back(EditStep::Inserted(index));
    edit.drawn = kind != kKindComment ? IsSightingKind(kind) || kind == kKindPoint || kind == kKindStation ||
                                            kind == kKindChemin
                                      : true;
    Recorded(std::move(edit), false);
    return true;
}

bool CGeoDocument::Disable(ui::FrontEnd& frontEnd, int index) {
    return Toggle(frontEnd, index, true);
}

bool CGeoDocument::Enable(ui::FrontEnd& frontEnd, int index) {
    return Toggle(frontEnd, index, false);
}

void CGeoDocument::RecordChanges(std::string label, ElementChanges changes) {
    if (changes.empty()) return;
    Edit edit{std::move(label), {}, 0, true};
    edit.steps.reserve(changes.size());
    for (ElementChange& change : changes)
        edit.steps.push_back(EditStep::Exchanged(change.index, std::move(change.other)));
    Recorded(std::move(edit), false);
}

void CGeoDocument::ForgetHistory() {
    m_history.Clear();
    ++m_drawingRevision;
    m_savedState = -1;
    m_selection.clear();
    Notify(kPartElements | kPartHistory | kPartSelection);
}

bool CGeoDocument::Undo() {
    if (!m_history.CanUndo()) return false;
    if (m_history.UndoChangesDrawing()) ++m_drawingRevision;
    const bool undone = m_history.Undo(m_carnet);
    // The indices of a selection no longer name the same elements after an insertion or a removal.
    m_selection.clear();
    Notify(kPartElements | kPartHistory | kPartSelection);
    return undone;
}

bool CGeoDocument::Redo() {
    if (!m_history.CanRedo()) return false;
    if (m_history.RedoChangesDrawing()) ++m_drawingRevision;
    const bool redone = m_history.Redo(m_carnet);
    m_selection.clear();
    Notify(kPartElements | kPartHistory | kPartSelection);
    return redone;
}

} // namespace pyr
