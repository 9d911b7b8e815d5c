#include "editor/DuplicatePoints.h"

#include "calc/ListingTables.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstdint>
#include <iterator>

namespace pyr {

namespace {

// Cells narrower than this (m) would only multiply them: a tolerance of 0 searches coincident points in
// cells of 1 mm.
constexpr double kMinCellMetre = 0.001;
// Cells are twice as wide as the tolerance: a point reaches into the next column (or row) of cells only
// from the half of its cell beside it, so that most points look into four cells, not nine.
constexpr double kCellsPerTolerance = 2.0;
// The cells a point looks into cover its reach and this part of a cell more on each side, so that no
// rounding of a coordinate divided by the cell's width leaves a point within reach outside them.
constexpr double kReachMargin = 0.01;
// Cell numbers are kept within this: a coordinate that no survey holds (beyond 10^15 m) shares the
// border cell, which changes how many points are compared, never which couples are found.
constexpr double kMaxCellNumber = 4e18;
// The couples of a listing drawn as one table: its texts are held until it is drawn.
constexpr std::size_t kPairsPerTable = 10'000;

// A point standing for its identifier.
struct GridPoint {
    double x;
    double y;
    int index;       // its element
    std::int64_t cx; // its cell
    std::int64_t cy;
};

std::int64_t CellNumber(double coordinate, double width) {
    return static_cast<std::int64_t>(
        std::clamp(std::floor(coordinate / width), -kMaxCellNumber, kMaxCellNumber));
}

std::uint64_t CellHash(std::int64_t cx, std::int64_t cy) {
    // splitmix64's finaliser over both numbers: neighbouring cells land far apart in the table.
    std::uint64_t h = static_cast<std::uint64_t>(cx) * 0x9E3779B97F4A7C15ull ^ static_cast<std::uint64_t>(cy);
    h ^= h >> 30;
    h *= 0xBF58476D1CE4E5B9ull;
    h ^= h >> 27;
    h *= 0x94D049BB133111EBull;
    h ^= h >> 31;
    return h;
}

// The occupied cells in an open-addressed table of the first point of each (the cell's numbers are
// those of that point); the points of a cell are chained through `next`, in their order. Each slot keeps
// the high half of its cell's hash, so that a search passing over other cells' slots seldom reads their
// points.
class CellGrid {
public:
    explicit CellGrid(const std::vector<GridPoint>& points) : m_points(points), m_next(points.size(), -1) {
        const std::size_t slots = std::bit_ceil(std::max<std::size_t>(16, points.size() * 2));
        m_mask = slots - 1;
        m_slots.assign(slots, Slot{});
        // From the last point to the first, each put at the head of its cell's chain.
        for (int p = static_cast<int>(points.size()) - 1; p >= 0; --p) {
            const std::uint64_t hash = CellHash(points[p].cx, points[p].cy);
            Slot& slot = m_slots[Find(points[p].cx, points[p].cy, hash)];
            m_next[p] = slot.first;
            slot = {p, static_cast<std::uint32_t>(hash >> 32)};
        }
    }

    // The first point of that cell, -1 when it is empty; then Next.
    int First(std::int64_t cx, std::int64_t cy) const {
        return m_slots[Find(cx, cy, CellHash(cx, cy))].first;
    }
    int Next(int p) const { return m_next[p]; }

private:
    struct Slot {
        int first = -1; // -1: an empty slot
        std::uint32_t tag = 0;
    };

    // The slot of that cell: its own, or the empty one where it would go.
    std::size_t Find(std::int64_t cx, std::int64_t cy, std::uint64_t hash) const {
        const auto tag = static_cast<std::uint32_t>(hash >> 32);
        for (std::size_t index = hash & m_mask;; index = (index + 1) & m_mask) {
            const Slot& slot = m_slots[index];
            if (slot.first < 0) return index;
            if (slot.tag != tag) continue;
            const GridPoint& point = m_points[static_cast<std::size_t>(slot.first)];
            if (point.cx == cx && point.cy == cy) return index;
        }
    }

    const std::vector<GridPoint>& m_points;
    std::vector<int> m_next;
    std::vector<Slot> m_slots;
    std::size_t m_mask = 0;
};

double Distance(double x1, double y1, double x2, double y2) {
    const double dx = x2 - x1, dy = y2 - y1;
    return std::sqrt(dx * dx + dy * dy);
}

// The couples as a table of two lines each: the couple's number and distance with its first point, then
// its second point. A table is drawn every kPairsPerTable couples, the column titles over the first.
void DrawPairs(CDlgCfgListing& listing, const CCarnet& carnet, const std::vector<DuplicatePair>& pairs) {
    const bool swap = CPointGen::SwapXY();
    std::array<std::string_view, std::size(msg::kDuplicateListColumns)> titles;
    std::copy(std::begin(msg::kDuplicateListColumns), std::end(msg::kDuplicateListColumns), titles.begin());
    if (swap) std::swap(titles[3], titles[4]);

    ListingTable table;
    auto addPoint = [&](int index) {
        table.Add(carnet.matAt(index));
        table.Add(std::to_string(index + 1));
        const double x = carnet.xAt(index), y = carnet.yAt(index);
        table.Add(listing.FormatCoor(swap ? y : x));
        table.Add(listing.FormatCoor(swap ? x : y));
    };
    for (std::size_t start = 0; start < pairs.size(); start += kPairsPerTable) {
        table.Clear(titles.size());
        if (start == 0) table.AddRow(titles);
        const std::size_t end = std::min(pairs.size(), start + kPairsPerTable);
        for (std::size_t i = start; i < end; ++i) {
            table.Add(std::to_string(i + 1));
            addPoint(pairs[i].first);
            table.Add(listing.FormatDist(pairs[i].distance));
            table.Add("");
            addPoint(pairs[i].second);
            table.Add("");
        }
        DrawTable(listing, table, start == 0, 2);
    }
}

std::string ToleranceText(double tolerance) {
    return Sprintf("%.*f", CPointGen::DeciXY(), tolerance);
}

} // namespace

bool IsValidDuplicateTolerance(double toleranceMetre) {
    return toleranceMetre >= 0.0 && toleranceMetre <= kMaxDuplicateTolerance; // false for NaN
}

DuplicatePoints FindDuplicatePoints(const CCarnet& carnet, double toleranceMetre) {
    DuplicatePoints results;
    results.tolerance = toleranceMetre;
    const double reach = toleranceMetre + kDuplicateDistanceSlack;
    const double width = std::max(toleranceMetre, kMinCellMetre) * kCellsPerTolerance;
    const double probe = reach + kReachMargin * width;

    // The first planimetric point of each identifier; the later ones of the same identifier set apart
    // when they stand elsewhere.
    std::vector<int> firstOf(static_cast<std::size_t>(carnet.NameCount()), -1); // by name rank
    std::vector<GridPoint> points;
    points.reserve(static_cast<std::size_t>(carnet.GetSize())); // untouched room costs no memory
    for (int i = 0; i < carnet.GetSize(); ++i) {
        if (carnet.GetType(i) != kKindPoint) continue;
        const auto* point = carnet.As<CPointGen>(i);
        if (!point || !point->hasXY() || !std::isfinite(point->x()) || !std::isfinite(point->y())) continue;
        const int rank = carnet.NameRank(i);
        if (rank < 0) continue;
        int& first = firstOf[static_cast<std::size_t>(rank)];
        if (first < 0) {
            first = static_cast<int>(points.size());
            points.push_back(
                {point->x(), point->y(), i, CellNumber(point->x(), width), CellNumber(point->y(), width)});
            continue;
        }
        const GridPoint& place = points[static_cast<std::size_t>(first)];
        const double distance = Distance(place.x, place.y, point->x(), point->y());
        if (distance > reach) results.conflicts.push_back({place.index, i, distance});
    }
    results.examined = static_cast<int>(points.size());

    // Each point with the later ones of the cells its reach touches, in the order of the points, so that
    // the couples come sorted by their first element and the search may stop at the limit.
    const CellGrid grid(points);
    const double reach2 = reach * reach;
    std::vector<DuplicatePair> found;
    for (int p = 0; p < static_cast<int>(points.size()); ++p) {
        const GridPoint& a = points[static_cast<std::size_t>(p)];
        found.clear();
        const std::int64_t xFrom = CellNumber(a.x - probe, width), xTo = CellNumber(a.x + probe, width);
        const std::int64_t yFrom = CellNumber(a.y - probe, width), yTo = CellNumber(a.y + probe, width);
        for (std::int64_t cx = xFrom; cx <= xTo; ++cx)
            for (std::int64_t cy = yFrom; cy <= yTo; ++cy)
                for (int q = grid.First(cx, cy); q >= 0; q = grid.Next(q)) {
                    if (q <= p) continue;
                    const GridPoint& b = points[static_cast<std::size_t>(q)];
                    const double ex = b.x - a.x, ey = b.y - a.y;
                    if (ex * ex + ey * ey <= reach2)
                        found.push_back({a.index, b.index, std::sqrt(ex * ex + ey * ey)});
                }
        std::sort(found.begin(), found.end(),
                  [](const DuplicatePair& l, const DuplicatePair& r) { return l.second < r.second; });
        results.pairs.insert(results.pairs.end(), found.begin(), found.end());
        if (results.pairs.size() > kMaxDuplicatePairs) {
            results.pairs.resize(kMaxDuplicatePairs);
            results.truncated = true;
            break;
        }
    }
    return results;
}

ElementReplacements CodeDuplicates(const CCarnet& carnet, const DuplicatePoints& results,
                                   const std::string& code) {
    ElementReplacements replacements;
    if (code.empty()) return replacements;
    std::vector<int> later;
    later.reserve(results.pairs.size());
    for (const DuplicatePair& pair : results.pairs)
        later.push_back(pair.second);
    std::sort(later.begin(), later.end());
    later.erase(std::unique(later.begin(), later.end()), later.end());
    for (int index : later) {
        if (carnet.symAt(index) == code) continue;
        std::unique_ptr<CElement> element = carnet.copyElement(index);
        if (!element) continue;
        element->setSym(code);
        replacements.push_back({index, std::move(element)});
    }
    return replacements;
}

std::string DuplicatePointsSummary(const DuplicatePoints& results) {
    std::string line =
        Sprintf(msg::kDuplicateSummary, results.pairs.size(), ToleranceText(results.tolerance).c_str());
    if (!results.conflicts.empty())
        line += Sprintf(msg::kDuplicateSummaryConflicts, results.conflicts.size());
    if (results.truncated) line += Sprintf(msg::kDuplicateSummaryTruncated, results.pairs.size());
    return line;
}

void WriteDuplicatePoints(CDlgCfgListing& listing, const CCarnet& carnet, const DuplicatePoints& results) {
    const std::string tolerance = listing.FormatDist(results.tolerance);
    DrawFrame(listing, {msg::kDuplicateListFrame}, true);
    Blank(listing);
    listing.WriteLine(msg::kDuplicateListTolerance, tolerance.c_str());
    listing.WriteLine(msg::kDuplicateListExamined, results.examined);
    listing.WriteLine(msg::kDuplicateListPairCount, results.pairs.size());
    listing.WriteLine(msg::kDuplicateListConflictCount, results.conflicts.size());
    Blank(listing);

    if (results.pairs.empty()) {
        listing.WriteLine("%s\n", msg::kDuplicateListNone);
    } else {
        listing.rtfWriteTabTitle(Sprintf(msg::kDuplicateListPairsTitle, tolerance.c_str()));
        DrawPairs(listing, carnet, results.pairs);
    }
    if (results.truncated) listing.WriteLine(msg::kDuplicateListTruncated, results.pairs.size());
    if (!results.conflicts.empty()) {
        Blank(listing);
        listing.rtfWriteTabTitle(Sprintf(msg::kDuplicateListConflictsTitle, tolerance.c_str()));
        DrawPairs(listing, carnet, results.conflicts);
    }
}

ListingRequest DuplicatePointsListing(std::string_view paramPath, const CCarnet& carnet,
                                      const DuplicatePoints& results) {
    ListingRequest request;
    request.paramPath = paramPath;
    request.geobasePath = carnet.PathName();
    request.kind = ListingKind::DuplicatePoints;
    request.resultCount = 1;
    request.writeResult = [&carnet, &results](CDlgCfgListing& listing, std::size_t) {
        WriteDuplicatePoints(listing, carnet, results);
    };
    return request;
}

} // namespace pyr
