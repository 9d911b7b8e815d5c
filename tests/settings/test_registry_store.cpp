#include "SettingsTestSupport.h"
#include "settings/ParamStore.h"
#include "settings/RegistryStore.h"
#include "settings/SettingsMessages.h"

#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr std::string_view kOptions = "Software\\Pyralis\\Calculs Topo\\Options_Corrections";

class RegistryStore : public test::SettingsTest {
protected:
    std::string HiveFile(std::string_view root) const {
        return folder / ("registre/" + std::string(root) + ".ini");
    }
};

TEST_F(RegistryStore, RootNamesAreWholeTextsWithoutRegardToCase) {
    const std::pair<std::string_view, RegistryRoot> roots[] = {
        {"HKEY_LOCAL_MACHINE", RegistryRoot::LocalMachine},
        {"HKEY_CURRENT_USER", RegistryRoot::CurrentUser},
        {"HKEY_CLASSES_ROOT", RegistryRoot::ClassesRoot},
        {"HKEY_USERS", RegistryRoot::Users},
        {"HKEY_PERFORMANCE_DATA", RegistryRoot::PerformanceData},
        {"HKEY_CURRENT_CONFIG", RegistryRoot::CurrentConfig},
        {"HKEY_DYN_DATA", RegistryRoot::DynData},
    };
    for (const auto& [name, root] : roots) {
        EXPECT_EQ(RegistryRootFromName(name), root) << name;
        std::string lower(name);
        for (char& c : lower)
            c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
        EXPECT_EQ(RegistryRootFromName(lower), root) << lower;
        EXPECT_EQ(RegistryRootName(root), name);
    }
    EXPECT_FALSE(RegistryRootFromName("HKEY_CURRENT_USER\\Software"));
    EXPECT_FALSE(RegistryRootFromName("HKEY_CURRENT_USER "));
    EXPECT_FALSE(RegistryRootFromName("HKCU"));
    EXPECT_FALSE(RegistryRootFromName(""));
    EXPECT_FALSE(RegistryRootFromName(kNullParamPath));
}

TEST_F(RegistryStore, TypedValuesGoToTheHiveFileOfTheirRoot) {
    EXPECT_TRUE(WriteParamDouble("hkey_current_user", kOptions, "RayonTerre", 6378.137));
    EXPECT_TRUE(WriteParamInt("HKEY_CURRENT_USER", kOptions, "Refraction", 13));
    EXPECT_TRUE(WriteParamString("HKEY_LOCAL_MACHINE", "Software\\Pyralis", "Dossier", "/opt/pyralis/"));
    EXPECT_EQ(
        ReadBytes(HiveFile("HKEY_CURRENT_USER")),
        "[Software\\Pyralis\\Calculs Topo\\Options_Corrections]\nRayonTerre=6378.137000\nRefraction=13\n");
    EXPECT_EQ(ReadBytes(HiveFile("HKEY_LOCAL_MACHINE")), "[Software\\Pyralis]\nDossier=/opt/pyralis/\n");

    double radius = 0;
    EXPECT_TRUE(ReadParamDouble("Hkey_Current_User", kOptions, "RayonTerre", 0, 0, 1e4, radius));
    EXPECT_EQ(radius, 6378.137);
    // Key paths and value names ignore case, as the registry's do.
    int refraction = 0;
    EXPECT_TRUE(ReadParamInt("HKEY_CURRENT_USER", "SOFTWARE\\pyralis\\CALCULS TOPO\\options_corrections",
                             "REFRACTION", 0, 0, 100, refraction));
    EXPECT_EQ(refraction, 13);
    std::string folder;
    EXPECT_TRUE(ReadParamString("HKEY_LOCAL_MACHINE", "Software\\Pyralis", "Dossier", "", folder));
    EXPECT_EQ(folder, "/opt/pyralis/");
    // Another root is another hive.
    EXPECT_FALSE(ReadParamString("HKEY_USERS", "Software\\Pyralis", "Dossier", "rien", folder));
    EXPECT_EQ(folder, "rien");
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(RegistryStore, TypedReadsOfMissingValuesAreSilentAndGiveTheDefault) {
    WriteParamString("HKEY_CURRENT_USER", kOptions, "Vide", "");
    std::string text;
    EXPECT_FALSE(ReadParamString("HKEY_CURRENT_USER", "Absente", "Cle", "défaut", text));
    EXPECT_EQ(text, "défaut");
    int number = -1;
    // Found but empty: nothing delivered, and the empty text reads as 0.
    EXPECT_FALSE(ReadParamInt("HKEY_CURRENT_USER", kOptions, "Vide", 7, -10, 10, number));
    EXPECT_EQ(number, 0);
    // Absent: nothing delivered, the default stays.
    EXPECT_FALSE(ReadParamInt("HKEY_CURRENT_USER", kOptions, "Absente", 7, -10, 10, number));
    EXPECT_EQ(number, 7);
    double real = -1;
    EXPECT_FALSE(ReadParamDouble("HKEY_CLASSES_ROOT", kOptions, "Absente", 150.5, 0, 100, real));
    EXPECT_EQ(real, 100.0);
    EXPECT_FALSE(ReadParamString("HKEY_CURRENT_USER", "", "Cle", "défaut", text));
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(RegistryStore, ReadsReportEachFailureWhenAsked) {
    WriteParamInt("HKEY_CURRENT_USER", kOptions, "Refraction", 13);
    ui::ScriptedFrontEnd parent;
    std::string value = "inchangé";
    EXPECT_FALSE(ReadRegistryValue("HKEY_NOWHERE", kOptions, "Refraction", value, true, &parent));
    EXPECT_FALSE(ReadRegistryValue("HKEY_CURRENT_USER", "", "Refraction", value, true, &parent));
    EXPECT_FALSE(
        ReadRegistryValue("HKEY_CURRENT_USER", "Software\\Absente", "Refraction", value, true, &parent));
    EXPECT_FALSE(ReadRegistryValue("HKEY_USERS", kOptions, "Refraction", value, true, &parent));
    EXPECT_FALSE(ReadRegistryValue("HKEY_CURRENT_USER", kOptions, "Absente", value, true, &parent));
    EXPECT_EQ(value, "inchangé");
    EXPECT_TRUE(ReadRegistryValue("HKEY_CURRENT_USER", kOptions, "Refraction", value, true, &parent));
    EXPECT_EQ(value, "13");

    std::vector<std::string> texts;
    for (const auto& message : parent.messages) {
        EXPECT_EQ(message.icon, ui::kIconError);
        EXPECT_EQ(message.caption, "PYRALIS");
        texts.push_back(message.text);
    }
    EXPECT_EQ(
        texts,
        (std::vector<std::string>{
            "Code incorrect pour la clef d'accès aux registres !",
            "Le nom de la clef de registre à ouvrir doit être indiqué !",
            "Software\\Absente : \naccès à la clef dans la base de registre impossible (code 2) !",
            std::string(kOptions) + " : \naccès à la clef dans la base de registre impossible (code 2) !",
            "Impossible de lire le paramètre 'Absente' dans la clef\n" + std::string(kOptions) +
                " !\n(Code d'erreur 2)",
        }));
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(RegistryStore, WriteCreatesTheKeyAndTheHiveFolder) {
    const std::string nested = folder / "profil/pyralis/registre";
    ScopedEnv hive("PYRALIS_REGISTRE", nested);
    EXPECT_TRUE(WriteRegistryValue("HKEY_CURRENT_USER", "Software\\Pyralis\\Nouvelle", "Cle", "1", true));
    EXPECT_EQ(ReadBytes(nested + "/HKEY_CURRENT_USER.ini"), "[Software\\Pyralis\\Nouvelle]\nCle=1\n");
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(RegistryStore, WriteFailuresAreReportedWithTheErrorIcon) {
    // The hive's folder cannot be made: a file holds its name.
    const std::string blocked = folder / "bloque";
    WriteBytes(blocked, "");
    ScopedEnv hive("PYRALIS_REGISTRE", blocked + "/registre");
    EXPECT_FALSE(WriteParamInt("HKEY_CURRENT_USER", kOptions, "Refraction", 13));
    EXPECT_FALSE(WriteParamInt("HKEY_CURRENT_USER", kOptions, "Refraction", 14));
    EXPECT_FALSE(WriteRegistryValue("HKEY_CURRENT_USER", kOptions, "Refraction", "13", false));
    EXPECT_FALSE(WriteRegistryValue("HKEY_BAD", kOptions, "Refraction", "13", true));
    EXPECT_FALSE(WriteRegistryValue("HKEY_CURRENT_USER", "", "Refraction", "13", true));

    ASSERT_EQ(frontEnd.messages.size(), 4u);
    for (const auto& message : frontEnd.messages)
        EXPECT_EQ(message.icon, ui::kIconError);
    // Every failing write is reported: the once-per-file memory is the file form's.
    EXPECT_EQ(frontEnd.messages[0].text, std::string(kOptions) +
                                             " : \nimpossible de créer la clef dans la base de registres !\n"
                                             "(Code d'erreur 20) !");
    EXPECT_EQ(frontEnd.messages[1].text, frontEnd.messages[0].text);
    EXPECT_EQ(frontEnd.messages[2].text, kMsgRegistryBadRoot);
    EXPECT_EQ(frontEnd.messages[3].text, kMsgRegistryNoKeyName);
}

TEST_F(RegistryStore, ValueThatCannotBeSetIsNamedInTheReport) {
    // The hive file's place is taken by a folder: the key cannot be read, then cannot be created.
    std::filesystem::create_directories(HiveFile("HKEY_USERS"));
    EXPECT_FALSE(WriteParamString("HKEY_USERS", "Software", "Cle", "x"));
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text,
              "Software : \nimpossible de créer la clef dans la base de registres !\n(Code d'erreur 21) !");

    // An existing key whose hive cannot be replaced: the value is named.
    if (geteuid() == 0) GTEST_SKIP() << "root writes in read-only folders";
    WriteParamString("HKEY_CURRENT_USER", "Software", "Cle", "x");
    ASSERT_EQ(chmod((folder / "registre").c_str(), 0555), 0);
    EXPECT_FALSE(WriteParamString("HKEY_CURRENT_USER", "Software", "Cle", "y"));
    chmod((folder / "registre").c_str(), 0755);
    ASSERT_EQ(frontEnd.messages.size(), 2u);
    EXPECT_EQ(frontEnd.messages[1].text,
              "Impossible d'enregistrer le paramètre 'Cle' dans la clef\nSoftware !\n(Code d'erreur 13)");
}

TEST_F(RegistryStore, LongValuesAreCutToTheRegistryBuffer) {
    const std::string longValue(10000, 'r');
    WriteParamString("HKEY_CURRENT_USER", kOptions, "Long", longValue);
    std::string text;
    EXPECT_TRUE(ReadParamString("HKEY_CURRENT_USER", kOptions, "Long", "", text));
    EXPECT_EQ(text, std::string(kRegistryValueBuffer - 1, 'r'));
}

} // namespace
} // namespace pyr
