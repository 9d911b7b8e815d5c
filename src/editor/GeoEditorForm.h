#pragma once

#include "editor/EditorViews.h"
#include "editor/GeoEditor.h"
#include "editor/GeoScene.h"
#include "ui/Form.h"

#include <string>
#include <vector>

namespace pyr {

// The window of the GéoBase editor: the GéoBases open (one current, chosen in a list), the current one's
// elements in a table of a view (every element, or those of some kinds), its drawing sharing the
// selection with the table, the property page of the element selected, the edits (insert, remove, move,
// disable, undo, redo), the search, the renumbering of points and the renaming of a station, and the
// dialogs of the editor's menus. Opening it opens the GéoBase (the one named, else the one chosen);
// closing it asks about each GéoBase modified.
class CGeoEditorForm : public ui::Form {
public:
    // The most fields an element has (an instrument's): the lines of the property page.
    static constexpr int kMaxFields = 9;

    enum Id : int {
        kDocumentsLabel = 3,
        kDocuments,
        kOpen,
        kCloseDocument,
        kSave,
        kSaveAs,
        kViewLabel,
        kView,
        kStatus,
        kDrawing,
        // The page of the element selected.
        kElementGroup,
        kFieldLabel0,                            // kMaxFields labels,
        kFieldEdit0 = kFieldLabel0 + kMaxFields, // then as many edits
        kEditGroup = kFieldEdit0 + kMaxFields,   // the edits
        kInsert,
        kRemove,
        kMoveUp,
        kMoveDown,
        kToggle,
        kUndo,
        kRedo,
        kSearchGroup, // the search
        kSearchIdsLabel,
        kSearchIds,
        kSearchCodeLabel,
        kSearchCode,
        kSearchKindLabel,
        kSearchKind,
        kSearchValueLabel,
        kSearchValue,
        kSearchAll,
        kSearchNext,
        kRenumberGroup, // the renumbering
        kRenumberPointsLabel,
        kRenumberPoints,
        kRenumberOffsetLabel,
        kRenumberOffset,
        kRenumberPrefixLabel,
        kRenumberPrefix,
        kRenumber,
        kRenameFromLabel,
        kRenameFrom,
        kRenameToLabel,
        kRenameTo,
        kRename,
        kMenuGroup, // the dialogs of the menus
        kReduce,
        kChangeFrame,
        kExport,
        kFormatLabel,
        kFormat,
        kRead,
        kProjectionLabel,
        kProjection,
        kChangeProjection,
        kDuplicates,
        kElements, // the tables, one per view, the view shown the only one seen
    };

    explicit CGeoEditorForm(CGeoEditor& editor);
    ~CGeoEditorForm() override;

    ui::DialogModel& Model() override { return m_editor; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;
    int OnDemandRows(int id) const override;
    std::string OnDemandRow(int id, int rank) const override;
    const GeoScene* Scene(int id) const override;

    // The table of a view.
    static int TableOf(int view) { return kElements + view; }
    int ViewShown() const { return m_view; }

private:
    // The elements of the view shown, by rank; the indices themselves for the view of every element.
    int IndexOfRank(int view, int rank) const;
    int RankOfIndex(int view, int index) const;
    const std::vector<int>& Indices(int view) const;
    // The element whose page is shown: the one selected (the first of several), -1 for none.
    int CurrentElement() const;
    SearchCriteria Criteria() const;
    void ElementsChanged();

    CGeoEditor& m_editor;
    int m_listener = 0;
    int m_view = 0;
    long m_revision = 1; // of the elements and of the current GéoBase
    // By view, the indices of its elements, made again when the revision changed.
    mutable std::vector<std::vector<int>> m_indices;
    mutable std::vector<long> m_indicesRevision;
    // The drawing's revision: changes when another GéoBase is shown, or when the one shown changed what
    // it draws; the scene is made again only then.
    long DrawingRevision() const;
    mutable GeoScene m_scene;
    mutable long m_sceneRevision = 0;
    mutable long m_drawingRevision = 1;
    mutable const CGeoDocument* m_drawnDocument = nullptr;
    mutable long m_drawnDocumentRevision = -1;
    // What the search and the renumbering fields hold.
    std::string m_searchIds, m_searchCode, m_searchValue;
    int m_searchKind = 0;
    std::string m_renumberPoints, m_renumberOffset, m_renumberPrefix;
    std::string m_renameFrom, m_renameTo;
    int m_format = 0;     // the format of the next reading, in the order of the reading menu
    int m_projection = 0; // the projection into which the points are converted, among those offered
    std::string m_said;   // the last result said in the status line
};

} // namespace pyr
