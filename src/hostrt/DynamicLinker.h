#pragma once

#include "hostrt/AcRx.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

// The host's dynamic linker: loads modules, talks to their entry points and remembers what each
// application asked for.
//
// A module starts locked: it cannot be unloaded until it unlocks itself (unlockApplication), except when
// the host shuts down (unloadAll). Every call may come from inside a module's entry point (a module loads
// the modules it depends on while it initialises), so none keeps a reference across a message.
class AcRxDynamicLinker : public AcRxObject {
public:
    AcRxDynamicLinker() = default;
    ~AcRxDynamicLinker() override;
    AcRxDynamicLinker(const AcRxDynamicLinker&) = delete;
    AcRxDynamicLinker& operator=(const AcRxDynamicLinker&) = delete;

    // Loads a shared library ('\' read as '/'; a name without a folder is taken in the current folder),
    // finds its "acrxEntryPoint" and sends it kInitAppMsg with the module's application id as packet.
    // False when the file does not load, has no entry point or answers kRetError; the module is then
    // closed again. A module already loaded under that path is not loaded twice: true.
    bool loadModule(const std::string& path);
    // Sends kUnloadAppMsg and closes the library. The name is the path given to loadModule or the bare
    // file name. False when no such module is loaded or when it is still locked.
    bool unloadModule(std::string_view name);
    // Unloads every module, the last loaded first, locked or not: the host is shutting down.
    void unloadAll();

    bool unlockApplication(void* appId);
    bool registerAppMDIAware(void* appId);
    bool isApplicationLocked(void* appId) const;
    bool isAppMDIAware(void* appId) const;

    // Sends a drawing message (AcRx::kLoadDwgMsg or kUnloadDwgMsg) to every loaded module, in load
    // order, with the host's handle of the drawing as packet.
    void sendDocumentMessage(AcRx::AppMsgCode message, void* document);

    bool isModuleLoaded(std::string_view name) const;
    // Paths of the loaded modules, in load order.
    std::vector<std::string> loadedModules() const;
    // Why the last loadModule failed (the system's words), empty after a success.
    const std::string& lastError() const { return m_lastError; }

private:
    struct Module {
        std::string path;
        void* handle = nullptr;
        AcRxEntryPointFunction entryPoint = nullptr;
        std::uintptr_t appId = 0;
        bool locked = true;
        bool mdiAware = false;
    };

    Module* find(std::string_view name);
    const Module* findApp(void* appId) const;
    Module* findApp(void* appId);
    void forget(std::uintptr_t appId);

    std::vector<Module> m_modules;
    std::uintptr_t m_nextAppId = 1;
    std::string m_lastError;
};
