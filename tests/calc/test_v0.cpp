// The orientation of one station, against stations and references built from exact coordinates.
#include "calc/CalculV0.h"
#include "calc/CalculV0Texts.h"
#include "core/Strings.h"
#include "test_v0_geometry.h"

#include <cmath>
#include <gtest/gtest.h>

namespace pyr::test {
namespace {

constexpr double kCentimilligon = 1e-5; // 0.01 mgon
constexpr double kTenthMm = 1e-4;

const Place kStation{1000.0, 2000.0, 100.0};
constexpr double kHi = 1.5;
constexpr double kHp = 1.3;

// The distance from the station's place to that of a reference, for the expected weights.
double Distance(Place a, Place b) {
    return std::hypot(b.x - a.x, b.y - a.y);
}

// A station S1 and references around it at every quarter and at odd bearings, read exactly.
struct Job {
    CCarnet carnet;
    int station = -1;
    std::vector<int> sightings;

    explicit Job(double v0, std::vector<std::pair<std::string, Place>> references = {
                                {"A", {1000.0, 2100.0, 101.0}},
                                {"B", {1200.0, 2000.0, 99.2}},
                                {"C", {812.4, 1734.9, 104.5}},
                                {"D", {1377.77, 2420.01, 88.0}},
                            }) {
        AddPoint(carnet, "S1", kStation);
        for (const auto& [name, place] : references)
            AddPoint(carnet, name, place);
        station = AddStation(carnet, "S1", kHi);
        for (const auto& [name, place] : references)
            sightings.push_back(AddSighting(carnet, name, kStation, kHi, place, kHp, v0));
    }

    V0Result Compute(const V0Settings& settings = {}) const {
        return ComputeStationV0(carnet, StationAt(carnet, station), sightings, settings);
    }
    CVisee& Sighting(std::size_t rank) { return *carnet.As<CVisee>(sightings[rank]); }
};

double TurnDistance(double a, double b) {
    const double d = std::fmod(std::fabs(a - b), 400.0);
    return std::min(d, 400.0 - d);
}

TEST(StationV0, ExactReferencesGiveTheV0BackWeightedOrNot) {
    for (double v0 : {0.0, 0.003, 123.456789, 250.0, 399.998})
        for (bool weighted : {true, false}) {
            const Job job(v0);
            V0Settings settings;
            settings.weighted = weighted;
            const V0Result result = job.Compute(settings);
            ASSERT_TRUE(result.computed) << v0;
            EXPECT_LT(TurnDistance(result.v0, v0), kCentimilligon) << v0;
            EXPECT_GE(result.v0, 0.0);
            EXPECT_LT(result.v0, 400.0);
            EXPECT_EQ(result.used, 4);
            EXPECT_TRUE(result.warnings.empty()) << result.warnings.front(); // distances and heights agree
            EXPECT_TRUE(result.remarks.empty());
            for (const V0Reference& ref : result.references) {
                EXPECT_LT(std::fabs(ref.residual), kCentimilligon) << ref.mat;
                EXPECT_NEAR(ref.measuredDistance, ref.distance, kTenthMm) << ref.mat;
            }
        }
    // The bearings and weights of the table: A due north at 100 m, B due east at 200 m.
    const V0Result result = Job(10.0).Compute();
    EXPECT_NEAR(result.references[0].bearing, 0.0, 1e-9);
    EXPECT_NEAR(result.references[0].distance, 100.0, 1e-9);
    EXPECT_NEAR(result.references[1].bearing, 100.0, 1e-9);
    EXPECT_NEAR(result.references[1].distance, 200.0, 1e-9);
    EXPECT_NEAR(result.references[1].partialV0, 10.0, kCentimilligon);
}

// Two references at 100 and 300 m. Their partial V0 are set by hand through their directions.
struct TwoReferences : Job {
    TwoReferences(double v0a, double v0b)
        : Job(0.0, {{"A", {1000.0, 2100.0, 100.0}}, {"B", {1300.0, 2000.0, 100.0}}}) {
        Sighting(0).setAH(std::fmod(0.0 - v0a + 400.0, 400.0));   // bearing 0
        Sighting(1).setAH(std::fmod(100.0 - v0b + 400.0, 400.0)); // bearing 100
    }
};

TEST(StationV0, PartialV0StraddlingTheFullTurnAverageNearZero) {
    V0Settings settings;
    settings.forced = true; // 0.02 gr apart: both out of tolerance, both kept
    for (bool weighted : {true, false}) {
        settings.weighted = weighted;
        const V0Result result = TwoReferences(399.99, 0.01).Compute(settings);
        ASSERT_TRUE(result.computed);
        // Weighted: (100 x -0.01 + 300 x 0.01) / 400 = 0.005; plain: 0.
        EXPECT_LT(TurnDistance(result.v0, weighted ? 0.005 : 0.0), kCentimilligon) << result.v0;
        EXPECT_EQ(result.used, 2);
        EXPECT_EQ(result.remarks.size(), 4u) << "two remarks for each reference";
    }
}

TEST(StationV0, WithTwoReferencesTheWorstOutOfToleranceGoesAndTheOtherAloneGivesTheV0) {
    const double tolerance = std::sqrt(0.5) * 0.0043; // 0.00304 gr
    // Weighted mean 50 + 0.008 x 100 / 400 = 50.002: A is 0.006 away, B 0.002.
    const V0Result result = TwoReferences(50.008, 50.0).Compute();
    ASSERT_TRUE(result.computed);
    EXPECT_NEAR(result.v0, 50.0, kCentimilligon);
    EXPECT_EQ(result.used, 1);
    EXPECT_FALSE(result.references[0].valid);
    EXPECT_EQ(result.references[0].partialV0, kUndefined);
    EXPECT_EQ(result.references[0].residual, kUndefined);
    EXPECT_TRUE(result.references[1].valid);
    EXPECT_EQ(result.remarks,
              (std::vector<std::string>{" -> V0 hors tolérance pour la référence <A> !",
                                        Sprintf("    (écart = 0.00600 Gr > %.5f Gr)", tolerance)}));

    // Within the tolerance both stay; forced, both stay whatever their spread, with their remarks.
    EXPECT_EQ(TwoReferences(50.004, 50.0).Compute().used, 2);
    V0Settings forced;
    forced.forced = true;
    const V0Result kept = TwoReferences(50.008, 50.0).Compute(forced);
    EXPECT_EQ(kept.used, 2);
    EXPECT_NEAR(kept.v0, 50.002, kCentimilligon);
    EXPECT_EQ(kept.remarks.size(), 2u) << "only A is beyond the tolerance";
}

TEST(StationV0, AReferenceAtTheStationsOwnPlaceIsDropped) {
    Job job(75.0);
    AddPoint(job.carnet, "S1BIS", {kStation.x + 0.00005, kStation.y, kStation.z});
    job.sightings.insert(job.sightings.begin(),
                         job.carnet.Add(std::make_unique<CReference>("S1BIS", 12.3), kKindReference));
    const V0Result result = job.Compute();
    ASSERT_TRUE(result.computed);
    EXPECT_NEAR(result.v0, 75.0, kCentimilligon);
    EXPECT_EQ(result.used, 4);
    EXPECT_FALSE(result.references[0].valid);
    EXPECT_EQ(result.remarks,
              std::vector<std::string>{"La référence <S1BIS> est confondue avec la station !"});

    // Alone, it leaves the station without any valid reference.
    const V0Result alone =
        ComputeStationV0(job.carnet, StationAt(job.carnet, job.station), {job.sightings[0]}, {});
    EXPECT_FALSE(alone.computed);
    EXPECT_EQ(alone.warnings, std::vector<std::string>{v0::kMsgNoValidReference});
}

TEST(StationV0, RoundedToSixDecimalsAndAFullTurnIsZero) {
    const struct {
        double in, out;
    } cases[] = {{399.9999996, 0.0},        {400.0, 0.0},  {-0.0000001, 0.0},
                 {123.4567894, 123.456789}, {-0.5, 399.5}, {400.25, 0.25}};
    for (const auto& c : cases)
        EXPECT_NEAR(RoundV0(c.in), c.out, 1e-12) << c.in;

    // A mean of 399.9999997 is a V0 of 0.
    const V0Result result = TwoReferences(399.9999997, 399.9999997).Compute();
    EXPECT_EQ(result.v0, 0.0);
}

TEST(StationV0, FaceRightReadingsAreTurnedToFaceLeft) {
    Job job(33.3333);
    // B read face right: AH + 200, AV read from the other side of the circle.
    CVisee& b = job.Sighting(1);
    const double ahLeft = b.ah();
    b.setAH(std::fmod(b.ah() + 200.0, 400.0));
    b.setAV(400.0 - b.av());
    const V0Result result = job.Compute();
    EXPECT_NEAR(result.v0, 33.3333, kCentimilligon);
    EXPECT_NEAR(result.references[1].ah, ahLeft, 1e-9);
    EXPECT_TRUE(result.warnings.empty());

    // A zenith angle of exactly 200 counts as face right: the direction turns by 200.
    CVisee& c = job.Sighting(2);
    c.setAV(200.0);
    c.setDI(0.0);
    c.setAH(std::fmod(c.ah() + 200.0, 400.0));
    EXPECT_NEAR(job.Compute().v0, 33.3333, kCentimilligon);
}

// The target stood 0.40 m beyond the point along the line of sight and 0.25 m to its right: the
// eccentric commands in front of the sighting bring it back to the point's own bearing.
TEST(StationV0, EccentricTargetsAreReducedToTheirPoint) {
    const double v0 = 210.0;
    const Place point{1150.0, 2260.0, 100.0};
    const double er = 0.40, et = 0.25;
    // Seen from the station, the point stands ER beyond the target and ET to its right: the target is
    // `along` away, `side` (radians) to the left of the point's bearing.
    const double horizontal = Distance(kStation, point);
    const double along = std::sqrt(horizontal * horizontal - et * et) - er;
    const double side = std::atan2(et, along + er);
    const double targetBearing = std::atan2(point.x - kStation.x, point.y - kStation.y) - side;
    const Place target{kStation.x + along * std::sin(targetBearing),
                       kStation.y + along * std::cos(targetBearing), point.z};

    Job job(v0, {{"A", {1000.0, 2100.0, 101.0}}});
    AddPoint(job.carnet, "P", point);
    job.carnet.Add(std::make_unique<CCommande>("ExcentRad", "0.40"), kKindExcentrement);
    job.carnet.Add(std::make_unique<CCommande>("ExcentTan", "0.25"), kKindExcentrement);
    const int eccentric = AddSighting(job.carnet, "P", kStation, kHi, target, kHp, v0);

    const V0Station station = StationAt(job.carnet, job.station);
    V0Settings forced;
    forced.forced = true;
    const V0Result alone = ComputeStationV0(job.carnet, station, {eccentric}, forced);
    EXPECT_NEAR(alone.v0, v0, kCentimilligon);
    EXPECT_NEAR(alone.references[0].measuredDistance, horizontal, kTenthMm);
    EXPECT_TRUE(alone.warnings.empty()) << alone.warnings.front();

    // Without its commands the target's own bearing is taken: off by the angle of the offset.
    job.carnet.RemoveRange(eccentric - 2, eccentric);
    const V0Result raw = ComputeStationV0(job.carnet, station, {eccentric - 2}, forced);
    EXPECT_NEAR(raw.v0, v0 + side * kGonPerRadian, kCentimilligon);
}

TEST(StationV0, DistanceAndHeightChecksWarnButKeepTheReference) {
    Job job(5.0, {{"A", {1000.0, 2100.0, 101.0}}, {"B", {1200.0, 2000.0, 99.2}}});
    CVisee& a = job.Sighting(0);
    a.setDI(a.di() + 0.1 / std::sin(a.av() / kGonPerRadian));       // 10 cm too long: beyond 3.01 cm
    job.carnet.As<CPointGen>(job.carnet.findMat("B"))->setZ(99.25); // 5 cm too high: beyond 3.61 cm
    const V0Result result = job.Compute();
    ASSERT_EQ(result.warnings.size(), 2u);
    EXPECT_EQ(result.warnings[0], "L'écart entre les distances horizontales mesurées et calculées\n"
                                  "vers la référence <A> est hors tolérance!\n"
                                  "Calculée :     100.000m / Mesurée :     100.100m\nEcart :      -0.100m");
    EXPECT_EQ(result.warnings[1], "L'écart entre les dénivelées mesurées et calculées\n"
                                  "vers la référence <B> est hors tolérance!\n"
                                  "Calculée :      -0.750m / Mesurée :      -0.800m\nEcart :       0.050m");
    EXPECT_EQ(result.used, 2);
    EXPECT_NEAR(result.v0, 5.0, kCentimilligon);

    // A scale of -200 ppm makes the 100 m measured 99.980 m: still within 3 cm.
    V0Settings scaled;
    scaled.correction.linearAlteration = -200.0;
    a.setDI(a.di() - 0.1 / std::sin(a.av() / kGonPerRadian));
    EXPECT_NEAR(job.Compute(scaled).references[0].measuredDistance, 99.98, kTenthMm);
}

TEST(StationV0, ReferencesOfferedAndChosenAtFirst) {
    CCarnet carnet;
    AddPoint(carnet, "S1", kStation);
    AddPoint(carnet, "A", {1000.0, 2100.0, 0.0});
    AddPoint(carnet, "B", {1100.0, 2000.0, 0.0});
    carnet.Add(std::make_unique<CPointGen>("H", 12.0), kKindPoint); // a height alone: no bearing
    const int s1 = AddStation(carnet, "S1", kHi);
    const int a = carnet.Add(std::make_unique<CReference>("A", 0.0), kKindReference);
    const int b = carnet.Add(std::make_unique<CMesure>("B", 100.0), kKindMesure);
    carnet.Add(std::make_unique<CMesure>("H", 100.0), kKindMesure);
    carnet.Add(std::make_unique<CMesure>("NEW", 100.0), kKindMesure);
    const int s2 = AddStation(carnet, "S1", kHi);
    const int b2 = carnet.Add(std::make_unique<CMesure>("B", 100.0), kKindMesure);

    EXPECT_EQ(OfferedReferences(carnet, s1), (std::vector<int>{a, b}));
    EXPECT_EQ(DefaultReferences(carnet, s1), std::vector<int>{a});
    EXPECT_EQ(DefaultReferences(carnet, s2), std::vector<int>{b2});
    EXPECT_EQ(StationAt(carnet, s2).reprise, 2);
    EXPECT_EQ(StationAt(carnet, s2).Designation(), "S1(2)");
}

} // namespace
} // namespace pyr::test
