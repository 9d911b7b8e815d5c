// "GeoEdit G.geo --changement-repere ..." as pyralis runs it: the editor's command line parsed by the
// common mechanism, the change made on the GéoBase opened, and the file left on disk. The job's frame 2 is
// frame 1 turned by exactly 100 gr about the origin (its north becoming the west), so that every expected
// coordinate is worked out by hand: (X, Y) goes to (-Y, X).
#include "TestSupport.h"
#include "calc/ChangeRepTexts.h"
#include "editor/GeoEditor.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

namespace {

using pyr::ui::DialogResult;

constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1001\tS1\t1.5\t50\n"
                             "1002\tP1\t1.3\t12.5\t100\t22.36\n"
                             "1006\tP1\t10\t20\t-999999\t-\n"
                             "1006\tP2\t-35.5\t4.25\t101.5\t-\n";

class ChangeRepCommand : public ::testing::Test {
protected:
    void SetUp() override { WriteBytes(dir / "a.geo", kJob); }
    DialogResult Run(std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), dir / "a.geo");
        frontEnd.dialogArguments = std::move(arguments);
        editor.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        return frontEnd.DoModal(editor);
    }
    pyr::CCarnet Saved() const {
        pyr::CCarnet carnet;
        carnet.Load(nullptr, dir / "a.geo");
        return carnet;
    }
    std::string LastMessage() const { return frontEnd.messages.empty() ? "" : frontEnd.messages.back().text; }

    TempDir dir;
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CGeoEditor editor;
};

const std::vector<std::string> kQuarterTurn = {"--changement-repere", "--repere1", "0,0,0,100", "--repere2",
                                               "0,0,-100,0"};

TEST_F(ChangeRepCommand, PointsAndV0AreChangedSavedWithABackupAndTrackedForUndo) {
    std::vector<std::string> arguments = kQuarterTurn;
    arguments.insert(arguments.end(), {"--modif-v0", "1"});
    ASSERT_EQ(Run(arguments), DialogResult::Ok) << LastMessage();
    EXPECT_EQ(LastMessage(), "2 Points ont été calculés\n1 Orientations de station modifiées");
    const pyr::CCarnet saved = Saved();
    EXPECT_NEAR(saved.xAt(2), -20.0, 1e-4);
    EXPECT_NEAR(saved.yAt(2), 10.0, 1e-4);
    EXPECT_NEAR(saved.xAt(3), -4.25, 1e-4);
    EXPECT_NEAR(saved.yAt(3), -35.5, 1e-4);
    EXPECT_EQ(saved.zAt(3), 101.5);
    EXPECT_NEAR(saved.v0At(0), 350.0, 1e-4);
    EXPECT_EQ(saved.ahAt(1), 12.5); // sightings are left as measured
    EXPECT_EQ(ReadBytes(dir / "a.bak"), kJob);
    EXPECT_NE(frontEnd.AllLines().find("GéoBase enregistrée dans <" + dir / "a.geo" + ">."),
              std::string::npos);
    // One edit of the editor's history: undone, the GéoBase is as it was, byte for byte once saved.
    ASSERT_TRUE(editor.Document().CanUndo());
    EXPECT_EQ(editor.Document().UndoLabel(), pyr::rep::kCaption);
    ASSERT_TRUE(editor.Document().Undo());
    EXPECT_TRUE(editor.Document().Modified());
    ASSERT_TRUE(editor.Save(frontEnd));
    EXPECT_EQ(ReadBytes(dir / "a.geo"), kJob);
}

TEST_F(ChangeRepCommand, ARefusedRequestFailsAndLeavesTheFileAsItWas) {
    const struct {
        std::vector<std::string> arguments;
        std::string message;
    } cases[] = {
        {{"--changement-repere", "--repere1", "0,0,0,100", "--repere2", "0,0,-100,0", "--selection", "P9-P1"},
         pyr::msg::kNoSelection},
        {{"--changement-repere", "--repere1", "0,0,0,100", "--repere2", "0,0,-100"},
         "--repere2 : « 0,0,-100 » n'est pas de la forme XA,YA,XB,YB (quatre nombres)."},
    };
    for (const auto& [arguments, message] : cases) {
        SCOPED_TRACE(arguments.back());
        pyr::CGeoEditor fresh;
        frontEnd.dialogArguments = arguments;
        frontEnd.dialogArguments.insert(frontEnd.dialogArguments.begin(), dir / "a.geo");
        fresh.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        EXPECT_EQ(frontEnd.DoModal(fresh), DialogResult::Failed);
        EXPECT_NE(LastMessage().find(message), std::string::npos) << LastMessage();
        EXPECT_EQ(ReadBytes(dir / "a.geo"), kJob);
    }
    pyr::CGeoEditor fresh; // no frame 2 at all
    frontEnd.dialogArguments = {dir / "a.geo", "--changement-repere", "--repere1", "0,0,0,100"};
    fresh.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
    EXPECT_EQ(frontEnd.DoModal(fresh), DialogResult::Failed);
    EXPECT_EQ(LastMessage(), pyr::rep::kFramesIncomplete);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), kJob);
}

TEST_F(ChangeRepCommand, ASelectionChangesOnlyItsPointsAndNothingSelectedIsNotSaved) {
    std::vector<std::string> arguments = kQuarterTurn;
    arguments.insert(arguments.end(), {"--selection", "P2"});
    ASSERT_EQ(Run(arguments), DialogResult::Ok);
    const pyr::CCarnet saved = Saved();
    EXPECT_EQ(saved.xAt(2), 10.0);
    EXPECT_NEAR(saved.xAt(3), -4.25, 1e-4);
    EXPECT_TRUE(editor.Document().CanUndo());

    const std::string before = ReadBytes(dir / "a.geo");
    arguments.back() = "Z1-Z9";
    ASSERT_EQ(Run(arguments), DialogResult::Ok);
    EXPECT_EQ(LastMessage(), pyr::msg::kNoChange);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), before);
    // The GéoBase opened again: the change made on the former copy is no longer the undo's to take back.
    EXPECT_FALSE(editor.Document().CanUndo());
}

// The change saves only once the former GéoBase is backed up: a backup that fails stops it.
TEST_F(ChangeRepCommand, TheChangeIsNotSavedWhenTheBackUpFails) {
    WriteBytes(dir / "a.bak", "copie protégée\n");
    ASSERT_EQ(chmod((dir / "a.bak").c_str(), 0444), 0); // refused to root as well
    EXPECT_EQ(Run(kQuarterTurn), DialogResult::Failed);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), kJob);
    EXPECT_EQ(LastMessage().find("Impossible de faire la copie de sauvegarde de la GéoBase"), 0u);
}

TEST(ChangeRepCommandAsUser, AReadOnlyGeoBaseIsNotChangedOnDisk) {
    SKIP_WHEN_ROOT();
    TempDir dir;
    WriteBytes(dir / "a.geo", kJob);
    ASSERT_EQ(chmod((dir / "a.geo").c_str(), 0444), 0);
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CGeoEditor editor;
    frontEnd.dialogArguments = {dir / "a.geo"};
    frontEnd.dialogArguments.insert(frontEnd.dialogArguments.end(), kQuarterTurn.begin(), kQuarterTurn.end());
    editor.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
    EXPECT_EQ(frontEnd.DoModal(editor), DialogResult::Failed);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), kJob);
    ASSERT_FALSE(frontEnd.messages.empty());
    EXPECT_NE(frontEnd.messages.back().text.find("lecture seule"), std::string::npos);
}

} // namespace
