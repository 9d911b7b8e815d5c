// The editor's first face: the elements of a GéoBase one a line.
#include "TestSupport.h"
#include "editor/GeoEditor.h"
#include "geobase/Carnet.h"
#include "settings/LastGeoBase.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

namespace {

using pyr::ui::DialogResult;

constexpr const char* kGeo = "GEOBASE PYRALIS\t1\n"
                             "1000\tLevé du 3 mars\n"
                             "1002\tA1\t1.3\t323.76206\t99.40145\t260.0083\n"
                             "1006\tA1\t651050.118\t6862512.447\t-999999\tXY\tBORNE\n";

class Editor : public ::testing::Test {
protected:
    DialogResult Open(std::string offered) {
        editor.SetInputs({std::move(offered), dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        return editor.Run(frontEnd);
    }
    TempDir dir;
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CGeoEditor editor;
};

TEST_F(Editor, TheGeoBaseOfferedIsShownAndRecordedAsTheLastOne) {
    WriteBytes(dir / "a.geo", kGeo);
    EXPECT_EQ(Open(dir / "a.geo"), DialogResult::Ok);
    ASSERT_EQ(frontEnd.fileChoices.size(), 1u);
    EXPECT_EQ(frontEnd.fileChoices[0].startPath, dir / "a.geo");
    ASSERT_EQ(frontEnd.lines.size(), 4u);
    EXPECT_EQ(frontEnd.lines[0], "GéoBase <" + dir / "a.geo" + "> : 3 élément(s).");
    // The label column is counted in characters: "Référence" is as wide as "Reference".
    EXPECT_EQ(frontEnd.lines[2], "000002  Référence     A1  1.3  323.76206  99.40145  260.0083");
    EXPECT_EQ(pyr::ReadLastGeoBase(dir / "Pyralis.ini"), dir / "a.geo");
}

// A field book opened by mistake is shown, line by line, but is no GéoBase for the next command to open.
TEST_F(Editor, AFileThatIsNoGeoBaseIsShownButNotRecordedAsTheLastOne) {
    pyr::WriteLastGeoBase(dir / "Pyralis.ini", dir / "a.geo");
    WriteBytes(dir / "carnet.gsi", "110001+0000000S1 81..00+00000000\n110002+000000A1 21.324+12345678\n");
    EXPECT_EQ(Open(dir / "carnet.gsi"), DialogResult::Ok);
    EXPECT_EQ(frontEnd.lines.back(), "000002  Commentaire   110002+000000A1 21.324+12345678");
    EXPECT_EQ(pyr::ReadLastGeoBase(dir / "Pyralis.ini"), dir / "a.geo");
}

TEST_F(Editor, ANamedGeoBaseIsOpenedWithoutAskingAndAMissingOneIsRefused) {
    editor.SetGeoBase(dir / "absente.geo");
    EXPECT_EQ(editor.Run(frontEnd), DialogResult::Failed);
    EXPECT_TRUE(frontEnd.fileChoices.empty());
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_NE(frontEnd.messages[0].text.find("Impossible d'ouvrir la GéoBase"), std::string::npos);
    EXPECT_EQ(pyr::ReadLastGeoBase(dir / "Pyralis.ini"), "");
}

TEST_F(Editor, NoGeoBaseChosenEndsWithoutChange) {
    EXPECT_EQ(Open(""), DialogResult::Cancel);
    EXPECT_TRUE(frontEnd.lines.empty());
}

// The reduction saves only once the former GéoBase is backed up: a backup that fails stops it.
TEST_F(Editor, TheReductionIsNotSavedWhenTheBackUpFails) {
    const std::string twoSetUps = "GEOBASE PYRALIS\t1\n"
                                  "1001\tS1\t1.75\t-999999\n"
                                  "1002\tA\t1.25\t2\t100\t50\n"
                                  "1001\tS1\t1.5\t-999999\n"
                                  "1002\tA\t1.25\t397\t100\t50\n";
    WriteBytes(dir / "a.geo", twoSetUps);
    WriteBytes(dir / "a.bak", "copie protégée\n");
    ASSERT_EQ(chmod((dir / "a.bak").c_str(), 0444), 0); // refused to root as well
    frontEnd.dialogArguments = {dir / "a.geo", "--reduction", "--Suppress", "1"};
    editor.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
    EXPECT_EQ(frontEnd.DoModal(editor), DialogResult::Failed);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), twoSetUps);
    EXPECT_EQ(ReadBytes(dir / "a.bak"), "copie protégée\n");
    ASSERT_FALSE(frontEnd.messages.empty());
    EXPECT_EQ(
        frontEnd.messages.back().text.find("Impossible de faire la copie de sauvegarde de la GéoBase\n" +
                                           dir / "a.geo" + "\ndans\n" + dir / "a.bak" + "\n(accès refusé)."),
        0u)
        << frontEnd.messages.back().text;
}

} // namespace
