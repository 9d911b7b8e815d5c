#include "calc/TraverseSearch.h"

#include "calc/SightingReduction.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"

#include <algorithm>
#include <set>
#include <unordered_set>

namespace pyr {

namespace {

// One set-up: its station element, its point (by the rank of its identifier in the GéoBase), the points it
// sights (their ranks, each once, sorted), its neighbours (edge numbers).
struct SetUp {
    int index = -1;
    int rank = -1;
    std::vector<int> sighted;
    std::vector<int> edges;
    bool known = false;
    bool Sights(int point) const { return std::binary_search(sighted.begin(), sighted.end(), point); }
};

struct Edge {
    int a = -1, b = -1;
    bool used = false;
    int Other(int node) const { return node == a ? b : a; }
};

std::string Designation(const CCarnet& carnet, int stationIndex) {
    return carnet.RepriseAt(stationIndex) > 1 ? carnet.StationDesignation(stationIndex)
                                              : carnet.GetAt(stationIndex)->mat();
}

} // namespace

std::vector<FoundTraverse> FindTraverses(const CCarnet& carnet) {
    // The set-ups and what each sights, identifiers compared by their ranks in the GéoBase's index.
    std::vector<SetUp> setUps;
    std::vector<int> firstOnPoint(static_cast<std::size_t>(carnet.NameCount()), -1); // by rank
    std::vector<int> nextOnPoint;                                                    // by set-up
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (kind == kKindStation) {
            SetUp setUp;
            setUp.index = i;
            setUp.rank = carnet.NameRank(i);
            double x = 0.0, y = 0.0, z = 0.0;
            setUp.known = PointPlaceOf(carnet, i, x, y, z);
            const int number = static_cast<int>(setUps.size());
            if (setUp.rank >= 0) {
                int& first = firstOnPoint[static_cast<std::size_t>(setUp.rank)];
                nextOnPoint.push_back(first);
                first = number;
            } else {
                nextOnPoint.push_back(-1);
            }
            setUps.push_back(std::move(setUp));
        } else if (IsSightingKind(kind) && !setUps.empty() && carnet.NameRank(i) >= 0) {
            setUps.back().sighted.push_back(carnet.NameRank(i));
        }
    }
    for (SetUp& setUp : setUps) {
        std::sort(setUp.sighted.begin(), setUp.sighted.end());
        setUp.sighted.erase(std::unique(setUp.sighted.begin(), setUp.sighted.end()), setUp.sighted.end());
    }
    // The neighbours: each sights the other's point.
    std::vector<Edge> edges;
    for (int a = 0; a < static_cast<int>(setUps.size()); ++a) {
        const SetUp& from = setUps[static_cast<std::size_t>(a)];
        for (const int point : from.sighted)
            for (int b = firstOnPoint[static_cast<std::size_t>(point)]; b >= 0;
                 b = nextOnPoint[static_cast<std::size_t>(b)]) {
                SetUp& to = setUps[static_cast<std::size_t>(b)];
                if (b <= a || to.rank == from.rank || !to.Sights(from.rank)) continue;
                const int edge = static_cast<int>(edges.size());
                edges.push_back({a, b});
                setUps[static_cast<std::size_t>(a)].edges.push_back(edge);
                to.edges.push_back(edge);
            }
    }
    // Each set-up's edges in the order they were found: the search is the same each time.
    for (SetUp& setUp : setUps)
        std::sort(setUp.edges.begin(), setUp.edges.end());

    std::vector<FoundTraverse> found;
    for (int start = 0; start < static_cast<int>(setUps.size()); ++start) {
        const SetUp& first = setUps[static_cast<std::size_t>(start)];
        if (!first.known) continue;
        for (int edge : first.edges) {
            if (edges[static_cast<std::size_t>(edge)].used) continue;
            const int second = edges[static_cast<std::size_t>(edge)].Other(start);
            // Two known set-ups seeing each other make no traverse: nothing lies between them to compute.
            if (setUps[static_cast<std::size_t>(second)].known) continue;
            std::vector<int> chain{start};
            std::vector<int> walked{edge};
            int previousEdge = edge;
            int current = second;
            bool reached = false;
            while (true) {
                chain.push_back(current);
                const SetUp& here = setUps[static_cast<std::size_t>(current)];
                if (here.known) {
                    reached = true;
                    break;
                }
                if (here.edges.size() != 2) break; // a dead end or a junction
                const int nextEdge = here.edges[0] == previousEdge ? here.edges[1] : here.edges[0];
                if (edges[static_cast<std::size_t>(nextEdge)].used) break;
                walked.push_back(nextEdge);
                previousEdge = nextEdge;
                current = edges[static_cast<std::size_t>(nextEdge)].Other(current);
                if (std::find(chain.begin() + 1, chain.end(), current) != chain.end())
                    break; // a loop of unknowns
            }
            for (int e : walked)
                edges[static_cast<std::size_t>(e)].used = true;
            if (!reached) continue;
            FoundTraverse traverse;
            const bool closed = setUps[static_cast<std::size_t>(chain.back())].rank == first.rank;
            traverse.closed = closed;
            if (closed) chain.pop_back(); // a closed traverse names its start once
            for (int node : chain)
                traverse.stations.push_back(
                    Designation(carnet, setUps[static_cast<std::size_t>(node)].index));
            found.push_back(std::move(traverse));
        }
    }
    return found;
}

std::vector<std::string> AddFoundTraverses(CCarnet& carnet, const std::vector<FoundTraverse>& found) {
    // The traverses already written, by their stations, either way round.
    std::set<std::vector<std::string>> written;
    std::unordered_set<std::string> names;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        if (carnet.GetType(i) != kKindChemin) continue;
        std::vector<std::string> stations = carnet.As<CChemin>(i)->stations();
        names.insert(carnet.matAt(i));
        written.insert(stations);
        std::reverse(stations.begin(), stations.end());
        written.insert(std::move(stations));
    }
    std::vector<std::string> added;
    long long number = 0;
    for (const FoundTraverse& traverse : found) {
        if (written.contains(traverse.stations)) continue;
        std::vector<std::string> reversed(traverse.stations.rbegin(), traverse.stations.rend());
        if (written.contains(reversed)) continue;
        std::string name;
        do
            name = "CH" + std::to_string(++number);
        while (names.contains(name) || carnet.findMat(name) >= 0);
        auto element = std::make_unique<CChemin>(name);
        for (const std::string& station : traverse.stations)
            element->add(station);
        element->setClosed(traverse.closed);
        if (carnet.Add(std::move(element), kKindChemin) < 0) continue;
        names.insert(name);
        written.insert(traverse.stations);
        added.push_back(name);
    }
    return added;
}

} // namespace pyr
