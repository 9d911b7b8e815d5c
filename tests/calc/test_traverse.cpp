// Polygonal traverses: exact geometries given back with no misclosure, and misclosures introduced on
// purpose shared as a hand computation of the compass rule shares them.
#include "calc/Traverse.h"
#include "core/Angles.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kTenthMm = 1e-4;
constexpr double kTenthMgon = 1e-4;

struct Place {
    std::string name;
    double x, y, z;
    double v0; // the orientation of the instrument set up there
};

// The reading of a direction from a station whose orientation is `v0`, in [0, 400).
double Reading(const Place& from, const Place& to) {
    return WrapGrads(Bearing(from.x, from.y, to.x, to.y) - from.v0);
}

// The traverse through the places as a perfect instrument measures it.
TraverseInput Exact(const std::vector<Place>& places, TraverseKind kind) {
    TraverseInput input;
    input.kind = kind;
    const bool closed = kind == TraverseKind::Closed;
    const std::size_t n = places.size();
    for (std::size_t i = 0; i < n; ++i) {
        TraverseStation station{places[i].name};
        const bool hasNext = closed || i + 1 < n;
        const bool hasBack = closed || i > 0;
        if (hasNext) {
            const Place& to = places[(i + 1) % n];
            station.forward = Reading(places[i], to);
            station.distance = std::hypot(to.x - places[i].x, to.y - places[i].y);
            station.dz = to.z - places[i].z;
        }
        if (hasBack) station.back = Reading(places[i], places[(i + n - 1) % n]);
        input.stations.push_back(station);
    }
    input.x0 = places.front().x, input.y0 = places.front().y, input.z0 = places.front().z;
    input.v00 = places.front().v0;
    input.xn = places.back().x, input.yn = places.back().y, input.zn = places.back().z;
    input.v0n = places.back().v0;
    return input;
}

void ExpectPlaces(const TraverseResult& result, const std::vector<Place>& places) {
    ASSERT_TRUE(result.ok) << result.why;
    ASSERT_EQ(result.stations.size(), places.size());
    for (std::size_t i = 0; i < places.size(); ++i) {
        SCOPED_TRACE(places[i].name);
        EXPECT_NEAR(result.stations[i].x, places[i].x, kTenthMm);
        EXPECT_NEAR(result.stations[i].y, places[i].y, kTenthMm);
        EXPECT_NEAR(result.stations[i].z, places[i].z, kTenthMm);
        EXPECT_NEAR(CentredGrads(result.stations[i].v0 - places[i].v0), 0.0, kTenthMgon);
    }
}

// A Lambert-93 traverse of five stations winding north-east, each instrument oriented its own way, one
// of them so that its readings cross 0/400 (its V0 a few milligons past the bearing of its next leg).
std::vector<Place> Winding() {
    std::vector<Place> places = {{"S1", 651200.000, 6862300.000, 52.310, 123.4567},
                                 {"S2", 651325.412, 6862371.905, 53.874, 12.0},
                                 {"S3", 651402.118, 6862512.447, 55.021, 0.0},
                                 {"S4", 651550.650, 6862598.300, 58.440, 301.25},
                                 {"S5", 651688.731, 6862554.562, 49.870, 77.7}};
    places[2].v0 = Bearing(places[2].x, places[2].y, places[3].x, places[3].y) + 0.005;
    return places;
}

TEST(Traverse, ExactGeometriesComeBackWithNoMisclosure) {
    const std::vector<Place> places = Winding();
    for (TraverseKind kind : {TraverseKind::Linked, TraverseKind::Position, TraverseKind::Open}) {
        const TraverseResult result = ComputeTraverse(Exact(places, kind));
        ExpectPlaces(result, places);
        if (kind == TraverseKind::Linked) {
            EXPECT_EQ(result.angles, 5);
            EXPECT_NEAR(result.angularMisclosure, 0.0, 1e-9);
        }
        if (kind != TraverseKind::Open) {
            EXPECT_NEAR(result.f, 0.0, 1e-6);
            EXPECT_NEAR(result.fz, 0.0, 1e-6);
        } else {
            EXPECT_EQ(result.f, kUndefined);
        }
    }
    // The readings of S3 do cross 0/400.
    const TraverseInput input = Exact(places, TraverseKind::Linked);
    EXPECT_GT(input.stations[2].forward, 399.99);

    // Closed on its start: a square walked round, the start station oriented on its references.
    const std::vector<Place> square = {{"A", 1000, 1000, 100, 10.0},
                                       {"B", 1100, 1000, 101, 20.0},
                                       {"C", 1100, 1100, 102, 30.0},
                                       {"D", 1000, 1100, 101.5, 390.0}};
    const TraverseResult loop = ComputeTraverse(Exact(square, TraverseKind::Closed));
    ExpectPlaces(loop, square);
    EXPECT_EQ(loop.legs.size(), 4u);
    EXPECT_EQ(loop.angles, 5);
    EXPECT_NEAR(loop.length, 400.0, 1e-9);
}

// Three legs due east from A (1000, 1000) to D (1300, 1000), every instrument oriented on north (V0 0):
// forward readings 100, back readings 300. The back reading at C is 4 mgon too large and the legs measure
// 100.000, 100.020 and 99.990 m. By hand:
//   V0 carried to D: 400 - 0.004, so the angular misclosure is -0.004 gr over 4 angles: +0.001 gr each;
//   compensated bearings 100.001, 100.002, 99.999 (the error of C sits in the angle at C);
//   dx = D sin G: 100.000, 100.020, 99.990 (cosine terms below 1e-7 m); dy = D cos G: -0.0015708,
//   -0.0031422, +0.0015706; fx = 300.010 - 300 = 0.010, fy = -0.0031424, f = 0.0104821, over 300.010 m;
//   compass corrections cx = -fx D / 300.010: -0.0033332, -0.0033339, -0.0033329; cy = -fy D / 300.010:
//   +0.0010474, +0.0010477, +0.0010473;
//   B = (1099.9966668, 999.9994766), C = (1200.0133329, 999.9973821), D closes exactly.
TEST(Traverse, MisclosuresAreSharedAsTheCompassRuleSharesThemByHand) {
    TraverseInput input;
    input.stations = {{"A", kUndefined, 100.0, 100.000, 1.0},
                      {"B", 300.0, 100.0, 100.020, -0.5},
                      {"C", 300.004, 100.0, 99.990, 0.27},
                      {"D", 300.0, kUndefined, kUndefined, kUndefined}};
    input.x0 = 1000, input.y0 = 1000, input.z0 = 50.0, input.v00 = 0.0;
    input.xn = 1300, input.yn = 1000, input.zn = 50.80, input.v0n = 0.0;
    const TraverseResult r = ComputeTraverse(input);
    ASSERT_TRUE(r.ok) << r.why;
    EXPECT_NEAR(r.angularMisclosure, -0.004, 1e-9);
    EXPECT_NEAR(r.stations[1].angleCorrection, 0.001, 1e-9);
    EXPECT_NEAR(r.legs[0].bearing, 100.001, kTenthMgon);
    EXPECT_NEAR(r.legs[1].bearing, 100.002, kTenthMgon);
    EXPECT_NEAR(r.legs[2].bearing, 99.999, kTenthMgon);
    EXPECT_NEAR(r.fx, 0.010, 1e-7);
    EXPECT_NEAR(r.fy, -0.0031424, 1e-7);
    EXPECT_NEAR(r.f, 0.0104821, 1e-7);
    EXPECT_NEAR(r.Ratio(), 300.010 / 0.0104821, 1.0);
    EXPECT_NEAR(r.legs[1].cx, -0.0033339, 1e-7);
    EXPECT_NEAR(r.legs[2].cy, 0.0010473, 1e-7);
    EXPECT_NEAR(r.stations[1].x, 1099.9966668, 1e-6);
    EXPECT_NEAR(r.stations[1].y, 999.9994766, 1e-6);
    EXPECT_NEAR(r.stations[2].x, 1200.0133329, 1e-6);
    EXPECT_NEAR(r.stations[2].y, 999.9973821, 1e-6);
    EXPECT_NEAR(r.stations[3].x, 1300.0, 1e-9);
    EXPECT_NEAR(r.stations[3].y, 1000.0, 1e-9);
    // The V0 of B and C: the compensated bearing of their next leg minus its reading; D keeps its own.
    EXPECT_NEAR(r.stations[1].v0, 0.002, kTenthMgon);
    EXPECT_NEAR(r.stations[2].v0, 399.999, kTenthMgon);
    EXPECT_NEAR(r.stations[3].v0, 0.0, kTenthMgon);
    // Heights: 50 + 0.77 = 50.77 against 50.80, fz = -0.030 shared by the lengths: +0.0099996,
    // +0.0100016, +0.0099986.
    EXPECT_NEAR(r.fz, -0.030, 1e-9);
    EXPECT_NEAR(r.stations[1].z, 51.0099996, 1e-6);
    EXPECT_NEAR(r.stations[2].z, 50.5200012, 1e-6);
    EXPECT_NEAR(r.stations[3].z, 50.80, 1e-9);

    // A closure measured but not distributed: the stations as carried, the misclosure reported all the same.
    TraverseInput kept = input;
    kept.distributeAngular = kept.distributePlanimetric = kept.distributeHeight = false;
    const TraverseResult k = ComputeTraverse(kept);
    ASSERT_TRUE(k.ok);
    EXPECT_NEAR(k.angularMisclosure, -0.004, 1e-9);
    EXPECT_NEAR(k.legs[2].bearing, 99.996, kTenthMgon);
    EXPECT_NEAR(k.stations[3].x, 1300.010, 1e-6);
    EXPECT_NEAR(k.stations[3].z, 50.77, 1e-9);
    EXPECT_NEAR(k.fz, -0.030, 1e-9);

    // By the coordinate differences, the east misclosure goes by |dx| and the north one by |dy|: the
    // leg that went most north takes most of fy.
    input.rule = TraverseRule::Component;
    const TraverseResult c = ComputeTraverse(input);
    ASSERT_TRUE(c.ok);
    const double sumDy = 0.0015708 + 0.0031422 + 0.0015706;
    EXPECT_NEAR(c.legs[1].cy, 0.0031424 * 0.0031422 / sumDy, 1e-7);
    EXPECT_NEAR(c.stations[3].x, 1300.0, 1e-9);
    EXPECT_NEAR(c.stations[3].y, 1000.0, 1e-9);
}

// A published worked example: the linked traverse S1-S2-S3-S4 of the corrected exercise
// "ChEncadre3Correction" (fr.scribd.com/document/553771121), angles measured to the right, starting bearing
// R1-S1 320.159 gr, closing bearing S4-R2 330.616 gr. Its figures are rounded to the millimetre and the
// milligrad (60.1666 m is written 60.166), so lengths are compared to the millimetre they keep.
TEST(Traverse, APublishedLinkedTraverseIsComputedAsItsCorrectionShows) {
    struct Row {
        const char* name;
        double angle;    // to the right: the back reading minus the forward reading
        double distance; // to the next station
    };
    const Row rows[] = {{"S1", 250.717, 246.522},
                        {"S2", 154.892, 264.843},
                        {"S3", 238.949, 218.961},
                        {"S4", 145.065, kUndefined}};
    // Each instrument oriented on the bearings the angles carry from R1, so that its readings are
    // those bearings: the first station sights R1 at 120.159 gr, the last one R2 at 330.616 gr.
    TraverseInput input;
    input.kind = TraverseKind::Linked;
    input.x0 = 10964.9, input.y0 = 5491.52, input.v00 = 0.0;
    input.xn = 10285.1, input.yn = 5356.271;
    double back = WrapGrads(320.159 + 200.0);
    for (const Row& row : rows) {
        TraverseStation station{row.name};
        const double forward = WrapGrads(back - row.angle);
        if (&row != rows) station.back = back;
        if (&row != std::end(rows) - 1)
            station.forward = forward, station.distance = row.distance;
        else
            input.v0n = 330.616 - forward; // the known closing bearing over the reading to R2
        input.stations.push_back(station);
        back = WrapGrads(forward + 200.0);
    }
    const TraverseResult result = ComputeTraverse(input);
    ASSERT_TRUE(result.ok) << result.why;
    // fa = 330.536 - 330.616 = -0.080 gr, 20 mgon given to each of the 4 angles.
    EXPECT_NEAR(result.angularMisclosure, -0.080, kTenthMgon);
    EXPECT_EQ(result.angles, 4);
    const double bearings[] = {269.462, 314.590, 275.661};
    const double dx[] = {-218.699, -257.918, -203.153}, dy[] = {-113.771, 60.166, -81.688};
    for (int i = 0; i < 3; ++i) {
        SCOPED_TRACE(i);
        EXPECT_NEAR(result.legs[i].bearing, bearings[i], kTenthMgon);
        EXPECT_NEAR(result.legs[i].dx, dx[i], 0.001);
        EXPECT_NEAR(result.legs[i].dy, dy[i], 0.001);
    }
    // fx = +0.030 m, fy = -0.044 m, shared in proportion to the legs over 730.326 m.
    EXPECT_NEAR(result.fx, 0.030, 0.001);
    EXPECT_NEAR(result.fy, -0.044, 0.001);
    EXPECT_NEAR(result.legs[0].cx, -0.0101, 0.001);
    EXPECT_NEAR(result.legs[0].cy, 0.0149, 0.001);
    const double x[] = {10964.9, 10746.191, 10488.262, 10285.1},
                 y[] = {5491.52, 5377.764, 5437.946, 5356.271};
    for (int i = 0; i < 4; ++i) {
        SCOPED_TRACE(rows[i].name);
        EXPECT_NEAR(result.stations[i].x, x[i], 0.001);
        EXPECT_NEAR(result.stations[i].y, y[i], 0.001);
    }
}

TEST(Traverse, WhatCannotBeComputedIsNamed) {
    const std::vector<Place> places = Winding();
    TraverseInput input = Exact(places, TraverseKind::Linked);
    input.stations[1].distance = kUndefined;
    EXPECT_EQ(ComputeTraverse(input).why, "pas de distance entre <S2> et <S3>");
    input = Exact(places, TraverseKind::Linked);
    input.stations[3].back = kUndefined;
    EXPECT_EQ(ComputeTraverse(input).why, "la station <S4> ne vise pas la station précédente <S3>");
    input = Exact(places, TraverseKind::Linked);
    input.stations[4].back = kUndefined; // the closing orientation cannot be carried to the end
    EXPECT_FALSE(ComputeTraverse(input).ok);
    input.kind = TraverseKind::Position; // which a traverse tied in position only does not need
    EXPECT_TRUE(ComputeTraverse(input).ok);
    input = Exact(places, TraverseKind::Linked);
    input.v00 = kUndefined;
    EXPECT_EQ(ComputeTraverse(input).why, "la station de départ <S1> n'est pas orientée");
    input = Exact(places, TraverseKind::Linked);
    input.xn = kUndefined;
    EXPECT_EQ(ComputeTraverse(input).why, "la station d'arrivée <S5> n'a pas de coordonnées connues");
    input.stations.resize(1);
    EXPECT_FALSE(ComputeTraverse(input).ok);
    // A height not measured on one leg: no height closure, no heights after it, the planimetry computed.
    input = Exact(places, TraverseKind::Linked);
    input.stations[2].dz = kUndefined;
    const TraverseResult result = ComputeTraverse(input);
    ASSERT_TRUE(result.ok);
    EXPECT_EQ(result.fz, kUndefined);
    EXPECT_EQ(result.stations[3].z, kUndefined);
    EXPECT_NEAR(result.stations[3].x, places[3].x, kTenthMm);
}

} // namespace
} // namespace pyr
