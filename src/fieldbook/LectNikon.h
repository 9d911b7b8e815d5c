#pragma once

#include "fieldbook/FieldBookReader.h"

#include <memory>

namespace pyr {

// The reader of Nikon raw V2.00 and DTM-series comma field books (the three Nikon entries); null while it is
// not built.
std::unique_ptr<CFieldBookReader> MakeNikonReader();

} // namespace pyr
