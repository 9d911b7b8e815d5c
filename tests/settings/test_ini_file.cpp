#include "SettingsTestSupport.h"
#include "core/TextEncoding.h"
#include "settings/IniFileStore.h"

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

    // A file without sections keeps its lines first.
    IniFile bare;
    bare.Parse("; premier bloc\n\n; second bloc\n");
    bare.Set("G", "x", "a");
    EXPECT_EQ(bare.Bytes(), "; premier bloc\n\n; second bloc\n\n[G]\nx=a\n");
}

TEST(IniFile, Windows1252FileReadsRightAndIsWrittenBackInItsCodePageUnlessItWouldLoseACharacter) {
    // "[Paramètres]\r\nClé=Géomètre expert\r\n" as a Windows machine writes it.
    IniFile ini;
    ini.Parse("[Param\xE8tres]\r\nCl\xE9=G\xE9om\xE8tre expert\r\nAutre=\x80 \x9C\r\n");
    EXPECT_EQ(Value(ini, "Paramètres", "Clé"), "Géomètre expert");
    EXPECT_EQ(Value(ini, "Paramètres", "Autre"), "€ œ");

    ini.Set("Paramètres", "Clé", "Relevé");
    EXPECT_EQ(ini.Bytes(), "[Param\xE8tres]\r\nCl\xE9=Relev\xE9\r\nAutre=\x80 \x9C\r\n");
    // '≠' has no place in the code page: the file goes over to UTF-8 whole rather than lose it.
    ini.Set("Paramètres", "Nouvelle", "€ ≠");
    EXPECT_EQ(ini.Bytes(), "[Paramètres]\r\nClé=Relevé\r\nAutre=€ œ\r\nNouvelle=€ ≠\r\n");
}

TEST(IniFile, Utf8FileKeepsItsByteOrderMarkAndLineEndsAndStaysUtf8) {
    IniFile ini;
    ini.Parse("\xEF\xBB\xBF[Réglages]\r\nClé=été\r\n");
    EXPECT_EQ(Value(ini, "Réglages", "Clé"), "été");
    ini.Set("Réglages", "Clé", "hiver");
    ini.Set("Réglages", "Autre", "caf\xE9"); // a Latin-1 byte: kept as U+EFE9
    EXPECT_EQ(ini.Bytes(), "\xEF\xBB\xBF[Réglages]\r\nClé=hiver\r\nAutre=caf\uEFE9\r\n");
}

// A file name is a string of bytes that the system gives and takes back as it is: whatever they are, the
// value reads back byte for byte, at once and from the file written, and the file stays UTF-8 text of
// the lines it had (in a Windows-1252 file too, which goes over to UTF-8).
TEST(IniFile, AnyBytesReadBackExactlyWhileTheFileStaysUtf8Text) {
    const std::string values[] = {
        "/chantiers/relev\xE9.geo",      // Latin-1
        "C:\\Relev\xC3\xA9\xFF\xC3.geo", // UTF-8, then a byte of none, then a cut sequence
        test::BytesOf("a\0b\nc\rd"),     // what a line cannot hold
        "\uEFE9 \uEF0A",                 // the escape characters themselves
        "\"C:\\a b.geo\"",
        "\"\"",
        "\"",
        " \"x\" ",                                // quotes, which the file takes off one pair of
        "  blancs\t",                             // blanks around
        "\xED\xA0\x80 \xF4\x90\x80\x80 \xC0\xAF", // a surrogate, past U+10FFFF, an overlong '/'
    };
    // A UTF-8 file and a Windows-1252 one, with their count of lines.
    for (const auto& [file, lines] :
         {std::pair{"[GeoBase]\nDerniere=x\n", 2}, {"[GeoBase]\r\nNote=Relev\xE9\r\n", 3}}) {
        for (const std::string& value : values) {
            IniFile ini;
            ini.Parse(file);
            ini.Set("GeoBase", "Derniere", value);
            EXPECT_EQ(Value(ini, "GeoBase", "Derniere"), value);
            const std::string bytes = ini.Bytes();
            EXPECT_EQ(std::count(bytes.begin(), bytes.end(), '\n'), lines) << bytes;
            EXPECT_EQ(bytes.find('\0'), std::string::npos) << bytes;
            IniFile again;
            again.Parse(bytes);
            EXPECT_EQ(Value(again, "GeoBase", "Derniere"), value) << bytes;
            EXPECT_EQ(Value(again, "GeoBase", "Note"), lines == 3 ? "Relevé" : "<absent>");
            EXPECT_EQ(again.Bytes(), bytes);
        }
        IniFile latin1;
        latin1.Parse(file);
        latin1.Set("GeoBase", "Derniere", values[0]);
        EXPECT_TRUE(IsValidUtf8(latin1.Bytes())) << "else read whole as Windows-1252 next time";
    }
}

TEST(IniFile, QuotedValuesAndCommentsThatLookLikeMarksKeepReadingTheSame) {
    IniFile ini;
    ini.Parse(";\x01 commentaire\n[A]\nDouble=\"\"C:\\a.geo\"\"\nSimple=\"  b \"\n");
    EXPECT_EQ(Value(ini, "A", "Double"), "\"C:\\a.geo\"");
    EXPECT_EQ(Value(ini, "A", "Simple"), "  b ");
    ini.Set("A", "Autre", "1");
    const std::string bytes = ini.Bytes();
    EXPECT_EQ(bytes.rfind(";\x01 commentaire\n[A]\n", 0), 0u) << bytes;
    IniFile again;
    again.Parse(bytes);
    EXPECT_EQ(again.Entries(), ini.Entries());

    // A key that opens with the bytes of a UTF-8 mark, behind blanks that the writing drops.
    IniFile marked;
    marked.Parse("  \xEF\xBB\xBF  Cle=1\n");
    const std::string markedBytes = marked.Bytes();
    IniFile markedAgain;
    markedAgain.Parse(markedBytes);
    EXPECT_EQ(markedAgain.Entries(), marked.Entries()) << markedBytes;
    EXPECT_EQ(markedAgain.Bytes(), markedBytes);
}

TEST(IniFile, TextIsToldFromWhatNoEditorWrites) {
    const struct {
        std::string bytes;
        bool text;
        const char* what;
    } cases[] = {
        {"", true, "empty"},
        {"; rien que des notes\r\n", true, "comments only"},
        {"[A]\r\nx=1\r\n\x1A", true, "ended by Ctrl-Z"},
        {"[Param\xE8tres]\r\nCl\xE9=\x80\r\n", true, "Windows-1252"},
        {"\xEF\xBB\xBF[Réglages]\nClé=été\n", true, "UTF-8 with its mark"},
        {"[A]\nnote=collée\x0B d'un traitement de texte \x1B\n" + std::string(40, 'x'), true,
         "a vertical tab and an escape slipped in"},
        {test::BytesOf("[A]\nx=1\0\n"), false, "a NUL"},
        {test::BytesOf("\xFF\xFE[\0A\0]\0"), false, "UTF-16LE"},
        {test::BytesOf("[\0A\0]\0\n\0"), false, "UTF-16LE without its mark"},
        {test::BytesOf("\xFE\xFF\0[\0A\0]"), false, "UTF-16BE"},
        {"    \xFF\xFE  1 KN STAT=R\n", true, "Windows-1252 that opens as a UTF-16 mark would"},
        {"\x7F"
         "ELF\x02\x01\x01\x03\x04\x05\x06\x07\x08" +
             std::string(200, 'a'),
         false, "an executable's head"},
        {"[A]\nx=\x01\x02\x03\x04\x05\x06\x07\x08\n", true, "eight stray controls"},
        {"[A]\nx=\x01\x02\x03\x04\x05\x06\x07\x08\x0E\n", false, "nine"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(IsParamFileText(c.bytes), c.text) << c.what;
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
