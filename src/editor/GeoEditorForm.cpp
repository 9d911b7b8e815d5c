#include "editor/GeoEditorForm.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookFormats.h"
#include "geobase/Kinds.h"
#include "projection/ProjectionNames.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <charconv>
#include <filesystem>

namespace pyr {

namespace {

using ui::ControlKind;
using ui::Ctl;

constexpr const char* kNoElement = "Aucun élément choisi";
constexpr const char* kElementTitle = "Élément n° %d : %s";
constexpr const char* kStatusLine = "%d élément(s), %d choisi(s)";
constexpr const char* kModified = " ; GéoBase modifiée";
constexpr const char* kFoundLine = "%d élément(s) trouvé(s).";
constexpr const char* kNothingFound = "Aucun élément trouvé.";
constexpr const char* kUndone = "Annulé : %s.";
constexpr const char* kRedone = "Rétabli : %s.";
constexpr const char* kBadOffset = "Le décalage « %s » n'est pas un nombre entier.";
constexpr const char* kAllKinds = "(tous)";
constexpr const char* kDuplicatesFound = "%d couple(s) de points doubles.";

// A menu entry as a line of a list: "Carnet &Wild, Leica" gives "Carnet Wild, Leica".
std::string WithoutAccelerator(std::string_view entry) {
    std::string line;
    for (char c : entry)
        if (c != '&') line += c;
    return line;
}

// The kinds the search offers, after "(tous)".
constexpr int kSearchKinds[] = {kKindComment, kKindStation, kKindReference, kKindMesure,   kKindLectAR,
                                kKindLectAV,  kKindPoint,   kKindChemin,    kKindAppareil, kKindCommand};

ui::Control Labelled(std::vector<ui::Control>& controls, int labelId, const char* label, int id, int parent,
                     int row, int column) {
    controls.push_back(Ctl(labelId, ControlKind::Label, "", label).In(parent).At(row, column).Buddy(id));
    return Ctl(id, ControlKind::Edit, "").In(parent).At(row, column + 1);
}

} // namespace

CGeoEditorForm::CGeoEditorForm(CGeoEditor& editor)
    : m_editor(editor), m_indices(EditorViews().size()), m_indicesRevision(EditorViews().size(), 0) {
    m_listener = m_editor.Listen([this](int parts) {
        if (parts & (CGeoEditor::kPartGeoBase | CGeoEditor::kPartDocuments | CGeoEditor::kPartFile))
            ElementsChanged();
        // Another GéoBase is drawn, even if it took the place in memory of one closed.
        if (parts & CGeoEditor::kPartDocuments) m_drawnDocument = nullptr;
    });
}

CGeoEditorForm::~CGeoEditorForm() {
    m_editor.StopListening(m_listener);
}

void CGeoEditorForm::ElementsChanged() {
    ++m_revision;
}

std::vector<ui::Control> CGeoEditorForm::Controls() const {
    std::vector<ui::Control> controls;
    // The GéoBases open.
    controls.push_back(
        Ctl(kDocumentsLabel, ControlKind::Label, "geobaseLabel", "&GéoBase :").Buddy(kDocuments));
    controls.push_back(Ctl(kDocuments, ControlKind::Combo, "geobases").At(0, 1, 1, 3).Width(50));
    controls.push_back(Ctl(kOpen, ControlKind::Button, "ouvrir", "&Ouvrir...").At(0, 4));
    controls.push_back(
        Ctl(kCloseDocument, ControlKind::Button, "fermerGeobase", "Fermer la Géo&Base").At(0, 5));
    controls.push_back(Ctl(kSave, ControlKind::Button, "enregistrer", "&Enregistrer").At(0, 6));
    controls.push_back(Ctl(kSaveAs, ControlKind::Button, "enregistrerSous", "Enregistrer &sous...").At(0, 7));
    controls.push_back(Ctl(kViewLabel, ControlKind::Label, "vueLabel", "&Vue :").At(1, 0).Buddy(kView));
    controls.push_back(Ctl(kView, ControlKind::Combo, "vue").At(1, 1, 1, 2));

    // The tables of the views and the drawing, side by side.
    const std::vector<EditorView>& views = EditorViews();
    for (std::size_t view = 0; view < views.size(); ++view) {
        ui::Control table =
            Ctl(TableOf(static_cast<int>(view)), ControlKind::List, Sprintf("elements%zu", view))
                .At(2, 0, 1, 5)
                .Columns(ViewHeadings(views[view]))
                .Width(80)
                .Lines(18)
                .OnDemand()
                .Multiple();
        controls.push_back(table);
    }
    controls.push_back(Ctl(kDrawing, ControlKind::Drawing, "dessin").At(2, 5, 1, 3).Width(50).Lines(18));

    // The page of the element selected.
    controls.push_back(Ctl(kElementGroup, ControlKind::Group, "element", kNoElement).At(3, 0, 1, 3));
    for (int field = 0; field < kMaxFields; ++field) {
        controls.push_back(
            Ctl(kFieldLabel0 + field, ControlKind::Label, Sprintf("champLabel%d", field), "Champ :")
                .In(kElementGroup)
                .At(field, 0)
                .Buddy(kFieldEdit0 + field));
        controls.push_back(Ctl(kFieldEdit0 + field, ControlKind::Edit, Sprintf("champ%d", field))
                               .In(kElementGroup)
                               .At(field, 1)
                               .Width(20));
    }

    // The edits.
    controls.push_back(Ctl(kEditGroup, ControlKind::Group, "edition", "Édition").At(3, 3, 1, 2));
    const struct {
        int id;
        const char* name;
        const char* text;
    } edits[] = {{kInsert, "inserer", "&Insérer un commentaire"},
                 {kRemove, "supprimer", "Su&pprimer"},
                 {kMoveUp, "monter", "&Monter"},
                 {kMoveDown, "descendre", "Descen&dre"},
                 {kToggle, "desactiver", "Dés&activer"},
                 {kUndo, "annuler", "Ann&uler"},
                 {kRedo, "retablir", "Ré&tablir"}};
    int row = 0;
    for (const auto& edit : edits)
        controls.push_back(
            Ctl(edit.id, ControlKind::Button, edit.name, edit.text).In(kEditGroup).At(row++, 0));

    // The search.
    controls.push_back(Ctl(kSearchGroup, ControlKind::Group, "recherche", "Recherche").At(3, 5, 1, 3));
    ui::Control edit = Labelled(controls, kSearchIdsLabel, "Ma&tricules :", kSearchIds, kSearchGroup, 0, 0);
    edit.name = "chercherMatricules";
    controls.push_back(edit);
    edit = Labelled(controls, kSearchCodeLabel, "Co&de :", kSearchCode, kSearchGroup, 1, 0);
    edit.name = "chercherCode";
    controls.push_back(edit);
    controls.push_back(Ctl(kSearchKindLabel, ControlKind::Label, "", "&Genre :")
                           .In(kSearchGroup)
                           .At(2, 0)
                           .Buddy(kSearchKind));
    controls.push_back(Ctl(kSearchKind, ControlKind::Combo, "chercherGenre").In(kSearchGroup).At(2, 1));
    edit = Labelled(controls, kSearchValueLabel, "Va&leur :", kSearchValue, kSearchGroup, 3, 0);
    edit.name = "chercherValeur";
    controls.push_back(edit);
    controls.push_back(
        Ctl(kSearchAll, ControlKind::Button, "chercher", "&Chercher").In(kSearchGroup).At(4, 0));
    controls.push_back(
        Ctl(kSearchNext, ControlKind::Button, "suivant", "Sui&vant").In(kSearchGroup).At(4, 1));

    // The renumbering and the renaming.
    controls.push_back(
        Ctl(kRenumberGroup, ControlKind::Group, "renumerotation", "Renumérotation").At(4, 0, 1, 5));
    edit = Labelled(controls, kRenumberPointsLabel, "Poi&nts :", kRenumberPoints, kRenumberGroup, 0, 0);
    edit.name = "renumPoints";
    controls.push_back(edit);
    edit = Labelled(controls, kRenumberOffsetLabel, "Déc&alage :", kRenumberOffset, kRenumberGroup, 0, 2);
    edit.name = "renumDecalage";
    controls.push_back(edit);
    edit = Labelled(controls, kRenumberPrefixLabel, "Pré&fixe :", kRenumberPrefix, kRenumberGroup, 0, 4);
    edit.name = "renumPrefixe";
    controls.push_back(edit);
    controls.push_back(
        Ctl(kRenumber, ControlKind::Button, "renumeroter", "Renu&méroter").In(kRenumberGroup).At(0, 6));
    edit = Labelled(controls, kRenameFromLabel, "Stat&ion :", kRenameFrom, kRenumberGroup, 1, 0);
    edit.name = "renommerStation";
    controls.push_back(edit);
    edit = Labelled(controls, kRenameToLabel, "No&uveau nom :", kRenameTo, kRenumberGroup, 1, 2);
    edit.name = "renommerNom";
    controls.push_back(edit);
    controls.push_back(
        Ctl(kRename, ControlKind::Button, "renommer", "&Renommer").In(kRenumberGroup).At(1, 6));

    // The dialogs of the menus.
    controls.push_back(Ctl(kMenuGroup, ControlKind::Group, "traitements", "Traitements").At(4, 5, 1, 3));
    controls.push_back(
        Ctl(kReduce, ControlKind::Button, "reduction", "Ré&duction des reprises").In(kMenuGroup).At(0, 0));
    controls.push_back(
        Ctl(kChangeFrame, ControlKind::Button, "repere", "Changement de &repère...").In(kMenuGroup).At(0, 1));
    controls.push_back(Ctl(kExport, ControlKind::Button, "exportation", "&Exportation de points...")
                           .In(kMenuGroup)
                           .At(0, 2));
    controls.push_back(Ctl(kFormatLabel, ControlKind::Label, "formatLabel", "F&ormat du carnet :")
                           .In(kMenuGroup)
                           .At(1, 0)
                           .Buddy(kFormat));
    controls.push_back(Ctl(kFormat, ControlKind::Combo, "format").In(kMenuGroup).At(1, 1));
    controls.push_back(Ctl(kRead, ControlKind::Button, "lecture", "&Lecture").In(kMenuGroup).At(1, 2));
    controls.push_back(
        Ctl(kDuplicates, ControlKind::Button, "pointsDoubles", "Points dou&bles").In(kMenuGroup).At(3, 0));
    controls.push_back(Ctl(kProjectionLabel, ControlKind::Label, "projectionLabel", "Pro&jection d'arrivée :")
                           .In(kMenuGroup)
                           .At(2, 0)
                           .Buddy(kProjection));
    controls.push_back(Ctl(kProjection, ControlKind::Combo, "projection").In(kMenuGroup).At(2, 1));
    controls.push_back(
        Ctl(kChangeProjection, ControlKind::Button, "changementProjection", "Changement de &projection")
            .In(kMenuGroup)
            .At(2, 2));

    controls.push_back(Ctl(kStatus, ControlKind::Status, "etat").At(5, 0, 1, 8));
    ui::Control close = Ctl(ui::kIdCancel, ControlKind::Button, "fermer", "&Fermer");
    close.parent = ui::kButtonRow;
    controls.push_back(close);
    return controls;
}

bool CGeoEditorForm::Open(ui::FrontEnd& frontEnd) {
    const ui::DialogResult opened = m_editor.OpenGeoBase(frontEnd);
    if (opened != ui::DialogResult::Ok) {
        End(opened);
        return false;
    }
    return true;
}

// ---------------------------------------------------------------- views

const std::vector<int>& CGeoEditorForm::Indices(int view) const {
    const auto at = static_cast<std::size_t>(view);
    if (m_indicesRevision[at] != m_revision) {
        m_indices[at] = ViewIndices(m_editor.Carnet(), EditorViews()[at]);
        m_indicesRevision[at] = m_revision;
    }
    return m_indices[at];
}

int CGeoEditorForm::IndexOfRank(int view, int rank) const {
    if (EditorViews()[static_cast<std::size_t>(view)].kinds.empty())
        return m_editor.Carnet().IsValidIndex(rank) ? rank : -1;
    const std::vector<int>& indices = Indices(view);
    return rank >= 0 && rank < static_cast<int>(indices.size()) ? indices[static_cast<std::size_t>(rank)]
                                                                : -1;
}

int CGeoEditorForm::RankOfIndex(int view, int index) const {
    if (index < 0) return -1;
    if (EditorViews()[static_cast<std::size_t>(view)].kinds.empty()) return index;
    const std::vector<int>& indices = Indices(view);
    const auto found = std::lower_bound(indices.begin(), indices.end(), index);
    return found != indices.end() && *found == index ? static_cast<int>(found - indices.begin()) : -1;
}

int CGeoEditorForm::OnDemandRows(int id) const {
    const int view = id - kElements;
    if (view < 0 || view >= static_cast<int>(EditorViews().size())) return 0;
    if (EditorViews()[static_cast<std::size_t>(view)].kinds.empty()) return m_editor.Carnet().GetSize();
    return static_cast<int>(Indices(view).size());
}

std::string CGeoEditorForm::OnDemandRow(int id, int rank) const {
    const int view = id - kElements;
    if (view < 0 || view >= static_cast<int>(EditorViews().size())) return {};
    const int index = IndexOfRank(view, rank);
    if (index < 0) return {};
    return ViewRow(m_editor.Carnet(), EditorViews()[static_cast<std::size_t>(view)], index);
}

long CGeoEditorForm::DrawingRevision() const {
    const CGeoDocument& document = m_editor.Document();
    if (&document != m_drawnDocument || document.DrawingRevision() != m_drawnDocumentRevision) {
        m_drawnDocument = &document;
        m_drawnDocumentRevision = document.DrawingRevision();
        ++m_drawingRevision;
    }
    return m_drawingRevision;
}

const GeoScene* CGeoEditorForm::Scene(int id) const {
    if (id != kDrawing) return nullptr;
    if (m_sceneRevision != DrawingRevision()) {
        m_scene.Build(m_editor.Carnet());
        m_sceneRevision = m_drawingRevision;
    }
    return &m_scene;
}

int CGeoEditorForm::CurrentElement() const {
    const std::vector<int>& selection = m_editor.Document().Selection();
    return selection.empty() ? -1 : selection.front();
}

// ---------------------------------------------------------------- states

ui::ControlState CGeoEditorForm::State(int id) const {
    ui::ControlState state;
    const CGeoDocument& document = m_editor.Document();
    const CCarnet& carnet = document.Carnet();
    const bool open = m_editor.DocumentCount() > 0;
    const int current = CurrentElement();
    const int kind = carnet.GetType(current);
    const std::vector<FieldInfo>& fields = KindFields(kind);
    const int selected = static_cast<int>(document.Selection().size());

    if (id >= kElements && id < kElements + static_cast<int>(EditorViews().size())) {
        const int view = id - kElements;
        state.visible = view == m_view;
        state.revision = m_revision;
        if (view == m_view) {
            state.current = RankOfIndex(view, current);
            for (int index : document.Selection())
                if (const int rank = RankOfIndex(view, index); rank >= 0) state.selection.push_back(rank);
        }
        return state;
    }
    if (id >= kFieldLabel0 && id < kFieldLabel0 + kMaxFields) {
        const auto field = static_cast<std::size_t>(id - kFieldLabel0);
        state.visible = field < fields.size();
        if (state.visible) {
            state.text = std::string(fields[field].label);
            if (!fields[field].unit.empty())
                state.text += Sprintf(" (%s)", std::string(fields[field].unit).c_str());
            state.text += " :";
        }
        return state;
    }
    if (id >= kFieldEdit0 && id < kFieldEdit0 + kMaxFields) {
        const auto field = static_cast<std::size_t>(id - kFieldEdit0);
        state.visible = field < fields.size();
        if (state.visible) state.text = FieldText(carnet, current, fields[field].key);
        return state;
    }
    switch (id) {
    case kDocuments:
        for (int rank = 0; rank < m_editor.DocumentCount(); ++rank) {
            const CGeoDocument& each = m_editor.DocumentAt(rank);
            state.items.push_back(std::filesystem::path(each.Path()).filename().string() +
                                  (each.Modified() ? " *" : ""));
            state.tips.push_back(each.Path());
        }
        state.current = m_editor.CurrentDocument();
        break;
    case kCloseDocument:
    case kSaveAs:
    case kInsert:
    case kReduce:
    case kChangeFrame:
    case kExport:
    case kSearchAll:
    case kSearchNext:
    case kRenumber:
    case kRename:
        state.enabled = open;
        break;
    case kSave:
        state.enabled = open && document.Modified();
        break;
    case kView:
        for (const EditorView& view : EditorViews())
            state.items.emplace_back(view.title);
        state.current = m_view;
        break;
    case kDrawing:
        state.revision = DrawingRevision();
        state.selection = document.Selection();
        break;
    case kElementGroup:
        state.text = current < 0 ? kNoElement
                                 : Sprintf(kElementTitle, current + 1, std::string(KindLabel(kind)).c_str());
        break;
    case kRemove:
        state.enabled = selected > 0;
        break;
    case kMoveUp:
        state.enabled = selected == 1 && current > 0;
        break;
    case kMoveDown:
        state.enabled = selected == 1 && current + 1 < carnet.GetSize();
        break;
    case kToggle:
        state.enabled = selected == 1;
        state.text = kind == kKindComment ? "Ré&activer" : "Dés&activer";
        break;
    case kUndo:
        state.enabled = document.CanUndo();
        break;
    case kRedo:
        state.enabled = document.CanRedo();
        break;
    case kSearchIds:
        state.text = m_searchIds;
        break;
    case kSearchCode:
        state.text = m_searchCode;
        break;
    case kSearchValue:
        state.text = m_searchValue;
        break;
    case kSearchKind:
        state.items.emplace_back(kAllKinds);
        for (int each : kSearchKinds)
            state.items.emplace_back(KindLabel(each));
        state.current = m_searchKind;
        break;
    case kRenumberPoints:
        state.text = m_renumberPoints;
        break;
    case kRenumberOffset:
        state.text = m_renumberOffset;
        break;
    case kRenumberPrefix:
        state.text = m_renumberPrefix;
        break;
    case kRenameFrom:
        state.text = m_renameFrom;
        break;
    case kRenameTo:
        state.text = m_renameTo;
        break;
    case kFormat:
        for (const auto& info : FieldBookFormats())
            state.items.push_back(WithoutAccelerator(info.menuEntry));
        state.current = m_format;
        break;
    case kRead:
        break;
    case kProjection:
        for (const NamedProjection& projection : OfferedProjections())
            state.items.emplace_back(projection.name);
        state.current = m_projection;
        break;
    case kChangeProjection:
    case kDuplicates:
        state.enabled = open;
        break;
    case kStatus:
        state.text = !m_said.empty() ? m_said
                                     : Sprintf(kStatusLine, carnet.GetSize(), selected) +
                                           (document.Modified() ? kModified : "");
        break;
    default:
        break;
    }
    return state;
}

// ---------------------------------------------------------------- actions

SearchCriteria CGeoEditorForm::Criteria() const {
    SearchCriteria criteria;
    criteria.identifiers = m_searchIds;
    if (!m_searchCode.empty()) criteria.code = m_searchCode;
    if (m_searchKind > 0) criteria.kinds.push_back(kSearchKinds[m_searchKind - 1]);
    if (!m_searchValue.empty()) criteria.value = ParseValueCriterion(m_searchValue);
    return criteria;
}

void CGeoEditorForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    m_said.clear();
    CGeoDocument& document = m_editor.Document();
    const bool text = event.kind == ui::EventKind::Text;
    if (id >= kElements && id < kElements + static_cast<int>(EditorViews().size())) {
        if (event.kind != ui::EventKind::Select) return;
        const int view = id - kElements;
        std::vector<int> indices;
        const std::vector<int> ranks =
            event.ranks.empty() && event.rank >= 0 ? std::vector<int>{event.rank} : event.ranks;
        indices.reserve(ranks.size());
        for (int rank : ranks)
            if (const int index = IndexOfRank(view, rank); index >= 0) indices.push_back(index);
        document.Select(std::move(indices));
        return;
    }
    if (id >= kFieldEdit0 && id < kFieldEdit0 + kMaxFields && text) {
        const int current = CurrentElement();
        const std::vector<FieldInfo>& fields = KindFields(m_editor.Carnet().GetType(current));
        const auto field = static_cast<std::size_t>(id - kFieldEdit0);
        if (field >= fields.size() || FieldText(m_editor.Carnet(), current, fields[field].key) == event.text)
            return;
        if (m_editor.SetField(frontEnd, current, fields[field].key, event.text)) document.Select({current});
        return;
    }
    switch (id) {
    case kDocuments:
        if (event.kind == ui::EventKind::Select) m_editor.SetCurrentDocument(event.rank);
        break;
    case kOpen:
        m_editor.OpenAnother(frontEnd);
        break;
    case kCloseDocument:
        m_editor.CloseCurrent(frontEnd);
        break;
    case kSave:
        m_editor.Save(frontEnd);
        break;
    case kSaveAs:
        m_editor.SaveAs(frontEnd);
        break;
    case kView:
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(EditorViews().size()))
            m_view = event.rank;
        break;
    case kDrawing:
        if (event.kind == ui::EventKind::Select)
            document.Select(event.rank >= 0 ? std::vector<int>{event.rank} : std::vector<int>{});
        break;
    case kInsert: {
        const int current = CurrentElement();
        m_editor.InsertComment(current >= 0 ? current : m_editor.Carnet().GetSize(), "");
        break;
    }
    case kRemove:
        m_editor.RemoveSelected();
        break;
    case kMoveUp:
        m_editor.MoveSelected(-1);
        break;
    case kMoveDown:
        m_editor.MoveSelected(1);
        break;
    case kToggle:
        m_editor.ToggleSelected(frontEnd);
        break;
    case kUndo: {
        const std::string label = document.UndoLabel();
        if (document.Undo()) m_said = Sprintf(kUndone, label.c_str());
        break;
    }
    case kRedo: {
        const std::string label = document.RedoLabel();
        if (document.Redo()) m_said = Sprintf(kRedone, label.c_str());
        break;
    }
    case kSearchIds:
        if (text) m_searchIds = event.text;
        break;
    case kSearchCode:
        if (text) m_searchCode = event.text;
        break;
    case kSearchValue:
        if (text) m_searchValue = event.text;
        break;
    case kSearchKind:
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank <= static_cast<int>(std::size(kSearchKinds)))
            m_searchKind = event.rank;
        break;
    case kSearchAll: {
        const int found = m_editor.SearchAll(frontEnd, Criteria());
        if (found >= 0) m_said = found == 0 ? kNothingFound : Sprintf(kFoundLine, found);
        break;
    }
    case kSearchNext:
        if (m_editor.SearchNext(frontEnd, Criteria(), true) == 0) m_said = kNothingFound;
        break;
    case kRenumberPoints:
        if (text) m_renumberPoints = event.text;
        break;
    case kRenumberOffset:
        if (text) m_renumberOffset = event.text;
        break;
    case kRenumberPrefix:
        if (text) m_renumberPrefix = event.text;
        break;
    case kRenumber: {
        RenumberRequest request;
        request.selection = m_renumberPoints;
        const std::string offset(Trimmed(m_renumberOffset));
        if (!offset.empty()) {
            const auto [end, error] =
                std::from_chars(offset.data(), offset.data() + offset.size(), request.offset);
            if (error != std::errc() || end != offset.data() + offset.size()) {
                frontEnd.MessageBox(Sprintf(kBadOffset, offset.c_str()), ui::kCaption, ui::kIconWarning);
                break;
            }
        }
        if (!Trimmed(m_renumberPrefix).empty()) request.newPrefix = std::string(Trimmed(m_renumberPrefix));
        m_editor.Renumber(frontEnd, request);
        break;
    }
    case kRenameFrom:
        if (text) m_renameFrom = event.text;
        break;
    case kRenameTo:
        if (text) m_renameTo = event.text;
        break;
    case kRename:
        m_editor.RenameStation(frontEnd, Trimmed(m_renameFrom), Trimmed(m_renameTo));
        break;
    case kFormat:
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(FieldBookFormats().size()))
            m_format = event.rank;
        break;
    case kReduce:
        m_editor.ReduceStations(frontEnd);
        break;
    case kChangeFrame:
        m_editor.ChangeFrame(frontEnd);
        break;
    case kExport:
        m_editor.ExportPoints(frontEnd); // the GéoBase stays as it is
        break;
    case kRead:
        m_editor.ReadFieldBook(frontEnd, FieldBookFormats()[static_cast<std::size_t>(m_format)].format);
        break;
    case kProjection:
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(OfferedProjections().size()))
            m_projection = event.rank;
        break;
    case kDuplicates: {
        const int found = m_editor.FindDuplicates(frontEnd, true);
        if (found >= 0) m_said = Sprintf(kDuplicatesFound, found);
        break;
    }
    case kChangeProjection:
        m_editor.ChangeProjection(frontEnd,
                                  OfferedProjections()[static_cast<std::size_t>(m_projection)].name);
        break;
    case ui::kIdCancel:
        if (m_editor.CanCloseAll(frontEnd)) End(ui::DialogResult::Ok);
        break;
    default:
        break;
    }
}

std::unique_ptr<ui::Form> CGeoEditor::MakeForm() {
    return std::make_unique<CGeoEditorForm>(*this);
}

} // namespace pyr
