// The editor's reduction of the stations: the GéoBase is saved, with its backup, only when the reduction
// changed it, and shown as it then stands.
#include "TestSupport.h"
#include "editor/GeoEditor.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <algorithm>
#include <filesystem>
#include <gtest/gtest.h>

namespace {

using pyr::ui::DialogResult;

// S1 occupied twice, the second time with its circle turned back by 5 gr; P sighted twice the first
// time.
constexpr const char* kTwoSetUps = "GEOBASE PYRALIS\t1\n"
                                   "1001\tS1\t1.6\t-999999\n"
                                   "1002\tA\t1.3\t2\t100\t50\n"
                                   "1003\tP\t1.3\t200\t100\t30\n"
                                   "1003\tP\t1.3\t200.0004\t100\t30\n"
                                   "1001\tS1\t1.6\t-999999\n"
                                   "1002\tA\t1.3\t397\t100\t50\n";

constexpr const char* kOneStation = "GEOBASE PYRALIS\t1\n"
                                    "1001\tS1\t1.6\t-999999\n"
                                    "1002\tA\t1.3\t2\t100\t50\n";

class EditorReduction : public ::testing::Test {
protected:
    DialogResult Run(const char* geo, std::vector<std::string> arguments) {
        WriteBytes(dir / "a.geo", geo);
        frontEnd.dialogArguments = std::move(arguments);
        frontEnd.dialogArguments.insert(frontEnd.dialogArguments.begin(), {"--geobase", dir / "a.geo"});
        editor.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        return frontEnd.DoModal(editor);
    }
    bool Has(const std::string& line) const {
        return std::find(frontEnd.lines.begin(), frontEnd.lines.end(), line) != frontEnd.lines.end();
    }

    TempDir dir;
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CGeoEditor editor;
};

TEST_F(EditorReduction, AChangedGeoBaseIsBackedUpSavedAndShownAsItNowStands) {
    ASSERT_EQ(Run(kTwoSetUps, {"--reduction", "--DoMeans", "1", "--Suppress", "1"}), DialogResult::Ok);
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text,
              "ATTENTION : Vérifier que la codification n'est pas altérée par cette commande !");
    EXPECT_EQ(ReadBytes(dir / "a.bak"), kTwoSetUps);
    EXPECT_TRUE(Has("GéoBase enregistrée dans <" + dir / "a.geo" + ">."));

    // One station left: A from both set-ups and P averaged.
    pyr::CCarnet saved;
    ASSERT_TRUE(saved.Load(nullptr, dir / "a.geo"));
    ASSERT_EQ(saved.GetSize(), 3);
    EXPECT_EQ(saved.CountStations(), 1);
    EXPECT_EQ(saved.matAt(1), "A");
    EXPECT_NEAR(saved.ahAt(1), 2.0, 1e-4);
    EXPECT_NEAR(saved.ahAt(2), 200.0002, 1e-4);
    EXPECT_TRUE(Has("GéoBase <" + dir / "a.geo" + "> : 3 élément(s)."));
    EXPECT_NE(ReadBytes(dir / "Pyralis.ini").find("DoMeans=1"), std::string::npos);
}

TEST_F(EditorReduction, AGeoBaseLeftAsItWasIsNotWritten) {
    ASSERT_EQ(Run(kOneStation, {"--reduction"}), DialogResult::Ok);
    EXPECT_TRUE(Has("Aucune modification apportée à la GéoBase !"));
    EXPECT_FALSE(std::filesystem::exists(dir / "a.bak"));
    EXPECT_EQ(ReadBytes(dir / "a.geo"), kOneStation);
    EXPECT_TRUE(Has("GéoBase <" + dir / "a.geo" + "> : 2 élément(s)."));
}

TEST_F(EditorReduction, WithoutTheReductionNothingIsReducedAndABadSwitchIsRefused) {
    ASSERT_EQ(Run(kTwoSetUps, {"--DoMeans", "1"}), DialogResult::Ok);
    EXPECT_TRUE(frontEnd.messages.empty());
    EXPECT_EQ(ReadBytes(dir / "a.geo"), kTwoSetUps);

    EXPECT_EQ(Run(kTwoSetUps, {"--reduction", "--DoMeans", "oui"}), DialogResult::Failed);
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text, "--DoMeans : 0 ou 1 attendu, et non « oui ».");
}

} // namespace
