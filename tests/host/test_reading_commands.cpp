// The reading commands and the editor's reading, run as a person or a script runs pyralis.
#include "HostTestSupport.h"
#include "fieldbook/FieldBookReader.h"

namespace {

constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1006\tA1\t651050.118\t6862512.447\t-999999\tXY\tBORNE\n";

class ReadingCommands : public PyralisTest {
protected:
    ReadingCommands() { WriteBytes(dir / "carnet.qdl", kQuendalBook); }
};

} // namespace

TEST_F(ReadingCommands, LQuendaConvertsTheFieldBookNamedIntoANewGeoBase) {
    const Outcome outcome = Run("LQuenda carnet.qdl");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(outcome.out, "\nCréation de la GéoBase en cours ...\n ... terminée : 3 lignes écrites.\n"
                           "GéoBase créée = <carnet.geo>.\n");
    EXPECT_EQ(ReadBytes(dir / "carnet.geo"), std::string("GEOBASE PYRALIS\t1\n") + kQuendalLines);
    const std::string params = ReadBytes(dir / "Pyralis.ini");
    EXPECT_TRUE(Has(params, "Carnet=carnet.qdl")) << params;
    EXPECT_TRUE(Has(params, "Derniere=" + dir / "carnet.geo")) << params;
    EXPECT_TRUE(
        Has(ReadBytes(dir / "registre/HKEY_CURRENT_USER.ini"), "DernierFichier=" + dir / "carnet.geo"));

    // Again without naming it: the last field book is taken, and the GéoBase is kept unless --oui.
    WriteBytes(dir / "carnet.geo", "à garder\n");
    const Outcome kept = Run("LQuenda");
    EXPECT_EQ(kept.status, 0);
    ExpectInOrder(kept.err, {"Sélectionnez le fichier carnet à traiter : carnet.qdl",
                             "La GéoBase indiquée existe déjà !\nVoulez-vous la remplacer ?\nRéponse : Non"});
    EXPECT_EQ(ReadBytes(dir / "carnet.geo"), "à garder\n");
    EXPECT_EQ(Run("--oui LQuenda --geobase autre.geo").status, 0);
    EXPECT_TRUE(std::filesystem::exists(dir / "autre.geo"));
}

TEST_F(ReadingCommands, TheHelpNamesTheFieldBookAndTheParameterFileWhereThereIsOne) {
    const Outcome help = Run("PyraLQuenda --help");
    EXPECT_EQ(help.status, 0);
    EXPECT_TRUE(Has(help.out, "Usage : pyralis PyraLQuenda [CARNET] [options]")) << help.out;
    EXPECT_FALSE(Has(help.out, "--parametrage")); // Quendal-Pc has no parameter file
    EXPECT_TRUE(Has(Run("LecWild --help").out, "--parametrage FICHIER"));
}

TEST_F(ReadingCommands, TheEditorAppendsAFieldBookToItsGeoBaseOrMakesANewOne) {
    WriteBytes(dir / "job.geo", kJob);
    const Outcome appended = Run("--oui GeoEdit job.geo --lecture quendal-pc carnet.qdl");
    EXPECT_EQ(appended.status, 0) << appended.err;
    EXPECT_EQ(ReadBytes(dir / "job.geo"), kJob + std::string(kQuendalLines));
    EXPECT_TRUE(Has(appended.out, "GéoBase <job.geo> : 4 élément(s), dont 3 lu(s) dans le carnet.\n"
                                  "000002  Station       S1  1.562  -999999\n"))
        << appended.out;

    // A GéoBase named that does not exist yet is made by the reading, without a question.
    const Outcome made = Run("GeoEdit neuve.geo --lecture LQuenda carnet.qdl");
    EXPECT_EQ(made.status, 0) << made.err;
    EXPECT_EQ(ReadBytes(dir / "neuve.geo"), std::string("GEOBASE PYRALIS\t1\n") + kQuendalLines);
    EXPECT_FALSE(Has(made.err, "n'est pas vide"));

    const Outcome unknown = Run("GeoEdit job.geo --lecture Inconnu carnet.qdl");
    EXPECT_EQ(unknown.status, 1);
    EXPECT_TRUE(Has(unknown.err, "Format de carnet inconnu : « Inconnu »")) << unknown.err;
}

// A field book from which nothing is read (empty, junk, another format) fails with a message that names
// it and the format tried: the GéoBase of that name stays byte for byte, and the last GéoBase stays the
// one the surveyor worked on.
TEST_F(ReadingCommands, ABookWithNothingToReadFailsAndReplacesNothing) {
    ASSERT_EQ(Run("LQuenda carnet.qdl").status, 0);
    const std::string registry = ReadBytes(dir / "registre/HKEY_CURRENT_USER.ini");
    ASSERT_TRUE(Has(ReadBytes(dir / "Pyralis.ini"), "Derniere=" + dir / "carnet.geo"));
    const struct {
        const char* command;
        const char* name;
        std::string bytes;
        const char* format;
    } cases[] = {
        {"LQuenda", "vide.qdl", "", "Quendal-Pc"},
        {"LecWild", "bruit.gsi", std::string("\x89PNG\r\n\x1a\n\0\0\0\rIHDR\xff\xfe", 18), "Wild"},
        {"LSokkia", "quendal.sdr", kQuendalBook, "Sokkia"},
        {"LTopcon", "quendal.gts7", kQuendalBook, "Topcon GT7"},
    };
    for (const auto& c : cases) {
        const std::string geoBase = std::filesystem::path(c.name).replace_extension(".geo").string();
        WriteBytes(dir / c.name, c.bytes);
        WriteBytes(dir / geoBase, kJob);
        const Outcome outcome = Run(std::string("--oui ") + c.command + " " + c.name);
        EXPECT_EQ(outcome.status, 1) << c.command << outcome.out << outcome.err;
        EXPECT_TRUE(Has(outcome.out, " ... terminée : 0 lignes écrites.\n")) << outcome.out;
        EXPECT_TRUE(Has(outcome.err, std::string("Carnet <") + c.name + "> : aucun élément lu au format « " +
                                         c.format + " » !"))
            << outcome.err;
        EXPECT_FALSE(Has(outcome.out, "GéoBase créée")) << outcome.out;
        EXPECT_EQ(ReadBytes(dir / geoBase), kJob) << c.command;
        EXPECT_TRUE(Has(ReadBytes(dir / "Pyralis.ini"), "Derniere=" + dir / "carnet.geo")) << c.command;
        EXPECT_EQ(ReadBytes(dir / "registre/HKEY_CURRENT_USER.ini"), registry) << c.command;
    }
}

// A book whose last line was cut by the transfer: that line is told with its number, and read.
TEST_F(ReadingCommands, ATruncatedLastLineIsReportedWithItsNumber) {
    std::string book = kQuendalBook;
    book.resize(book.size() - 8); // "...;111.5994;POTEAU\n" loses "POTEAU\n" and the last ';'
    WriteBytes(dir / "coupé.qdl", book);
    const Outcome outcome = Run("LQuenda coupé.qdl");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(outcome.out,
              "\nCréation de la GéoBase en cours ...\n"
              "Attention : ligne 4 sans fin de ligne, le carnet semble coupé ; elle est lue telle "
              "quelle !\n ... terminée : 3 lignes écrites.\nGéoBase créée = <coupé.geo>.\n");
}

// The reading dialog names the file it did not find.
TEST_F(ReadingCommands, TheMissingFileMessagesNameTheFile) {
    for (const auto& [arguments, said] :
         {std::pair{"LQuenda absent.qdl", "Le fichier carnet indiqué n'existe pas !\n(absent.qdl)"},
          {"LecWild carnet.qdl --parametrage absent.ini",
           "Le fichier de paramétrage indiqué n'existe pas !\n(absent.ini)"}}) {
        const Outcome outcome = Run(arguments);
        EXPECT_EQ(outcome.status, 1) << arguments;
        EXPECT_TRUE(Has(outcome.err, said)) << outcome.err;
    }
}

namespace {
// Access rights, which root does not meet: run again by CTest as a user.
class ReadingCommandsAsUser : public ReadingCommands {};
} // namespace

// A field book its user may not read: the message names it and says why.
TEST_F(ReadingCommandsAsUser, AnUnreadableBookIsNamedWithTheReason) {
    SKIP_WHEN_ROOT();
    chmod((dir / "carnet.qdl").c_str(), 0);
    const Outcome outcome = Run("LQuenda carnet.qdl");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "Impossible d'ouvrir le fichier carnet !\n(carnet.qdl : accès refusé)"))
        << outcome.err;
    EXPECT_FALSE(std::filesystem::exists(dir / "carnet.geo"));
}
