#include "editor/GeoScene.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <string_view>
#include <tuple>
#include <unordered_map>
#include <utility>

namespace pyr {

namespace {

// About this many points and stations to a cell: a window query then reads few cells and few items
// outside the window. The grid never exceeds kMaxCells, whatever the job.
constexpr double kItemsPerCell = 2.0;
constexpr double kMaxCells = 4.0e6;

// What the scene knows of one identifier while it is built.
struct NameSlot {
    int point = -1;        // the drawn point, once an element gave a planimetry
    double z = kUndefined; // the first altitude an element gave
    int setUps = 0;        // station set-ups met so far on it, drawn or not
    int firstStation = -1; // its drawn set-ups, chained
    int lastStation = -1;
};

using NameSlots = std::unordered_map<std::string_view, NameSlot>;

std::string Designation(const std::string& name, int reprise) {
    return reprise <= 1 ? name : Sprintf("%s(%d)", name.c_str(), reprise);
}

std::string Place(double x, double y, double z) {
    using namespace scenetext;
    const std::string altitude = IsKnown(z) ? Sprintf(kAltitude, FormatFixed(z, CPointGen::DeciZ()).c_str())
                                            : std::string(kNoAltitude);
    return Sprintf(kPlace, FormatFixed(x, CPointGen::DeciXY()).c_str(),
                   FormatFixed(y, CPointGen::DeciXY()).c_str(), altitude.c_str());
}

} // namespace

void GroundRect::Extend(double x, double y) {
    minX = std::min(minX, x);
    minY = std::min(minY, y);
    maxX = std::max(maxX, x);
    maxY = std::max(maxY, y);
}

void GeoScene::Clear() {
    *this = GeoScene();
}

void GeoScene::Build(const CCarnet& carnet) {
    Clear();
    const int size = carnet.GetSize();
    NameSlots slots;
    slots.reserve(static_cast<std::size_t>(size) / 2 + 16);

    // The points first: a sighting may come before the point it sighted in the GéoBase. The element kinds
    // fix the element classes, so that no element needs a dynamic cast.
    for (int i = 0; i < size; ++i) {
        if (carnet.GetType(i) != kKindPoint) continue;
        const auto& element = static_cast<const CPointGen&>(*carnet.GetAt(i));
        NameSlot& slot = slots[element.mat()];
        if (IsUndefined(slot.z) && element.hasZ()) slot.z = element.z();
        if (slot.point < 0 && element.hasXY()) {
            slot.point = static_cast<int>(m_points.size());
            ScenePoint& point = m_points.emplace_back();
            point.name = element.mat();
            point.x = element.x();
            point.y = element.y();
            point.known = element.invariantXY();
            point.element = i;
            m_extent.Extend(point.x, point.y);
        }
    }
    for (auto& [name, slot] : slots)
        if (slot.point >= 0) m_points[static_cast<std::size_t>(slot.point)].z = slot.z;

    // Stations and their sightings, in order: a sighting belongs to the nearest station before it.
    std::vector<int> traverses;
    // The drawn set-up the sightings belong to; -1 when it is not drawn, and before the first station.
    int station = -1;
    for (int i = 0; i < size; ++i) {
        const int kind = carnet.GetType(i);
        if (kind == kKindStation) {
            const auto& element = static_cast<const CStation&>(*carnet.GetAt(i));
            NameSlot& slot = slots[element.mat()];
            const int reprise = ++slot.setUps;
            if (slot.point < 0) {
                ++m_unplacedStations;
                station = -1;
                continue;
            }
            station = static_cast<int>(m_stations.size());
            ScenePoint& point = m_points[static_cast<std::size_t>(slot.point)];
            point.stationHere = true;
            SceneStation& setUp = m_stations.emplace_back();
            setUp.name = element.mat();
            setUp.designation = Designation(setUp.name, reprise);
            setUp.reprise = reprise;
            setUp.element = i;
            setUp.x = point.x;
            setUp.y = point.y;
            setUp.z = point.z;
            setUp.hi = element.hi();
            setUp.v0 = element.v0();
            if (slot.firstStation < 0)
                slot.firstStation = station;
            else
                m_stations[static_cast<std::size_t>(slot.lastStation)].nextOnPoint = station;
            setUp.firstOnPoint = slot.firstStation;
            slot.lastStation = station;
        } else if (IsSightingKind(kind)) {
            const bool reference = kind == kKindReference;
            if (station < 0) {
                ++m_undrawnSightings;
                continue;
            }
            SceneStation& setUp = m_stations[static_cast<std::size_t>(station)];
            ++(reference ? setUp.references : setUp.measures);
            const auto found = slots.find(carnet.GetAt(i)->mat());
            if (found == slots.end() || found->second.point < 0) {
                ++m_undrawnSightings;
                continue;
            }
            m_sightings.push_back({station, found->second.point, reference, i});
        } else if (kind == kKindChemin) {
            traverses.push_back(i);
        }
    }

    // Traverses: through their set-ups, "S1(2)" or "S1" for the first one.
    for (int element : traverses) {
        const auto& chemin = static_cast<const CChemin&>(*carnet.GetAt(element));
        const int traverse = static_cast<int>(m_traverses.size());
        m_traverses.push_back({chemin.mat(), chemin.isClosed(), element});
        std::vector<int> run; // the placed set-ups since the last interruption
        std::vector<std::vector<int>> runs;
        for (const std::string& text : chemin.stations()) {
            std::string name;
            int reprise = 1;
            int found = -1;
            if (CCarnet::extrStaRep(text, name, reprise)) {
                const auto slot = slots.find(name);
                if (slot != slots.end())
                    for (int s = slot->second.firstStation; s >= 0;
                         s = m_stations[static_cast<std::size_t>(s)].nextOnPoint)
                        if (m_stations[static_cast<std::size_t>(s)].reprise == reprise) {
                            found = s;
                            break;
                        }
            }
            if (found >= 0) {
                run.push_back(found);
            } else if (!run.empty()) {
                runs.push_back(std::move(run));
                run.clear();
            }
        }
        const bool unbroken = runs.empty();
        if (!run.empty()) runs.push_back(std::move(run));
        // A closed traverse goes back to its first station when every station of it is placed.
        if (chemin.isClosed() && unbroken && runs.size() == 1 && runs[0].size() > 2)
            runs[0].push_back(runs[0][0]);
        for (const std::vector<int>& stations : runs)
            for (std::size_t k = 1; k < stations.size(); ++k) {
                const SceneStation& from = m_stations[static_cast<std::size_t>(stations[k - 1])];
                const SceneStation& to = m_stations[static_cast<std::size_t>(stations[k])];
                m_legs.push_back({traverse, from.x, from.y, to.x, to.y});
            }
    }

    BuildGrid();
}

// ---- The grid

int GeoScene::Column(double x) const {
    const double column = std::floor((x - m_extent.minX) / m_cellSize);
    return static_cast<int>(std::clamp(column, 0.0, static_cast<double>(m_columns - 1)));
}

int GeoScene::Row(double y) const {
    const double row = std::floor((y - m_extent.minY) / m_cellSize);
    return static_cast<int>(std::clamp(row, 0.0, static_cast<double>(m_rows - 1)));
}

template <class Visit>
void GeoScene::ForEachCellOf(double x1, double y1, double x2, double y2, Visit&& visit) const {
    if (y1 > y2) {
        std::swap(x1, x2);
        std::swap(y1, y2);
    }
    // Row by row: the part of the segment inside a row's band spans a run of columns. The run is widened
    // by a hair so that a segment through a cell's corner is listed in both cells that touch it.
    const double hair = m_cellSize * 1e-9;
    const int lastRow = Row(y2);
    for (int row = Row(y1); row <= lastRow; ++row) {
        double xa = x1;
        double xb = x2;
        if (y2 > y1) {
            const double low = std::max(y1, m_extent.minY + row * m_cellSize);
            const double high = std::min(y2, m_extent.minY + (row + 1) * m_cellSize);
            const double slope = (x2 - x1) / (y2 - y1);
            xa = x1 + slope * (low - y1);
            xb = x1 + slope * (high - y1);
        }
        const int firstColumn = Column(std::min(xa, xb) - hair);
        const int lastColumn = Column(std::max(xa, xb) + hair);
        for (int column = firstColumn; column <= lastColumn; ++column)
            visit(static_cast<std::size_t>(row) * static_cast<std::size_t>(m_columns) +
                  static_cast<std::size_t>(column));
    }
}

template <class Position>
void GeoScene::FillPointCells(CellLists& lists, std::size_t count, Position&& position) {
    const std::size_t cells = static_cast<std::size_t>(m_columns) * static_cast<std::size_t>(m_rows);
    std::vector<std::uint32_t> cellOf(count);
    lists.start.assign(cells + 1, 0);
    for (std::size_t i = 0; i < count; ++i) {
        const auto [x, y] = position(i);
        cellOf[i] = static_cast<std::uint32_t>(static_cast<std::size_t>(Row(y)) *
                                                   static_cast<std::size_t>(m_columns) +
                                               static_cast<std::size_t>(Column(x)));
        ++lists.start[cellOf[i] + 1];
    }
    std::partial_sum(lists.start.begin(), lists.start.end(), lists.start.begin());
    lists.items.resize(count);
    std::vector<std::uint32_t> next(lists.start.begin(), lists.start.end() - 1);
    for (std::size_t i = 0; i < count; ++i)
        lists.items[next[cellOf[i]]++] = static_cast<std::uint32_t>(i);
}

template <class Ends>
void GeoScene::FillSegmentCells(CellLists& lists, std::size_t count, Ends&& ends) {
    const std::size_t cells = static_cast<std::size_t>(m_columns) * static_cast<std::size_t>(m_rows);
    lists.start.assign(cells + 1, 0);
    for (std::size_t i = 0; i < count; ++i) {
        const auto [x1, y1, x2, y2] = ends(i);
        ForEachCellOf(x1, y1, x2, y2, [&](std::size_t cell) { ++lists.start[cell + 1]; });
    }
    std::partial_sum(lists.start.begin(), lists.start.end(), lists.start.begin());
    lists.items.resize(lists.start.back());
    std::vector<std::uint32_t> next(lists.start.begin(), lists.start.end() - 1);
    for (std::size_t i = 0; i < count; ++i) {
        const auto [x1, y1, x2, y2] = ends(i);
        ForEachCellOf(x1, y1, x2, y2,
                      [&](std::size_t cell) { lists.items[next[cell]++] = static_cast<std::uint32_t>(i); });
    }
}

void GeoScene::BuildGrid() {
    if (m_extent.IsEmpty()) return;
    // Square cells sized for the number of points over the extent; a long and narrow job (a road, a line
    // of points) still has cells as wide as a thousandth of its length.
    const double side = std::max(m_extent.Width(), m_extent.Height());
    const double items = static_cast<double>(m_points.size() + m_stations.size());
    const double cells = std::clamp(items / kItemsPerCell, 1.0, kMaxCells);
    const double width = std::max(m_extent.Width(), side / 1000);
    const double height = std::max(m_extent.Height(), side / 1000);
    m_cellSize = side > 0 ? std::sqrt(width * height / cells) : 1.0;
    m_columns = static_cast<int>(std::min(m_extent.Width() / m_cellSize, 4096.0)) + 1;
    m_rows = static_cast<int>(std::min(m_extent.Height() / m_cellSize, 4096.0)) + 1;
    // The cap on the columns and rows may leave cells too small to cover the extent: widen them.
    m_cellSize = std::max({m_cellSize, m_extent.Width() / m_columns, m_extent.Height() / m_rows});

    FillPointCells(m_pointCells, m_points.size(),
                   [&](std::size_t i) { return std::pair(m_points[i].x, m_points[i].y); });
    FillPointCells(m_stationCells, m_stations.size(),
                   [&](std::size_t i) { return std::pair(m_stations[i].x, m_stations[i].y); });
    FillSegmentCells(m_sightingCells, m_sightings.size(), [&](std::size_t i) {
        const SceneSighting& sighting = m_sightings[i];
        const SceneStation& from = m_stations[static_cast<std::size_t>(sighting.station)];
        const ScenePoint& to = m_points[static_cast<std::size_t>(sighting.target)];
        return std::tuple(from.x, from.y, to.x, to.y);
    });
    FillSegmentCells(m_legCells, m_legs.size(), [&](std::size_t i) {
        return std::tuple(m_legs[i].x1, m_legs[i].y1, m_legs[i].x2, m_legs[i].y2);
    });
}

void GeoScene::Query(const GroundRect& window, SceneSelection& selection) const {
    selection.points.clear();
    selection.stations.clear();
    selection.sightings.clear();
    selection.legs.clear();
    selection.whole = !m_extent.IsEmpty() && window.Contains(m_extent);
    if (selection.whole) {
        // Everything is seen: no cell to read.
        auto all = [](std::vector<int>& ids, std::size_t count) {
            ids.resize(count);
            std::iota(ids.begin(), ids.end(), 0);
        };
        all(selection.points, m_points.size());
        all(selection.stations, m_stations.size());
        all(selection.sightings, m_sightings.size());
        all(selection.legs, m_legs.size());
        return;
    }
    if (m_extent.IsEmpty() || window.IsEmpty() || !window.Intersects(m_extent)) return;

    const int firstColumn = Column(window.minX), lastColumn = Column(window.maxX);
    const int firstRow = Row(window.minY), lastRow = Row(window.maxY);
    auto cells = [&](auto&& visit) {
        for (int row = firstRow; row <= lastRow; ++row)
            for (int column = firstColumn; column <= lastColumn; ++column)
                visit(static_cast<std::size_t>(row) * static_cast<std::size_t>(m_columns) +
                      static_cast<std::size_t>(column));
    };
    auto places = [&](const CellLists& lists, std::vector<int>& ids, auto&& position) {
        cells([&](std::size_t cell) {
            for (std::uint32_t k = lists.start[cell]; k < lists.start[cell + 1]; ++k) {
                const std::uint32_t id = lists.items[k];
                const auto [x, y] = position(id);
                if (window.Contains(x, y)) ids.push_back(static_cast<int>(id));
            }
        });
    };
    places(m_pointCells, selection.points,
           [&](std::uint32_t i) { return std::pair(m_points[i].x, m_points[i].y); });
    places(m_stationCells, selection.stations,
           [&](std::uint32_t i) { return std::pair(m_stations[i].x, m_stations[i].y); });
    // A segment crossing several cells of the window is listed once.
    auto segments = [&](const CellLists& lists, std::vector<int>& ids, std::size_t count) {
        selection.seen.assign(count, 0);
        cells([&](std::size_t cell) {
            for (std::uint32_t k = lists.start[cell]; k < lists.start[cell + 1]; ++k) {
                const std::uint32_t id = lists.items[k];
                if (selection.seen[id]) continue;
                selection.seen[id] = 1;
                ids.push_back(static_cast<int>(id));
            }
        });
    };
    segments(m_sightingCells, selection.sightings, m_sightings.size());
    segments(m_legCells, selection.legs, m_legs.size());
}

// ---- Picking

SceneHit GeoScene::Pick(double x, double y, double tolerance) const {
    SceneHit hit;
    if (m_extent.IsEmpty() || !(tolerance >= 0)) return hit;
    const GroundRect window = GroundRect::Around(x, y, tolerance, tolerance);
    if (!window.Intersects(m_extent)) return hit;
    double bestPoint = tolerance, bestStation = tolerance;
    int point = -1, station = -1;
    const int firstColumn = Column(window.minX), lastColumn = Column(window.maxX);
    const int firstRow = Row(window.minY), lastRow = Row(window.maxY);
    auto nearest = [&](const CellLists& lists, auto&& position, double& best, int& found) {
        for (int row = firstRow; row <= lastRow; ++row)
            for (int column = firstColumn; column <= lastColumn; ++column) {
                const std::size_t cell = static_cast<std::size_t>(row) * static_cast<std::size_t>(m_columns) +
                                         static_cast<std::size_t>(column);
                for (std::uint32_t k = lists.start[cell]; k < lists.start[cell + 1]; ++k) {
                    const int id = static_cast<int>(lists.items[k]);
                    const auto [px, py] = position(lists.items[k]);
                    const double distance = std::hypot(px - x, py - y);
                    // Among items at the same distance, the first of the GéoBase.
                    if (distance < best || (distance == best && (found < 0 || id < found))) {
                        best = distance;
                        found = id;
                    }
                }
            }
    };
    nearest(
        m_pointCells, [&](std::uint32_t i) { return std::pair(m_points[i].x, m_points[i].y); }, bestPoint,
        point);
    nearest(
        m_stationCells, [&](std::uint32_t i) { return std::pair(m_stations[i].x, m_stations[i].y); },
        bestStation, station);
    if (station >= 0 && (point < 0 || bestStation <= bestPoint)) {
        hit.kind = SceneHit::Kind::Station;
        hit.index = m_stations[static_cast<std::size_t>(station)].firstOnPoint;
        hit.distance = bestStation;
        hit.description = DescribeStation(hit.index);
    } else if (point >= 0) {
        hit.kind = SceneHit::Kind::Point;
        hit.index = point;
        hit.distance = bestPoint;
        hit.description = DescribePoint(point);
    }
    return hit;
}

std::string GeoScene::DescribePoint(int index) const {
    using namespace scenetext;
    const ScenePoint& point = m_points.at(static_cast<std::size_t>(index));
    return Sprintf(kPoint, point.name.c_str()) + (point.known ? kKnownPoint : kComputedPoint) +
           Place(point.x, point.y, point.z);
}

std::string GeoScene::DescribeStation(int index) const {
    using namespace scenetext;
    const SceneStation& first =
        m_stations.at(static_cast<std::size_t>(m_stations.at(static_cast<std::size_t>(index)).firstOnPoint));
    std::string text = Sprintf(kStation, first.name.c_str()) + Place(first.x, first.y, first.z);
    const bool several = first.nextOnPoint >= 0;
    for (int s = first.firstOnPoint; s >= 0; s = m_stations[static_cast<std::size_t>(s)].nextOnPoint) {
        const SceneStation& setUp = m_stations[static_cast<std::size_t>(s)];
        const std::string designation = several ? setUp.designation + " : " : std::string();
        const std::string hi = IsKnown(setUp.hi)
                                   ? Sprintf(kHeight, FormatFixed(setUp.hi, CStation::DeciZ()).c_str())
                                   : std::string(kNoHeight);
        const std::string v0 = IsKnown(setUp.v0) && setUp.v0 >= 0
                                   ? Sprintf(kV0, FormatFixed(setUp.v0, CStation::DeciAng()).c_str())
                                   : std::string(kNoV0);
        const int sightings = setUp.references + setUp.measures;
        text += Sprintf(kSetUp, designation.c_str(), hi.c_str(), v0.c_str(), sightings,
                        sightings > 1 ? "s" : "", setUp.references, setUp.measures);
    }
    return text;
}

} // namespace pyr
