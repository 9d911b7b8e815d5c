// The services module looked for in a real folder tree: a host's working folder "Travail" with the
// installation's "Programmes" beside it or inside it.
#include "HostTestSupport.h"
#include "host/ServicesLookup.h"

namespace {

namespace fs = std::filesystem;
using pyr::host::GetMainServices;
using pyr::host::kMainServicesModule;
using pyr::host::kMainServicesName;

class ServicesLookup : public ::testing::Test {
protected:
    void SetUp() override {
        fs::create_directories(dir.Root() / "Travail");
        fs::create_directories(dir.Root() / "Programmes");
        pyr::SetSupportPath({dir / "Travail"});
        pyr::SetAbortHandler([this](const std::string& message) { aborts.push_back(message); });
    }
    void TearDown() override {
        acrxDynamicLinker()->unloadAll();
        pyr::SetAbortHandler({});
        pyr::SetSupportPath({});
    }

    // A copy of a built module under the services module's name.
    std::string Install(const std::string& folder, const std::string& builtModule) {
        fs::create_directories(dir.Root() / folder);
        const std::string path = (dir.Root() / folder / kMainServicesModule).string();
        fs::copy_file(builtModule, path);
        return path;
    }

    std::vector<std::string> Loaded() const { return acrxDynamicLinker()->loadedModules(); }

    TempDir dir;
    std::vector<std::string> aborts;
};

const std::string kServices = ProgramFile(kMainServicesModule);

// The bare name first, then the programs folder beside the working folder, then the one inside it.
TEST_F(ServicesLookup, TheBareNameThenTheProgramsFolderBesideThenInsideTheWorkingFolder) {
    const std::string bare = Install("Travail", kServices);
    const std::string sibling = Install("Programmes", kServices);
    const std::string child = Install("Travail/Programmes", kServices);
    for (const std::string& expected : {bare, sibling, child}) {
        AcRxObject* services = GetMainServices(kMainServicesModule, kMainServicesName);
        ASSERT_NE(services, nullptr) << expected;
        EXPECT_EQ(services, acrxServiceDictionary()->at(kMainServicesName));
        EXPECT_EQ(Loaded(), std::vector<std::string>{expected});
        acrxDynamicLinker()->unloadAll();
        fs::remove(expected);
    }
    EXPECT_TRUE(aborts.empty());
}

TEST_F(ServicesLookup, ARegisteredServiceIsUsedWithoutSearchOrLoad) {
    Install("Travail", kServices);
    AcRxObject already;
    acrxServiceDictionary()->atPut(kMainServicesName, &already);
    EXPECT_EQ(GetMainServices(kMainServicesModule, kMainServicesName), &already);
    EXPECT_TRUE(Loaded().empty());
    acrxServiceDictionary()->remove(kMainServicesName);
}

TEST_F(ServicesLookup, EachFailureAbortsWithItsMessage) {
    // Nowhere to be found.
    EXPECT_EQ(GetMainServices(kMainServicesModule, kMainServicesName), nullptr);
    // Found, but not a module.
    WriteBytes(dir / "Programmes/Pyr2000Srv.arx", "ceci n'est pas un module");
    EXPECT_EQ(GetMainServices(kMainServicesModule, kMainServicesName), nullptr);
    // A module, but one that registers another service.
    fs::remove(dir / "Programmes/Pyr2000Srv.arx");
    Install("Programmes", PYR_TEST_MODULE_A);
    EXPECT_EQ(GetMainServices(kMainServicesModule, kMainServicesName), nullptr);

    EXPECT_EQ(aborts, (std::vector<std::string>{"Impossible de trouver le module <Pyr2000Srv.arx>!!!",
                                                "Impossible de charger le module <Pyr2000Srv.arx>!!!",
                                                "Pas de service <PyralisMainServices r17.2>\n"
                                                "enregistré par le module <Pyr2000Srv.arx>!!!"}));
}

} // namespace
