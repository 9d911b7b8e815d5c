#pragma once

#include <functional>
#include <string>
#include <vector>

// The two lists of a point computation: the sightings available and those taken into the calculation,
// moved from one to the other by four arrows (add one, add all, remove one, remove all), each list with
// its highlighted line. The dialogs of intersection, resection and their kin hold one and compute again
// after every move.
namespace pyr {

class CSightingLists {
public:
    // A line of either list.
    struct Line {
        int index = -1;      // the sighting element
        int station = -1;    // its station element
        std::string text;    // what the list shows: "S1(2)  P"
        std::string tooltip; // "%s %s : %s": the sighting's command, point and parameters
    };

    // New sightings available; none taken.
    void Fill(std::vector<Line> available);

    const std::vector<Line>& Available() const { return m_available; }
    const std::vector<Line>& Selected() const { return m_selected; }
    // The highlighted line of each list, -1 for none (a rank out of the list counts as none).
    void HighlightAvailable(int rank);
    void HighlightSelected(int rank);
    int HighlightedAvailable() const { return m_highAvailable; }
    int HighlightedSelected() const { return m_highSelected; }

    // The four arrows: each returns whether a line moved. A line taken goes to the end of the other list;
    // the highlight stays on the line that took its place.
    bool AddOne();
    bool AddAll();
    bool RemoveOne();
    bool RemoveAll();
    // Takes exactly the lines `keep` accepts, in GéoBase order, the others left available. Returns whether
    // any was taken.
    bool SelectOnly(const std::function<bool(const Line&)>& keep);

    // The enabling of the arrows.
    bool CanAddOne() const { return m_highAvailable >= 0; }
    bool CanAddAll() const { return !m_available.empty(); }
    bool CanRemoveOne() const { return m_highSelected >= 0; }
    bool CanRemoveAll() const { return !m_selected.empty(); }
    // The lines of both lists.
    std::size_t Count() const { return m_available.size() + m_selected.size(); }

private:
    static bool Move(std::vector<Line>& from, std::vector<Line>& to, int& highlight);

    std::vector<Line> m_available;
    std::vector<Line> m_selected;
    int m_highAvailable = -1;
    int m_highSelected = -1;
};

} // namespace pyr
