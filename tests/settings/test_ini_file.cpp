#include "TestSupport.h"
#include "settings/IniFileStore.h"

#include <gtest/gtest.h>

namespace pyr {
namespace {

std::string Value(const IniFile& ini, std::string_view section, std::string_view key) {
    std::string value = "<absent>";
    ini.Get(section, key, value);
    return value;
}

TEST(IniFile, SectionsAndKeysIgnoreCaseAndValuesLoseTheirSurroundings) {
    IniFile ini;
    ini.Parse("[Calcul Intersection]\n  NombreDecimaleXY =  3  \nChemin=\"  C:\\a b.geo \"\n"
              "Rayon=6378\nRayon=9999\n");
    EXPECT_EQ(Value(ini, "calcul intersection", "NOMBREDECIMALEXY"), "3");
    EXPECT_EQ(Value(ini, "Calcul Intersection", "Chemin"), "  C:\\a b.geo ");
    EXPECT_EQ(Value(ini, "Calcul Intersection", "Rayon"), "6378"); // of two lines of a key, the first
    EXPECT_EQ(Value(ini, "Absente", "Rayon"), "<absent>");
}

TEST(IniFile, WritingValuesKeepsEveryOtherLineInItsPlace) {
    IniFile ini;
    ini.Parse("; Paramètres PYRALIS\n\n[GeoBase]\nDerniere=ancien.geo\n\n[Options_Corrections]\n"
              "; rayon terrestre en km\nRayonTerre=6378\nnote tapée sans égal\nRefraction=0.13\n\n"
              "[Autre]\nCle=1\n\n; fin du fichier\n");
    ini.Set("geobase", "DERNIERE", "nouveau.geo");
    ini.Set("Options_Corrections", "Echelle", " blancs autour ");
    ini.Set("Calcul Intersection", "Listing", "0");
    const std::string bytes = ini.Bytes();
    // The key keeps its spelling, the new key ends its section, the new section comes before the
    // comments that end the file.
    std::size_t at = 0;
    for (std::string_view line :
         {"; Paramètres PYRALIS\n", "[GeoBase]\n", "Derniere=nouveau.geo\n", "[Options_Corrections]\n",
          "; rayon terrestre en km\n", "RayonTerre=6378\n", "note tapée sans égal\n", "Refraction=0.13\n",
          "Echelle=", "[Autre]\n", "Cle=1\n", "[Calcul Intersection]\n", "Listing=0\n",
          "; fin du fichier\n"}) {
        at = bytes.find(line, at);
        ASSERT_NE(at, std::string::npos) << "'" << line << "' missing or out of place in\n" << bytes;
    }
    EXPECT_EQ(bytes.find("ancien"), std::string::npos);
    EXPECT_EQ(bytes.find("\n\n\n"), std::string::npos) << "blank lines added in\n" << bytes;

    // A value with blanks around it reads back with them.
    IniFile again;
    again.Parse(bytes);
    EXPECT_EQ(Value(again, "Options_Corrections", "Echelle"), " blancs autour ");
}

TEST(IniFile, FileWithoutSectionsKeepsItsLinesFirst) {
    IniFile ini;
    ini.Parse("; premier bloc\n\n; second bloc\n");
    ini.Set("G", "x", "a");
    EXPECT_EQ(ini.Bytes(), "; premier bloc\n\n; second bloc\n\n[G]\nx=a\n");
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

TEST(IniFile, Utf8FileKeepsItsByteOrderMarkAndLineEndsAndStaysUtf8) {
    IniFile ini;
    ini.Parse("\xEF\xBB\xBF[Réglages]\r\nClé=été\r\n");
    EXPECT_EQ(Value(ini, "Réglages", "Clé"), "été");
    ini.Set("Réglages", "Clé", "hiver");
    ini.Set("Réglages", "Autre", "caf\xE9"); // not UTF-8: taken as Windows-1252
    EXPECT_EQ(ini.Bytes(), "\xEF\xBB\xBF[Réglages]\r\nClé=hiver\r\nAutre=café\r\n");
}

TEST(IniFile, SaveReplacesTheFileAndKeepsItsPermissionsAndLink) {
    TempDir folder;
    const std::string real = folder / "reel.ini";
    const std::string link = folder / "lien.ini";
    WriteBytes(real, "[A]\nx=1\n");
    std::filesystem::permissions(real, std::filesystem::perms(0640));
    std::filesystem::create_symlink(real, link);

    ASSERT_EQ(ReplaceFileContents(link, "[A]\nx=2\n"), 0);
    EXPECT_EQ(ReadBytes(real), "[A]\nx=2\n"); // written through the link
    EXPECT_EQ(std::filesystem::status(real).permissions(), std::filesystem::perms(0640));
    // No temporary file left beside it.
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.Root()), {}), 2);
}

} // namespace
} // namespace pyr
