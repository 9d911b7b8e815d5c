#include "geobase/CarnetIndex.h"

#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <algorithm>
#include <cstring>
#include <functional>

namespace pyr {

namespace {

constexpr std::uint64_t kRankBits = 0xFFFFFFFFu;

std::uint64_t Tag(std::uint64_t hash) {
    return hash & ~kRankBits;
}

} // namespace

bool CarnetIndex::Name::Is(std::string_view text) const {
    if (text.size() != mat.size()) return false;
    if (text.size() <= kHeld) return std::memcmp(held, text.data(), text.size()) == 0;
    return std::memcmp(held, text.data(), kHeld) == 0 && text == mat;
}

void CarnetIndex::Clear() {
    m_valid = false;
    m_names.clear();
    m_rankOf.clear();
    std::fill(m_slots.begin(), m_slots.end(), 0);
    for (auto& list : m_byKind)
        list.clear();
}

void CarnetIndex::Invalidate() {
    if (m_valid) Clear();
}

void CarnetIndex::Build(const std::vector<std::unique_ptr<CElement>>& elements, const std::vector<int>& kinds,
                        std::uint64_t identifierChanges) {
    Clear();
    // Mostly a point and its sightings, or a station's name and its point's: half as many identifiers
    // as elements is room enough to start with.
    m_names.reserve(elements.size() / 2 + 16);
    m_rankOf.reserve(elements.size());
    Reserve(elements.size() / 2 + 16);
    for (std::size_t i = 0; i < elements.size(); ++i)
        Add(static_cast<int>(i), *elements[i], kinds[i]);
    m_size = elements.size();
    m_identifierChanges = identifierChanges;
    m_valid = true;
}

void CarnetIndex::Appended(std::size_t size, std::uint64_t identifierChanges, const CElement& element,
                           int kind) {
    if (!m_valid || m_size + 1 != size || m_identifierChanges != identifierChanges) {
        Invalidate();
        return;
    }
    Add(static_cast<int>(size - 1), element, kind);
    m_size = size;
}

void CarnetIndex::Exchanged(std::size_t size, std::uint64_t identifierChanges, int index,
                            const CElement& before, const CElement& element) {
    if (!IsValid(size, identifierChanges) || before.mat() != element.mat()) {
        Invalidate();
        return;
    }
    // Same identifier, same place: only the view of its text may have to follow the element.
    const int rank = NameRankOf(index);
    if (rank < 0) return;
    Name& name = m_names[static_cast<std::size_t>(rank)];
    if (name.indices.front() == index) name.mat = element.mat();
}

int CarnetIndex::RankOf(const std::string& mat) const {
    if (mat.empty()) return -1;
    const std::uint64_t entry = m_slots[SlotOf(mat, std::hash<std::string_view>{}(mat))];
    return entry == 0 ? -1 : static_cast<int>((entry & kRankBits) - 1);
}

void CarnetIndex::Shift(int from, int by) {
    const auto shift = [from, by](std::vector<int>& indices) {
        for (auto at = std::lower_bound(indices.begin(), indices.end(), from); at != indices.end(); ++at)
            *at += by;
    };
    for (Name& name : m_names)
        if (name.indices.back() >= from) shift(name.indices);
    for (auto& list : m_byKind)
        shift(list);
}

void CarnetIndex::Inserted(std::size_t size, std::uint64_t identifierChanges, int index,
                           const CElement& element, int kind) {
    if (!IsValid(size - 1, identifierChanges) || !IsKnownKind(kind)) {
        Invalidate();
        return;
    }
    // An identifier new to the store, or whose first element it now is, changes the order of the ranks.
    const int rank = RankOf(element.mat());
    if (!element.mat().empty() &&
        (rank < 0 || m_names[static_cast<std::size_t>(rank)].indices.front() >= index)) {
        Invalidate();
        return;
    }
    Shift(index, 1);
    m_rankOf.insert(m_rankOf.begin() + index, rank);
    if (rank >= 0) {
        std::vector<int>& indices = m_names[static_cast<std::size_t>(rank)].indices;
        indices.insert(std::lower_bound(indices.begin(), indices.end(), index), index);
    }
    std::vector<int>& ofKind = m_byKind[static_cast<std::size_t>(kind - kKindComment)];
    ofKind.insert(std::lower_bound(ofKind.begin(), ofKind.end(), index), index);
    m_size = size;
}

void CarnetIndex::Removed(std::size_t size, std::uint64_t identifierChanges, int index, int kind) {
    if (!IsValid(size + 1, identifierChanges) || !IsKnownKind(kind)) {
        Invalidate();
        return;
    }
    // The last element of an identifier, or its first one, changes the order of the ranks.
    const int rank = NameRankOf(index);
    if (rank >= 0) {
        const std::vector<int>& indices = m_names[static_cast<std::size_t>(rank)].indices;
        if (indices.size() < 2 || indices.front() == index) {
            Invalidate();
            return;
        }
    }
    if (rank >= 0) {
        std::vector<int>& indices = m_names[static_cast<std::size_t>(rank)].indices;
        indices.erase(std::lower_bound(indices.begin(), indices.end(), index));
    }
    std::vector<int>& ofKind = m_byKind[static_cast<std::size_t>(kind - kKindComment)];
    ofKind.erase(std::lower_bound(ofKind.begin(), ofKind.end(), index));
    m_rankOf.erase(m_rankOf.begin() + index);
    Shift(index + 1, -1);
    m_size = size;
}

void CarnetIndex::Reserve(std::size_t names) {
    std::size_t capacity = 16;
    while (capacity < 2 * names)
        capacity *= 2;
    if (capacity <= m_slots.size()) return;
    m_slots.assign(capacity, 0);
    for (std::size_t rank = 0; rank < m_names.size(); ++rank)
        m_slots[SlotOf(m_names[rank].mat, m_names[rank].hash)] = Tag(m_names[rank].hash) | (rank + 1);
}

std::size_t CarnetIndex::SlotOf(std::string_view mat, std::uint64_t hash) const {
    const std::size_t mask = m_slots.size() - 1;
    for (std::size_t slot = hash & mask;; slot = (slot + 1) & mask) {
        const std::uint64_t entry = m_slots[slot];
        if (entry == 0) return slot;
        if (Tag(entry) == Tag(hash) && m_names[(entry & kRankBits) - 1].Is(mat)) return slot;
    }
}

void CarnetIndex::Add(int index, const CElement& element, int kind) {
    if (IsKnownKind(kind)) m_byKind[static_cast<std::size_t>(kind - kKindComment)].push_back(index);
    const std::string& mat = element.mat();
    if (mat.empty()) {
        m_rankOf.push_back(-1);
        return;
    }
    const std::uint64_t hash = std::hash<std::string_view>{}(mat);
    std::size_t slot = SlotOf(mat, hash);
    if (m_slots[slot] != 0) {
        const std::uint64_t rank = (m_slots[slot] & kRankBits) - 1;
        m_names[rank].indices.push_back(index);
        m_rankOf.push_back(static_cast<int>(rank));
        return;
    }
    if (2 * (m_names.size() + 1) > m_slots.size()) {
        Reserve(m_names.size() + 1);
        slot = SlotOf(mat, hash);
    }
    m_rankOf.push_back(static_cast<int>(m_names.size()));
    Name& name = m_names.emplace_back();
    name.indices.push_back(index);
    name.hash = hash;
    name.mat = mat;
    std::memcpy(name.held, mat.data(), std::min(mat.size(), Name::kHeld));
    m_slots[slot] = Tag(hash) | m_names.size();
}

const std::vector<int>* CarnetIndex::WithMat(std::string_view mat) const {
    if (m_slots.empty() || mat.empty()) return nullptr;
    const std::uint64_t entry = m_slots[SlotOf(mat, std::hash<std::string_view>{}(mat))];
    return entry == 0 ? nullptr : &m_names[(entry & kRankBits) - 1].indices;
}

const std::vector<int>& CarnetIndex::WithKind(int kind) const {
    return IsKnownKind(kind) ? m_byKind[static_cast<std::size_t>(kind - kKindComment)] : m_none;
}

} // namespace pyr
