#include "fieldbook/LectZeiss.h"

namespace pyr {

std::unique_ptr<CFieldBookReader> MakeZeissReader() {
    return nullptr;
}

} // namespace pyr
