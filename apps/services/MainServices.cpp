// The main services module "Pyr2000Srv.arx": registers "PyralisMainServices r17.2", which gives the
// modules of the suite their parent window, their toolbar, the current parameter file, the installation
// folder and the title of the running command.
#include "ServiceModule.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"

#include <dlfcn.h>
#include <filesystem>
#include <map>
#include <set>

namespace {

using namespace pyr::host;

struct Toolbar {
    std::string appName;
    bool visible = false;
};

class MainServices : public CPyrMainServices {
public:
    void RegisterModule(std::string_view appName, std::string_view configuration) override {
        m_modules[std::string(appName)] = std::string(configuration);
    }
    void UnregisterModule(std::string_view appName) override { m_modules.erase(std::string(appName)); }
    bool IsModuleRegistered(std::string_view appName) const override {
        return m_modules.count(std::string(appName)) != 0;
    }

    void SwitchToModuleResources(std::string_view appName) override { m_resources = appName; }
    void RestoreHostResources() override { m_resources.clear(); }
    std::string ResourceModule() const override { return m_resources; }

    // The host's window; a host without one gets the module's own console.
    pyr::ui::FrontEnd* GetParentWindow() override {
        if (pyr::ui::FrontEnd* window = adsw_acadMainWnd()) return window;
        return &pyr::ui::ApplicationFrontEnd();
    }

    bool InstallToolbar(std::string_view menuGroup, std::string_view appName) override {
        m_toolbars[std::string(menuGroup)].appName = appName;
        return true;
    }
    void ShowToolbar(std::string_view menuGroup, bool show) override {
        auto toolbar = m_toolbars.find(std::string(menuGroup));
        if (toolbar != m_toolbars.end()) toolbar->second.visible = show;
    }
    void RemoveToolbar(std::string_view menuGroup) override { m_toolbars.erase(std::string(menuGroup)); }
    bool IsToolbarInstalled(std::string_view menuGroup) const override {
        return m_toolbars.count(std::string(menuGroup)) != 0;
    }
    bool IsToolbarVisible(std::string_view menuGroup) const override {
        auto toolbar = m_toolbars.find(std::string(menuGroup));
        return toolbar != m_toolbars.end() && toolbar->second.visible;
    }

    std::string GetParamFilePath() const override { return pyr::DefaultParamFilePath(); }

    // The folder this module was loaded from: the installation's programs, beside its "Config".
    std::string GetConfigFolder() const override {
        Dl_info info{};
        if (!dladdr(reinterpret_cast<void*>(&acrxEntryPointOfThisModule), &info) || !info.dli_fname)
            return {};
        std::string folder = std::filesystem::path(info.dli_fname).parent_path().string();
        if (folder.empty() || folder.back() != '/') folder += '/';
        return folder;
    }

    void SetCommandTitle(std::string_view title) override { m_title = title; }
    std::string CommandTitle() const override { return m_title; }

    static void acrxEntryPointOfThisModule() {}

private:
    std::map<std::string, std::string> m_modules;
    std::map<std::string, Toolbar> m_toolbars;
    std::string m_resources;
    std::string m_title;
};

MainServices g_services;

} // namespace

extern "C" __attribute__((visibility("default"))) int acrxEntryPoint(int message, void* packet) {
    return ServiceModuleEntryPoint(message, packet, kMainServicesName, &g_services);
}

extern "C" __attribute__((visibility("default"))) int acrxGetApiVersion() {
    return AcRx::kApiVersion;
}
