#include "fieldbook/LectGeodim.h"

namespace pyr {

std::unique_ptr<CFieldBookReader> MakeGeodimReader() {
    return nullptr;
}

} // namespace pyr
