#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "settings/IniFileStore.h"
#include "settings/ParamStore.h"
#include "settings/RegistryStore.h"

#include <clocale>
#include <tuple>

namespace pyr {
namespace {

using ParamStore = test::SettingsTest;

TEST_F(ParamStore, NumbersAreReadLikeAtoiAndAtofThenBroughtWithinTheirLimits) {
    WriteBytes(path, "[C]\nRayon=5000\nSansChiffre=abc\nLenient=  12 mm\nPourcent=150.5\nPasNombre=nan\n");
    const std::tuple<const char*, int, int, int> integers[] = {
        {"Rayon", 1000, 4000, 4000}, {"SansChiffre", 1, 10, 1}, {"Lenient", -100, 100, 12}};
    for (const auto& [key, minimum, maximum, expected] : integers) {
        int value = -1;
        EXPECT_TRUE(ReadParamInt(path, "C", key, 7, minimum, maximum, value));
        EXPECT_EQ(value, expected) << key << " in [" << minimum << ", " << maximum << "]";
    }
    double real = -1;
    EXPECT_TRUE(ReadParamDouble(path, "C", "Pourcent", 5, 0, 100, real));
    EXPECT_EQ(real, 100);
    ReadParamDouble(path, "C", "PasNombre", 5, 1, 10, real); // not-a-number gives the minimum
    EXPECT_EQ(real, 1);
}

TEST_F(ParamStore, AbsentFileOrKeyGivesTheDefaultAndAKeyStoredEmptyDeliversNothing) {
    WriteBytes(path, "[GeoBase]\nDerniere=a.geo\nVide=\n");
    for (const auto& [file, key] :
         {std::pair{folder / "absent.ini", "Derniere"}, std::pair{path, "Absente"}}) {
        std::string text;
        int number = 0;
        EXPECT_TRUE(ReadParamString(file, "GeoBase", key, "défaut.geo", text));
        EXPECT_TRUE(ReadParamInt(file, "GeoBase", key, 42, 0, 100, number));
        EXPECT_EQ(std::tie(text, number), std::make_tuple("défaut.geo", 42)) << file << " " << key;
    }
    // The default goes through its "%f" text: past six decimals it is rounded.
    double real = 0;
    ReadParamDouble(path, "GeoBase", "Absente", 0.12345678, 0, 1, real);
    EXPECT_EQ(real, 0.123457);
    // A key stored empty delivers no characters: 0, brought within the limits.
    EXPECT_FALSE(ReadParamDouble(path, "GeoBase", "Vide", 7, 1, 10, real));
    EXPECT_EQ(real, 1.0);
    // The in-place read keeps the string it is given when nothing is stored.
    std::string kept = "inchangé";
    EXPECT_TRUE(CParamFile(path).ReadString("GeoBase", "Absente", kept));
    EXPECT_EQ(kept, "inchangé");
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(ParamStore, LongFileValuesAreCutAtTheBufferOnACharacterBoundary) {
    // 'é' is two bytes: placed across the cut, it goes whole.
    WriteBytes(path, "[A]\nLong=" + std::string(5000, 'x') + "\nAccent=" + std::string(4094, 'a') + "éz\n");
    std::string text;
    ReadParamString(path, "A", "Long", "", text);
    EXPECT_EQ(text, std::string(kFileValueBuffer - 1, 'x'));
    ReadParamString(path, "A", "Accent", "", text);
    EXPECT_EQ(text, std::string(4094, 'a'));
}

TEST_F(ParamStore, WritesStoreIntegersAndSwitchesAsDecimalsAndRealsWithSixDecimals) {
    const CParamFile params(path);
    EXPECT_TRUE(params.WriteInt("Calcul", "Decimales", -42));
    EXPECT_TRUE(params.WriteBool("Calcul", "Listing", true));
    EXPECT_TRUE(params.WriteDouble("Calcul", "Rayon", 6378.137));
    EXPECT_TRUE(params.WriteString("Calcul", "Derniere", "C:\\Relevé 2024.geo"));
    EXPECT_EQ(ReadBytes(path), "[Calcul]\nDecimales=-42\nListing=1\nRayon=6378.137000\n"
                               "Derniere=C:\\Relevé 2024.geo\n");
    EXPECT_TRUE(frontEnd.messages.empty());
}

// A parameter file that cannot be written is reported once for the many values a dialog writes in a
// row, and a file just written is not reported when a later write to it fails.
TEST_F(ParamStore, FailingWritesAreReportedOncePerFileAndNotRightAfterASuccess) {
    const std::string missing = folder / "absent/Pyralis.ini";
    EXPECT_FALSE(WriteParamInt(missing, "A", "x", 1));
    EXPECT_FALSE(WriteParamBool(folder / "absent/PYRALIS.INI", "A", "w", 1)); // the same file
    // A missing file in an existing folder is created. Then a folder takes its place: writes to it fail,
    // silently until another file has been written.
    EXPECT_TRUE(WriteParamInt(path, "A", "x", 1));
    std::filesystem::remove(path);
    std::filesystem::create_directory(path);
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 2));
    EXPECT_TRUE(WriteParamInt(folder / "Autre.ini", "A", "x", 1));
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 3));
    EXPECT_EQ(
        Texts(frontEnd, ui::kIconWarning),
        (std::vector<std::string>{missing + " :\nFichier de paramètres inexistant !\n(Code d'erreur 2)\n"
                                            "Cause : fichier ou dossier inexistant.",
                                  path + " :\nSauvegarde des paramètres imposssible !\n(Code d'erreur 21)\n"
                                         "Cause : c'est un dossier, pas un fichier."}));
    EXPECT_EQ(frontEnd.Failures(), 2) << "each message a failure of the command";
}

TEST_F(ParamStore, NullAndEmptyNames) {
    EXPECT_FALSE(WriteParamInt(kNullParamPath, "A", "x", 1));
    EXPECT_FALSE(CParamFile().WriteInt("A", "y", 1));
    // A null name and an empty one are two names: each is reported after the other.
    EXPECT_FALSE(WriteParamInt("", "A", "x", 1));
    EXPECT_FALSE(WriteParamInt(kNullParamPath, "A", "x", 1));
    EXPECT_EQ(Texts(frontEnd, ui::kIconWarning),
              (std::vector<std::string>{"Pointeur nul pour le fichier de paramètres !\n(Code d'erreur 22)",
                                        "Pas de nom pour le fichier de paramètres !\n(Code d'erreur 2)",
                                        "Pointeur nul pour le fichier de paramètres !\n(Code d'erreur 22)"}));
    // An empty key is refused with a reason of its own.
    EXPECT_FALSE(WriteParamInt(path, "A", "", 1));
    EXPECT_EQ(frontEnd.messages.back().text,
              path +
                  " :\nFichier de paramètres inexistant !\n(Code d'erreur 22)\nCause : paramètre sans nom.");
}

class ParamStoreAsUser : public ParamStore {};

TEST_F(ParamStoreAsUser, AFileThatCannotBeReadIsNotWrittenOverAndIsNamedWithTheSystemCode) {
    SKIP_WHEN_ROOT();
    WriteBytes(path, "[A]\nx=0\n");
    ASSERT_EQ(chmod(path.c_str(), 0200), 0);
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 1));
    ASSERT_EQ(chmod(path.c_str(), 0600), 0);
    EXPECT_EQ(ReadBytes(path), "[A]\nx=0\n");
    EXPECT_EQ(Texts(frontEnd, ui::kIconWarning),
              std::vector<std::string>{path +
                                       " :\nSauvegarde des paramètres imposssible !\n(Code d'erreur 13)\n"
                                       "Cause : accès refusé."});
    EXPECT_EQ(frontEnd.Failures(), 1);
}

TEST_F(ParamStoreAsUser, AFileThatIsNotTextStaysWhereItIsWhenItsFolderCannotTakeAnother) {
    SKIP_WHEN_ROOT();
    const std::string sealed = folder / "scelle";
    std::filesystem::create_directory(sealed);
    const std::string file = sealed + "/Pyralis.ini";
    WriteBytes(file, test::BytesOf("\xFF\xFE[\0"));
    ASSERT_EQ(chmod(sealed.c_str(), 0555), 0);
    EXPECT_FALSE(WriteParamInt(file, "A", "x", 1));
    ASSERT_EQ(chmod(sealed.c_str(), 0755), 0);
    EXPECT_EQ(ReadBytes(file), test::BytesOf("\xFF\xFE[\0"));
    EXPECT_FALSE(std::filesystem::exists(file + ".illisible"));
    EXPECT_EQ(frontEnd.messages.back().text, file + " :\nSauvegarde des paramètres imposssible !\n"
                                                    "(Code d'erreur 13)\nCause : accès refusé.");
}

// A parameter file in a form this program cannot read holds someone's settings all the same: it is never
// written over, but kept aside whole, under a name of its own, when the settings are first written.
TEST_F(ParamStore, AFileThatIsNotTextGivesTheDefaultsIsNamedOnceAndIsSetAsideWholeOnTheFirstWrite) {
    const std::string notText[] = {
        test::BytesOf("\xFF\xFE[\0G\0]\0\r\0\n\0x\0=\0\x31\0"), // UTF-16LE with its mark
        test::BytesOf("[\0G\0]\0\r\0\n\0x\0=\0\x31\0"),         // and without
        test::BytesOf("PK\x03\x04\x14\0\0\0\x08\0"),            // a zip archive
    };
    const std::string aside[] = {path + ".illisible", path + ".illisible.2", path + ".illisible.3"};
    for (int i = 0; i < 3; ++i) {
        ForgetUnreadableParamFiles();
        frontEnd.messages.clear();
        WriteBytes(path, notText[i]);
        int number = 0;
        std::string text;
        for (int read = 0; read < 2; ++read) {
            EXPECT_TRUE(ReadParamInt(path, "G", "x", 7, 0, 10, number));
            EXPECT_TRUE(ReadParamString(path, "G", "y", "défaut", text));
            EXPECT_EQ(std::tie(number, text), std::make_tuple(7, "défaut"));
        }
        EXPECT_EQ(Texts(frontEnd, ui::kIconWarning),
                  std::vector<std::string>{path +
                                           " :\nFichier de paramètres illisible (ce n'est pas un fichier "
                                           "texte) !\nLes paramètres par défaut sont utilisés ; le fichier "
                                           "sera mis de côté tel quel au premier enregistrement des "
                                           "paramètres."});
        EXPECT_EQ(ReadBytes(path), notText[i]) << "reading changes nothing";

        EXPECT_TRUE(WriteParamInt(path, "G", "x", 2));
        EXPECT_TRUE(WriteParamInt(path, "G", "z", 3));
        EXPECT_EQ(ReadBytes(aside[i]), notText[i]);
        EXPECT_EQ(ReadBytes(path), "[G]\nx=2\nz=3\n");
        EXPECT_EQ(frontEnd.messages.back().text,
                  path +
                      " :\nFichier de paramètres illisible (ce n'est pas un fichier texte) !\n"
                      "Il a été mis de côté tel quel sous le nom\n" +
                      aside[i] + "\net un nouveau fichier de paramètres est créé.");
        EXPECT_EQ(frontEnd.messages.size(), 2u);
    }
    EXPECT_EQ(frontEnd.Failures(), 0) << "the settings were written";
}

// A GéoBase named by the system in Latin-1 must be found again by the next command: its name is kept byte
// for byte, and the file that keeps it stays UTF-8 (else it would be read whole as Windows-1252).
TEST_F(ParamStore, AFileNameInAnyEncodingComesBackByteForByteInEveryFormOfTheStore) {
    const std::string name = folder / "relev\xE9.geo";
    WriteBytes(folder / "windows.ini", "[GeoBase]\r\nNote=Relev\xE9\r\n");
    // The store as it is named, and the file that holds it.
    for (const auto& [params, file] : {std::pair<std::string, std::string>{path, path},
                                       {folder / "windows.ini", folder / "windows.ini"},
                                       {"HKEY_CURRENT_USER", folder / "registre/HKEY_CURRENT_USER.ini"}}) {
        ASSERT_TRUE(WriteParamString(params, "GeoBase", "Derniere", name)) << params;
        std::string read;
        ReadParamString(params, "GeoBase", "Derniere", "", read);
        EXPECT_EQ(read, name) << params;
        EXPECT_TRUE(IsValidUtf8(ReadBytes(file))) << ReadBytes(file);
    }
    std::string note;
    ReadParamString(folder / "windows.ini", "GeoBase", "Note", "", note);
    EXPECT_EQ(note, "Relevé");
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(ParamStore, NumbersKeepTheirDecimalPointUnderAFrenchLocale) {
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    if (!std::setlocale(LC_ALL, "fr_FR.UTF-8")) GTEST_SKIP() << "fr_FR.UTF-8 is not installed";
    char localeText[16];
    std::snprintf(localeText, sizeof localeText, "%.1f", 2.5);
    const std::string messageText = Sprintf("%.1f", 2.5);
    WriteParamDouble(path, "A", "Reel", 2.5);
    const std::string decimals = FormatDecimals(1234.5678, 2) + " " + FormatDecimals(6378137.0, -1);
    std::setlocale(LC_ALL, previous.c_str());

    EXPECT_EQ(std::string(localeText), "2,5")
        << "without a decimal comma in the locale this test proves nothing";
    EXPECT_EQ(messageText, "2.5");
    EXPECT_EQ(ReadBytes(path), "[A]\nReel=2.500000\n");
    EXPECT_EQ(decimals, "1234.57 6.37814e+06"); // fixed decimals, or none asked for: "%g"
}

TEST_F(ParamStore, ConfigurationPathsFollowTheEnvironment) {
    EXPECT_EQ(DefaultParamFilePath(), path);
    ScopedEnv params("PYRALIS_PARAMS", std::nullopt), hive("PYRALIS_REGISTRE", std::nullopt);
    ScopedEnv config("XDG_CONFIG_HOME", "/cfg"), home("HOME", "/home/geometre");
    EXPECT_EQ(DefaultParamFilePath(), "/cfg/pyralis/Pyralis.ini");
    EXPECT_EQ(RegistryHiveFolder(), "/cfg/pyralis/registre");
    // A relative XDG_CONFIG_HOME is not valid and is passed over (the scoped one puts the old back).
    setenv("XDG_CONFIG_HOME", "relatif", 1);
    EXPECT_EQ(DefaultParamFilePath(), "/home/geometre/.config/pyralis/Pyralis.ini");
}

} // namespace
} // namespace pyr
