#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <string_view>
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
    // The edits of the editor, kept in the index without building it again over a million elements
    // when they leave the order of the identifiers' first elements as it was; otherwise the index is
    // dropped. `size` is the store's size after the change.
    // The element at `index` was exchanged with `element`, of the same kind.
    void Exchanged(std::size_t size, std::uint64_t identifierChanges, int index, const CElement& before,
                   const CElement& element);
    // `element` of `kind` was inserted at `index`.
    void Inserted(std::size_t size, std::uint64_t identifierChanges, int index, const CElement& element,
                  int kind);
    // The element of `kind` at `index` was removed.
    void Removed(std::size_t size, std::uint64_t identifierChanges, int index, int kind);

    // The indices of the elements of that identifier (all kinds), in increasing order; null when none.
    // Valid until the index changes.
    const std::vector<int>* WithMat(std::string_view mat) const;
    // The indices of the elements of that kind, in increasing order.
    const std::vector<int>& WithKind(int kind) const;
    // The rank of the identifier of the element at `index` among the identifiers, in the order of their
    // first element, -1 for an element without one: a dense key, read without hashing the identifier.
    int NameRankOf(int index) const {
        const auto at = static_cast<std::size_t>(index);
        return at < m_rankOf.size() ? m_rankOf[at] : -1;
    }
    // The indices of the elements bearing the identifier of that rank, in increasing order.
    const std::vector<int>& WithNameRank(int rank) const {
        return rank >= 0 && static_cast<std::size_t>(rank) < m_names.size()
                   ? m_names[static_cast<std::size_t>(rank)].indices
                   : m_none;
    }
    std::size_t NameCount() const { return m_names.size(); }

private:
    // One identifier: one cache line, its text held in it when short, so that a look-up in a store of a
    // million identifiers reads its slot, this line and the indices.
    struct alignas(64) Name {
        std::vector<int> indices;
        std::uint64_t hash = 0;
        std::string_view mat; // viewed in its first element
        static constexpr std::size_t kHeld = 16;
        char held[kHeld] = {}; // the first kHeld bytes of mat

        bool Is(std::string_view text) const;
    };

    void Add(int index, const CElement& element, int kind);
    // The rank of that identifier, -1 when the index holds none.
    int RankOf(const std::string& mat) const;
    // Every index from `from` on moved by `by` (+1 or -1), in the identifiers' and the kinds' lists.
    void Shift(int from, int by);
    void Clear();
    // The slots for `names` identifiers: at most half of them used, so that a look-up seldom probes
    // more than one or two.
    void Reserve(std::size_t names);
    // The slot of that identifier, or the empty slot where it would go.
    std::size_t SlotOf(std::string_view mat, std::uint64_t hash) const;

    bool m_valid = false;
    std::size_t m_size = 0;
    std::uint64_t m_identifierChanges = 0;
    std::vector<Name> m_names; // in the order of their first element
    std::vector<int> m_rankOf; // of each element, its identifier's rank in m_names, -1 without
    // Open addressing, probed in sequence: 0 for an empty slot, else the upper half of the identifier's
    // hash and its rank in m_names plus one.
    std::vector<std::uint64_t> m_slots;
    std::array<std::vector<int>, 66> m_byKind; // kinds 1000 to 1065
    std::vector<int> m_none;
};

} // namespace pyr
