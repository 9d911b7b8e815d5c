#pragma once

#include "core/Strings.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

// Selections of points typed by the user: "100-150, A1-A9; P7 P-12". The grammar is written for
// surveyors in docs/identifiants.md.
namespace pyr {

namespace msg {

// Reasons why a selection is not correct; each one follows the item it is about: « 150-100 » : ...
inline constexpr const char* kSelWhyEmpty = "la liste ne désigne aucun point";
inline constexpr const char* kSelWhyUnfinished =
    "plage incomplète, il manque un matricule d'un côté du tiret";
inline constexpr const char* kSelWhyNoNumbers = "une plage va d'un matricule numéroté à un autre";
inline constexpr const char* kSelWhyPrefixes = "les deux bornes de la plage n'ont pas le même préfixe";
inline constexpr const char* kSelWhyReversed =
    "plage à l'envers, le premier numéro est plus grand que le dernier";
inline constexpr const char* kSelWhyTooLarge = "numéro trop grand";

} // namespace msg

// A selection read once, for testing every point of a GéoBase against it: plain identifiers in a hash
// set, ranges as sorted and merged number intervals per prefix.
class CSelection {
public:
    // The selection written in text, or nothing when the text is not a correct selection; `why` then
    // receives the French reason, with the faulty item.
    static std::optional<CSelection> Parse(std::string_view text, std::string* why = nullptr);

    // Whether the identifier is designated: the same identifier once normalised (letter case counts),
    // or the same prefix with a number inside a range ("A007" is in "A1-A9").
    bool Contains(std::string_view id) const;

    // How many identifiers the selection designates, each counted once: the numbers of its ranges, and
    // the plain identifiers that no range already holds. Saturates at the largest long long.
    long long Count() const { return m_count; }

private:
    struct Interval {
        long long first;
        long long last;
    };
    CSelection() = default;
    bool InRange(std::string_view normalisedId) const;

    TextSet m_ids;
    std::unordered_map<std::string, std::vector<Interval>, TextHash, std::equal_to<>> m_ranges;
    long long m_count = 0;
};

// The text forms the store forwards to. They keep the last text read, so that testing every point of
// a GéoBase against the same text reads it only once.
bool IsValidSelString(std::string_view text);
// The count of CSelection::Count, 0 for an incorrect text.
long long GetSelStringCount(std::string_view text);
// False for an incorrect text.
bool IsPointInSel(std::string_view id, std::string_view text);

} // namespace pyr
