#pragma once

#include "geobase/Elements.h"

#include <memory>
#include <vector>

namespace pyr {

// The new state of the element at an index, of the same kind: what an edit of the GéoBase editor
// (a field typed, a renumbering, a station renamed) puts in place of the element there. The editor's
// document exchanges it with the element in the store, so that the old state is what undoes the edit.
struct ElementReplacement {
    int index = -1;
    std::unique_ptr<CElement> element;
};
using ElementReplacements = std::vector<ElementReplacement>;

} // namespace pyr
