#pragma once

#include "fieldbook/FieldBookFormats.h"

#include <memory>

namespace pyr {

class CFieldBookReader;

// The reader of a format, or null for a format whose reader this version does not have yet. A reader
// written for a format is added here.
std::unique_ptr<CFieldBookReader> MakeFieldBookReader(FieldBookFormat format);

} // namespace pyr
