#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pyr {

class CElement;

// Where each identifier and each kind stands in a store: the sorted indices of the elements of an
// identifier, and of a kind. Built on the first look-up after a change; an append keeps it up to date,
// any other change (removal, insertion, change of kind, renaming an element) makes it be built again.
// The identifiers are viewed in the elements themselves, which stay where they are in memory.
class CarnetIndex {
public:
    bool IsValid(std::size_t size, std::uint64_t identifierChanges) const {
        return m_valid && m_size == size && m_identifierChanges == identifierChanges;
    }
    void Invalidate();
    void Build(const std::vector<std::unique_ptr<CElement>>& elements, const std::vector<int>& kinds,
               std::uint64_t identifierChanges);
    // An element appended at the end: kept in the index when the index was valid.
    void Appended(std::size_t size, std::uint64_t identifierChanges, const CElement& element, int kind);

    // The indices of the elements of that identifier (all kinds), in increasing order; null when none.
    const std::vector<int>* WithMat(std::string_view mat) const;
    // The indices of the elements of that kind, in increasing order.
    const std::vector<int>& WithKind(int kind) const;

private:
    void Add(int index, const CElement& element, int kind);

    bool m_valid = false;
    std::size_t m_size = 0;
    std::uint64_t m_identifierChanges = 0;
    std::unordered_map<std::string_view, std::vector<int>> m_byMat;
    std::array<std::vector<int>, 66> m_byKind; // kinds 1000 to 1065
    std::vector<int> m_none;
};

} // namespace pyr
