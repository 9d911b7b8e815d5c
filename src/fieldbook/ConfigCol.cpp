#include "fieldbook/ConfigCol.h"

#include "core/Strings.h"

#include <algorithm>

namespace pyr {

void CColumnarFields::Split(std::string_view line) {
    m_line = line;
    m_ascii =
        std::none_of(line.begin(), line.end(), [](char c) { return static_cast<unsigned char>(c) >= 0x80; });
}

std::size_t CColumnarFields::Offset(int column) const {
    const auto rank = static_cast<std::size_t>(std::max(column, 0));
    if (m_ascii) return std::min(rank, m_line.size());
    // A character starts at every byte that does not continue a UTF-8 sequence.
    std::size_t seen = 0;
    for (std::size_t i = 0; i < m_line.size(); ++i) {
        if ((static_cast<unsigned char>(m_line[i]) & 0xC0) == 0x80) continue;
        if (seen++ == rank) return i;
    }
    return m_line.size();
}

std::string_view CColumnarFields::Field(const FieldPlace& place, std::size_t) const {
    const std::size_t from = Offset(place.first - 1);
    const std::size_t to = place.last > 0 ? Offset(place.last) : m_line.size();
    return from < to ? Trimmed(m_line.substr(from, to - from)) : std::string_view();
}

std::string_view CColumnarFields::After(const FieldPlace& place, std::size_t) const {
    if (place.last <= 0) return {};
    return Trimmed(m_line.substr(Offset(place.last)));
}

} // namespace pyr
