#include "SettingsTestSupport.h"
#include "settings/ParamStore.h"
#include "settings/RegistryStore.h"

#include <clocale>
#include <cstdio>
#include <gtest/gtest.h>
#include <string>

namespace pyr {
namespace {

class ParamStore : public test::SettingsTest {
protected:
    ParamStore() : path(folder / "Pyralis.ini") {}

    void Store(std::string_view text) { WriteBytes(path, text); }

    std::string path;
};

TEST_F(ParamStore, IntegersAreReadLikeAtoiThenBroughtWithinTheirLimits) {
    Store("[Options_Corrections]\n"
          "RayonTerre=5000\n"
          "SansChiffre=abc\n"
          "Lenient=  12 mm\n"
          "Negatif=-45\n"
          "Enorme=99999999999\n");
    int value = -1;
    // An earth radius in km stored below its lower limit.
    EXPECT_TRUE(ReadParamInt(path, "Options_Corrections", "RayonTerre", 6378, 6000, 7000, value));
    EXPECT_EQ(value, 6000);
    EXPECT_TRUE(ReadParamInt(path, "Options_Corrections", "RayonTerre", 6378, 1000, 4000, value));
    EXPECT_EQ(value, 4000);
    // No digits: 0, then the minimum when 0 is below it.
    ReadParamInt(path, "Options_Corrections", "SansChiffre", 7, 1, 10, value);
    EXPECT_EQ(value, 1);
    ReadParamInt(path, "Options_Corrections", "SansChiffre", 7, -5, 5, value);
    EXPECT_EQ(value, 0);
    ReadParamInt(path, "Options_Corrections", "Lenient", 0, -100, 100, value);
    EXPECT_EQ(value, 12);
    ReadParamInt(path, "Options_Corrections", "Negatif", 0, -100, 100, value);
    EXPECT_EQ(value, -45);
    ReadParamInt(path, "Options_Corrections", "Enorme", 0, 0, 1000, value);
    EXPECT_EQ(value, 1000);
}

TEST_F(ParamStore, RealsAreReadLikeAtofThenBroughtWithinTheirLimits) {
    Store("[Calcul]\nPourcent=150.5\nEchelle= 0.9996 ppm\nVirgule=2,75\nExposant=-1.5e2\nPasNombre=nan\n");
    double value = -1;
    EXPECT_TRUE(ReadParamDouble(path, "Calcul", "Pourcent", 50.0, 0.0, 100.0, value));
    EXPECT_EQ(value, 100.0);
    ReadParamDouble(path, "Calcul", "Echelle", 1.0, 0.0, 2.0, value);
    EXPECT_EQ(value, 0.9996);
    // A decimal comma ends the number, as it does for atof in the C locale.
    ReadParamDouble(path, "Calcul", "Virgule", 0.0, -10.0, 10.0, value);
    EXPECT_EQ(value, 2.0);
    ReadParamDouble(path, "Calcul", "Exposant", 0.0, -1000.0, 1000.0, value);
    EXPECT_EQ(value, -150.0);
    ReadParamDouble(path, "Calcul", "PasNombre", 5.0, 1.0, 10.0, value);
    EXPECT_EQ(value, 1.0);
}

TEST_F(ParamStore, AbsentFileSectionOrKeyGivesTheDefault) {
    const std::string absent = folder / "absent.ini";
    Store("[GeoBase]\nDerniere=C:\\Chantiers\\a.geo\n");
    for (const auto& [file, section, key] :
         {std::tuple{absent, "GeoBase", "Derniere"}, std::tuple{path, "Absente", "Derniere"},
          std::tuple{path, "GeoBase", "Absente"}}) {
        SCOPED_TRACE(std::string(section) + "/" + key);
        std::string text;
        EXPECT_TRUE(ReadParamString(file, section, key, "défaut.geo", text));
        EXPECT_EQ(text, "défaut.geo");
        int number = 0;
        EXPECT_TRUE(ReadParamInt(file, section, key, 42, 0, 100, number));
        EXPECT_EQ(number, 42);
        double real = 0;
        EXPECT_TRUE(ReadParamDouble(file, section, key, 6378.137, 6000, 7000, real));
        EXPECT_EQ(real, 6378.137);
    }
    // The default goes through its "%f" text: past six decimals it is rounded.
    double small = 0;
    ReadParamDouble(path, "GeoBase", "Absente", 0.12345678, 0, 1, small);
    EXPECT_EQ(small, 0.123457);
    // A default outside the limits is brought within them like a stored value.
    int number = 0;
    ReadParamInt(path, "GeoBase", "Absente", 500, 0, 100, number);
    EXPECT_EQ(number, 100);
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(ParamStore, NumberReadsTellWhetherTheStoreDeliveredAnyCharacters) {
    Store("[A]\nVide=\nPlein=3\n");
    int number = -1;
    // A key stored empty delivers nothing: 0, brought within the limits.
    EXPECT_FALSE(ReadParamInt(path, "A", "Vide", 7, -10, 10, number));
    EXPECT_EQ(number, 0);
    EXPECT_TRUE(ReadParamInt(path, "A", "Plein", 7, -10, 10, number));
    EXPECT_EQ(number, 3);
    double real = -1;
    EXPECT_FALSE(ReadParamDouble(path, "A", "Vide", 7, 1, 10, real));
    EXPECT_EQ(real, 1.0);
}

TEST_F(ParamStore, StringReadsInPlaceAndTheBufferCut) {
    std::string longValue(5000, 'x');
    // 'é' is two bytes: placed across the cut, it goes whole.
    std::string accented = std::string(4094, 'a') + "éz";
    Store("[A]\nLong=" + longValue + "\nAccent=" + accented + "\nDerniere=b.geo\n");

    std::string text = "a.geo";
    EXPECT_TRUE(ReadParamString(path, "A", "Derniere", text));
    EXPECT_EQ(text, "b.geo");
    text = "a.geo";
    EXPECT_TRUE(ReadParamString(path, "A", "Absente", text));
    EXPECT_EQ(text, "a.geo");

    ReadParamString(path, "A", "Long", "", text);
    EXPECT_EQ(text, std::string(kFileValueBuffer - 1, 'x'));
    ReadParamString(path, "A", "Accent", "", text);
    EXPECT_EQ(text, std::string(4094, 'a'));
    // A default goes through the same buffer.
    ReadParamString(path, "A", "Absente", longValue, text);
    EXPECT_EQ(text.size(), kFileValueBuffer - 1);
}

TEST_F(ParamStore, WritesEncodeValuesAsDecimalTextAndReadBack) {
    EXPECT_TRUE(WriteParamInt(path, "Calcul Intersection", "NombreDecimaleXY", -42));
    EXPECT_TRUE(WriteParamBool(path, "Calcul Intersection", "Listing", true));
    EXPECT_TRUE(WriteParamBool(path, "Calcul Intersection", "Journal", false));
    EXPECT_TRUE(WriteParamDouble(path, "Options_Corrections", "RayonTerre", 6378.137));
    EXPECT_TRUE(WriteParamDouble(path, "Options_Corrections", "Coef", -0.5));
    EXPECT_TRUE(WriteParamDouble(path, "Options_Corrections", "Petit", 1e-7));
    EXPECT_TRUE(WriteParamString(path, "GeoBase", "Derniere", "C:\\Chantiers\\Relevé 2024.geo"));
    EXPECT_EQ(ReadBytes(path), "[Calcul Intersection]\n"
                               "NombreDecimaleXY=-42\n"
                               "Listing=1\n"
                               "Journal=0\n"
                               "\n"
                               "[Options_Corrections]\n"
                               "RayonTerre=6378.137000\n"
                               "Coef=-0.500000\n"
                               "Petit=0.000000\n"
                               "\n"
                               "[GeoBase]\n"
                               "Derniere=C:\\Chantiers\\Relevé 2024.geo\n");

    int number = 0;
    ReadParamInt(path, "calcul intersection", "nombredecimalexy", 0, -100, 100, number);
    EXPECT_EQ(number, -42);
    double real = 0;
    ReadParamDouble(path, "OPTIONS_CORRECTIONS", "RAYONTERRE", 0, 0, 1e4, real);
    EXPECT_EQ(real, 6378.137);
    std::string text;
    ReadParamString(path, "GeoBase", "Derniere", "", text);
    EXPECT_EQ(text, "C:\\Chantiers\\Relevé 2024.geo");
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(ParamStore, NumbersKeepTheirDecimalPointUnderAFrenchLocale) {
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    if (!std::setlocale(LC_ALL, "fr_FR.UTF-8")) GTEST_SKIP() << "fr_FR.UTF-8 is not installed";
    char probe[16];
    std::snprintf(probe, sizeof probe, "%.1f", 2.5);
    const bool decimalComma = std::string(probe) == "2,5";

    WriteParamDouble(path, "A", "Reel", 2.5);
    double real = 0;
    ReadParamDouble(path, "A", "Reel", 0, 0, 10, real);
    const std::string decimals = FormatDecimals(1234.5678, 2);
    std::setlocale(LC_ALL, previous.c_str());

    EXPECT_TRUE(decimalComma) << "the locale should write a decimal comma, else this test proves nothing";
    EXPECT_EQ(ReadBytes(path), "[A]\nReel=2.500000\n");
    EXPECT_EQ(real, 2.5);
    EXPECT_EQ(decimals, "1234.57");
}

TEST_F(ParamStore, FormatDecimalsGivesWhatPrintfGivesInTheCLocale) {
    const double values[] = {0.0,       -0.0, 3.14159265,      2.5, 0.125, -1234.5678,
                             6378137.0, 1e-7, 123456789.987654};
    for (double value : values) {
        for (int decimals : {-1, 0, 1, 2, 3, 6, 9}) {
            char expected[128];
            if (decimals < 0)
                std::snprintf(expected, sizeof expected, "%g", value);
            else
                std::snprintf(expected, sizeof expected, "%.*f", decimals, value);
            EXPECT_EQ(FormatDecimals(value, decimals), expected) << value << " with " << decimals;
        }
    }
}

TEST_F(ParamStore, RootFollowedByMoreTextIsWrittenAsAFile) {
    const auto previous = std::filesystem::current_path();
    std::filesystem::current_path(folder.Root());
    const bool written = WriteParamInt("HKEY_CURRENT_USER\\Software", "Options", "Cle", 5);
    std::filesystem::current_path(previous);

    EXPECT_TRUE(written);
    EXPECT_EQ(ReadBytes(folder / "HKEY_CURRENT_USER\\Software"), "[Options]\nCle=5\n");
    EXPECT_FALSE(std::filesystem::exists(folder / "registre"));
}

TEST_F(ParamStore, ParameterFileObjectWorksOnItsPath) {
    const CParamFile params(path);
    EXPECT_TRUE(params.WriteDouble("Dlg", "Tolerance", 0.015));
    EXPECT_TRUE(params.WriteBool("Dlg", "Auto", 1));
    double tolerance = 0;
    int flag = 0;
    std::string kept = "inchangé";
    params.ReadDouble("Dlg", "Tolerance", 0, 0, 1, tolerance);
    params.ReadInt("Dlg", "Auto", 0, 0, 1, flag);
    params.ReadString("Dlg", "Absent", kept);
    EXPECT_EQ(tolerance, 0.015);
    EXPECT_EQ(flag, 1);
    EXPECT_EQ(kept, "inchangé");
    EXPECT_TRUE(CParamFile("hkey_current_user").IsRegistry());

    const CParamFile none;
    EXPECT_EQ(none.Path().data(), nullptr);
    EXPECT_FALSE(none.WriteInt("Dlg", "Nombre", 1));
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text, "Pointeur nul pour le fichier de paramètres !\n(Code d'erreur 22)");
}

TEST_F(ParamStore, ConfigurationPathsFollowTheEnvironment) {
    EXPECT_EQ(DefaultParamFilePath(), folder / "Pyralis.ini");
    EXPECT_EQ(RegistryHiveFolder(), folder / "registre");
    ScopedEnv params("PYRALIS_PARAMS", std::nullopt);
    ScopedEnv hive("PYRALIS_REGISTRE", std::nullopt);
    {
        ScopedEnv config("XDG_CONFIG_HOME", "/home/geometre/.cfg");
        EXPECT_EQ(DefaultParamFilePath(), "/home/geometre/.cfg/pyralis/Pyralis.ini");
        EXPECT_EQ(RegistryHiveFolder(), "/home/geometre/.cfg/pyralis/registre");
    }
    // A relative XDG_CONFIG_HOME is not valid and is passed over.
    ScopedEnv config("XDG_CONFIG_HOME", "relatif");
    ScopedEnv home("HOME", "/home/geometre");
    EXPECT_EQ(DefaultParamFilePath(), "/home/geometre/.config/pyralis/Pyralis.ini");
    EXPECT_EQ(RegistryHiveFolder(), "/home/geometre/.config/pyralis/registre");
}

} // namespace
} // namespace pyr
