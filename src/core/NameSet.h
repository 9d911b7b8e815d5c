#pragma once

#include "core/Strings.h"

#include <bitset>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace pyr {

// A set of names asked about far more often than it holds the name asked: the few thousand points of a
// field book given with their coordinates, asked about for each of a million sightings. A bit per
// 16-bit hash answers most of the questions without looking into the set.
class NameSet {
public:
    void Insert(std::string_view name) {
        m_filter->set(Hash16(name));
        m_names.emplace(name);
    }
    bool Contains(std::string_view name) const {
        return !m_names.empty() && m_filter->test(Hash16(name)) && m_names.find(name) != m_names.end();
    }
    void Clear() {
        m_filter->reset();
        m_names.clear();
    }

private:
    // FNV-1a folded to 16 bits: a few cycles for an identifier of a few characters.
    static std::size_t Hash16(std::string_view name) {
        std::uint32_t hash = 2166136261u;
        for (const char c : name)
            hash = (hash ^ static_cast<unsigned char>(c)) * 16777619u;
        return (hash ^ (hash >> 16)) & 0xFFFF;
    }
    std::unique_ptr<std::bitset<65536>> m_filter = std::make_unique<std::bitset<65536>>();
    TextSet m_names;
};

} // namespace pyr
