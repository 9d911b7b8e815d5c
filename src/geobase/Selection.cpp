#include "geobase/Selection.h"

#include "geobase/Matricule.h"

#include <algorithm>
#include <climits>

namespace pyr {

namespace {

// Items are separated by commas, semicolons and blanks; a no-break space counts as a blank.
std::size_t SeparatorAt(std::string_view text, std::size_t i) {
    const char c = text[i];
    if (c == ',' || c == ';' || c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\v' || c == '\f')
        return 1;
    const std::string_view rest = text.substr(i);
    if (rest.starts_with("\xC2\xA0")) return 2;
    if (rest.starts_with("\xE2\x80\xAF")) return 3;
    return 0;
}

// One item of the list. `joined`: made of words that blanks around a dash separated ("100 - 150"),
// which can only be a range.
struct Item {
    std::string text;
    bool joined = false;
};

std::vector<Item> SplitItems(std::string_view text) {
    struct Word {
        std::string_view text;
        bool afterComma; // a ',' or ';' stands between it and the word before
    };
    std::vector<Word> words;
    bool comma = false;
    std::size_t i = 0;
    while (i < text.size()) {
        if (std::size_t n = SeparatorAt(text, i)) {
            comma = comma || text[i] == ',' || text[i] == ';';
            i += n;
            continue;
        }
        const std::size_t start = i;
        while (i < text.size() && SeparatorAt(text, i) == 0)
            ++i;
        words.push_back({text.substr(start, i - start), comma});
        comma = false;
    }

    std::vector<Item> items;
    for (std::size_t w = 0; w < words.size(); ++w) {
        Item item{std::string(words[w].text)};
        while (w + 1 < words.size() && !words[w + 1].afterComma &&
               (item.text.back() == '-' || words[w + 1].text.front() == '-')) {
            item.text += words[++w].text;
            item.joined = true;
        }
        items.push_back(std::move(item));
    }
    return items;
}

bool EndsWithDigit(std::string_view text) {
    return !text.empty() && text.back() >= '0' && text.back() <= '9';
}

struct Range {
    std::string_view prefix;
    long long first = 0;
    long long last = 0;
};

// Reads the item as a range "first-last" split at one of its dashes. Each dash with a numbered
// identifier on both sides is a candidate; the first candidate that makes a correct range is taken.
// Returns the range, or sets `fault` to the reason of the first candidate when none is correct (and
// leaves it null when the item has no candidate: it is not a range).
std::optional<Range> ReadRange(std::string_view item, std::string& fault) {
    std::string firstFault;
    for (std::size_t dash = 1; dash + 1 < item.size(); ++dash) {
        if (item[dash] != '-') continue;
        const std::string_view left = FormMatView(item.substr(0, dash));
        const std::string_view right = FormMatView(item.substr(dash + 1));
        if (!EndsWithDigit(left) || !EndsWithDigit(right)) continue;

        const MatParts from = SplitMat(left);
        const MatParts to = SplitMat(right);
        std::string why;
        // "A1-9" is short for "A1-A9": an end without a prefix takes the prefix of the other.
        if (!to.prefix.empty() && to.prefix != from.prefix) {
            why = msg::kSelWhyPrefixes;
        } else if (from.number < 0 || to.number < 0) {
            why = msg::kSelWhyTooLarge;
        } else if (IsValidMat(left, &why) && IsValidMat(right, &why)) {
            if (from.number <= to.number) return Range{from.prefix, from.number, to.number};
            why = msg::kSelWhyReversed;
        }
        if (firstFault.empty()) firstFault = std::move(why);
    }
    fault = std::move(firstFault);
    return std::nullopt;
}

std::string ItemFault(std::string_view item, std::string_view why) {
    std::string text = "« ";
    text += item;
    text += " » : ";
    text += why;
    return text;
}

long long SaturatedSum(long long a, long long b) {
    return a > LLONG_MAX - b ? LLONG_MAX : a + b;
}

} // namespace

std::optional<CSelection> CSelection::Parse(std::string_view text, std::string* why) {
    auto refuse = [why](std::string reason) -> std::optional<CSelection> {
        if (why) *why = std::move(reason);
        return std::nullopt;
    };

    const std::vector<Item> items = SplitItems(text);
    if (items.empty()) return refuse(msg::kSelWhyEmpty);

    CSelection selection;
    for (const Item& item : items) {
        if (item.text.front() == '-' || item.text.back() == '-')
            return refuse(ItemFault(item.text, msg::kSelWhyUnfinished));
        std::string fault;
        if (auto range = ReadRange(item.text, fault)) {
            auto& intervals = selection.m_ranges.try_emplace(std::string(range->prefix)).first->second;
            intervals.push_back({range->first, range->last});
            continue;
        }
        if (!fault.empty()) return refuse(ItemFault(item.text, fault));
        if (item.joined) return refuse(ItemFault(item.text, msg::kSelWhyNoNumbers));
        // Not a range: an identifier, dashes included ("P-12").
        std::string reason;
        if (!IsValidMat(item.text, &reason)) return refuse(ItemFault(item.text, reason));
        selection.m_ids.emplace(FormMatView(item.text));
    }

    long long count = 0;
    for (auto& [prefix, intervals] : selection.m_ranges) {
        std::sort(intervals.begin(), intervals.end(),
                  [](const Interval& a, const Interval& b) { return a.first < b.first; });
        std::vector<Interval> merged;
        for (const Interval& interval : intervals) {
            // Overlapping or touching intervals become one ("1-5 6-9" is "1-9").
            if (!merged.empty() && interval.first <= merged.back().last + 1)
                merged.back().last = std::max(merged.back().last, interval.last);
            else
                merged.push_back(interval);
        }
        intervals = std::move(merged);
        for (const Interval& interval : intervals)
            count = SaturatedSum(count, interval.last - interval.first + 1);
    }
    for (const std::string& id : selection.m_ids)
        if (!selection.InRange(id)) count = SaturatedSum(count, 1);
    selection.m_count = count;
    return selection;
}

bool CSelection::InRange(std::string_view normalisedId) const {
    if (m_ranges.empty()) return false;
    const MatParts parts = SplitMat(normalisedId);
    if (parts.number < 0) return false;
    const auto found = m_ranges.find(parts.prefix);
    if (found == m_ranges.end()) return false;
    const std::vector<Interval>& intervals = found->second;
    auto after =
        std::upper_bound(intervals.begin(), intervals.end(), parts.number,
                         [](long long number, const Interval& interval) { return number < interval.first; });
    return after != intervals.begin() && parts.number <= std::prev(after)->last;
}

bool CSelection::Contains(std::string_view id) const {
    const std::string_view mat = FormMatView(id);
    return m_ids.contains(mat) || InRange(mat);
}

namespace {

// The selection of the last text read.
const CSelection* LastSelection(std::string_view text) {
    thread_local bool read = false;
    thread_local std::string lastText;
    thread_local std::optional<CSelection> lastSelection;
    if (!read || text != lastText) {
        lastSelection = CSelection::Parse(text);
        lastText.assign(text);
        read = true;
    }
    return lastSelection ? &*lastSelection : nullptr;
}

} // namespace

bool IsValidSelString(std::string_view text) {
    return LastSelection(text) != nullptr;
}

long long GetSelStringCount(std::string_view text) {
    const CSelection* selection = LastSelection(text);
    return selection ? selection->Count() : 0;
}

bool IsPointInSel(std::string_view id, std::string_view text) {
    const CSelection* selection = LastSelection(text);
    return selection && selection->Contains(id);
}

} // namespace pyr
