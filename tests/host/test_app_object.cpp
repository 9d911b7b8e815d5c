// The application object and the command table, taken directly (without loading the module).
#include "HostTestSupport.h"
#include "host/CommandContext.h"
#include "host/PyrAppModul.h"

namespace {

using namespace pyr::host;

// Without an application object every message is an error; with one, messages it does not know are
// answered zero and change nothing.
TEST(AppObject, UnknownMessagesAreAnsweredZeroAndChangeNothing) {
    ASSERT_EQ(TheApp(), nullptr);
    for (int message : {1, 2, 3, 4, 42})
        EXPECT_EQ(ModuleEntryPoint(message, nullptr), AcRx::kRetError) << message;
    CPyrAppModul app;
    SetTheApp(&app);
    const size_t commands = acedRegCmds()->commands().size();
    const size_t services = acrxServiceDictionary()->numEntries();
    for (int message : {0, 5, 6, 99, -1})
        EXPECT_EQ(ModuleEntryPoint(message, &app), AcRx::kRetOK) << message;
    EXPECT_EQ(acedRegCmds()->commands().size(), commands);
    EXPECT_EQ(acrxServiceDictionary()->numEntries(), services);
    EXPECT_EQ(app.DataManager().Count(), 0u);
    SetTheApp(nullptr);
}

TEST(AppObject, EachDrawingIsKnownOnceAndClosingItIsAnswered) {
    CPyrAppModul app;
    int first = 0, second = 0;
    EXPECT_EQ(app.OnMessage(AcRx::kLoadDwgMsg, &first), AcRx::kRetOK);
    EXPECT_EQ(app.OnMessage(AcRx::kLoadDwgMsg, &first), AcRx::kRetOK);
    EXPECT_EQ(app.OnMessage(AcRx::kLoadDwgMsg, &second), AcRx::kRetOK);
    EXPECT_EQ(app.OnMessage(AcRx::kUnloadDwgMsg, &first), AcRx::kRetOK);
    EXPECT_EQ(app.DataManager().Count(), 2u);
    EXPECT_TRUE(app.DataManager().Knows(&second));
}

TEST(AppObject, AFailedInitialisationIsAnErrorAndRegistersNothing) {
    std::vector<std::string> aborts;
    pyr::SetAbortHandler([&](const std::string& message) { aborts.push_back(message); });
    pyr::SetSupportPath({});
    CPyrAppModul app;
    int id = 7;
    EXPECT_EQ(app.OnMessage(AcRx::kInitAppMsg, &id), AcRx::kRetError);
    EXPECT_EQ(app.AppId(), &id);
    EXPECT_EQ(aborts, std::vector<std::string>{"Impossible de trouver le module <Pyr2000Srv.arx>!!!"});
    EXPECT_EQ(acedRegCmds()->lookupCmd("CalInter"), nullptr);
    pyr::SetAbortHandler({});
}

// The echo and the UCS following during a dialog are seen through the module's tests; here, what only
// the context itself decides: one record, AFLAGS put back, the destructor closing.
TEST(CommandContext, RecordsOnceAndPutsTheDrawingBackEvenWhenLeftOpen) {
    pyr::ResetSysVars();
    acedSetVar("CLAYER", "Stations");
    acedSetVar("AFLAGS", "2");
    {
        CCmdContext context;
        context.Open();
        acedSetVar("AFLAGS", "0");
        context.Close();
        EXPECT_EQ(SysVar("AFLAGS"), "2");
        acedSetVar("CLAYER", "Nouveau");
        context.Open();
        EXPECT_EQ(context.Recorded("CLAYER"), "Stations");
    }
    EXPECT_EQ(SysVar("CLAYER"), "Stations");
    pyr::ResetSysVars();
}

} // namespace
