#include "hostrt/DynamicLinker.h"

#include <algorithm>
#include <dlfcn.h>
#include <filesystem>
#include <utility>

namespace {

std::string Slashed(std::string_view name) {
    std::string path(name);
    std::replace(path.begin(), path.end(), '\\', '/');
    return path;
}

// The path under which a module is remembered: absolute, without "." or ".." steps.
std::string ModulePath(std::string_view name) {
    const std::filesystem::path path(Slashed(name));
    std::error_code error;
    const std::filesystem::path absolute = std::filesystem::absolute(path, error);
    return (error ? path : absolute).lexically_normal().string();
}

void* AppIdPacket(std::uintptr_t appId) {
    return reinterpret_cast<void*>(appId);
}

} // namespace

// Modules stay open when the program ends: closing them then would run their code after the objects it
// registered are gone. A host that wants them told calls unloadAll first.
AcRxDynamicLinker::~AcRxDynamicLinker() = default;

bool AcRxDynamicLinker::loadModule(const std::string& path) {
    const std::string file = ModulePath(path);
    if (find(file)) {
        m_lastError.clear();
        return true;
    }
    dlerror();
    void* handle = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!handle) {
        const char* why = dlerror();
        m_lastError = why ? why : file;
        return false;
    }
    auto entryPoint = reinterpret_cast<AcRxEntryPointFunction>(dlsym(handle, "acrxEntryPoint"));
    if (!entryPoint) {
        m_lastError = "pas de point d'entrée acrxEntryPoint dans " + file;
        dlclose(handle);
        return false;
    }
    const std::uintptr_t appId = m_nextAppId++;
    m_modules.push_back({file, handle, entryPoint, appId, true, false});
    // The module may load others while it answers: m_modules may move under this call.
    if (entryPoint(AcRx::kInitAppMsg, AppIdPacket(appId)) == AcRx::kRetError) {
        forget(appId);
        dlclose(handle);
        m_lastError = "le module " + file + " refuse son initialisation";
        return false;
    }
    m_lastError.clear();
    return true;
}

bool AcRxDynamicLinker::unloadModule(std::string_view name) {
    const Module* module = find(name);
    if (!module || module->locked) return false;
    const Module closing = *module;
    closing.entryPoint(AcRx::kUnloadAppMsg, AppIdPacket(closing.appId));
    forget(closing.appId);
    dlclose(closing.handle);
    return true;
}

void AcRxDynamicLinker::unloadAll() {
    while (!m_modules.empty()) {
        const Module closing = m_modules.back();
        closing.entryPoint(AcRx::kUnloadAppMsg, AppIdPacket(closing.appId));
        forget(closing.appId);
        dlclose(closing.handle);
    }
}

bool AcRxDynamicLinker::unlockApplication(void* appId) {
    Module* module = findApp(appId);
    if (!module) return false;
    module->locked = false;
    return true;
}

bool AcRxDynamicLinker::registerAppMDIAware(void* appId) {
    Module* module = findApp(appId);
    if (!module) return false;
    module->mdiAware = true;
    return true;
}

bool AcRxDynamicLinker::isApplicationLocked(void* appId) const {
    const Module* module = findApp(appId);
    return module && module->locked;
}

bool AcRxDynamicLinker::isAppMDIAware(void* appId) const {
    const Module* module = findApp(appId);
    return module && module->mdiAware;
}

void AcRxDynamicLinker::sendDocumentMessage(AcRx::AppMsgCode message, void* document) {
    std::vector<std::uintptr_t> appIds;
    for (const Module& module : m_modules)
        appIds.push_back(module.appId);
    for (std::uintptr_t appId : appIds)
        if (const Module* module = findApp(AppIdPacket(appId))) module->entryPoint(message, document);
}

bool AcRxDynamicLinker::isModuleLoaded(std::string_view name) const {
    return const_cast<AcRxDynamicLinker*>(this)->find(name) != nullptr;
}

std::vector<std::string> AcRxDynamicLinker::loadedModules() const {
    std::vector<std::string> paths;
    for (const Module& module : m_modules)
        paths.push_back(module.path);
    return paths;
}

AcRxDynamicLinker::Module* AcRxDynamicLinker::find(std::string_view name) {
    const std::string slashed = Slashed(name);
    const bool bare = slashed.find('/') == std::string::npos;
    const std::string path = bare ? std::string() : ModulePath(slashed);
    for (Module& module : m_modules) {
        if (bare ? std::filesystem::path(module.path).filename() == slashed : module.path == path)
            return &module;
    }
    return nullptr;
}

const AcRxDynamicLinker::Module* AcRxDynamicLinker::findApp(void* appId) const {
    for (const Module& module : m_modules)
        if (AppIdPacket(module.appId) == appId) return &module;
    return nullptr;
}

AcRxDynamicLinker::Module* AcRxDynamicLinker::findApp(void* appId) {
    return const_cast<Module*>(std::as_const(*this).findApp(appId));
}

void AcRxDynamicLinker::forget(std::uintptr_t appId) {
    std::erase_if(m_modules, [&](const Module& module) { return module.appId == appId; });
}
