#pragma once

#include "core/Undefined.h"

#include <cstdint>
#include <limits>
#include <string>
#include <vector>

// What the graphic view of a GéoBase draws, in ground coordinates: X the easting and Y the northing, in
// metres, Y upwards. The scene is built once from a GéoBase and then holds its own copy of what is drawn,
// with a uniform grid over its extent, so that drawing a window of it or finding what lies under the
// cursor touches only the cells concerned.
namespace pyr {

class CCarnet;

// The words of the descriptions of what is picked.
namespace scenetext {
inline constexpr const char* kPoint = "Point %s";
inline constexpr const char* kKnownPoint = " (point connu)";
inline constexpr const char* kComputedPoint = " (point calculé)";
inline constexpr const char* kStation = "Station %s";
inline constexpr const char* kPlace = " : X = %s m, Y = %s m, %s";
inline constexpr const char* kAltitude = "Z = %s m";
inline constexpr const char* kNoAltitude = "Z inconnu";
inline constexpr const char* kSetUp = " ; %sHI = %s, %s, %d visée%s (%d de référence, %d de mesure)";
inline constexpr const char* kHeight = "%s m";
inline constexpr const char* kNoHeight = "inconnue";
inline constexpr const char* kV0 = "V0 = %s gr";
inline constexpr const char* kNoV0 = "V0 non calculé";
} // namespace scenetext

// A rectangle of the ground (metres). Empty until a point extends it.
struct GroundRect {
    double minX = std::numeric_limits<double>::infinity();
    double minY = std::numeric_limits<double>::infinity();
    double maxX = -std::numeric_limits<double>::infinity();
    double maxY = -std::numeric_limits<double>::infinity();

    static GroundRect Around(double x, double y, double halfWidth, double halfHeight) {
        return {x - halfWidth, y - halfHeight, x + halfWidth, y + halfHeight};
    }
    bool IsEmpty() const { return !(minX <= maxX && minY <= maxY); }
    double Width() const { return IsEmpty() ? 0.0 : maxX - minX; }
    double Height() const { return IsEmpty() ? 0.0 : maxY - minY; }
    double CentreX() const { return (minX + maxX) / 2; }
    double CentreY() const { return (minY + maxY) / 2; }
    void Extend(double x, double y);
    bool Contains(double x, double y) const { return x >= minX && x <= maxX && y >= minY && y <= maxY; }
    bool Contains(const GroundRect& other) const {
        return other.minX >= minX && other.maxX <= maxX && other.minY >= minY && other.maxY <= maxY;
    }
    bool Intersects(const GroundRect& other) const {
        return other.minX <= maxX && other.maxX >= minX && other.minY <= maxY && other.maxY >= minY;
    }
};

// A point of the GéoBase that has a planimetry: drawn once, at the first of its elements holding one.
struct ScenePoint {
    std::string name;
    double x = 0.0;
    double y = 0.0;
    double z = kUndefined; // from the first of its elements holding an altitude
    // A known point: its planimetry is declared invariant (a control point that no computation may move
    // without asking). The others are points computed or measured on the job.
    bool known = false;
    // A drawn station stands on it: the station's symbol and designation say it.
    bool stationHere = false;
    int element = -1; // the element that gives the planimetry
};

// A station set-up whose point has a planimetry.
struct SceneStation {
    std::string name;
    std::string designation; // "S1" for the first set-up on a point, "S1(2)" for the second
    int reprise = 1;
    int element = -1;
    double x = 0.0;
    double y = 0.0;
    double z = kUndefined;
    double hi = kUndefined; // instrument height (m)
    double v0 = kUndefined; // orientation (gr), known when >= 0
    int references = 0;     // sightings written under the set-up, drawn or not
    int measures = 0;
    int firstOnPoint = -1; // the set-ups on the same point, in GéoBase order: the first one,
    int nextOnPoint = -1;  // and the next one (-1 after the last)
};

// A sighting from a drawn station to a drawn point.
struct SceneSighting {
    int station = -1; // in Stations()
    int target = -1;  // in Points()
    bool reference = false;
    int element = -1;
};

// A leg of a traverse between two of its stations that are drawn; a station that cannot be placed
// interrupts the line rather than joining its neighbours by a leg that was never run.
struct SceneLeg {
    int traverse = -1; // in Traverses()
    double x1 = 0.0, y1 = 0.0, x2 = 0.0, y2 = 0.0;
};

struct SceneTraverse {
    std::string name;
    bool closed = false;
    int element = -1;
};

// What lies in a window of the scene (indices into the scene's lists), filled by GeoScene::Query. Kept by
// whoever draws, so that its memory serves every redraw.
struct SceneSelection {
    std::vector<int> points;
    std::vector<int> stations;
    std::vector<int> sightings;
    std::vector<int> legs;
    bool whole = false;             // the window holds the whole extent: every element is in it
    std::vector<std::uint8_t> seen; // scratch: a segment crossing several cells is listed once
};

// The nearest point or station to a place, with its description (French).
struct SceneHit {
    enum class Kind { None, Point, Station };
    Kind kind = Kind::None;
    int index = -1;        // in Points() or Stations()
    double distance = 0.0; // metres
    std::string description;

    explicit operator bool() const { return kind != Kind::None; }
};

class GeoScene {
public:
    GeoScene() = default;
    explicit GeoScene(const CCarnet& carnet) { Build(carnet); }

    void Build(const CCarnet& carnet);
    void Clear();

    const std::vector<ScenePoint>& Points() const { return m_points; }
    const std::vector<SceneStation>& Stations() const { return m_stations; }
    const std::vector<SceneSighting>& Sightings() const { return m_sightings; }
    const std::vector<SceneLeg>& Legs() const { return m_legs; }
    const std::vector<SceneTraverse>& Traverses() const { return m_traverses; }
    bool IsEmpty() const { return m_points.empty() && m_stations.empty(); }
    // Everything drawn; empty when nothing is.
    const GroundRect& Extent() const { return m_extent; }

    // What the GéoBase holds that cannot be drawn: station set-ups whose point has no planimetry, and
    // sightings whose station or sighted point has none.
    int UnplacedStations() const { return m_unplacedStations; }
    int UndrawnSightings() const { return m_undrawnSightings; }

    // The elements inside a window (a segment when it may cross it: its cells do).
    void Query(const GroundRect& window, SceneSelection& selection) const;

    // The nearest point or station within `tolerance` metres of (x, y); a station wins over the point it
    // stands on. Nothing when none is that close.
    SceneHit Pick(double x, double y, double tolerance) const;
    // "Point A1 (point connu) : X = 651050.1180 m, Y = 6862512.4470 m, Z = 55.021 m"; for a station, its
    // place and every set-up on it, with HI, V0 and the number of sightings.
    std::string DescribePoint(int index) const;
    std::string DescribeStation(int index) const;

private:
    // The uniform grid: square cells over the extent, one list of indices per cell and per layer, held
    // as offsets into one array (compressed rows).
    struct CellLists {
        std::vector<std::uint32_t> start; // cells + 1 offsets
        std::vector<std::uint32_t> items;
    };
    void BuildGrid();
    int Column(double x) const;
    int Row(double y) const;
    // Calls `visit(cell)` for every cell that the segment crosses.
    template <class Visit>
    void ForEachCellOf(double x1, double y1, double x2, double y2, Visit&& visit) const;
    template <class Position>
    void FillPointCells(CellLists& lists, std::size_t count, Position&& position);
    template <class Ends>
    void FillSegmentCells(CellLists& lists, std::size_t count, Ends&& ends);

    std::vector<ScenePoint> m_points;
    std::vector<SceneStation> m_stations;
    std::vector<SceneSighting> m_sightings;
    std::vector<SceneLeg> m_legs;
    std::vector<SceneTraverse> m_traverses;
    GroundRect m_extent;
    int m_unplacedStations = 0;
    int m_undrawnSightings = 0;

    double m_cellSize = 1.0;
    int m_columns = 0;
    int m_rows = 0;
    CellLists m_pointCells;
    CellLists m_stationCells;
    CellLists m_sightingCells;
    CellLists m_legCells;
};

} // namespace pyr
