#include "geobase/CarnetIndex.h"

#include "geobase/Elements.h"
#include "geobase/Kinds.h"

namespace pyr {

void CarnetIndex::Invalidate() {
    if (!m_valid) return;
    m_valid = false;
    m_byMat.clear();
    for (auto& list : m_byKind)
        list.clear();
}

void CarnetIndex::Build(const std::vector<std::unique_ptr<CElement>>& elements, const std::vector<int>& kinds,
                        std::uint64_t identifierChanges) {
    m_valid = false;
    m_byMat.clear();
    for (auto& list : m_byKind)
        list.clear();
    m_byMat.reserve(elements.size() / 2 + 16);
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

void CarnetIndex::Add(int index, const CElement& element, int kind) {
    if (!element.mat().empty()) m_byMat[element.mat()].push_back(index);
    if (IsKnownKind(kind)) m_byKind[static_cast<std::size_t>(kind - kKindComment)].push_back(index);
}

const std::vector<int>* CarnetIndex::WithMat(std::string_view mat) const {
    auto it = m_byMat.find(mat);
    return it == m_byMat.end() ? nullptr : &it->second;
}

const std::vector<int>& CarnetIndex::WithKind(int kind) const {
    return IsKnownKind(kind) ? m_byKind[static_cast<std::size_t>(kind - kKindComment)] : m_none;
}

} // namespace pyr
