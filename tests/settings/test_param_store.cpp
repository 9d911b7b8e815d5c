#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "settings/ParamStore.h"
#include "settings/RegistryStore.h"

#include <clocale>
#include <cstdio>
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
        (std::vector<std::string>{missing + " :\nFichier de paramètres inexistant !\n(Code d'erreur 2)",
                                  path + " :\nSauvegarde des paramètres imposssible !\n(Code d'erreur 21)"}));
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
}

class ParamStoreAsUser : public ParamStore {};

TEST_F(ParamStoreAsUser, AFileThatCannotBeReadIsNotWrittenOverAndIsNamedWithTheSystemCode) {
    SKIP_WHEN_ROOT();
    WriteBytes(path, "[A]\nx=0\n");
    ASSERT_EQ(chmod(path.c_str(), 0200), 0);
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 1));
    ASSERT_EQ(chmod(path.c_str(), 0600), 0);
    EXPECT_EQ(ReadBytes(path), "[A]\nx=0\n");
    EXPECT_EQ(
        Texts(frontEnd, ui::kIconWarning),
        std::vector<std::string>{path + " :\nSauvegarde des paramètres imposssible !\n(Code d'erreur 13)"});
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
