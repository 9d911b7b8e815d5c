#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pyr {

struct StationPlace;

// The combo of the station occurrences a dialog can compute, each shown "S1 (2)": its name and
// occurrence. A person or a command line names one as "S1" (its first occurrence offered), "S1(2)" or
// "S1 (2)".
class CStationChoice {
public:
    void Clear();
    // Offers a station occurrence; returns what the combo shows.
    const std::string& Offer(const StationPlace& place);
    const std::vector<std::string>& Shown() const { return m_shown; }
    bool Empty() const { return m_shown.empty(); }
    // The station element named, -1 when it is not offered.
    int Find(std::string_view designation) const;
    // What the combo shows for an occurrence.
    static std::string ShownAs(const StationPlace& place);

private:
    struct Offered {
        int index;
        std::string name;
        int reprise;
    };
    std::vector<std::string> m_shown;
    std::vector<Offered> m_offered;
};

} // namespace pyr
