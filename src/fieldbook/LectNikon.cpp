#include "fieldbook/LectNikon.h"

namespace pyr {

std::unique_ptr<CFieldBookReader> MakeNikonReader() {
    return nullptr;
}

} // namespace pyr
