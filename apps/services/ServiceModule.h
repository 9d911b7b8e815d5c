#pragma once

#include "hostrt/HostRuntime.h"

// The entry point of a module whose whole work is to offer one service: registered on loading, taken
// back on unloading.
inline int ServiceModuleEntryPoint(int message, void* packet, const char* name, AcRxObject* service) {
    switch (message) {
    case AcRx::kInitAppMsg:
        acrxDynamicLinker()->unlockApplication(packet);
        acrxDynamicLinker()->registerAppMDIAware(packet);
        acrxServiceDictionary()->atPut(name, service);
        return AcRx::kRetOK;
    case AcRx::kUnloadAppMsg:
        if (acrxServiceDictionary()->at(name) == service) acrxServiceDictionary()->remove(name);
        return AcRx::kRetOK;
    default:
        return AcRx::kRetOK;
    }
}
