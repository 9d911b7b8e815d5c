// Saving never costs the surveyor a file: not the GéoBase, not its backup, not a file that is not a
// GéoBase, not a file they protected; and what is saved is always UTF-8 that reads back as written.
#include "TestSupport.h"
#include "core/TextEncoding.h"
#include "geobase/Carnet.h"
#include "geobase/GeoFile.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

using namespace pyr;

namespace {

constexpr const char* kGeo = "GEOBASE PYRALIS\t1\n1006\tP1\t651000\t6862000\t52.3\t-\n";
// The first records of a raw Wild GSI-8 field book: nothing of it reads as an element.
constexpr const char* kRawBook = "410001+0000STA1 42....+00001.55 \r\n"
                                 "110002+00000001 21.102+00000000 22.102+10000000 31..00+00025000 \r\n";

std::string RefusedForeign(const std::string& path) {
    return "Impossible d'enregistrer la GéoBase sous\n" + path +
           " !\nCe fichier n'est pas une GéoBase : il est laissé tel qu'il est.\n"
           "Enregistrez la GéoBase sous un autre nom.";
}

// A job of `count` known points, about 40 bytes a line.
CCarnet Points(int count) {
    CCarnet c;
    for (int i = 0; i < count; ++i)
        c.Add(std::make_unique<CPointGen>("P" + std::to_string(i), 651000.125 + i, 6862000.5 + i, 52.3),
              kKindPoint);
    return c;
}

class GeoSave : public ::testing::Test {
protected:
    TempDir dir;
    std::string path = dir / "chantier.geo";
    std::string backup = dir / "chantier.bak";
    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt{fe};
};

} // namespace

TEST_F(GeoSave, AFileIsForeignWhenWithoutHeaderMoreThanHalfOfItsLinesAreUnreadable) {
    const std::pair<std::string, bool> cases[] = {
        {"", false},                                              // nothing to lose
        {" \n\t\n\n", false},                                     // blanks only
        {"410001+0000STA1\n", true},                              // one line, unreadable
        {"1000\tnote\n410001+0000STA1\n", false},                 // half is not more than half
        {"1000\tnote\n410001+0000STA1\n110002+00000001\n", true}, // two of three
        {"1000\tnote\n\n  \n\t\n410001+0000STA1\n", false},       // blank lines do not count
        {"1006\tP1\t1\t2\n1006\tP2\t1\t2\n1000\tnote\n", true},   // known kinds, fields missing
        {"GEOBASE PYRALIS\t1\nx\ny\nz\n", false},                 // the header says it
        {"\xEF\xBB\xBFGEOBASE PYRALIS\t1\nx\ny\n", false},        // after a byte-order mark
        {"x\r\ny\r\nGEOBASE PYRALIS\t1\r\nz\r\n", false},         // a header further down
        {"Op\xE9rateur : Lef\xE8vre\nLev\xE9 du 3 mars\n", true}, // a Windows-1252 text
        {"1000\tLev\xE9\n1006\tP1\t1\t2\t3\t-\nfin\n", false},    // an old GéoBase without header
    };
    for (const auto& [text, foreign] : cases) {
        EXPECT_EQ(TakeGeoFileCensus(text).IsForeign(), foreign) << text;

        // Loaded: the store knows it, and refuses to save over it without reading it again.
        WriteBytes(path, text);
        CCarnet loaded;
        ASSERT_EQ(loaded.Load(&txt, path), 1);
        EXPECT_EQ(loaded.LoadedFileIsForeign(), foreign) << text;
        EXPECT_EQ(loaded.Save(path, &fe), foreign ? 0 : 1) << text;
        EXPECT_TRUE(!foreign || ReadBytes(path) == text) << "a foreign file is left as it was";

        // Saved over by another store: it looks at the file, and comes to the same answer.
        WriteBytes(path, text);
        CCarnet other = Points(1);
        EXPECT_EQ(other.Save(path, &fe), foreign ? 0 : 1) << text;
        EXPECT_EQ(ReadBytes(path) == text, foreign) << text;
    }
}

TEST_F(GeoSave, AFileThatIsNotAGeoBaseIsShownButNeitherItNorItsBackupIsWritten) {
    WriteBytes(path, kRawBook);
    WriteBytes(backup, "copie d'avant\n");
    const std::vector<std::string> before = FileNames(dir.Root());

    CCarnet c;
    ASSERT_EQ(c.Load(&txt, path), 1);
    EXPECT_EQ(c.GetSize(), 2); // every line kept, as a comment
    EXPECT_EQ(fe.lines.back(),
              "<" + path +
                  "> n'est pas une GéoBase (2 ligne(s) illisible(s) sur 2) : ses lignes sont "
                  "montrées en commentaires, mais ce fichier ne sera pas remplacé par un "
                  "enregistrement.");
    c.Append(Points(3));

    // The refusal comes first, whether the caller backs up or not, and ends the command on a failure.
    EXPECT_EQ(c.BackUp(&fe), 0);
    EXPECT_EQ(c.Save(path, &fe), 0);
    ASSERT_EQ(fe.messages.size(), 2u);
    EXPECT_EQ(fe.messages[0].text, RefusedForeign(path));
    EXPECT_EQ(fe.messages[1].text, RefusedForeign(path));
    EXPECT_EQ(fe.Failures(), 2);
    EXPECT_EQ(ReadBytes(path), kRawBook);
    EXPECT_EQ(ReadBytes(backup), "copie d'avant\n");
    EXPECT_EQ(FileNames(dir.Root()), before);

    // Under another name it is a GéoBase like any other, saved again and again.
    const std::string other = dir / "leve.geo";
    ASSERT_EQ(c.Save(other, &fe), 1);
    EXPECT_FALSE(c.LoadedFileIsForeign());
    EXPECT_EQ(c.BackUp(&fe), 1);
    ASSERT_EQ(c.Save(other, &fe), 1);
    EXPECT_EQ(ReadBytes(dir / "leve.bak"), ReadBytes(other));
    EXPECT_EQ(ReadBytes(path), kRawBook);
}

TEST_F(GeoSave, TextsThatAreNotUtf8AreSavedAsTheirWindows1252ReadingAndLoadBackEqual) {
    CCarnet c;
    c.Add(std::make_unique<CPointGen>("B\xE9ton", 1.0, 2.0, 3.0,
                                      "R\xE9"
                                      "f"),
          kKindPoint);
    c.Add(std::make_unique<CComment>("Op\xE9rateur\tLef\xE8vre"), kKindComment);
    c.Add(std::make_unique<CComment>("Lev\xC3"), kKindComment);    // a header that cut a letter in two
    c.Add(std::make_unique<CStation>("Forêt", 1.5), kKindStation); // UTF-8 already: kept as it is
    EXPECT_EQ(ElementLine(*c.GetAt(0), kKindPoint), "1006\tBéton\t1\t2\t3\t-\tRéf");

    ASSERT_EQ(c.Save(path), 1);
    const std::string bytes = ReadBytes(path);
    EXPECT_TRUE(IsValidUtf8(bytes));
    EXPECT_EQ(bytes, "GEOBASE PYRALIS\t1\n"
                     "1006\tBéton\t1\t2\t3\t-\tRéf\n"
                     "1000\tOpérateur\\tLefèvre\n"
                     "1000\tLevÃ\n"
                     "1001\tForêt\t1.5\t-999999\n");

    CCarnet back;
    ASSERT_EQ(back.Load(&txt, path), 1);
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines(); // read as UTF-8, not as Windows-1252
    EXPECT_EQ(back.findMat("Béton"), 0);
    EXPECT_EQ(back.symAt(0), "Réf");
    EXPECT_EQ(back.As<CComment>(1)->text(), "Opérateur\tLefèvre");
    ASSERT_EQ(back.Save(path), 1);
    EXPECT_EQ(ReadBytes(path), bytes);
}

TEST(GeoSaveAsUser, AFolderThatMayNotBeWrittenKeepsTheGeoBaseAndItsBackupAsTheyWere) {
    SKIP_WHEN_ROOT();
    TempDir dir;
    const std::filesystem::path folder = dir.Root() / "protégé";
    std::filesystem::create_directory(folder);
    const std::string path = (folder / "chantier.geo").string();
    const std::string backup = (folder / "chantier.bak").string();
    WriteBytes(path, kGeo);
    WriteBytes(backup, "copie d'avant\n");
    ASSERT_EQ(chmod(folder.c_str(), 0555), 0);

    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt(fe);
    CCarnet c;
    ASSERT_EQ(c.Load(&txt, path), 1);
    EXPECT_TRUE(fe.lines.empty()) << "the file itself may be written: " << fe.AllLines();
    c.Append(Points(2));
    EXPECT_EQ(c.BackUp(&fe), 0);
    EXPECT_EQ(c.Save(path, &fe), 0);
    ASSERT_EQ(fe.messages.size(), 2u);
    EXPECT_NE(fe.messages[0].text.find("dans\n" + backup + "\n(accès refusé)."), std::string::npos)
        << fe.messages[0].text;
    EXPECT_EQ(fe.messages[1].text, "Impossible d'enregistrer la GéoBase sous\n" + path +
                                       " !\n(accès refusé).\nLe fichier est resté tel qu'il était.");
    EXPECT_EQ(fe.Failures(), 2);
    EXPECT_EQ(ReadBytes(path), kGeo);
    EXPECT_EQ(ReadBytes(backup), "copie d'avant\n");
    EXPECT_EQ(FileNames(folder), (std::vector<std::string>{"chantier.bak", "chantier.geo"}));
    chmod(folder.c_str(), 0755);
}
