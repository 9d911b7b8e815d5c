#include "SettingsTestSupport.h"
#include "settings/IniFileStore.h"

#include <cerrno>
#include <gtest/gtest.h>
#include <sys/stat.h>

namespace pyr {
namespace {

std::string Value(const IniFile& ini, std::string_view section, std::string_view key) {
    std::string value = "<absent>";
    ini.Get(section, key, value);
    return value;
}

TEST(IniFile, SectionsAndKeysIgnoreCaseAndValuesLoseTheirSurroundings) {
    IniFile ini;
    ini.Parse("[Calcul Intersection]\n"
              "  NombreDecimaleXY =  3  \n"
              "Chemin=\"  C:\\Chantiers\\a b.geo \"\n"
              "Vide=\n"
              "Rayon=6378\n"
              "Rayon=9999\n");
    EXPECT_EQ(Value(ini, "calcul intersection", "nombredecimalexy"), "3");
    EXPECT_EQ(Value(ini, "CALCUL INTERSECTION", "NOMBREDECIMALEXY"), "3");
    EXPECT_EQ(Value(ini, "Calcul Intersection", "Chemin"), "  C:\\Chantiers\\a b.geo ");
    EXPECT_EQ(Value(ini, "Calcul Intersection", "Vide"), "");
    // Of two lines of one key, the first counts.
    EXPECT_EQ(Value(ini, "Calcul Intersection", "Rayon"), "6378");
    EXPECT_EQ(Value(ini, "Calcul Intersection", "Absent"), "<absent>");
    EXPECT_EQ(Value(ini, "Absente", "Rayon"), "<absent>");
    EXPECT_TRUE(ini.HasSection("CALCUL intersection"));
    EXPECT_FALSE(ini.HasSection("Calcul"));
}

TEST(IniFile, WritingOneValueKeepsEveryOtherLine) {
    IniFile ini;
    ini.Parse("; Paramètres PYRALIS\n"
              "; écrit à la main\n"
              "\n"
              "; la dernière GéoBase\n"
              "[GeoBase]\n"
              "Derniere=C:\\Chantiers\\ancien.geo\n"
              "\n"
              "[Options_Corrections]\n"
              "; rayon terrestre en km\n"
              "RayonTerre=6378\n"
              "note tapée sans égal\n"
              "Refraction=0.13\n"
              "\n"
              "[Autre]\n"
              "Cle=1\n"
              "\n"
              "; fin du fichier\n");
    ini.Set("geobase", "DERNIERE", "C:\\Chantiers\\nouveau.geo");
    ini.Set("Options_Corrections", "Echelle", "1");
    ini.Set("Calcul Intersection", "Listing", "0");
    EXPECT_EQ(ini.Bytes(), "; Paramètres PYRALIS\n"
                           "; écrit à la main\n"
                           "\n"
                           "; la dernière GéoBase\n"
                           "[GeoBase]\n"
                           "Derniere=C:\\Chantiers\\nouveau.geo\n"
                           "\n"
                           "[Options_Corrections]\n"
                           "\n"
                           "; rayon terrestre en km\n"
                           "RayonTerre=6378\n"
                           "\n"
                           "note tapée sans égal\n"
                           "Refraction=0.13\n"
                           "Echelle=1\n"
                           "\n"
                           "[Autre]\n"
                           "Cle=1\n"
                           "\n"
                           "[Calcul Intersection]\n"
                           "Listing=0\n"
                           "\n"
                           "; fin du fichier\n");
}

TEST(IniFile, WrittenTextReadsBackToTheSameTextAndValues) {
    IniFile first;
    first.Parse("#entête\n[A]\nx = 1\n;c\n\n\n;d\ny=\"  deux \"\nsans égal\n[B]\nz=3\n; fin\n\n");
    first.Set("A", "w", " blancs autour ");
    const std::string once = first.Bytes();
    IniFile second;
    second.Parse(once);
    EXPECT_EQ(second.Bytes(), once);
    EXPECT_EQ(Value(second, "A", "x"), "1");
    EXPECT_EQ(Value(second, "A", "y"), "  deux ");
    EXPECT_EQ(Value(second, "A", "w"), " blancs autour ");
    EXPECT_EQ(Value(second, "B", "z"), "3");
}

TEST(IniFile, FileOfCommentsOnlyKeepsThemFirst) {
    IniFile ini;
    ini.Parse("; premier bloc\n\n; second bloc\n");
    ini.Set("GeoBase", "Derniere", "a.geo");
    EXPECT_EQ(ini.Bytes(), "; premier bloc\n\n; second bloc\n\n[GeoBase]\nDerniere=a.geo\n");

    IniFile empty;
    empty.Parse("");
    empty.Set("GeoBase", "Derniere", "a.geo");
    EXPECT_EQ(empty.Bytes(), "[GeoBase]\nDerniere=a.geo\n");
}

TEST(IniFile, Windows1252FileReadsRightAndIsWrittenBackInItsCodePage) {
    // "[Paramètres]\r\nClé=Géomètre expert\r\n" as a Windows machine writes it.
    IniFile ini;
    ini.Parse("[Param\xE8tres]\r\nCl\xE9=G\xE9om\xE8tre expert\r\nAutre=\x80 \x9C\r\n");
    EXPECT_EQ(Value(ini, "Paramètres", "Clé"), "Géomètre expert");
    EXPECT_EQ(Value(ini, "Paramètres", "Autre"), "€ œ");

    ini.Set("Paramètres", "Clé", "Relevé");
    ini.Set("Paramètres", "Nouvelle", "€ ≠"); // '≠' has no place in the code page
    EXPECT_EQ(ini.Bytes(), "[Param\xE8tres]\r\nCl\xE9=Relev\xE9\r\nAutre=\x80 \x9C\r\nNouvelle=\x80 ?\r\n");
}

TEST(IniFile, Utf8FileKeepsItsByteOrderMarkAndLineEnds) {
    IniFile ini;
    ini.Parse("\xEF\xBB\xBF[Réglages]\r\nClé=été\r\n");
    EXPECT_EQ(Value(ini, "Réglages", "Clé"), "été");
    ini.Set("Réglages", "Clé", "hiver");
    EXPECT_EQ(ini.Bytes(), "\xEF\xBB\xBF[Réglages]\r\nClé=hiver\r\n");
}

TEST(IniFile, TextThatIsNotUtf8IsStoredAsWindows1252SoTheFileStaysUtf8) {
    IniFile ini;
    ini.Parse("[A]\nx=déjà\n");
    ini.Set("A", "y", "caf\xE9");
    IniFile again;
    again.Parse(ini.Bytes());
    EXPECT_EQ(Value(again, "A", "x"), "déjà");
    EXPECT_EQ(Value(again, "A", "y"), "café");
}

TEST(IniFile, SaveReplacesTheFileAndKeepsItsPermissionsAndLink) {
    TempDir folder;
    const std::string real = folder / "reel.ini";
    const std::string link = folder / "lien.ini";
    WriteBytes(real, "[A]\nx=1\n");
    ASSERT_EQ(chmod(real.c_str(), 0640), 0);
    ASSERT_EQ(symlink(real.c_str(), link.c_str()), 0);

    IniFile ini;
    ASSERT_EQ(ini.Load(link), 0);
    ini.Set("A", "x", "2");
    ASSERT_EQ(ini.Save(link), 0);

    EXPECT_TRUE(std::filesystem::is_symlink(link));
    EXPECT_EQ(ReadBytes(real), "[A]\nx=2\n");
    struct stat info {};
    ASSERT_EQ(stat(real.c_str(), &info), 0);
    EXPECT_EQ(info.st_mode & 0777, 0640u);
    // Nothing left beside it.
    int entries = 0;
    for ([[maybe_unused]] const auto& entry : std::filesystem::directory_iterator(folder.Root()))
        ++entries;
    EXPECT_EQ(entries, 2);
}

TEST(IniFile, SaveFailuresLeaveTheFileAlone) {
    TempDir folder;
    IniFile ini;
    ini.Set("A", "x", "1");
    EXPECT_EQ(ini.Save(folder / "absent/params.ini"), ENOENT);
    std::filesystem::create_directory(folder / "dossier.ini");
    EXPECT_EQ(ini.Save(folder / "dossier.ini"), EISDIR);
    EXPECT_EQ(ini.Load(folder / "dossier.ini"), EISDIR);
    EXPECT_EQ(ini.Load(folder / "absent.ini"), ENOENT);
}

TEST(IniFile, ReadOnlyFileIsNotReplaced) {
    if (geteuid() == 0) GTEST_SKIP() << "root writes read-only files";
    TempDir folder;
    IniFile ini;
    ini.Set("A", "x", "1");
    const std::string readOnly = folder / "lecture-seule.ini";
    WriteBytes(readOnly, "[A]\nx=0\n");
    ASSERT_EQ(chmod(readOnly.c_str(), 0444), 0);
    EXPECT_EQ(ini.Save(readOnly), EACCES);
    EXPECT_EQ(ReadBytes(readOnly), "[A]\nx=0\n");
}

// A dialog reads its switches one by one, each read taking the file afresh.
TEST(IniFile, ManyReadsInARowOfALargeFileFindEveryValue) {
    TempDir folder;
    const std::string path = folder / "grand.ini";
    std::string text;
    for (int section = 0; text.size() < 20000; ++section) {
        text += "[Section " + std::to_string(section) + "]\n";
        for (int key = 0; key < 20; ++key)
            text += "Parametre" + std::to_string(key) + "=" + std::to_string(section * key) + ".125\n";
    }
    WriteBytes(path, text);

    int found = 0;
    for (int i = 0; i < 200; ++i) {
        std::string value;
        found += ReadParamString(path, "Section " + std::to_string(i % 40),
                                 "Parametre" + std::to_string(i % 20), "", value) &&
                 !value.empty();
    }
    EXPECT_EQ(found, 200);
}

} // namespace
} // namespace pyr
