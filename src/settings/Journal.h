#pragma once

#include "ui/FrontEnd.h"

#include <ctime>
#include <string>
#include <string_view>
#include <vector>

// The journal of a GéoBase: a text file beside it ("chantier.geo" gives "chantier.jnl") to which every
// computation appends, when it closes having written points, the date and its name, then a line for
// each point (and station) written, in the order of writing. It is never rewritten, only appended to:
// it is the history of the job.
namespace pyr {

// What each computation writes after the date.
inline constexpr const char* kJournalIntersection = "Calcul de points par intersection";
inline constexpr const char* kJournalResection = "Calcul de points par relèvement";
inline constexpr const char* kJournalRecoupement = "Calcul de points par recoupement";
inline constexpr const char* kJournalEccentric = "Calcul d'une station excentrée";
inline constexpr const char* kJournalStationV0 = "Calcul des V0 de stations";

// The GéoBase's path with its extension replaced by "jnl" (added when it has none).
std::string JournalPath(std::string_view geoBasePath);

// "\n\n<date> - <computation>", the date as "%A %d %B %Y à %H h %M mn" in French.
std::string JournalHeader(std::string_view computation, const std::tm& when);
// The line of a written point: its coordinates known among X, Y (both or neither) and Z, in metres
// with four decimals, Y before X when the surveyor's axes are swapped.
std::string JournalPointLine(std::string_view mat, double x, double y, double z, bool yFirst);
// The line of a written station: its V0 in grads with five decimals.
std::string JournalStationLine(std::string_view station, double v0);

// Whether the surveyor wants a journal ("ProduireJournal" of the listing options).
bool JournalWanted(std::string_view paramPath);

// The lines of one computation, gathered while it writes its results and appended on closing.
class CJournal {
public:
    CJournal(std::string geoBasePath, std::string computation)
        : m_geoBasePath(std::move(geoBasePath)), m_computation(std::move(computation)) {}

    void AddPoint(std::string_view mat, double x, double y, double z, bool yFirst) {
        m_lines.push_back(JournalPointLine(mat, x, y, z, yFirst));
    }
    void AddStation(std::string_view station, double v0) {
        m_lines.push_back(JournalStationLine(station, v0));
    }
    bool IsEmpty() const { return m_lines.empty(); }

    // Appends the header and the lines to the journal, then forgets them. Nothing is written when no
    // line was gathered. The journal is completed through a copy of it renamed over it, so that an
    // append cut short (a full disk) leaves it whole. When it cannot be written, the front end is told
    // which file and why, as a failure of the command, and the lines are kept, so that a later call may
    // still write them. Returns whether the lines were written.
    bool Append(ui::FrontEnd& frontEnd, const std::tm& when);
    bool Append(ui::FrontEnd& frontEnd);

private:
    std::string m_geoBasePath;
    std::string m_computation;
    std::vector<std::string> m_lines;
};

} // namespace pyr
