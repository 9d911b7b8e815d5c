#pragma once

#include "fieldbook/FieldBookReader.h"

#include <memory>

namespace pyr {

// The reader of Trimble (Zeiss) Rec 500, R4, R5 and M5 field books; null while it is not built.
std::unique_ptr<CFieldBookReader> MakeZeissReader();

} // namespace pyr
