// The editor's edits from a command line: each one saves the GéoBase when it changed it, and a refused
// one changes nothing and says why.
#include "TestSupport.h"
#include "editor/GeoEditor.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace {

using pyr::ui::DialogResult;

// What a reader makes of sightings met before any station: a station "INCONNUE" that the surveyor
// names afterwards, here the point 12 sighted from S2 and listed in a traverse.
constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1001\tINCONNUE\t1.55\t-999999\n"
                             "1003\t101\t1.3\t10\t100\t25\n"
                             "1003\t102\t1.3\t110\t100\t30\n"
                             "1001\tS2\t1.6\t-999999\n"
                             "1002\t12\t1.3\t210\t100\t40\n"
                             "1003\t101\t1.3\t220\t100\t42\n"
                             "1006\t101\t1000\t2000\t-999999\t-\n"
                             "1006\t102\t1010\t2030\t-999999\t-\n"
                             "1007\tCH1\t0\t2\tS2\tINCONNUE\n";

class EditBatch : public ::testing::Test {
protected:
    EditBatch() { WriteBytes(dir / "a.geo", kJob); }
    DialogResult Run(std::vector<std::string> arguments) {
        pyr::CGeoEditor editor;
        editor.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
        frontEnd.dialogArguments = std::move(arguments);
        frontEnd.dialogArguments.insert(frontEnd.dialogArguments.begin(), dir / "a.geo");
        frontEnd.lines.clear();
        return frontEnd.DoModal(editor);
    }
    std::string Saved() const { return ReadBytes(dir / "a.geo"); }

    TempDir dir;
    pyr::ui::ScriptedFrontEnd frontEnd;
};

} // namespace

TEST_F(EditBatch, RenamingTheUnknownStationFollowsItsSightingsAndTraverses) {
    ASSERT_EQ(Run({"--renommer", "INCONNUE=12"}), DialogResult::Ok);
    EXPECT_EQ(Saved(), "GEOBASE PYRALIS\t1\n"
                       "1001\t12\t1.55\t-999999\n"
                       "1003\t101\t1.3\t10\t100\t25\n"
                       "1003\t102\t1.3\t110\t100\t30\n"
                       "1001\tS2\t1.6\t-999999\n"
                       "1002\t12\t1.3\t210\t100\t40\n"
                       "1003\t101\t1.3\t220\t100\t42\n"
                       "1006\t101\t1000\t2000\t-999999\t-\n"
                       "1006\t102\t1010\t2030\t-999999\t-\n"
                       "1007\tCH1\t0\t2\tS2\t12\n");
    EXPECT_EQ(ReadBytes(dir / "a.bak"), kJob);
    // The station and the traverse: the sighting of 12 from S2 bore the name already.
    EXPECT_NE(frontEnd.AllLines().find("Station <INCONNUE> renommée <12> : 2 élément(s) modifié(s)."),
              std::string::npos)
        << frontEnd.AllLines();
}

TEST_F(EditBatch, RenumberingAndRemovingPointsSaveOnce) {
    ASSERT_EQ(Run({"--renumeroter", "--selection", "101-102", "--decalage", "100", "--prefixe", "P"}),
              DialogResult::Ok);
    std::string expected = kJob;
    for (const auto& [from, to] : {std::pair{"\t101\t", "\tP201\t"}, {"\t102\t", "\tP202\t"}})
        for (std::size_t at = expected.find(from); at != std::string::npos; at = expected.find(from, at))
            expected.replace(at, std::string(from).size(), to);
    EXPECT_EQ(Saved(), expected);

    // The point P201 removed: its sightings stay.
    ASSERT_EQ(Run({"--supprimer", "P201"}), DialogResult::Ok);
    pyr::CCarnet saved;
    ASSERT_TRUE(saved.Load(nullptr, dir / "a.geo"));
    EXPECT_EQ(saved.GetSize(), 8);
    EXPECT_EQ(saved.findMat("P201"), -1);
    EXPECT_EQ(saved.Find(pyr::kKindMesure, "P201"), 1);
}

TEST_F(EditBatch, ARefusedEditChangesNothingAndSaysWhy) {
    const struct {
        std::vector<std::string> arguments;
        std::string message;
    } cases[] = {
        {{"--renommer", "S7=S8"}, "La station <S7> n'existe pas dans la GéoBase."},
        {{"--renommer", "INCONNUE=S2"},
         "La station <S2> existe déjà : le changement de nom de la station est refusé."},
        {{"--renumeroter", "--selection", "101", "--decalage", "1"},
         "Le point <102> existe déjà : la renumérotation est refusée."},
        {{"--supprimer", "P9-P1"}, "La liste de sélection des points n'est pas correcte !"},
    };
    for (const auto& [arguments, message] : cases) {
        SCOPED_TRACE(arguments.front() + " " + arguments[1]);
        frontEnd.messages.clear();
        EXPECT_EQ(Run(arguments), DialogResult::Failed);
        ASSERT_FALSE(frontEnd.messages.empty());
        EXPECT_EQ(frontEnd.messages.front().text.find(message), 0u) << frontEnd.messages.front().text;
        EXPECT_EQ(Saved(), kJob);
    }
    // An option that cannot be read: the command does not run.
    frontEnd.messages.clear();
    EXPECT_EQ(Run({"--renommer", "INCONNUE"}), DialogResult::Failed);
    ASSERT_FALSE(frontEnd.messages.empty());
    EXPECT_NE(frontEnd.messages.back().text.find("n'est pas de la forme ANCIEN=NOUVEAU"), std::string::npos);
    // Nothing to remove: nothing saved.
    EXPECT_EQ(Run({"--supprimer", "Z1"}), DialogResult::Failed);
    EXPECT_FALSE(std::filesystem::exists(dir / "a.bak"));
}

TEST_F(EditBatch, TheSearchListsWhatItFindsWithoutSaving) {
    ASSERT_EQ(Run({"--chercher", "101", "--genre", "Mesure"}), DialogResult::Ok);
    ASSERT_EQ(frontEnd.lines.size(), 3u);
    EXPECT_EQ(frontEnd.lines[0], "2 élément(s) trouvé(s).");
    EXPECT_EQ(frontEnd.lines[1], "000002  Mesure        101  1.3  10  100  25");
    ASSERT_EQ(Run({"--chercher", "--genre", "1006", "--valeur", "y>2010"}), DialogResult::Ok);
    ASSERT_EQ(frontEnd.lines.size(), 2u);
    EXPECT_EQ(frontEnd.lines[1], "000008  Point         102  1010  2030  -999999  -");
    EXPECT_EQ(Run({"--chercher", "--valeur", "y~2010"}), DialogResult::Failed);
    EXPECT_FALSE(std::filesystem::exists(dir / "a.bak"));
}

// The change of projection of the job: from the projection its options give into the one named, every
// point at once. Lambert-93's origin (3°E, 46°30'N) stands at (700 000, 6 600 000) there and at
// (1 700 000, 5 255 574.0521) in CC46. Undone, the GéoBase is the file it was.
TEST_F(EditBatch, TheChangeOfProjectionConvertsEveryPointAndIsUndone) {
    const std::string job = "GEOBASE PYRALIS\t1\n"
                            "1001\tS1\t1.55\t-999999\n"
                            "1006\tO\t700000\t6600000\t312.5\tXY\n"
                            "1006\tZ\t-999999\t-999999\t12\t-\n";
    WriteBytes(dir / "a.geo", job);
    WriteBytes(dir / "Pyralis.ini", "[Options_Corrections]\nProjection=Lambert 93\n");
    ASSERT_EQ(Run({"--changement-projection", "CC46"}), DialogResult::Ok) << frontEnd.AllLines();
    EXPECT_EQ(Saved(), "GEOBASE PYRALIS\t1\n"
                       "1001\tS1\t1.55\t-999999\n"
                       "1006\tO\t1700000\t5255574.0521\t312.5\tXY\n"
                       "1006\tZ\t-999999\t-999999\t12\t-\n");
    EXPECT_NE(frontEnd.AllLines().find("1 point(s) convertis de Lambert 93 en CC46."), std::string::npos);

    pyr::CGeoEditor editor;
    editor.SetInputs({"", dir / "Pyralis.ini", "", "éditeur de GéoBases"});
    editor.SetGeoBase(dir / "a.geo");
    ASSERT_EQ(editor.OpenGeoBase(frontEnd), DialogResult::Ok);
    ASSERT_TRUE(editor.ChangeProjection(frontEnd, "Lambert 93", "CC46"));
    EXPECT_EQ(Saved(), job);
    ASSERT_TRUE(editor.Document().Undo());
    ASSERT_TRUE(editor.Save(frontEnd));
    EXPECT_NE(Saved(), job);
    EXPECT_NE(Saved().find("1700000\t5255574.0521"), std::string::npos);

    // Local coordinates are not converted: refused, nothing changed.
    WriteBytes(dir / "Pyralis.ini", "[Options_Corrections]\nProjection=Aucune\n");
    const std::string before = Saved();
    frontEnd.messages.clear();
    EXPECT_EQ(Run({"--changement-projection", "CC46"}), DialogResult::Failed);
    ASSERT_FALSE(frontEnd.messages.empty());
    EXPECT_EQ(frontEnd.messages.back().text.find("Changement de projection impossible"), 0u);
    EXPECT_EQ(Saved(), before);
}

// The same corner surveyed twice, 3 cm apart (0.018 m east, 0.024 m north), under 101 and 201: a couple
// within the 5 cm of the options, the later point coded as they ask, the listing written where named.
TEST_F(EditBatch, TheDuplicatePointsAreListedAndTheLaterOneCoded) {
    WriteBytes(dir / "a.geo", "GEOBASE PYRALIS\t1\n"
                              "1006\t101\t1000\t2000\t-999999\t-\n"
                              "1006\t102\t1010\t2030\t-999999\t-\n"
                              "1006\t201\t1000.018\t2000.024\t-999999\t-\n");
    WriteBytes(dir / "Pyralis.ini", "[Options_Editeur]\nTolerancePointDouble=0.05\nCodePointDouble=DBL\n");
    ASSERT_EQ(Run({"--points-doubles", dir / "doubles.ptd"}), DialogResult::Ok) << frontEnd.AllLines();
    EXPECT_EQ(Saved(), "GEOBASE PYRALIS\t1\n"
                       "1006\t101\t1000\t2000\t-999999\t-\n"
                       "1006\t102\t1010\t2030\t-999999\t-\n"
                       "1006\t201\t1000.018\t2000.024\t-999999\t-\tDBL\n");
    EXPECT_NE(frontEnd.AllLines().find("1 couple(s) de points doubles à moins de 0.0500 m."),
              std::string::npos)
        << frontEnd.AllLines();
    const std::string listing = ReadBytes(dir / "doubles.ptd");
    EXPECT_NE(listing.find("Recherche des points doubles"), std::string::npos);
    EXPECT_NE(listing.find("0.0300"), std::string::npos) << listing; // the distance of the couple

    // Searched again: the couple is found, already coded, and nothing is saved.
    std::filesystem::remove(dir / "a.bak");
    ASSERT_EQ(Run({"--points-doubles"}), DialogResult::Ok);
    EXPECT_FALSE(std::filesystem::exists(dir / "a.bak"));
    // A tolerance that is not one is refused.
    WriteBytes(dir / "Pyralis.ini", "[Options_Editeur]\nTolerancePointDouble=beaucoup\n");
    frontEnd.messages.clear();
    EXPECT_EQ(Run({"--points-doubles"}), DialogResult::Failed);
    ASSERT_FALSE(frontEnd.messages.empty());
    EXPECT_EQ(frontEnd.messages.front().text,
              "La tolérance des points doubles doit être un nombre compris entre 0 et 100 m.");
}
