#pragma once

#include "editor/ElementFields.h"
#include "geobase/Carnet.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

// The editor's search of a GéoBase: the elements of an identifier or a selection of identifiers, of a
// code, of some kinds, or whose value of a field compares to a number. Every criterion given must hold.
namespace pyr {

enum class CompareOp { Equal, Less, Greater };

// A field's value compared to a number at the decimals the field is shown with: "Z = 102.35" finds the
// Z shown 102.350 whatever digits lie beyond. An element without the field, or whose value is
// undefined, never matches.
struct ValueCriterion {
    FieldKey key = FieldKey::Z;
    CompareOp op = CompareOp::Equal;
    double value = 0.0;
};

struct SearchCriteria {
    // One identifier ("P12"), or a selection ("100-150, A1-A9 P7"); empty: any element.
    std::string identifiers;
    // The code, compared exactly (letter case counts); an empty code finds the elements without one.
    std::optional<std::string> code;
    // The kind codes looked for; empty: every kind.
    std::vector<int> kinds;
    std::optional<ValueCriterion> value;
};

// A value criterion as a person writes it: a field's key name, a comparison and a number ("z>100.5",
// "X = 651 200,25", "di<5"); nothing when the text is not one.
std::optional<ValueCriterion> ParseValueCriterion(std::string_view text);

// Why the criteria cannot be searched (an incorrect selection, with its faulty item), in French; empty
// when they can. Search and FindNext find nothing for such criteria.
std::string SearchCriteriaError(const SearchCriteria& criteria);

// The indices of the elements from `from` on that meet the criteria, in GéoBase order. Linear in the
// size of the GéoBase; for one identifier, in the number of its elements.
std::vector<int> Search(const CCarnet& carnet, const SearchCriteria& criteria, int from = 0);

// "Chercher suivant": the first element after `index` (forwards) or before it (backwards) that meets the
// criteria, going round past the end (the beginning), `index` itself coming last; -1 when none does.
// An index outside the GéoBase starts from its first (last) element.
int FindNext(const CCarnet& carnet, const SearchCriteria& criteria, int index, bool forward = true);

} // namespace pyr
