// The export commands run as a script runs them: the scope options, an existing file replaced, completed
// or kept, the settings file of a format, and the editor's export.
#include "HostTestSupport.h"

namespace pyr::test {
namespace {

class ExportCommand : public PyralisTest {
protected:
    ExportCommand() {
        CCarnet c;
        c.Add(std::make_unique<CPointGen>("A1", 1000.0, 2000.0, 100.0, "BORNE"), kKindPoint);
        c.Add(std::make_unique<CStation>("A1", 1.55), kKindStation);
        c.Add(std::make_unique<CMesure>("A7", 1.3, 112.3456, 100.5, 24.142), kKindMesure);
        c.Add(std::make_unique<CPointGen>("A7", 1020.0, 1990.0, 99.5), kKindPoint);
        c.Add(std::make_unique<CPointGen>("B5", 990.0, 2005.0, kUndefined), kKindPoint);
        EXPECT_EQ(c.Save(dir / "chantier.geo"), 1);
    }
};

TEST_F(ExportCommand, EachCommandWritesItsFormatOverTheScopeAsked) {
    Outcome outcome = Run("EQuendal --geobase chantier.geo --sortie tout.txt --tous-les-points");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "tout.txt"), "QUENDAL-PC;1\nPOINT;A1;1000;2000;100;BORNE\nSTATION;A1;1.55\n"
                                           "MESURE;A7;1.3;112.3456;100.5;24.142\nPOINT;A7;1020;1990;99.5\n"
                                           "POINT;B5;990;2005\n");

    outcome = Run("EQuendal --geobase chantier.geo --sortie plage.txt --de A1 --a A9 --carnet 1");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "plage.txt"),
              "QUENDAL-PC;1\nPOINT;A1;1000;2000;100;BORNE\nPOINT;A7;1020;1990;99.5\n");

    outcome = Run("EQuendal --geobase chantier.geo --sortie sel.txt --selection A7 --points 0");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "sel.txt"), "QUENDAL-PC;1\nMESURE;A7;1.3;112.3456;100.5;24.142\n");

    // The points export takes the format named, else the last one used, and names the file after the
    // GéoBase. The box of the points stays as the last export left it.
    outcome = Run("EPoints --geobase chantier.geo --format 0 --selection B5");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "Il n'y a rien à exporter !")) << outcome.err;
    outcome = Run("EPoints --geobase chantier.geo --format 0 --selection B5 --points 1");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(SavedGeoBase(dir / "chantier_2.geo").GetSize(), 1);
    EXPECT_TRUE(Has(ReadBytes(dir / "Pyralis.ini"), "DernierFormat=0")) << ReadBytes(dir / "Pyralis.ini");

    outcome = Run("EPoints --geobase chantier.geo --format 9");
    EXPECT_NE(outcome.status, 0);
    EXPECT_TRUE(Has(outcome.err, "format « 9 » inconnu")) << outcome.err;
}

TEST_F(ExportCommand, AnExistingFileIsKeptUnlessTheScriptSaysToReplaceOrCompleteIt) {
    WriteBytes(dir / "pts.txt", "QUENDAL-PC;1\nPOINT;Z1;1;2;3\n");
    Outcome outcome = Run("EQuendal --geobase chantier.geo --sortie pts.txt --carnet 0");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.err, "Le fichier de points à créer existe déjà !")) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "pts.txt"), "QUENDAL-PC;1\nPOINT;Z1;1;2;3\n");

    outcome = Run("EQuendal --geobase chantier.geo --sortie pts.txt --carnet 0 --completer");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "pts.txt"), "QUENDAL-PC;1\nPOINT;Z1;1;2;3\nPOINT;A1;1000;2000;100;BORNE\n"
                                          "POINT;A7;1020;1990;99.5\nPOINT;B5;990;2005\n");
    outcome = Run("EQuendal --geobase chantier.geo --sortie pts.txt --carnet 0 --remplacer --selection B5");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "pts.txt"), "QUENDAL-PC;1\nPOINT;B5;990;2005\n");

    EXPECT_NE(Run("EQuendal --geobase chantier.geo --sortie pts.txt --remplacer --completer").status, 0);
}

TEST_F(ExportCommand, AFormatWithoutItsSettingsFileWritesNothing) {
    const Outcome outcome = Run("ESeparat --geobase chantier.geo --sortie pts.txt --parametres absent.sep");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "absent.sep")) << outcome.err;
    EXPECT_FALSE(std::filesystem::exists(dir / "pts.txt"));
}

TEST_F(ExportCommand, TheEditorExportsItsGeoBaseOrItsSelection) {
    Outcome outcome =
        Run("GeoEdit chantier.geo --exportation --format 3 --sortie sel.txt --selection A7 --carnet 0");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "sel.txt"), "QUENDAL-PC;1\nPOINT;A7;1020;1990;99.5\n");

    outcome = Run("GeoEdit chantier.geo --exportation --format 0 --sortie copie.geo --carnet 1");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(SavedGeoBase(dir / "copie.geo").GetSize(), 5);
}

class ExportCommandAsUser : public ExportCommand {};

TEST_F(ExportCommandAsUser, AFileOrAFolderThatMayNotBeWrittenIsNamedAndLeftAsItWas) {
    SKIP_WHEN_ROOT();
    std::filesystem::create_directory(dir / "ferme");
    ASSERT_EQ(chmod((dir / "ferme").c_str(), 0555), 0);
    Outcome outcome = Run("ESokkia --geobase chantier.geo --sortie ferme/pts.sdr");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "ferme/pts.sdr")) << outcome.err;
    EXPECT_FALSE(std::filesystem::exists(dir / "ferme/pts.sdr"));

    WriteBytes(dir / "pts.txt", "QUENDAL-PC;1\n");
    ASSERT_EQ(chmod((dir / "pts.txt").c_str(), 0444), 0);
    outcome = Run("EQuendal --geobase chantier.geo --sortie pts.txt --completer");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "pts.txt")) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "pts.txt"), "QUENDAL-PC;1\n");
}

} // namespace
} // namespace pyr::test
