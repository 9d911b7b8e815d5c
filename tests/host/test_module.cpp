// The module PyrCalTopo15.arx as its host sees it: loaded through the dynamic linker, with the real
// services module beside it, its commands run from the host's command stack.
#include "HostTestSupport.h"
#include "host/CommandTable.h"
#include "settings/ParamStore.h"

#include <set>

namespace {

using pyr::host::kCommandGroup;
using pyr::host::kToolbarGroup;

const char* const kModule = "PyrCalTopo15.arx";

class Module : public ::testing::Test {
protected:
    void SetUp() override {
        pyr::SetMainWindow(&frontEnd);
        pyr::SetSupportPath({PYR_PROGRAM_DIR});
        ASSERT_TRUE(acrxDynamicLinker()->loadModule(ProgramFile(kModule)))
            << acrxDynamicLinker()->lastError();
    }
    void TearDown() override {
        acrxDynamicLinker()->unloadModule(kModule);
        acrxDynamicLinker()->unloadAll();
        pyr::SetMainWindow(nullptr);
        pyr::SetSupportPath({});
        pyr::ResetSysVars();
    }

    bool Run(const char* name) { return acedRegCmds()->runCommand(name); }

    std::vector<std::string> Group() const {
        std::vector<std::string> names;
        for (const AcEdCommand& command : acedRegCmds()->commands())
            if (command.group == kCommandGroup) names.push_back(command.globalName + " " + command.localName);
        return names;
    }

    TempDir dir;
    ScopedEnv params{"PYRALIS_PARAMS", dir / "Pyralis.ini"};
    RecordingFrontEnd frontEnd;
};

TEST_F(Module, InitialisationLoadsTheServicesInstallsTheToolbarAndRegistersTheCommandsInOrder) {
    EXPECT_EQ(acrxDynamicLinker()->loadedModules(),
              (std::vector<std::string>{ProgramFile(kModule), ProgramFile("Pyr2000Srv.arx")}));
    ASSERT_NE(RegisteredServices(), nullptr);
    EXPECT_TRUE(RegisteredServices()->IsModuleRegistered("PyrCalTopo15"));
    EXPECT_TRUE(RegisteredServices()->IsToolbarVisible(kToolbarGroup));
    // Every command of the table, in its order; their names are those pyralis lists and runs.
    std::vector<std::string> table;
    for (const pyr::host::CommandEntry& command : pyr::host::CommandTable())
        table.push_back(std::string(command.globalName) + " " + command.localName);
    EXPECT_EQ(Group(), table);

    // Unloading takes the commands, the toolbar and the titles back.
    pyr::host::CPyrMainServices* services = RegisteredServices();
    ASSERT_TRUE(acrxDynamicLinker()->unloadModule(kModule));
    EXPECT_TRUE(Group().empty());
    EXPECT_FALSE(services->IsToolbarInstalled(kToolbarGroup));
    EXPECT_FALSE(services->IsModuleRegistered("PyrCalTopo15"));
    EXPECT_FALSE(acrxServiceIsRegistered(pyr::host::kCommandTitlesName));
}

TEST_F(Module, EachExportCommandHandsItsOwnTitleToTheServices) {
    std::set<std::string> titles;
    for (const char* name :
         {"EPoints", "EGeoBase", "ESeparat", "EColonne", "EQuendal", "ELeica", "ESpectra", "ESokkia"}) {
        ASSERT_TRUE(Run(name));
        EXPECT_EQ(RegisteredServices()->CommandTitle(), frontEnd.seen.back().title);
        titles.insert(frontEnd.seen.back().title);
    }
    EXPECT_EQ(titles.size(), 8u);
    EXPECT_TRUE(titles.count("transformation GéoBase -> format Trimble GDM"));
}

TEST_F(Module, WhileADialogRunsTheEchoAndUcsFollowingAreOffAndEverythingComesBackAfter) {
    acedSetVar("CMDECHO", "1");
    acedSetVar("UCSFOLLOW", "1");
    acedSetVar("CLAYER", "Points");
    frontEnd.layerSetByDialog = "Autre";
    ASSERT_TRUE(Run("CalculV0"));
    ASSERT_EQ(frontEnd.seen.size(), 1u);
    EXPECT_EQ(frontEnd.seen[0].cmdecho, "0");
    EXPECT_EQ(frontEnd.seen[0].ucsfollow, "0");
    EXPECT_EQ(frontEnd.seen[0].resources, "PyrCalTopo15");
    EXPECT_EQ(SysVar("CMDECHO"), "1");
    EXPECT_EQ(SysVar("UCSFOLLOW"), "1");
    EXPECT_EQ(SysVar("CLAYER"), "Points");
    EXPECT_EQ(RegisteredServices()->ResourceModule(), "");
}

TEST_F(Module, TheLastGeoBaseIsOfferedFirstUnlessAnotherIsNamed) {
    ASSERT_TRUE(
        pyr::WriteParamString(dir / "Pyralis.ini", "GeoBase", "Derniere", "/chantiers/lotissement.geo"));
    ASSERT_TRUE(Run("CalRelev"));
    frontEnd.dialogArguments = {"--geobase", "/chantiers/autre.geo"};
    ASSERT_TRUE(Run("CalRelev"));
    ASSERT_EQ(frontEnd.seen.size(), 2u);
    EXPECT_EQ(frontEnd.seen[0].geoBase, "/chantiers/lotissement.geo");
    EXPECT_FALSE(frontEnd.seen[0].geoBaseNamed);
    EXPECT_EQ(frontEnd.seen[0].paramPath, dir / "Pyralis.ini");
    EXPECT_EQ(frontEnd.seen[1].geoBase, "/chantiers/autre.geo");
    EXPECT_TRUE(frontEnd.seen[1].geoBaseNamed);
}

TEST_F(Module, TheToolbarCommandRunsNoDialogAndTheTableOfCodesBringsTheScaleServices) {
    RegisteredServices()->ShowToolbar(kToolbarGroup, false);
    ASSERT_TRUE(Run("PyrCalTopo15"));
    EXPECT_TRUE(RegisteredServices()->IsToolbarVisible(kToolbarGroup));
    EXPECT_TRUE(frontEnd.seen.empty());

    EXPECT_FALSE(acrxServiceIsRegistered(pyr::host::kScaleServicesName));
    ASSERT_TRUE(Run("CalTabCode"));
    EXPECT_TRUE(acrxServiceIsRegistered(pyr::host::kScaleServicesName));
}

} // namespace
