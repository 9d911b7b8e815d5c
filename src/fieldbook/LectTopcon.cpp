#include "fieldbook/LectTopcon.h"

namespace pyr {

std::unique_ptr<CFieldBookReader> MakeTopconReader() {
    return nullptr;
}

} // namespace pyr
