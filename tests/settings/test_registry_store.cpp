#include "SettingsTestSupport.h"
#include "settings/ParamStore.h"
#include "settings/RegistryStore.h"

namespace pyr {
namespace {

using RegistryStore = test::SettingsTest;

constexpr std::string_view kOptions = "Software\\Pyralis\\Options";

TEST_F(RegistryStore, ARootNameWithMoreTextIsAFileAndNotARegistryKey) {
    const auto previous = std::filesystem::current_path();
    std::filesystem::current_path(folder.Root());
    const bool written = WriteParamInt("HKEY_CURRENT_USER\\Software", "Options", "Cle", 5);
    std::filesystem::current_path(previous);
    EXPECT_TRUE(written);
    EXPECT_EQ(ReadBytes(folder / "HKEY_CURRENT_USER\\Software"), "[Options]\nCle=5\n");
    EXPECT_FALSE(std::filesystem::exists(folder / "registre"));
}

TEST_F(RegistryStore, TypedValuesRoundTripInTheHiveFileOfTheirRootAndMissingOnesReadSilently) {
    const std::string hive = folder / "registre"; // made on the first write
    EXPECT_TRUE(WriteParamDouble("hkey_current_user", kOptions, "RayonTerre", 6378.137));
    EXPECT_TRUE(WriteParamInt("HKEY_CURRENT_USER", kOptions, "Refraction", 13));
    EXPECT_TRUE(WriteParamString("HKEY_LOCAL_MACHINE", "Software\\Pyralis", "Vide", ""));
    EXPECT_EQ(ReadBytes(hive + "/HKEY_CURRENT_USER.ini"),
              "[Software\\Pyralis\\Options]\nRayonTerre=6378.137000\nRefraction=13\n");
    EXPECT_EQ(ReadBytes(hive + "/HKEY_LOCAL_MACHINE.ini"), "[Software\\Pyralis]\nVide=\n");

    double real = 0;
    // Root names, key paths and value names ignore case, as the registry's do.
    EXPECT_TRUE(
        ReadParamDouble("Hkey_Current_User", "SOFTWARE\\pyralis\\OPTIONS", "RAYONTERRE", 0, 0, 1e4, real));
    EXPECT_EQ(real, 6378.137);

    // Missing: nothing delivered, no message, the default (brought within the limits) stays.
    std::string text;
    EXPECT_FALSE(ReadParamString("HKEY_USERS", kOptions, "Refraction", "défaut", text)); // another hive
    EXPECT_EQ(text, "défaut");
    EXPECT_FALSE(ReadParamDouble("HKEY_CURRENT_USER", "Absente", "RayonTerre", 150.5, 0, 100, real));
    EXPECT_EQ(real, 100.0);
    EXPECT_TRUE(frontEnd.messages.empty());

    // Long values are cut to the registry's buffer.
    WriteParamString("HKEY_CURRENT_USER", kOptions, "Long", std::string(10000, 'r'));
    EXPECT_TRUE(ReadParamString("HKEY_CURRENT_USER", kOptions, "Long", "", text));
    EXPECT_EQ(text, std::string(kRegistryValueBuffer - 1, 'r'));
}

TEST_F(RegistryStore, ReadsReportEachFailureWhenAsked) {
    WriteParamInt("HKEY_CURRENT_USER", kOptions, "Refraction", 13);
    ui::ScriptedFrontEnd parent;
    std::string value = "inchangé";
    EXPECT_FALSE(ReadRegistryValue("HKEY_NOWHERE", kOptions, "Refraction", value, true, &parent));
    EXPECT_FALSE(ReadRegistryValue("HKEY_CURRENT_USER", "", "Refraction", value, true, &parent));
    EXPECT_FALSE(
        ReadRegistryValue("HKEY_CURRENT_USER", "Software\\Absente", "Refraction", value, true, &parent));
    EXPECT_FALSE(ReadRegistryValue("HKEY_CURRENT_USER", kOptions, "Absente", value, true, &parent));
    EXPECT_EQ(value, "inchangé");
    EXPECT_EQ(Texts(parent, ui::kIconError),
              (std::vector<std::string>{
                  "Code incorrect pour la clef d'accès aux registres !",
                  "Le nom de la clef de registre à ouvrir doit être indiqué !",
                  "Software\\Absente : \naccès à la clef dans la base de registre impossible (code 2) !",
                  "Impossible de lire le paramètre 'Absente' dans la clef\nSoftware\\Pyralis\\Options !\n"
                  "(Code d'erreur 2)"}));
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(RegistryStore, EveryFailingWriteIsReportedWithTheErrorIcon) {
    // A folder where the hive file should be: it cannot be read, so the key cannot be created.
    std::filesystem::create_directories(folder / "registre/HKEY_USERS.ini");
    EXPECT_FALSE(WriteParamString("HKEY_USERS", "Software", "Cle", "x"));
    // The hive's folder cannot be made: a file holds its name. Unlike files, every failure is reported,
    // unless the caller asks for silence.
    WriteBytes(folder / "bloque", "");
    ScopedEnv hive("PYRALIS_REGISTRE", folder / "bloque/registre");
    EXPECT_FALSE(WriteParamInt("HKEY_CURRENT_USER", "Software", "Cle", 13));
    EXPECT_FALSE(WriteParamInt("HKEY_CURRENT_USER", "Software", "Cle", 14));
    EXPECT_FALSE(WriteRegistryValue("HKEY_CURRENT_USER", "Software", "Cle", "13", false));
    const std::string cannotCreate =
        "Software : \nimpossible de créer la clef dans la base de registres !\n(Code d'erreur ";
    const std::string notAFolder = ") !\nCause : un élément du chemin n'est pas un dossier.";
    EXPECT_EQ(Texts(frontEnd, ui::kIconError),
              (std::vector<std::string>{cannotCreate + "21) !\nCause : c'est un dossier, pas un fichier.",
                                        cannotCreate + "20" + notAFolder, cannotCreate + "20" + notAFolder}));
    EXPECT_EQ(frontEnd.Failures(), 3);
}

TEST_F(RegistryStore, AHiveFileThatIsNotTextIsSetAsideWholeAndANewOneMade) {
    const std::string hive = folder / "registre/HKEY_CURRENT_USER.ini";
    std::filesystem::create_directories(folder / "registre");
    const std::string utf16 = test::BytesOf("\xFF\xFE[\0S\0]\0");
    WriteBytes(hive, utf16);
    int value = 0;
    ReadParamInt("HKEY_CURRENT_USER", "Software", "Cle", 4, 0, 10, value);
    EXPECT_EQ(value, 4);
    EXPECT_TRUE(WriteParamInt("HKEY_CURRENT_USER", "Software", "Cle", 5));
    EXPECT_EQ(ReadBytes(hive + ".illisible"), utf16);
    EXPECT_EQ(ReadBytes(hive), "[Software]\nCle=5\n");
    EXPECT_EQ(Texts(frontEnd, ui::kIconWarning).size(), 2u); // their wording is the parameter file's
    EXPECT_EQ(frontEnd.Failures(), 0);
}

class RegistryStoreAsUser : public RegistryStore {};

TEST_F(RegistryStoreAsUser, ValueThatCannotBeSetIsNamedInTheReport) {
    SKIP_WHEN_ROOT();
    WriteParamString("HKEY_CURRENT_USER", "Software", "Cle", "x");
    ASSERT_EQ(chmod((folder / "registre").c_str(), 0555), 0);
    EXPECT_FALSE(WriteParamString("HKEY_CURRENT_USER", "Software", "Cle", "y"));
    chmod((folder / "registre").c_str(), 0755);
    EXPECT_EQ(
        Texts(frontEnd, ui::kIconError),
        std::vector<std::string>{"Impossible d'enregistrer le paramètre 'Cle' dans la clef\nSoftware !\n"
                                 "(Code d'erreur 13)\nCause : accès refusé."});
    EXPECT_EQ(frontEnd.Failures(), 1);
}

} // namespace
} // namespace pyr
