// The editor as a window: the GéoBase's elements listed, and its actions run through the front end.
#include "TestSupport.h"
#include "editor/GeoEditorForm.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>

namespace {

using pyr::CGeoEditorForm;
using pyr::ui::Answer;
using pyr::ui::DialogResult;
using pyr::ui::EventKind;

constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1000\tLevé du 2 mars\n"
                             "1001\tS1\t1.562\t-999999\n"
                             "1003\tA1\t1.3\t323.76206\t99.40145\t260.0083\n";
constexpr const char* kBook = "QUENDAL-PC;1\nSTATION;S2;1.5\nMESURE;102;1.8;388.64623;99.18242;111.5994\n";

class EditorForm : public ::testing::Test {
protected:
    EditorForm() {
        WriteBytes(dir / "job.geo", kJob);
        WriteBytes(dir / "carnet.qdl", kBook);
        editor.SetInputs({dir / "job.geo", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
    }
    std::vector<std::string> Lines() const {
        pyr::CCarnet carnet;
        EXPECT_TRUE(carnet.Load(nullptr, dir / "job.geo"));
        std::vector<std::string> lines;
        for (int i = 0; i < carnet.GetSize(); ++i)
            lines.push_back(pyr::EditorRow(carnet, i));
        return lines;
    }

    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CGeoEditor editor;
};

} // namespace

TEST_F(EditorForm, ListsTheElementsAndReadsAFieldBookIntoThem) {
    const auto form = editor.MakeForm();
    ASSERT_TRUE(form->Open(frontEnd)); // the GéoBase offered, confirmed
    EXPECT_EQ(form->State(CGeoEditorForm::kGeoBase).text, dir / "job.geo");
    EXPECT_EQ(form->State(CGeoEditorForm::kElements).items, Lines());

    // The reduction's dialog and the reading's are run by the front end.
    form->Act(frontEnd, CGeoEditorForm::kReduce, {});
    const auto formats = form->State(CGeoEditorForm::kFormat).items;
    ASSERT_EQ(formats.back(), "Carnet Quendal-Pc");
    form->Act(frontEnd, CGeoEditorForm::kFormat,
              {EventKind::Select, static_cast<int>(formats.size()) - 1, false, {}});
    frontEnd.dialogArguments = {dir / "carnet.qdl"};
    frontEnd.answers = {Answer::Yes}; // added to the GéoBase open
    form->Act(frontEnd, CGeoEditorForm::kRead, {});
    EXPECT_EQ(frontEnd.dialogs.size(), 2u);
    EXPECT_EQ(frontEnd.dialogs.back(), "Lecture du carnet Quendal-Pc");
    const auto lines = Lines();
    ASSERT_EQ(lines.size(), 5u);
    EXPECT_EQ(form->State(CGeoEditorForm::kElements).items, lines);
    EXPECT_EQ(form->State(CGeoEditorForm::kStatus).text, "5 élément(s)");

    form->Act(frontEnd, pyr::ui::kIdCancel, {});
    EXPECT_EQ(form->Ended(), DialogResult::Ok);
}

// No to adding: a new GéoBase named after the field book chosen in the reading dialog, which the window
// then shows.
TEST_F(EditorForm, ANewGeoBaseIsNamedAfterTheFieldBookChosen) {
    const auto form = editor.MakeForm();
    ASSERT_TRUE(form->Open(frontEnd));
    form->Act(frontEnd, CGeoEditorForm::kFormat, {EventKind::Select, 10, false, {}});
    frontEnd.dialogArguments = {dir / "carnet.qdl"};
    frontEnd.answers = {Answer::No};
    form->Act(frontEnd, CGeoEditorForm::kRead, {});
    EXPECT_EQ(form->State(CGeoEditorForm::kGeoBase).text, dir / "carnet.geo");
    EXPECT_EQ(form->State(CGeoEditorForm::kElements).items.size(), 2u);
    EXPECT_EQ(ReadBytes(dir / "job.geo"), kJob);

    // No GéoBase chosen: the window does not open.
    frontEnd.files = {std::nullopt};
    const auto none = editor.MakeForm();
    EXPECT_FALSE(none->Open(frontEnd));
    EXPECT_EQ(none->Ended(), DialogResult::Cancel);
}
