#include "host/CommandContext.h"

#include "host/HostTexts.h"
#include "host/Services.h"
#include "hostrt/HostRuntime.h"

#include <cstring>

namespace pyr::host {

namespace {

CPyrMainServices* RegisteredServices() {
    return static_cast<CPyrMainServices*>(acrxServiceDictionary()->at(kMainServicesName));
}

} // namespace

void CCmdContext::Open() {
    if (m_open) return;
    if (!m_recorded) {
        for (Variable& variable : m_variables)
            variable.known = acedGetVar(variable.name, variable.value) == RTNORM;
        m_recorded = true;
    }
    acedSetVar("CMDECHO", "0");
    acedSetVar("UCSFOLLOW", "0");
    if (CPyrMainServices* services = RegisteredServices()) services->SwitchToModuleResources(kAppName);
    m_open = true;
}

void CCmdContext::Close() {
    if (!m_open) return;
    for (const Variable& variable : m_variables)
        if (variable.restored && variable.known) acedSetVar(variable.name, variable.value);
    if (CPyrMainServices* services = RegisteredServices()) services->RestoreHostResources();
    m_open = false;
}

const std::string& CCmdContext::Recorded(const char* variable) const {
    static const std::string none;
    for (const Variable& recorded : m_variables)
        if (std::strcmp(recorded.name, variable) == 0) return recorded.value;
    return none;
}

} // namespace pyr::host
