#include "core/Strings.h"
#include "hostrt/AcRx.h"
#include "hostrt/CommandStack.h"
#include "hostrt/DynamicLinker.h"

#include <cstdio>
#include <cstdlib>

namespace {

// The one state of the runtime, shared by the host program and every module that links this library.
struct Runtime {
    AcRxDynamicLinker linker;
    AcRxDictionary services;
    AcEdCommandStack commands;
    AcRxDictionary registry;
    std::function<void(const std::string&)> abortHandler;

    Runtime() {
        registry.atPut("DynamicLinker", &linker);
        registry.atPut("ServiceDictionary", &services);
        registry.atPut("ACAD_REGISTERED_COMMANDS", &commands);
    }
};

Runtime& State() {
    static Runtime runtime;
    return runtime;
}

} // namespace

AcRxObject* AcRxDictionary::at(std::string_view name) const {
    for (const auto& [key, entry] : m_entries)
        if (key == name) return entry;
    return nullptr;
}

AcRxObject* AcRxDictionary::atPut(std::string_view name, AcRxObject* entry) {
    for (auto& [key, old] : m_entries)
        if (key == name) {
            AcRxObject* replaced = old;
            old = entry;
            return replaced;
        }
    m_entries.emplace_back(std::string(name), entry);
    return nullptr;
}

AcRxObject* AcRxDictionary::remove(std::string_view name) {
    for (auto it = m_entries.begin(); it != m_entries.end(); ++it)
        if (it->first == name) {
            AcRxObject* removed = it->second;
            m_entries.erase(it);
            return removed;
        }
    return nullptr;
}

std::vector<std::string> AcRxDictionary::names() const {
    std::vector<std::string> names;
    for (const auto& entry : m_entries)
        names.push_back(entry.first);
    return names;
}

AcRxDictionary* acrxSysRegistry() {
    return &State().registry;
}
AcRxDynamicLinker* acrxDynamicLinker() {
    return &State().linker;
}
AcRxDictionary* acrxServiceDictionary() {
    return &State().services;
}
AcEdCommandStack* acedRegCmds() {
    return &State().commands;
}

bool acrxServiceIsRegistered(std::string_view serviceName) {
    return State().services.has(serviceName);
}

void acrx_abort(const char* format, ...) {
    std::va_list args;
    va_start(args, format);
    const std::string message = pyr::VSprintf(format, args);
    va_end(args);
    if (State().abortHandler) {
        State().abortHandler(message);
        return;
    }
    std::fflush(stdout);
    std::fprintf(stderr, "%s\n", message.c_str());
    std::fflush(stderr);
    // No static destructors: they would close modules whose code is on the stack right now.
    std::_Exit(EXIT_FAILURE);
}

namespace pyr {

void SetAbortHandler(std::function<void(const std::string& message)> handler) {
    State().abortHandler = std::move(handler);
}

} // namespace pyr
