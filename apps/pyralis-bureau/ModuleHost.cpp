#include "ModuleHost.h"

#include "core/Strings.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "hostrt/HostRuntime.h"
#include "settings/LastGeoBase.h"

namespace pyr::bureau {

namespace {
int g_drawing = 0; // the one drawing of this host
} // namespace

bool ModuleHost::Load(const std::string& programFolder) {
    if (m_loaded) return true;
    SetSupportPath({programFolder});
    std::string module;
    if (acedFindFile(host::kModuleFile, module) != RTNORM || !acrxDynamicLinker()->loadModule(module)) {
        m_failure =
            Sprintf(host::kMsgModuleNotLoaded, host::kModuleFile) + "\n" + acrxDynamicLinker()->lastError();
        return false;
    }
    acrxDynamicLinker()->sendDocumentMessage(AcRx::kLoadDwgMsg, &g_drawing);
    m_loaded = true;
    return true;
}

void ModuleHost::Unload() {
    if (!m_loaded) return;
    acrxDynamicLinker()->sendDocumentMessage(AcRx::kUnloadDwgMsg, &g_drawing);
    acrxDynamicLinker()->unloadAll();
    m_loaded = false;
}

std::vector<CommandInfo> ModuleHost::Commands() const {
    const auto* titles =
        static_cast<const host::CPyrCommandTitles*>(acrxServiceDictionary()->at(host::kCommandTitlesName));
    std::vector<CommandInfo> commands;
    for (const AcEdCommand& command : acedRegCmds()->commands()) {
        if (command.group != host::kCommandGroup) continue;
        CommandInfo info{command.globalName, command.localName, {}, true};
        if (titles) {
            info.title = titles->Title(command.globalName);
            info.available = titles->Available(command.globalName);
        }
        commands.push_back(std::move(info));
    }
    return commands;
}

bool ModuleHost::IsCommand(const std::string& name) const {
    return acedRegCmds()->lookupCmd(name) != nullptr;
}

bool ModuleHost::Run(const std::string& name) const {
    return acedRegCmds()->runCommand(name);
}

host::CPyrMainServices* ModuleHost::Services() const {
    return static_cast<host::CPyrMainServices*>(acrxServiceDictionary()->at(host::kMainServicesName));
}

std::string ModuleHost::ParamPath() const {
    const host::CPyrMainServices* services = Services();
    return services ? services->GetParamFilePath() : std::string();
}

std::string ModuleHost::LastGeoBase() const {
    const std::string paramPath = ParamPath();
    return paramPath.empty() ? std::string() : ReadLastGeoBase(paramPath);
}

} // namespace pyr::bureau
