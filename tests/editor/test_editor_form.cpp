// The editor as a window: the GéoBases open, the tables of their elements, the property page, the edits
// with their undo, the search, the renumbering, and the dialogs of its menus run through the front end.
#include "TestSupport.h"
#include "editor/GeoEditorForm.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>

namespace {

using pyr::CGeoEditorForm;
using pyr::ui::Answer;
using pyr::ui::DialogResult;
using pyr::ui::Event;
using pyr::ui::EventKind;

constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1000\tLevé du 2 mars\n"
                             "1001\tINCONNUE\t1.562\t-999999\n"
                             "1003\tA1\t1.3\t323.76206\t99.40145\t260.0083\n"
                             "1003\t102\t1.8\t388.64623\t99.18242\t111.5994\n"
                             "1006\tA1\t651050.118\t6862512.447\t55.021\tXY\n"
                             "1006\t102\t650900.5\t6862400.25\t-999999\t-\n";
constexpr const char* kBook = "QUENDAL-PC;1\nSTATION;S2;1.5\nMESURE;102;1.8;388.64623;99.18242;111.5994\n";

Event Select(std::vector<int> ranks) {
    Event event{EventKind::Select, ranks.empty() ? -1 : ranks.front(), false, {}};
    event.ranks = std::move(ranks);
    return event;
}

Event Typed(std::string text) {
    return {EventKind::Text, -1, false, std::move(text)};
}

class EditorForm : public ::testing::Test {
protected:
    EditorForm() {
        WriteBytes(dir / "job.geo", kJob);
        WriteBytes(dir / "carnet.qdl", kBook);
        editor.SetInputs({dir / "job.geo", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        form = editor.MakeForm();
        EXPECT_TRUE(form->Open(frontEnd)); // the GéoBase offered, confirmed
    }
    // The lines of a view's table, asked for as a desktop table asks for them.
    std::vector<std::string> Rows(int view = 0) const {
        std::vector<std::string> rows;
        const int id = CGeoEditorForm::TableOf(view);
        for (int rank = 0; rank < form->OnDemandRows(id); ++rank)
            rows.push_back(form->OnDemandRow(id, rank));
        return rows;
    }
    std::vector<std::string> SavedRows() const {
        pyr::CCarnet carnet;
        EXPECT_TRUE(carnet.Load(nullptr, dir / "job.geo"));
        std::vector<std::string> rows;
        for (int i = 0; i < carnet.GetSize(); ++i)
            rows.push_back(pyr::EditorRow(carnet, i));
        return rows;
    }
    void Act(int id, const Event& event = {}) { form->Act(frontEnd, id, event); }
    std::string Text(int id) const { return form->State(id).text; }

    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CGeoEditor editor;
    std::unique_ptr<pyr::ui::Form> form;
};

} // namespace

TEST_F(EditorForm, ListsTheElementsAndReadsAFieldBookIntoThem) {
    EXPECT_EQ(form->State(CGeoEditorForm::kDocuments).items, std::vector<std::string>{"job.geo"});
    EXPECT_EQ(Rows(), SavedRows());
    EXPECT_EQ(Text(CGeoEditorForm::kStatus), "6 élément(s), 0 choisi(s)");

    // The reduction's dialog and the reading's are run by the front end.
    Act(CGeoEditorForm::kReduce);
    const auto formats = form->State(CGeoEditorForm::kFormat).items;
    ASSERT_EQ(formats.back(), "Carnet Quendal-Pc");
    Act(CGeoEditorForm::kFormat, {EventKind::Select, static_cast<int>(formats.size()) - 1, false, {}});
    frontEnd.dialogArguments = {dir / "carnet.qdl"};
    frontEnd.answers = {Answer::Yes}; // added to the GéoBase open
    const long before = form->State(CGeoEditorForm::TableOf(0)).revision;
    Act(CGeoEditorForm::kRead);
    EXPECT_EQ(frontEnd.dialogs.size(), 2u);
    EXPECT_EQ(frontEnd.dialogs.back(), "Lecture du carnet Quendal-Pc");
    // Read and saved: the table, told its lines changed, shows the file.
    EXPECT_NE(form->State(CGeoEditorForm::TableOf(0)).revision, before);
    ASSERT_EQ(SavedRows().size(), 8u);
    EXPECT_EQ(Rows(), SavedRows());
    EXPECT_EQ(Text(CGeoEditorForm::kStatus), "8 élément(s), 0 choisi(s)");

    Act(pyr::ui::kIdCancel);
    EXPECT_EQ(form->Ended(), DialogResult::Ok);
}

// No to adding: a new GéoBase named after the field book chosen in the reading dialog, opened beside the
// first one, which stays as it was.
TEST_F(EditorForm, ANewGeoBaseIsNamedAfterTheFieldBookAndOpenedBesideTheFirst) {
    Act(CGeoEditorForm::kFormat, {EventKind::Select, 10, false, {}});
    frontEnd.dialogArguments = {dir / "carnet.qdl"};
    frontEnd.answers = {Answer::No};
    Act(CGeoEditorForm::kRead);
    const pyr::ui::ControlState documents = form->State(CGeoEditorForm::kDocuments);
    EXPECT_EQ(documents.items, (std::vector<std::string>{"job.geo", "carnet.geo"}));
    EXPECT_EQ(documents.current, 1);
    EXPECT_EQ(form->OnDemandRows(CGeoEditorForm::TableOf(0)), 2);
    EXPECT_EQ(ReadBytes(dir / "job.geo"), kJob);
    Act(CGeoEditorForm::kDocuments, {EventKind::Select, 0, false, {}});
    EXPECT_EQ(form->OnDemandRows(CGeoEditorForm::TableOf(0)), 6);

    // No GéoBase chosen: the window does not open.
    frontEnd.files = {std::nullopt};
    pyr::CGeoEditor other;
    other.SetInputs({dir / "job.geo", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
    const auto none = other.MakeForm();
    EXPECT_FALSE(none->Open(frontEnd));
    EXPECT_EQ(none->Ended(), DialogResult::Cancel);
}

// The views by kind list their elements with their own columns; a line chosen in one is the element
// selected everywhere: in the others, in the drawing, on the property page.
TEST_F(EditorForm, TheViewsTheDrawingAndThePropertyPageShareOneSelection) {
    constexpr int kPoints = 2;
    EXPECT_EQ(Rows(kPoints),
              (std::vector<std::string>{"000005\tA1\t651050.1180\t6862512.4470\t55.021\tOui\tNon\t",
                                        "000006\t102\t650900.5000\t6862400.2500\t\tNon\tNon\t"}));
    EXPECT_EQ(Rows(1).front(), "000002\tStation\tINCONNUE\t1.562\t\t\t\t");
    EXPECT_EQ(Rows(6), std::vector<std::string>{"000001\tLevé du 2 mars"});

    Act(CGeoEditorForm::kView, {EventKind::Select, kPoints, false, {}});
    EXPECT_TRUE(form->State(CGeoEditorForm::TableOf(kPoints)).visible);
    EXPECT_FALSE(form->State(CGeoEditorForm::TableOf(0)).visible);
    Act(CGeoEditorForm::TableOf(kPoints), Select({1}));
    EXPECT_EQ(editor.Document().Selection(), std::vector<int>{5});
    EXPECT_EQ(form->State(CGeoEditorForm::kDrawing).selection, std::vector<int>{5});
    EXPECT_EQ(Text(CGeoEditorForm::kElementGroup), "Élément n° 6 : Point");
    EXPECT_EQ(Text(CGeoEditorForm::kFieldLabel0 + 1), "X (m) :");
    EXPECT_EQ(Text(CGeoEditorForm::kFieldEdit0 + 1), "650900.5000");
    EXPECT_TRUE(form->State(CGeoEditorForm::kFieldEdit0 + 7).visible);  // its parameters
    EXPECT_FALSE(form->State(CGeoEditorForm::kFieldEdit0 + 8).visible); // a point has 8 fields

    // Picked in the drawing: the point A1, current in the view of the points.
    const pyr::GeoScene* scene = form->Scene(CGeoEditorForm::kDrawing);
    ASSERT_NE(scene, nullptr);
    EXPECT_EQ(scene->Points().size(), 2u);
    Act(CGeoEditorForm::kDrawing, Select({4}));
    EXPECT_EQ(form->State(CGeoEditorForm::TableOf(kPoints)).current, 0);
    Act(CGeoEditorForm::kView, {EventKind::Select, 0, false, {}});
    EXPECT_EQ(form->State(CGeoEditorForm::TableOf(0)).selection, std::vector<int>{4});
    Act(CGeoEditorForm::TableOf(0), Select({2, 3, 4}));
    EXPECT_EQ(Text(CGeoEditorForm::kStatus), "6 élément(s), 3 choisi(s)");
    EXPECT_EQ(form->State(CGeoEditorForm::TableOf(1)).selection, std::vector<int>{}); // not shown
}

// Every edit of the window, then every one undone: the GéoBase saved is the file it was, byte for byte;
// redone, it is what the edits made.
TEST_F(EditorForm, EveryEditIsUndoneAndRedoneToTheSameBytes) {
    // A point moved on its page, a comment inserted and typed, a line moved, one disabled, one removed.
    Act(CGeoEditorForm::TableOf(0), Select({5}));
    Act(CGeoEditorForm::kFieldEdit0 + 1, Typed("650 901,25"));
    Act(CGeoEditorForm::kInsert);
    EXPECT_EQ(editor.Document().Selection(), std::vector<int>{5});
    Act(CGeoEditorForm::kFieldEdit0, Typed("point refait"));
    Act(CGeoEditorForm::kMoveUp);
    Act(CGeoEditorForm::TableOf(0), Select({2}));
    Act(CGeoEditorForm::kToggle);
    EXPECT_EQ(form->State(CGeoEditorForm::kToggle).text, "Ré&activer");
    Act(CGeoEditorForm::TableOf(0), Select({0}));
    Act(CGeoEditorForm::kRemove);
    // The station renamed, and the points renumbered.
    Act(CGeoEditorForm::kRenameFrom, Typed("INCONNUE"));
    Act(CGeoEditorForm::kRenameTo, Typed("S9"));
    Act(CGeoEditorForm::kRename);
    Act(CGeoEditorForm::kRenumberPoints, Typed("100-200"));
    Act(CGeoEditorForm::kRenumberOffset, Typed("1000"));
    Act(CGeoEditorForm::kRenumber);
    EXPECT_TRUE(frontEnd.messages.empty()) << frontEnd.messages.front().text;
    EXPECT_EQ(Rows(), (std::vector<std::string>{
                          "000001\tStation\tS9  1.562  -999999",
                          "000002\tCommentaire\t1003\\tA1\\t1.3\\t323.76206\\t99.40145\\t260.0083",
                          "000003\tMesure\t1102  1.8  388.64623  99.18242  111.5994",
                          "000004\tCommentaire\tpoint refait",
                          "000005\tPoint\tA1  651050.118  6862512.447  55.021  XY",
                          "000006\tPoint\t1102  650901.25  6862400.25  -999999  -",
                      }));
    EXPECT_TRUE(form->State(CGeoEditorForm::kSave).enabled);
    ASSERT_TRUE(editor.Save(frontEnd));
    const std::string edited = ReadBytes(dir / "job.geo");
    EXPECT_FALSE(form->State(CGeoEditorForm::kSave).enabled);

    int undone = 0;
    while (form->State(CGeoEditorForm::kUndo).enabled) {
        Act(CGeoEditorForm::kUndo);
        ++undone;
    }
    EXPECT_EQ(undone, 8);
    EXPECT_EQ(Text(CGeoEditorForm::kStatus), "Annulé : Modification du champ X de l'élément # 6.");
    ASSERT_TRUE(editor.Save(frontEnd));
    EXPECT_EQ(ReadBytes(dir / "job.geo"), kJob);
    while (form->State(CGeoEditorForm::kRedo).enabled)
        Act(CGeoEditorForm::kRedo);
    ASSERT_TRUE(editor.Save(frontEnd));
    EXPECT_EQ(ReadBytes(dir / "job.geo"), edited);
}

// The drawing of a million elements is made again only when what it shows changed: not for a sighting's
// distance or a comment, but for a point moved, an element removed, and their undoing.
TEST_F(EditorForm, TheDrawingIsMadeAgainOnlyWhenWhatItShowsChanged) {
    const auto revision = [this] { return form->State(CGeoEditorForm::kDrawing).revision; };
    const pyr::GeoScene* scene = form->Scene(CGeoEditorForm::kDrawing);
    ASSERT_NE(scene, nullptr);
    long seen = revision();

    Act(CGeoEditorForm::TableOf(0), Select({2})); // the sighting of A1
    Act(CGeoEditorForm::kFieldEdit0 + 4, Typed("260.5"));
    Act(CGeoEditorForm::TableOf(0), Select({0})); // the comment
    Act(CGeoEditorForm::kFieldEdit0, Typed("Levé du 3 mars"));
    Act(CGeoEditorForm::kUndo);
    EXPECT_EQ(revision(), seen);

    Act(CGeoEditorForm::TableOf(0), Select({4})); // the point A1 moved
    Act(CGeoEditorForm::kFieldEdit0 + 1, Typed("651060"));
    EXPECT_NE(revision(), seen);
    seen = revision();
    EXPECT_EQ(form->Scene(CGeoEditorForm::kDrawing)->Points()[0].x, 651060.0);
    Act(CGeoEditorForm::kUndo);
    EXPECT_NE(revision(), seen);
    seen = revision();
    EXPECT_EQ(form->Scene(CGeoEditorForm::kDrawing)->Points()[0].x, 651050.118);
    Act(CGeoEditorForm::kUndo); // the sighting's distance: not drawn
    EXPECT_EQ(revision(), seen);
    Act(CGeoEditorForm::TableOf(0), Select({0}));
    Act(CGeoEditorForm::kRemove); // every element after it changes its number
    EXPECT_NE(revision(), seen);
    EXPECT_EQ(form->Scene(CGeoEditorForm::kDrawing)->Points()[0].element, 3);
}

// A value the GéoBase cannot hold is refused with the reason its validation gives, and nothing changes.
TEST_F(EditorForm, AnInvalidFieldIsRefusedWithItsMessageAndChangesNothing) {
    Act(CGeoEditorForm::TableOf(0), Select({2}));
    Act(CGeoEditorForm::kFieldEdit0 + 4, Typed("-5")); // a negative distance
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_FALSE(frontEnd.messages[0].text.empty());
    Act(CGeoEditorForm::kFieldEdit0 + 1, Typed("1,3 m"));
    ASSERT_EQ(frontEnd.messages.size(), 2u);
    EXPECT_FALSE(editor.Document().CanUndo());
    EXPECT_FALSE(editor.Document().Modified());
    EXPECT_EQ(Rows(), SavedRows());

    // Renumbering what is not there, an offset that is no number, and renaming a station that does not
    // exist: refused, said, nothing changed.
    Act(CGeoEditorForm::kRenumberPoints, Typed("Z1-Z9"));
    Act(CGeoEditorForm::kRenumberOffset, Typed("5"));
    Act(CGeoEditorForm::kRenumber);
    ASSERT_EQ(frontEnd.messages.size(), 3u);
    EXPECT_EQ(frontEnd.messages[2].text, "Aucun point à renuméroter.");
    Act(CGeoEditorForm::kRenumberOffset, Typed("5,5"));
    Act(CGeoEditorForm::kRenumber);
    ASSERT_EQ(frontEnd.messages.size(), 4u);
    EXPECT_EQ(frontEnd.messages[3].text, "Le décalage « 5,5 » n'est pas un nombre entier.");
    Act(CGeoEditorForm::kRenameFrom, Typed("S7"));
    Act(CGeoEditorForm::kRenameTo, Typed("S8"));
    Act(CGeoEditorForm::kRename);
    ASSERT_EQ(frontEnd.messages.size(), 5u);
    EXPECT_EQ(frontEnd.messages[4].text, "La station <S7> n'existe pas dans la GéoBase.");
    EXPECT_FALSE(editor.Document().CanUndo());
}

TEST_F(EditorForm, TheSearchSelectsWhatItFindsOrTheNextOne) {
    Act(CGeoEditorForm::kSearchIds, Typed("A1"));
    Act(CGeoEditorForm::kSearchAll);
    EXPECT_EQ(editor.Document().Selection(), (std::vector<int>{2, 4}));
    EXPECT_EQ(Text(CGeoEditorForm::kStatus), "2 élément(s) trouvé(s).");
    Act(CGeoEditorForm::kSearchKind, {EventKind::Select, 7, false, {}}); // Point
    Act(CGeoEditorForm::kSearchIds, Typed(""));
    Act(CGeoEditorForm::kSearchValue, Typed("z > 50"));
    Act(CGeoEditorForm::kSearchAll);
    EXPECT_EQ(editor.Document().Selection(), std::vector<int>{4});
    Act(CGeoEditorForm::kSearchValue, Typed(""));
    Act(CGeoEditorForm::kSearchNext);
    EXPECT_EQ(editor.Document().Selection(), std::vector<int>{5});
    Act(CGeoEditorForm::kSearchNext); // round past the end
    EXPECT_EQ(editor.Document().Selection(), std::vector<int>{4});
    Act(CGeoEditorForm::kSearchIds, Typed("P9-P1"));
    Act(CGeoEditorForm::kSearchAll);
    ASSERT_EQ(frontEnd.messages.size(), 1u); // the selection is not correct
    EXPECT_EQ(editor.Document().Selection(), std::vector<int>{4});
}

// Closing asks about a modified GéoBase: Cancel keeps the window open, No closes it unsaved.
TEST_F(EditorForm, ClosingAModifiedGeoBaseAsks) {
    Act(CGeoEditorForm::TableOf(0), Select({0}));
    Act(CGeoEditorForm::kRemove);
    EXPECT_EQ(form->State(CGeoEditorForm::kDocuments).items, std::vector<std::string>{"job.geo *"});
    frontEnd.answers = {Answer::Cancel};
    Act(pyr::ui::kIdCancel);
    EXPECT_FALSE(form->Ended());
    ASSERT_EQ(frontEnd.questions.size(), 1u);
    EXPECT_EQ(frontEnd.questions[0], "La GéoBase courante a été modifiée !\nVoulez vous l'enregistrer ?");
    frontEnd.answers = {Answer::No};
    Act(pyr::ui::kIdCancel);
    EXPECT_EQ(form->Ended(), DialogResult::Ok);
    EXPECT_EQ(ReadBytes(dir / "job.geo"), kJob);
}
