#include "calc/TraverseSearch.h"

#include "core/Strings.h"
#include "geobase/Carnet.h"

#include <algorithm>
#include <set>
#include <string_view>
#include <unordered_map>
#include <unordered_set>

namespace pyr {

namespace {

// One set-up: its station element, its point, what it sights, its neighbours (edge numbers).
struct SetUp {
    int index = -1;
    std::string_view name;
    std::unordered_set<std::string_view> sighted;
    std::vector<std::string_view> order; // the points sighted, each once, in the order of the sightings
    std::vector<int> edges;
    bool known = false;
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
    // The set-ups and what each sights.
    std::vector<SetUp> setUps;
    std::unordered_map<std::string_view, std::vector<int>> byName;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (kind == kKindStation) {
            SetUp setUp;
            setUp.index = i;
            setUp.name = carnet.GetAt(i)->mat();
            setUp.known = carnet.hasXY(setUp.name);
            byName[setUp.name].push_back(static_cast<int>(setUps.size()));
            setUps.push_back(std::move(setUp));
        } else if (IsSightingKind(kind) && !setUps.empty()) {
            SetUp& setUp = setUps.back();
            if (setUp.sighted.insert(carnet.GetAt(i)->mat()).second)
                setUp.order.push_back(carnet.GetAt(i)->mat());
        }
    }
    // The neighbours: each sights the other's point.
    std::vector<Edge> edges;
    for (int a = 0; a < static_cast<int>(setUps.size()); ++a)
        for (std::string_view name : setUps[static_cast<std::size_t>(a)].order) {
            const auto found = byName.find(name);
            if (found == byName.end()) continue;
            for (int b : found->second) {
                if (b <= a ||
                    setUps[static_cast<std::size_t>(b)].name == setUps[static_cast<std::size_t>(a)].name)
                    continue;
                if (!setUps[static_cast<std::size_t>(b)].sighted.contains(
                        setUps[static_cast<std::size_t>(a)].name))
                    continue;
                const int edge = static_cast<int>(edges.size());
                edges.push_back({a, b});
                setUps[static_cast<std::size_t>(a)].edges.push_back(edge);
                setUps[static_cast<std::size_t>(b)].edges.push_back(edge);
            }
        }
    // Each set-up's edges in the order they were found, the GéoBase's: the search is the same each time.
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
            const bool closed = setUps[static_cast<std::size_t>(chain.back())].name == first.name;
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
