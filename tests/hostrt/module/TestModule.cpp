// A module as the host sees one: an entry point that registers a service and three commands on
// initialisation and takes them back when unloaded. Built twice, as module "A" and module "B".
#include "TestJournal.h"
#include "hostrt/HostRuntime.h"

#include <cstdint>

namespace {

const std::string kName = PYR_TEST_MODULE_NAME;
const std::string kGroup = "PYR_TEST_" + kName;
const std::string kService = "PyrTestService " + kName;

TestService g_service;

void Record(const std::string& event) {
    if (TestJournal* journal = Journal()) journal->events.push_back(kName + " " + event);
}

int Init(void* appId) {
    Record("1");
    TestJournal* journal = Journal();
    if (journal && journal->refuseInit) return AcRx::kRetError;
    if (!journal || !journal->stayLocked) acrxDynamicLinker()->unlockApplication(appId);
    acrxDynamicLinker()->registerAppMDIAware(appId);
    if (journal && !journal->loadOnInit.empty() && !acrxDynamicLinker()->loadModule(journal->loadOnInit))
        return AcRx::kRetError;
    g_service.appId = appId;
    acrxServiceDictionary()->atPut(kService, &g_service);
    // Deliberately neither alphabetical nor by name length.
    for (const char* name : {"Zeta", "Alpha", "Mu"})
        acedRegCmds()->addCommand(kGroup, "Pyra" + std::string(name) + kName, std::string(name) + kName,
                                  ACRX_CMD_MODAL, [name] { Record(name); });
    return AcRx::kRetOK;
}

} // namespace

extern "C" __attribute__((visibility("default"))) int acrxEntryPoint(int message, void* packet) {
    switch (message) {
    case AcRx::kInitAppMsg:
        return Init(packet);
    case AcRx::kUnloadAppMsg:
        acedRegCmds()->removeGroup(kGroup);
        acrxServiceDictionary()->remove(kService);
        Record("2");
        return AcRx::kRetOK;
    case AcRx::kLoadDwgMsg:
    case AcRx::kUnloadDwgMsg:
        Record(std::to_string(message) + " " + std::to_string(reinterpret_cast<std::uintptr_t>(packet)));
        return AcRx::kRetOK;
    default:
        return AcRx::kRetOK;
    }
}
