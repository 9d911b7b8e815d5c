#pragma once

#include <string>
#include <vector>

// The automatic search of the traverses of a GéoBase: from its station set-ups and the sightings they
// make of one another, the chains of set-ups that run from a known station to a known station (or back to
// the same one), each set-up sighting the one before it and the one after it.
namespace pyr {

class CCarnet;

struct FoundTraverse {
    std::vector<std::string> stations; // designations, "S1" or "S1(2)" for a second set-up on S1
    bool closed = false;               // back on its first station, not repeated at the end
};

// Two set-ups are neighbours when each sights the other's point. A chain starts on a set-up over a point
// of known planimetry, goes through set-ups over unknown points that have exactly two neighbours, and ends
// on a set-up over a known point. A chain that ends nowhere (a set-up with one neighbour) or at a set-up
// with more than two neighbours (a junction) is not a traverse and is left out. Each pair of neighbours is
// looked at once: the search is linear in the size of the GéoBase.
std::vector<FoundTraverse> FindTraverses(const CCarnet& carnet);

// Appends the traverses found as traverse elements named "CH1", "CH2" ... (names no element uses), except
// those that a traverse of the GéoBase already runs through, either way round: a traverse the surveyor
// wrote stays as written. Returns the names of the traverses added.
std::vector<std::string> AddFoundTraverses(CCarnet& carnet, const std::vector<FoundTraverse>& found);

} // namespace pyr
