// The command stack and the dictionaries on their own, without a module.
#include "hostrt/HostRuntime.h"

#include <gtest/gtest.h>

namespace {

class CommandStack : public ::testing::Test {
protected:
    void TearDown() override {
        stack->removeGroup("G1");
        stack->removeGroup("G2");
    }
    AcEdCommandStack* stack = acedRegCmds();
};

TEST_F(CommandStack, ANameIsTakenOncePerGroupWhateverItsCase) {
    ASSERT_TRUE(stack->addCommand("G1", "PyraCalInter", "CalInter", ACRX_CMD_MODAL, {}));
    EXPECT_FALSE(stack->addCommand("g1", "PYRACALINTER", "Autre", ACRX_CMD_MODAL, {}));
    EXPECT_FALSE(stack->addCommand("G1", "PyraAutre", "calinter", ACRX_CMD_MODAL, {}));
    EXPECT_FALSE(stack->addCommand("G1", "", "Vide", ACRX_CMD_MODAL, {}));
    EXPECT_FALSE(stack->addCommand("", "PyraVide", "Vide", ACRX_CMD_MODAL, {}));
    // Another group may reuse it; the first registered answers.
    ASSERT_TRUE(stack->addCommand("G2", "PyraCalInter", "CalInter", ACRX_CMD_TRANSPARENT, {}));
    EXPECT_EQ(stack->commands().size(), 2u);
    EXPECT_EQ(stack->lookupCmd("calinter")->group, "G1");
    EXPECT_TRUE(stack->removeGroup("g1"));
    EXPECT_EQ(stack->lookupCmd("calinter")->group, "G2");
    EXPECT_FALSE(stack->removeGroup("G1"));
}

TEST_F(CommandStack, GlobalNamesAnswerBeforeLocalOnes) {
    ASSERT_TRUE(stack->addCommand("G1", "Liste", "Premiere", ACRX_CMD_MODAL, {}));
    ASSERT_TRUE(stack->addCommand("G1", "PyraListe", "LISTE", ACRX_CMD_MODAL, {}));
    EXPECT_EQ(stack->lookupCmd("liste")->globalName, "Liste");
    EXPECT_EQ(stack->lookupLocalCmd("liste")->globalName, "PyraListe");
    EXPECT_EQ(stack->lookupGlobalCmd("Premiere"), nullptr);
}

TEST_F(CommandStack, AHandlerMayRemoveItsOwnGroupWhileItRuns) {
    int runs = 0;
    ASSERT_TRUE(stack->addCommand("G1", "PyraFin", "Fin", ACRX_CMD_MODAL, [&] {
        stack->removeGroup("G1");
        ++runs;
    }));
    EXPECT_TRUE(stack->runCommand("fin"));
    EXPECT_EQ(runs, 1);
    EXPECT_FALSE(stack->runCommand("fin"));
}

TEST(Dictionary, EntriesAreReplacedInPlaceAndRemovedByName) {
    AcRxDictionary dictionary;
    AcRxObject first, second, third;
    EXPECT_EQ(dictionary.atPut("Un", &first), nullptr);
    EXPECT_EQ(dictionary.atPut("Deux", &second), nullptr);
    EXPECT_EQ(dictionary.atPut("Un", &third), &first);
    EXPECT_EQ(dictionary.names(), (std::vector<std::string>{"Un", "Deux"}));
    EXPECT_EQ(dictionary.at("Un"), &third);
    EXPECT_EQ(dictionary.remove("Un"), &third);
    EXPECT_EQ(dictionary.remove("Un"), nullptr);
    EXPECT_FALSE(dictionary.has("Un"));
    EXPECT_EQ(dictionary.numEntries(), 1u);
}

} // namespace
