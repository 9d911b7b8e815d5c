#pragma once

#include "fieldbook/FieldBookReader.h"

#include <memory>

namespace pyr {

// The reader of Sokkia SDR2x and SDR33 field books; null while it is not built.
std::unique_ptr<CFieldBookReader> MakeSokkiaReader();

} // namespace pyr
