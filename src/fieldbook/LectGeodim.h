#pragma once

#include "fieldbook/FieldBookReader.h"

#include <memory>

namespace pyr {

// The reader of Trimble GDM (Geodimeter) label job and area files; null while it is not built.
std::unique_ptr<CFieldBookReader> MakeGeodimReader();

} // namespace pyr
