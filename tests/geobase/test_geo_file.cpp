// GéoBase files: what is saved loads back the same, and nothing that was read is ever lost.
#include "TestSupport.h"
#include "geobase/Carnet.h"
#include "geobase/GeoFile.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

using namespace pyr;

namespace {

// One element of every kind, with the texts a field book can bring (accents, tabulations, a Windows
// path, a line break) and missing values.
CCarnet EveryKind() {
    CCarnet c;
    c.Add(std::make_unique<CComment>("Fichier = C:\\Relevés\\job.gsi\tfin"), kKindComment);
    c.Add(std::make_unique<CComment>(""), kKindComment);
    auto instrument = std::make_unique<CAppareil>("TCR 705 n°1", -0.0012, 0.0344);
    instrument->setSigmaPpm(2.0);
    c.Add(std::move(instrument), kKindAppareil);
    auto point = std::make_unique<CPointGen>("1001", 651325.412, 6862371.905, 53.874, "BORNE");
    point->setInvariantXY(true);
    c.Add(std::move(point), kKindPoint);
    auto z = std::make_unique<CPointGen>("NGF12", 0.0, "repère");
    z->setInvariantZ(true);
    c.Add(std::move(z), kKindPoint);
    c.Add(std::make_unique<CPointGen>("A1", 0.1, 0.2, kUndefined), kKindPoint);
    auto station = std::make_unique<CStation>("S1", 1.562, 37.12345, "");
    station->setPar("météo=beau");
    c.Add(std::move(station), kKindStation);
    c.Add(std::make_unique<CReference>("1001", 1.3, 323.76206, 99.40145, 260.0083), kKindReference);
    c.Add(std::make_unique<CMesure>("P7", kUndefined, 0.0, kUndefined, kUndefined, "ANGLE\nBAT"),
          kKindMesure);
    c.Add(std::make_unique<CLectAR>("NGF12", 1.4215, 25.3), kKindLectAR);
    c.Add(std::make_unique<CLectAV>("P7", 1.183), kKindLectAV);
    auto traverse = std::make_unique<CChemin>("POLY 1");
    traverse->add("S1(1)");
    traverse->add("S2(2)");
    traverse->setClosed(true);
    c.Add(std::move(traverse), kKindChemin);
    c.Add(std::make_unique<CChemin>("VIDE"), kKindChemin);
    c.Add(std::make_unique<CCommande>("Sym_2Pts", "1.5 2", "P7"), 1025);
    return c;
}

class GeoFile : public ::testing::Test {
protected:
    // The store read from a file holding these bytes; what the loader said is in `fe`.
    CCarnet Loaded(std::string_view bytes) {
        WriteBytes(path, bytes);
        CCarnet c;
        EXPECT_EQ(c.Load(&txt, path), 1);
        return c;
    }

    TempDir dir;
    std::string path = dir / "job.geo";
    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt{fe};
};

} // namespace

TEST_F(GeoFile, SaveThenLoadGivesTheSameElementsAndSavingAgainTheSameBytes) {
    CCarnet original = EveryKind();
    ASSERT_EQ(original.Save(path), 1);
    CCarnet loaded;
    ASSERT_EQ(loaded.Load(&txt, path), 1);
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
    // Fields that a writer and a reader could both forget, and texts that must be escaped.
    EXPECT_EQ(loaded.As<CComment>(0)->text(), "Fichier = C:\\Relevés\\job.gsi\tfin");
    EXPECT_EQ(loaded.As<CAppareil>(2)->sigmaPpm(), 2.0);
    EXPECT_EQ(loaded.zAt(4), 0.0);
    EXPECT_TRUE(loaded.As<CPointGen>(4)->invariantZ());
    EXPECT_EQ(loaded.parAt(6), "météo=beau");
    EXPECT_EQ(loaded.symAt(8), "ANGLE\nBAT");
    EXPECT_EQ(loaded.As<CChemin>(11)->stations(), (std::vector<std::string>{"S1(1)", "S2(2)"}));
    EXPECT_TRUE(loaded.As<CChemin>(11)->isClosed());

    // Saved again, every element writes the same line, each of its fields included.
    std::string bytes = ReadBytes(path);
    ASSERT_EQ(loaded.Save(path), 1);
    EXPECT_EQ(ReadBytes(path), bytes);
    // Whatever the user's locale, one element a line, with its kind code first.
    EXPECT_EQ(bytes.substr(0, bytes.find('\n')), "GEOBASE PYRALIS\t1");
    EXPECT_NE(bytes.find("\n1006\t1001\t651325.412\t6862371.905\t53.874\tXY\tBORNE\n"), std::string::npos);
    EXPECT_NE(bytes.find("\n1006\tA1\t0.1\t0.2\t-999999\t-\n"), std::string::npos);
}

TEST_F(GeoFile, ABigStoreIsSavedLineForLineAsEachElementWritesItself) {
    // Enough elements for the store to be written in many runs, by two threads, with values that only
    // the general way writes (seventeen digits, subnormal, beyond 10^15) and texts that are escaped or
    // not UTF-8.
    CCarnet c;
    for (int round = 0; round < 2600; ++round) {
        c.Append(EveryKind());
        c.Add(
            std::make_unique<CPointGen>("G" + std::to_string(round), 0.1 + 0.2 * round, 1e20 + round, 5e-324),
            kKindPoint);
        c.Add(std::make_unique<CComment>("Opérateur \xE9t\xE9 " + std::to_string(round)), kKindComment);
    }
    ASSERT_GT(c.GetSize(), 40000);
    std::string expected = "GEOBASE PYRALIS\t1\n";
    for (int i = 0; i < c.GetSize(); ++i)
        expected += ElementLine(*c.GetAt(i), c.GetType(i)) + "\n";

    ASSERT_EQ(c.Save(path), 1);
    const std::string saved = ReadBytes(path);
    ASSERT_EQ(saved.size(), expected.size());
    EXPECT_TRUE(saved == expected);
    EXPECT_NE(saved.find("\n1006\tG1\t0.30000000000000004\t100000000000000000000\t0.0000"),
              std::string::npos);

    // The same text through a stream, and after a reading, the same bytes again.
    const std::string streamed = dir / "flux.geo";
    std::FILE* file = std::fopen(streamed.c_str(), "wb");
    ASSERT_NE(file, nullptr);
    EXPECT_TRUE(c.Write(file));
    std::fclose(file);
    EXPECT_TRUE(ReadBytes(streamed) == expected);
    CCarnet loaded;
    ASSERT_EQ(loaded.Load(&txt, path), 1);
    ASSERT_EQ(loaded.GetSize(), c.GetSize());
    ASSERT_EQ(loaded.Save(path), 1);
    EXPECT_TRUE(ReadBytes(path) == expected);
}

TEST_F(GeoFile, ALineThatCannotBeReadIsReportedAndKeptForTheNextSave) {
    CCarnet c = Loaded("GEOBASE PYRALIS\t1\n"
                       "1001\tS1\t1.5\t-999999\n"
                       "1003\tP1\t1.3\t12,5\t100\t20\n" // a decimal comma
                       "\n"
                       "2001\tinconnu\n"
                       "1006\tP2\t1\t2\n" // a field missing
                       "1006\tP3\t1\t2\t3\t-\n");
    ASSERT_EQ(c.GetSize(), 5);
    EXPECT_EQ(c.As<CComment>(1)->text(), "1003\tP1\t1.3\t12,5\t100\t20");
    EXPECT_EQ(fe.lines,
              (std::vector<std::string>{
                  "Erreur ligne 3 : valeur numérique incorrecte <12,5> ; la ligne est conservée en "
                  "commentaire.",
                  "Erreur ligne 5 : type d'élément 2001 inconnu ; la ligne est conservée en commentaire.",
                  "Erreur ligne 6 : il manque des champs (4 lus, 6 attendus) ; la ligne est conservée "
                  "en commentaire."}));

    ASSERT_EQ(c.Save(path), 1);
    EXPECT_EQ(Loaded(ReadBytes(path)).As<CComment>(1)->text(), "1003\tP1\t1.3\t12,5\t100\t20");
}

TEST_F(GeoFile, AWindows1252FileLoadsWithItsAccentsAndAnyLineEnd) {
    CCarnet c = Loaded("GEOBASE PYRALIS\t1\r\n1000\tOp\xE9rateur : Lef\xE8vre\r\n"
                       "1006\tB\xE9ton\t1\t2\t3\t-\r1006\tP2\t4\t5\t6\t-");
    ASSERT_EQ(c.GetSize(), 3);
    EXPECT_EQ(c.As<CComment>(0)->text(), "Opérateur : Lefèvre");
    EXPECT_EQ(c.findMat("Béton"), 1);
    EXPECT_EQ(c.zAt(2), 6.0);
    EXPECT_NE(fe.AllLines().find("Windows-1252"), std::string::npos);
}

TEST_F(GeoFile, AFileWithoutHeaderOrFromANewerVersionIsStillRead) {
    EXPECT_EQ(Loaded("1006\tP1\t1\t2\t3\t-\n").GetSize(), 1);
    EXPECT_NE(fe.AllLines().find("en-tête"), std::string::npos);

    EXPECT_EQ(Loaded("GEOBASE PYRALIS\t7\n1006\tP1\t1\t2\t3\t-\tcode\tpar\tchamp futur\n").findMat("P1"), 0);
    EXPECT_NE(fe.AllLines().find("version 7"), std::string::npos);
}

TEST_F(GeoFile, AMissingFileIsSaidAndLeavesAnEmptyStore) {
    CCarnet c = EveryKind();
    EXPECT_EQ(c.Load(nullptr, path, {}, 0, &fe), 0);
    EXPECT_EQ(c.GetSize(), 0);
    ASSERT_EQ(fe.messages.size(), 1u);
    EXPECT_EQ(fe.messages[0].text,
              "Impossible d'ouvrir la GéoBase <" + path + "> !\n(fichier ou dossier inexistant)");
}

TEST_F(GeoFile, SavingBacksUpTheFormerFileAndKeepsItsAccessRights) {
    CCarnet c = EveryKind();
    ASSERT_EQ(c.Save(path), 1);
    chmod(path.c_str(), 0640);
    std::string before = ReadBytes(path);

    c.removeElement(0);
    EXPECT_EQ(c.BackUp(), 1);
    ASSERT_EQ(c.Save(path, &fe, true), 1);
    EXPECT_EQ(fe.messages.back().text, "GéoBase enregistrée dans <" + path + ">.");
    EXPECT_EQ(ReadBytes(dir / "job.bak"), before);
    EXPECT_NE(ReadBytes(path), before);
    struct stat info {};
    ASSERT_EQ(stat(path.c_str(), &info), 0);
    EXPECT_EQ(info.st_mode & 0777, 0640u); // the access rights stay those of the file replaced
}

TEST_F(GeoFile, ElementsTurnedIntoCommentsComeBackExactly) {
    CCarnet c = EveryKind();
    std::string line = ElementLine(*c.GetAt(3), kKindPoint);
    ASSERT_TRUE(c.changeObjectIntoComment(&txt, 3));
    EXPECT_EQ(c.findMat("1001"), -1);
    ASSERT_TRUE(c.changeCommentIntoObject(&txt, 3));
    EXPECT_EQ(ElementLine(*c.GetAt(3), c.GetType(3)), line);
    EXPECT_FALSE(c.changeCommentIntoObject(&txt, 3));
    c.As<CComment>(0)->setText("simple remarque");
    EXPECT_FALSE(c.changeCommentIntoObject(&txt, 0));
    EXPECT_EQ(fe.lines, (std::vector<std::string>{
                            "Elément # 4 (Point <1001>) transformé en commentaire.",
                            "Elément # 4 : commentaire rétabli en Point <1001>.",
                            "Elément # 4 : ce n'est pas un commentaire !",
                            "Elément # 1 : ce commentaire ne décrit pas un élément de la GéoBase (type "
                            "d'élément simple remarque inconnu) !"}));
}
