// Real modules (tests/hostrt/module) loaded through the dynamic linker; they write down what they receive
// in a journal that the test puts in the service dictionary.
#include "TestSupport.h"
#include "hostrt/HostRuntime.h"
#include "module/TestJournal.h"

#include <gtest/gtest.h>

namespace {

using Events = std::vector<std::string>;

class Modules : public ::testing::Test {
protected:
    void SetUp() override { acrxServiceDictionary()->atPut(kJournalName, &journal); }
    void TearDown() override {
        linker->unloadAll();
        acrxServiceDictionary()->remove(kJournalName);
    }

    TestService* Service(const char* module) {
        return static_cast<TestService*>(
            acrxServiceDictionary()->at(std::string("PyrTestService ") + module));
    }

    TestJournal journal;
    AcRxDynamicLinker* linker = acrxDynamicLinker();
};

TEST_F(Modules, LifeOfAModuleFromLoadToUnload) {
    ASSERT_TRUE(linker->loadModule(PYR_TEST_MODULE_A)) << linker->lastError();
    EXPECT_EQ(journal.events, Events{"A 1"});
    EXPECT_EQ(linker->loadedModules(), Events{PYR_TEST_MODULE_A});

    // Its service, registered during the initialisation, knows the application id it was given.
    ASSERT_TRUE(acrxServiceIsRegistered("PyrTestService A"));
    void* appId = Service("A")->appId;
    EXPECT_TRUE(linker->isAppMDIAware(appId));
    EXPECT_FALSE(linker->isApplicationLocked(appId));

    int drawing = 0;
    linker->sendDocumentMessage(AcRx::kLoadDwgMsg, &drawing);
    linker->sendDocumentMessage(AcRx::kUnloadDwgMsg, &drawing);
    const std::string packet = std::to_string(reinterpret_cast<std::uintptr_t>(&drawing));
    EXPECT_EQ(journal.events, (Events{"A 1", "A 3 " + packet, "A 4 " + packet}));

    // A second load of the same file is no second module.
    EXPECT_TRUE(linker->loadModule(PYR_TEST_MODULE_A));
    EXPECT_EQ(journal.events.size(), 3u);

    // Unloaded by its bare file name, it hears message 2.
    const std::string bare = std::filesystem::path(PYR_TEST_MODULE_A).filename().string();
    ASSERT_TRUE(linker->unloadModule(bare));
    EXPECT_EQ(journal.events.back(), "A 2");
    EXPECT_TRUE(linker->loadedModules().empty());
    EXPECT_FALSE(linker->isAppMDIAware(appId)); // the id means nothing any more
    EXPECT_FALSE(linker->unloadModule(bare));
}

TEST_F(Modules, FilesThatAreNoModulesAndModulesThatRefuseTheirInitialisationAreNotKept) {
    TempDir dir;
    WriteBytes(dir / "texte.arx", "pas une bibliothèque");
    journal.refuseInit = true;
    for (const std::string& path : {dir / "absent.arx", dir / "texte.arx", std::string(PYR_HOSTRT_LIBRARY),
                                    std::string(PYR_TEST_MODULE_A)}) {
        EXPECT_FALSE(linker->loadModule(path)) << path;
        EXPECT_FALSE(linker->lastError().empty()) << path;
    }
    EXPECT_EQ(journal.events, Events{"A 1"}); // and no message 2 to the module that refused
    EXPECT_TRUE(linker->loadedModules().empty());
}

TEST_F(Modules, ALockedModuleStaysUntilTheHostShutsDown) {
    journal.stayLocked = true;
    ASSERT_TRUE(linker->loadModule(PYR_TEST_MODULE_A));
    EXPECT_TRUE(linker->isApplicationLocked(Service("A")->appId));
    EXPECT_FALSE(linker->unloadModule(PYR_TEST_MODULE_A));
    EXPECT_EQ(journal.events, Events{"A 1"});
    linker->unloadAll();
    EXPECT_EQ(journal.events, (Events{"A 1", "A 2"}));
}

TEST_F(Modules, AModuleLoadsItsDependencyWhoseCommandsComeFirstAndAnswerToEitherNameInAnyCase) {
    journal.loadOnInit = PYR_TEST_MODULE_B;
    ASSERT_TRUE(linker->loadModule(PYR_TEST_MODULE_A)) << linker->lastError();
    EXPECT_EQ(linker->loadedModules(), (Events{PYR_TEST_MODULE_A, PYR_TEST_MODULE_B}));
    ASSERT_TRUE(acrxServiceIsRegistered("PyrTestService A") && acrxServiceIsRegistered("PyrTestService B"));
    EXPECT_NE(Service("A")->appId, Service("B")->appId);
    EXPECT_TRUE(linker->isAppMDIAware(Service("A")->appId));

    // B registered its commands within A's initialisation, before A registered its own.
    Events order;
    for (const AcEdCommand& command : acedRegCmds()->commands())
        order.push_back(command.group + " " + command.globalName + " " + command.localName);
    EXPECT_EQ(order, (Events{"PYR_TEST_B PyraZetaB ZetaB", "PYR_TEST_B PyraAlphaB AlphaB",
                             "PYR_TEST_B PyraMuB MuB", "PYR_TEST_A PyraZetaA ZetaA",
                             "PYR_TEST_A PyraAlphaA AlphaA", "PYR_TEST_A PyraMuA MuA"}));
    for (const char* name : {"PyraMuA", "pyramua", "MUA", "alphaB"})
        EXPECT_TRUE(acedRegCmds()->runCommand(name)) << name;
    EXPECT_FALSE(acedRegCmds()->runCommand("PyraMu"));

    linker->sendDocumentMessage(AcRx::kLoadDwgMsg, nullptr);
    linker->unloadAll(); // the last loaded first
    EXPECT_EQ(journal.events,
              (Events{"A 1", "B 1", "A Mu", "A Mu", "A Mu", "B Alpha", "A 3 0", "B 3 0", "B 2", "A 2"}));
}

} // namespace
