#pragma once

#include "fieldbook/FieldBookReader.h"

#include <memory>

namespace pyr {

// The reader of Topcon GTS-7 / GTS-700 keyword field books; null while it is not built.
std::unique_ptr<CFieldBookReader> MakeTopconReader();

} // namespace pyr
