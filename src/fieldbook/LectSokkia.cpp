#include "fieldbook/LectSokkia.h"

namespace pyr {

std::unique_ptr<CFieldBookReader> MakeSokkiaReader() {
    return nullptr;
}

} // namespace pyr
