#include "editor/GeoSearch.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Kinds.h"
#include "geobase/Matricule.h"
#include "geobase/Selection.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cstdint>

namespace pyr {

std::optional<ValueCriterion> ParseValueCriterion(std::string_view text) {
    const std::size_t at = text.find_first_of("=<>");
    if (at == std::string_view::npos || at == 0) return std::nullopt;
    std::string name(Trimmed(text.substr(0, at)));
    for (char& c : name)
        c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    const std::optional<FieldKey> key = FieldKeyFromName(name);
    double value = 0.0;
    if (!key || !ParseTypedNumber(Trimmed(text.substr(at + 1)), value)) return std::nullopt;
    const CompareOp op = text[at] == '='   ? CompareOp::Equal
                         : text[at] == '<' ? CompareOp::Less
                                           : CompareOp::Greater;
    return ValueCriterion{*key, op, value};
}

namespace {

constexpr const char* kBadSelection = "La sélection de matricules n'est pas correcte : %s !";
constexpr int kKindCount = kKindLastCommand - kKindComment + 1;

// The criteria read once for a whole search.
class Matcher {
public:
    Matcher(const CCarnet& carnet, const SearchCriteria& criteria) : m_carnet(carnet), m_criteria(criteria) {
        const std::string_view text = Trimmed(criteria.identifiers);
        if (!text.empty()) {
            std::string why;
            std::optional<CSelection> selection = CSelection::Parse(text, &why);
            if (!selection) {
                m_error = Sprintf(kBadSelection, why.c_str());
                return;
            }
            if (IsSingleIdentifier(text)) {
                // The elements of one identifier, from the store's index: no identifier compared.
                const int first = carnet.Find(0, FormMatView(text));
                m_candidates = first < 0 ? &m_none : &carnet.SameMat(first);
            } else {
                m_selection = std::move(selection);
                m_inSelection.assign(static_cast<std::size_t>(carnet.NameCount()), kUnknown);
            }
        }
        m_anyKind = criteria.kinds.empty();
        for (int kind : criteria.kinds)
            if (IsKnownKind(kind)) m_kinds[static_cast<std::size_t>(kind - kKindComment)] = true;
        if (criteria.value) {
            m_wanted.fill(kUndefined);
            for (int kind = kKindComment; kind <= kKindLastCommand; ++kind) {
                const int decimals = FieldDecimals(kind, criteria.value->key);
                if (decimals < 0) continue;
                m_decimals[static_cast<std::size_t>(kind - kKindComment)] = decimals;
                m_wanted[static_cast<std::size_t>(kind - kKindComment)] =
                    RoundToDecimals(criteria.value->value, decimals);
            }
        }
    }

    const std::string& Error() const { return m_error; }
    // The only elements that can match, in increasing order; null when any element can.
    const std::vector<int>* Candidates() const { return m_candidates; }

    bool Matches(int index) {
        const int kind = m_carnet.GetType(index);
        const auto slot = static_cast<std::size_t>(kind - kKindComment);
        if (!m_anyKind && !m_kinds[slot]) return false;
        const CElement& element = *m_carnet.GetAt(index);
        if (m_criteria.code && element.sym() != *m_criteria.code) return false;
        if (m_selection && !InSelection(index)) return false;
        if (m_criteria.value) {
            if (IsUndefined(m_wanted[slot])) return false; // the kind has no such field
            const double value = FieldNumber(element, kind, m_criteria.value->key);
            if (IsUndefined(value)) return false;
            const double shown = RoundToDecimals(value, m_decimals[slot]);
            switch (m_criteria.value->op) {
            case CompareOp::Equal:
                return shown == m_wanted[slot];
            case CompareOp::Less:
                return shown < m_wanted[slot];
            case CompareOp::Greater:
                return shown > m_wanted[slot];
            }
        }
        return true;
    }

private:
    static constexpr std::int8_t kUnknown = -1;

    // Plain identifiers take the index; a range, a list or an identifier with a dash (which the
    // selection may read as a range) is tested as a selection.
    static bool IsSingleIdentifier(std::string_view text) {
        return text.find_first_of(" \t,;-") == std::string_view::npos;
    }

    // Each identifier tested once against the selection, however many elements bear it.
    bool InSelection(int index) {
        const int rank = m_carnet.NameRank(index);
        if (rank < 0) return false;
        std::int8_t& known = m_inSelection[static_cast<std::size_t>(rank)];
        if (known == kUnknown) known = m_selection->Contains(m_carnet.GetAt(index)->mat()) ? 1 : 0;
        return known == 1;
    }

    const CCarnet& m_carnet;
    const SearchCriteria& m_criteria;
    std::string m_error;
    const std::vector<int>* m_candidates = nullptr;
    std::vector<int> m_none;
    std::optional<CSelection> m_selection;
    std::vector<std::int8_t> m_inSelection;
    bool m_anyKind = true;
    std::array<bool, kKindCount> m_kinds{};
    std::array<int, kKindCount> m_decimals{};
    std::array<double, kKindCount> m_wanted{};
};

} // namespace

std::string SearchCriteriaError(const SearchCriteria& criteria) {
    const CCarnet empty;
    return Matcher(empty, criteria).Error();
}

std::vector<int> Search(const CCarnet& carnet, const SearchCriteria& criteria, int from) {
    std::vector<int> found;
    Matcher matcher(carnet, criteria);
    if (!matcher.Error().empty()) return found;
    from = std::max(from, 0);
    if (const std::vector<int>* candidates = matcher.Candidates()) {
        for (auto it = std::lower_bound(candidates->begin(), candidates->end(), from);
             it != candidates->end(); ++it)
            if (matcher.Matches(*it)) found.push_back(*it);
        return found;
    }
    for (int i = from; i < carnet.GetSize(); ++i)
        if (matcher.Matches(i)) found.push_back(i);
    return found;
}

int FindNext(const CCarnet& carnet, const SearchCriteria& criteria, int index, bool forward) {
    Matcher matcher(carnet, criteria);
    const int size = carnet.GetSize();
    if (!matcher.Error().empty() || size == 0) return -1;
    // Outside the GéoBase, the search starts at its first (last) element, as if from just before it.
    if (index < 0 || index >= size) index = forward ? size - 1 : 0;

    if (const std::vector<int>* candidates = matcher.Candidates()) {
        const auto count = static_cast<std::ptrdiff_t>(candidates->size());
        if (count == 0) return -1;
        // The position of the first candidate past `index` in the direction of the search.
        std::ptrdiff_t at =
            forward
                ? std::upper_bound(candidates->begin(), candidates->end(), index) - candidates->begin()
                : std::lower_bound(candidates->begin(), candidates->end(), index) - candidates->begin() - 1;
        for (std::ptrdiff_t step = 0; step < count; ++step) {
            const std::ptrdiff_t wrapped = ((at % count) + count) % count;
            const int candidate = (*candidates)[static_cast<std::size_t>(wrapped)];
            if (matcher.Matches(candidate)) return candidate;
            at += forward ? 1 : -1;
        }
        return -1;
    }
    for (int step = 1; step <= size; ++step) {
        const int candidate = forward ? (index + step) % size : ((index - step) % size + size) % size;
        if (matcher.Matches(candidate)) return candidate;
    }
    return -1;
}

} // namespace pyr
