#pragma once

#include "RegistryStore.h"

#include <string>

// What each platform does under the registry form: open, query, create, set. The checks before and the
// messages after are common (RegistryStore.cpp).
namespace pyr::registry_detail {

enum class Step { Done, Open, Query, Create, Set };

struct Outcome {
    Step failedAt = Step::Done;
    int code = 0; // the system's code of the failure
};

// Opens the key for reading and queries the value, whole.
Outcome ReadValue(RegistryRoot root, const std::string& keyPath, const std::string& name, std::string& value);

// Opens the key for writing, creating it when it cannot be opened, and sets the value as text.
Outcome WriteValue(RegistryRoot root, const std::string& keyPath, const std::string& name,
                   const std::string& value);

} // namespace pyr::registry_detail
