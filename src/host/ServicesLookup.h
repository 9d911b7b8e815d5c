#pragma once

#include "host/Services.h"

namespace pyr::host {

// The service registered under `service` in the host's service dictionary. When it is not there yet,
// the module file is looked for with acedFindFile under its bare name, then in "..\Programmes\", then in
// "Programmes\", and the first found is loaded through the host's dynamic linker. A module that cannot
// be found or loaded, or that does not register the service, ends the host program (acrx_abort): the
// module cannot work without its services. Null only when the host's abort returned (a test's).
// Not cached: every command asks afresh.
AcRxObject* GetMainServices(const char* module, const char* service);

CPyrMainServices* MainServices();
CPyrEchelleServices* ScaleServices();

} // namespace pyr::host
