// What the graphic view draws of a GéoBase: constructed jobs whose drawing is known beforehand.
#include "editor/GeoScene.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <memory>
#include <set>
#include <tuple>

namespace {

using pyr::CCarnet;
using pyr::GeoScene;
using pyr::GroundRect;
using pyr::SceneHit;

void Point(CCarnet& carnet, const std::string& name, double x, double y, double z, bool invariant = false) {
    auto point = std::make_unique<pyr::CPointGen>(name, x, y, z);
    point->setInvariantXY(invariant);
    carnet.Add(std::move(point), pyr::kKindPoint);
}
void Station(CCarnet& carnet, const std::string& name, double hi, double v0 = pyr::kUndefined) {
    carnet.Add(std::make_unique<pyr::CStation>(name, hi, v0), pyr::kKindStation);
}
// The readings do not matter: the view draws a sighting from its station to its target's place.
void Reference(CCarnet& carnet, const std::string& target) {
    carnet.Add(std::make_unique<pyr::CReference>(target, 1.3, 0.0, 100.0, 10.0), pyr::kKindReference);
}
void Measure(CCarnet& carnet, const std::string& target) {
    carnet.Add(std::make_unique<pyr::CMesure>(target, 1.3, 0.0, 100.0, 10.0), pyr::kKindMesure);
}
void Traverse(CCarnet& carnet, const char* name, std::initializer_list<const char*> stations, bool closed) {
    auto traverse = std::make_unique<pyr::CChemin>(name);
    for (const char* station : stations)
        traverse->add(station);
    traverse->setClosed(closed);
    carnet.Add(std::move(traverse), pyr::kKindChemin);
}

// A control point A1 and a computed point P1 100 m apart on the 2000 m northing; stations S1, S2, S3 at the
// corners of a right triangle above them, S1 set up twice; S9's point has no planimetry, P2 only an altitude.
CCarnet SmallJob() {
    CCarnet carnet;
    Reference(carnet, "A1"); // before any station: belongs to none
    Point(carnet, "A1", 1000.0, 2000.0, 50.0, true);
    Point(carnet, "S1", 1000.0, 2100.0, 51.0);
    Point(carnet, "S2", 1100.0, 2100.0, pyr::kUndefined);
    Point(carnet, "S3", 1000.0, 2200.0, 53.0);
    carnet.Add(std::make_unique<pyr::CPointGen>("P2", 49.5), pyr::kKindPoint);
    Point(carnet, "S9", pyr::kUndefined, pyr::kUndefined, 60.0);
    Station(carnet, "S1", 1.562);
    Reference(carnet, "A1");
    Measure(carnet, "P1"); // P1 is written after its sighting
    Measure(carnet, "P2");
    Measure(carnet, "X99");
    Station(carnet, "S9", 1.5);
    Reference(carnet, "A1");
    Station(carnet, "S1", 1.498, 123.45678);
    Reference(carnet, "S2");
    Station(carnet, "S2", 1.6);
    Station(carnet, "S3", 1.6);
    Point(carnet, "P1", 1100.0, 2000.0, 49.0);
    Point(carnet, "P1", 1105.0, 2005.0, 48.0); // a second element of P1: the first planimetry holds
    Traverse(carnet, "T1", {"S1(1)", "S2", "S9(1)", "S1(2)"}, false);
    Traverse(carnet, "T2", {"S1", "S2(1)", "S3(1)"}, true);
    return carnet;
}

const pyr::ScenePoint* FindPoint(const GeoScene& scene, const std::string& name) {
    for (const auto& point : scene.Points())
        if (point.name == name) return &point;
    return nullptr;
}

TEST(GeoScene, DrawsWhatIsPlacedAndCountsWhatIsNot) {
    const GeoScene scene(SmallJob());

    const GroundRect& extent = scene.Extent();
    EXPECT_EQ(std::tie(extent.minX, extent.minY, extent.maxX, extent.maxY),
              std::make_tuple(1000.0, 2000.0, 1100.0, 2200.0));

    // Points: those with a planimetry, once each; known (invariant) and computed told apart.
    ASSERT_EQ(scene.Points().size(), 5u);
    EXPECT_TRUE(FindPoint(scene, "A1")->known);
    const pyr::ScenePoint* p1 = FindPoint(scene, "P1");
    ASSERT_NE(p1, nullptr);
    EXPECT_FALSE(p1->known);
    EXPECT_EQ(std::tie(p1->x, p1->z), std::make_tuple(1100.0, 49.0));
    EXPECT_EQ(FindPoint(scene, "P2"), nullptr);
    EXPECT_EQ(FindPoint(scene, "S9"), nullptr);
    EXPECT_TRUE(FindPoint(scene, "S1")->stationHere);
    EXPECT_FALSE(FindPoint(scene, "A1")->stationHere);

    // Stations: S9 has no place; the second set-up on S1 is S1(2), at S1's place.
    std::vector<std::string> designations;
    for (const auto& station : scene.Stations())
        designations.push_back(station.designation);
    EXPECT_EQ(designations, (std::vector<std::string>{"S1", "S1(2)", "S2", "S3"}));
    EXPECT_EQ(scene.UnplacedStations(), 1);
    EXPECT_EQ(std::tie(scene.Stations()[1].x, scene.Stations()[1].y), std::make_tuple(1000.0, 2100.0));

    // Sightings: S1 to A1 (reference) and P1 (measure), S1(2) to S2 (reference). Undrawn: the one before any
    // station, those to P2 (no planimetry) and X99 (no point), the one from S9.
    ASSERT_EQ(scene.Sightings().size(), 3u);
    std::set<std::pair<std::string, bool>> drawn;
    for (const auto& sighting : scene.Sightings())
        drawn.emplace(scene.Stations()[sighting.station].designation + ">" +
                          scene.Points()[sighting.target].name,
                      sighting.reference);
    EXPECT_EQ(drawn, (std::set<std::pair<std::string, bool>>{
                         {"S1>A1", true}, {"S1>P1", false}, {"S1(2)>S2", true}}));
    EXPECT_EQ(scene.UndrawnSightings(), 4);

    // T1 breaks at S9: one leg S1-S2, S1(2) alone. T2, closed, goes back from S3 to S1.
    ASSERT_EQ(scene.Legs().size(), 4u);
    auto leg = [&](std::size_t i) {
        const auto& l = scene.Legs()[i];
        return std::vector<double>{static_cast<double>(l.traverse), l.x1, l.y1, l.x2, l.y2};
    };
    EXPECT_EQ(leg(0), (std::vector<double>{0, 1000, 2100, 1100, 2100}));
    EXPECT_EQ(leg(1), (std::vector<double>{1, 1000, 2100, 1100, 2100}));
    EXPECT_EQ(leg(3), (std::vector<double>{1, 1000, 2200, 1000, 2100}));
}

TEST(GeoScene, PicksTheNearestWithinTheToleranceAndDescribesIt) {
    const GeoScene scene(SmallJob());

    // P1 is √2 m from (1101, 2001).
    EXPECT_FALSE(scene.Pick(1101.0, 2001.0, 1.4));
    SceneHit hit = scene.Pick(1101.0, 2001.0, 1.5);
    ASSERT_EQ(hit.kind, SceneHit::Kind::Point);
    EXPECT_NEAR(hit.distance, std::sqrt(2.0), 1e-9);
    EXPECT_EQ(hit.description, "Point P1 (point calculé) : X = 1100.0000 m, Y = 2000.0000 m, Z = 49.000 m");
    // Between A1 and S1, nearer A1.
    hit = scene.Pick(1000.0, 2040.0, 100.0);
    EXPECT_EQ(hit.description, "Point A1 (point connu) : X = 1000.0000 m, Y = 2000.0000 m, Z = 50.000 m");

    // A station wins over its own point, and is described with each of its set-ups: every sighting
    // written under a set-up counts, drawn or not.
    hit = scene.Pick(1000.0, 2100.5, 1.0);
    ASSERT_EQ(hit.kind, SceneHit::Kind::Station);
    EXPECT_EQ(hit.description,
              "Station S1 : X = 1000.0000 m, Y = 2100.0000 m, Z = 51.000 m"
              " ; S1 : HI = 1.562 m, V0 non calculé, 4 visées (1 de référence, 3 de mesure)"
              " ; S1(2) : HI = 1.498 m, V0 = 123.45678 gr, 1 visée (1 de référence, 0 de mesure)");
    hit = scene.Pick(1100.0, 2100.0, 1.0);
    EXPECT_EQ(
        hit.description,
        "Station S2 : X = 1100.0000 m, Y = 2100.0000 m, Z inconnu ; HI = 1.600 m, V0 non calculé, 0 visée "
        "(0 de référence, 0 de mesure)");

    EXPECT_FALSE(GeoScene().Pick(0, 0, 1e9));
}

// A square grid of 60 x 60 points 10 m apart, each sighted from the station at the centre of its block of
// 6 x 6 and, for one in seven, from a far corner station and from one far west: short, long and near
// horizontal segments across many cells.
TEST(GeoScene, AWindowHoldsExactlyThePointsInItAndEverySegmentCrossingIt) {
    CCarnet carnet;
    const auto grid = [](int i, int j) { return "P" + std::to_string(i * 60 + j); };
    for (int i = 0; i < 60; ++i)
        for (int j = 0; j < 60; ++j)
            Point(carnet, grid(i, j), 500000.0 + i * 10.0, 6000000.0 + j * 10.0, 100.0);
    for (int bi = 0; bi < 10; ++bi)
        for (int bj = 0; bj < 10; ++bj) {
            Station(carnet, grid(bi * 6 + 3, bj * 6 + 3), 1.5);
            for (int i = bi * 6; i < bi * 6 + 6; ++i)
                for (int j = bj * 6; j < bj * 6 + 6; ++j)
                    Measure(carnet, grid(i, j));
        }
    Point(carnet, "W", 499400.0, 6000233.0, 100.0);
    for (const char* far : {"P0", "W"}) {
        Station(carnet, far, 1.5);
        for (int k = 0; k < 3600; k += 7)
            Reference(carnet, "P" + std::to_string(k));
    }
    const GeoScene scene(carnet);
    ASSERT_EQ(scene.Sightings().size(), 3600u + 2 * 515u);

    const GroundRect window{500123.0, 6000201.0, 500177.0, 6000262.0};
    pyr::SceneSelection selection;
    scene.Query(window, selection);
    EXPECT_FALSE(selection.whole);

    std::set<int> points(selection.points.begin(), selection.points.end());
    EXPECT_EQ(points.size(), selection.points.size());
    for (int i = 0; i < static_cast<int>(scene.Points().size()); ++i)
        EXPECT_EQ(points.count(i) == 1, window.Contains(scene.Points()[i].x, scene.Points()[i].y)) << i;
    EXPECT_EQ(points.size(), 5u * 6u); // x 500130..500170, y 6000210..6000260

    // Listed once each; every sighting that crosses the window among them (checked by sampling it every
    // decimetre), and few of the others.
    std::set<int> sightings(selection.sightings.begin(), selection.sightings.end());
    EXPECT_EQ(sightings.size(), selection.sightings.size());
    int crossing = 0;
    for (int i = 0; i < static_cast<int>(scene.Sightings().size()); ++i) {
        const auto& sighting = scene.Sightings()[i];
        const auto& from = scene.Stations()[sighting.station];
        const auto& to = scene.Points()[sighting.target];
        const double length = std::hypot(to.x - from.x, to.y - from.y);
        const int steps = std::max(1, static_cast<int>(length * 10));
        bool crosses = false;
        for (int s = 0; s <= steps && !crosses; ++s) {
            const double t = static_cast<double>(s) / steps;
            crosses = window.Contains(from.x + t * (to.x - from.x), from.y + t * (to.y - from.y));
        }
        if (crosses) {
            ++crossing;
            EXPECT_EQ(sightings.count(i), 1u) << i;
        }
    }
    EXPECT_GT(crossing, 30);
    EXPECT_LT(selection.sightings.size(), scene.Sightings().size() / 4);

    // A window over the whole job holds all.
    scene.Query(GroundRect{0, 0, 1e7, 1e7}, selection);
    EXPECT_TRUE(selection.whole);
    EXPECT_EQ(selection.sightings.size(), scene.Sightings().size());
    // A window beside the job, none.
    scene.Query(GroundRect{400000, 6000000, 400100, 6000100}, selection);
    EXPECT_TRUE(selection.points.empty() && selection.sightings.empty());
}

} // namespace
