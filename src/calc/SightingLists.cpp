#include "calc/SightingLists.h"

#include <algorithm>
#include <iterator>

namespace pyr {

namespace {
int Within(int rank, std::size_t size) {
    return rank >= 0 && rank < static_cast<int>(size) ? rank : -1;
}
} // namespace

void CSightingLists::Fill(std::vector<Line> available) {
    m_available = std::move(available);
    m_selected.clear();
    m_highAvailable = m_highSelected = -1;
}

void CSightingLists::HighlightAvailable(int rank) {
    m_highAvailable = Within(rank, m_available.size());
}

void CSightingLists::HighlightSelected(int rank) {
    m_highSelected = Within(rank, m_selected.size());
}

bool CSightingLists::Move(std::vector<Line>& from, std::vector<Line>& to, int& highlight) {
    if (Within(highlight, from.size()) < 0) return false;
    to.push_back(std::move(from[static_cast<std::size_t>(highlight)]));
    from.erase(from.begin() + highlight);
    highlight = from.empty() ? -1 : std::min(highlight, static_cast<int>(from.size()) - 1);
    return true;
}

bool CSightingLists::AddOne() {
    return Move(m_available, m_selected, m_highAvailable);
}

bool CSightingLists::RemoveOne() {
    return Move(m_selected, m_available, m_highSelected);
}

bool CSightingLists::AddAll() {
    if (m_available.empty()) return false;
    std::move(m_available.begin(), m_available.end(), std::back_inserter(m_selected));
    m_available.clear();
    m_highAvailable = -1;
    return true;
}

bool CSightingLists::RemoveAll() {
    if (m_selected.empty()) return false;
    std::move(m_selected.begin(), m_selected.end(), std::back_inserter(m_available));
    m_selected.clear();
    m_highSelected = -1;
    return true;
}

bool CSightingLists::SelectOnly(const std::function<bool(const Line&)>& keep) {
    std::vector<Line> all = std::move(m_selected);
    std::move(m_available.begin(), m_available.end(), std::back_inserter(all));
    std::sort(all.begin(), all.end(), [](const Line& a, const Line& b) { return a.index < b.index; });
    m_selected.clear();
    m_available.clear();
    for (Line& line : all)
        (keep(line) ? m_selected : m_available).push_back(std::move(line));
    m_highAvailable = m_highSelected = -1;
    return !m_selected.empty();
}

} // namespace pyr
