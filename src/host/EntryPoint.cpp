// The two functions that the module exports; everything else stays inside it.
#include "host/PyrAppModul.h"
#include "hostrt/AcRx.h"

namespace {
// Created when the host loads the module, gone when it unloads it.
struct AppHolder {
    pyr::host::CPyrAppModul app;
    AppHolder() { pyr::host::SetTheApp(&app); }
    ~AppHolder() { pyr::host::SetTheApp(nullptr); }
} g_holder;
} // namespace

extern "C" __attribute__((visibility("default"))) int acrxEntryPoint(int message, void* packet) {
    return pyr::host::ModuleEntryPoint(message, packet);
}

extern "C" __attribute__((visibility("default"))) int acrxGetApiVersion() {
    return AcRx::kApiVersion;
}
