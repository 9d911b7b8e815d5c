#include "host/PyrAppModul.h"

#include "host/CommandTable.h"
#include "host/HostTexts.h"
#include "host/ServicesLookup.h"
#include "hostrt/HostRuntime.h"

namespace pyr::host {

namespace {
CPyrAppModul* g_app = nullptr;
}

CPyrAppModul* TheApp() {
    return g_app;
}

void SetTheApp(CPyrAppModul* app) {
    g_app = app;
}

int ModuleEntryPoint(int message, void* packet) {
    if (!g_app) return AcRx::kRetError;
    return g_app->OnMessage(message, packet);
}

CPyrAppModul::CPyrAppModul() : m_appName(kAppName) {}

CPyrAppModul::~CPyrAppModul() = default;

int CPyrAppModul::OnMessage(int message, void* packet) {
    switch (message) {
    case AcRx::kInitAppMsg:
        m_appId = packet;
        acrxDynamicLinker()->unlockApplication(m_appId);
        acrxDynamicLinker()->registerAppMDIAware(m_appId);
        return Init() ? AcRx::kRetOK : AcRx::kRetError;
    case AcRx::kUnloadAppMsg:
        Uninit();
        return AcRx::kRetOK;
    case AcRx::kLoadDwgMsg:
        if (!m_dataManager.Knows(packet)) m_dataManager.Register(packet);
        OnDocument();
        return AcRx::kRetOK;
    case AcRx::kUnloadDwgMsg:
        OnDocument();
        return AcRx::kRetOK;
    default:
        return AcRx::kRetOK;
    }
}

int CPyrAppModul::Init() {
    CPyrMainServices* services = MainServices();
    if (!services) return 0;
    services->RegisterModule(m_appName, m_configuration);
    services->InstallToolbar(kToolbarGroup, m_appName);
    services->ShowToolbar(kToolbarGroup, true);
    if (RegisterCommands()) return 1;
    // A host that refuses one of the commands gets none: nothing of the module is left behind.
    UnregisterCommands();
    services->RemoveToolbar(kToolbarGroup);
    services->UnregisterModule(m_appName);
    return 0;
}

void CPyrAppModul::Uninit() {
    UnregisterCommands();
    // The services are not looked up (nor loaded) again on the way out: when they are already gone,
    // there is nothing left to take leave of.
    if (!acrxServiceIsRegistered(kMainServicesName)) return;
    if (CPyrMainServices* services = MainServices()) {
        services->ShowToolbar(kToolbarGroup, false);
        services->RemoveToolbar(kToolbarGroup);
        services->UnregisterModule(m_appName);
    }
}

void CPyrAppModul::OnDocument() {}

void* CPyrAppModul::AppId() const {
    return m_appId;
}

} // namespace pyr::host
