#include "host/ServicesLookup.h"

#include "host/HostTexts.h"
#include "hostrt/HostRuntime.h"

#include <string>

namespace pyr::host {

AcRxObject* GetMainServices(const char* module, const char* service) {
    if (!acrxServiceIsRegistered(service)) {
        std::string found;
        bool isFound = false;
        for (const std::string folder : {"", kProgramsSibling, kProgramsChild}) {
            if (acedFindFile(folder + module, found) == RTNORM) {
                isFound = true;
                break;
            }
        }
        if (!isFound) {
            acrx_abort(kMsgModuleNotFound, module);
            return nullptr;
        }
        if (!acrxDynamicLinker()->loadModule(found)) {
            acrx_abort(kMsgModuleNotLoaded, module);
            return nullptr;
        }
        if (!acrxServiceIsRegistered(service)) {
            acrx_abort(kMsgNoService, service, module);
            return nullptr;
        }
    }
    return acrxServiceDictionary()->at(service);
}

CPyrMainServices* MainServices() {
    return static_cast<CPyrMainServices*>(GetMainServices(kMainServicesModule, kMainServicesName));
}

CPyrEchelleServices* ScaleServices() {
    return static_cast<CPyrEchelleServices*>(GetMainServices(kScaleServicesModule, kScaleServicesName));
}

} // namespace pyr::host
