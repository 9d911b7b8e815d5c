// The orientation of one station, against stations and references built from exact coordinates.
#include "calc/CalculV0.h"
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
using Points = std::vector<std::pair<std::string, Place>>;

// A station S1 and references around it, read exactly on 1.3 m targets: by default A due north at 100 m,
// B due east at 200 m, C at an odd bearing.
struct Job {
    CCarnet carnet;
    int station = -1;
    std::vector<int> sightings;

    explicit Job(double v0, const Points& references = {{"A", {1000.0, 2100.0, 101.0}},
                                                        {"B", {1200.0, 2000.0, 99.2}},
                                                        {"C", {812.4, 1734.9, 104.5}}}) {
        AddPoint(carnet, "S1", kStation);
        for (const auto& [name, place] : references)
            AddPoint(carnet, name, place);
        station = AddStation(carnet, "S1", kHi);
        for (const auto& [name, place] : references)
            sightings.push_back(AddSighting(carnet, name, kStation, kHi, place, 1.3, v0));
    }

    V0Result Compute(bool weighted = true, bool forced = false, double scalePpm = 0.0) const {
        V0Settings settings;
        settings.weighted = weighted;
        settings.forced = forced;
        settings.reduction.correction.linearAlteration = scalePpm;
        return ComputeStationV0(carnet, StationPlaceAt(carnet, station), sightings, settings);
    }
    CVisee& Sighting(std::size_t rank) { return *carnet.As<CVisee>(sightings[rank]); }
};

double TurnDistance(double a, double b) {
    const double d = std::fmod(std::fabs(a - b), 400.0);
    return std::min(d, 400.0 - d);
}

// B is read face right, and D on a target 0.40 m short of it along the line of sight, the radial offset
// written in front of its sighting.
TEST(StationV0, ExactReferencesGiveTheV0BackWeightedOrNotFaceRightOrEccentric) {
    const Place d{1377.77, 2420.01, 88.0};
    const double k = 1.0 - 0.40 / std::hypot(d.x - kStation.x, d.y - kStation.y);
    const Place target{kStation.x + k * (d.x - kStation.x), kStation.y + k * (d.y - kStation.y), d.z};
    for (double v0 : {0.003, 123.456789, 250.0, 399.998})
        for (bool weighted : {true, false}) {
            Job job(v0);
            CVisee& b = job.Sighting(1);
            b.setAH(std::fmod(b.ah() + 200.0, 400.0));
            b.setAV(400.0 - b.av());
            AddPoint(job.carnet, "D", d);
            job.carnet.Add(std::make_unique<CCommande>("ExcentRad", "0.40"), kKindExcentrement);
            job.sightings.push_back(AddSighting(job.carnet, "D", kStation, kHi, target, 1.3, v0));
            const V0Result result = job.Compute(weighted);
            ASSERT_TRUE(result.computed) << v0;
            EXPECT_LT(TurnDistance(result.v0, v0), kCentimilligon) << v0;
            EXPECT_EQ(result.used, 4);
            EXPECT_TRUE(result.warnings.empty()) << result.warnings.front(); // distances and heights agree
            EXPECT_TRUE(result.remarks.empty());
            for (const V0Reference& ref : result.references) {
                EXPECT_LT(std::fabs(ref.residual), kCentimilligon) << ref.mat;
                EXPECT_NEAR(ref.measuredDistance, ref.distance, kTenthMm) << ref.mat;
            }
        }
}

// Two references due north at 100 m and due east at 300 m, their partial V0 set by hand.
struct TwoReferences : Job {
    TwoReferences(double v0a, double v0b)
        : Job(0.0, {{"A", {1000.0, 2100.0, 100.0}}, {"B", {1300.0, 2000.0, 100.0}}}) {
        Sighting(0).setAH(std::fmod(400.0 - v0a, 400.0));
        Sighting(1).setAH(std::fmod(500.0 - v0b, 400.0));
    }
};

TEST(StationV0, TwoReferencesAcrossTheFullTurnOrOneOutOfTolerance) {
    for (bool weighted : {true, false}) {
        // 0.02 gr apart: both out of tolerance, both kept when forced.
        const V0Result result = TwoReferences(399.99, 0.01).Compute(weighted, true);
        ASSERT_TRUE(result.computed);
        // Weighted: (100 x -0.01 + 300 x 0.01) / 400 = 0.005; plain: 0.
        EXPECT_LT(TurnDistance(result.v0, weighted ? 0.005 : 0.0), kCentimilligon) << result.v0;
        EXPECT_EQ(result.used, 2);
        EXPECT_EQ(result.remarks.size(), 4u) << "two remarks for each reference";
    }
    EXPECT_EQ(TwoReferences(399.9999997, 399.9999997).Compute().v0, 0.0); // a mean of 399.9999997

    // Weighted mean 50 + 0.008 x 100 / 400 = 50.002: A is 0.006 away, B 0.002, T_V0 = 0.00304. The worst
    // goes, and the other alone gives the V0.
    const V0Result result = TwoReferences(50.008, 50.0).Compute();
    ASSERT_TRUE(result.computed);
    EXPECT_NEAR(result.v0, 50.0, kCentimilligon);
    EXPECT_EQ(result.used, 1);
    EXPECT_EQ(result.references[0].residual, kUndefined);
    EXPECT_EQ(result.remarks, (std::vector<std::string>{
                                  " -> V0 hors tolérance pour la référence <A> !",
                                  Sprintf("    (écart = 0.00600 Gr > %.5f Gr)", std::sqrt(0.5) * 0.0043)}));
}

TEST(StationV0, AReferenceAtTheStationsOwnPlaceIsDroppedAndTheV0Rounded) {
    Job job(75.0);
    AddPoint(job.carnet, "S1BIS", {kStation.x + 0.00005, kStation.y, kStation.z});
    job.sightings.insert(job.sightings.begin(),
                         job.carnet.Add(std::make_unique<CReference>("S1BIS", 12.3), kKindReference));
    const V0Result result = job.Compute();
    ASSERT_TRUE(result.computed);
    EXPECT_NEAR(result.v0, 75.0, kCentimilligon);
    EXPECT_EQ(result.used, 3);
    EXPECT_FALSE(result.references[0].valid);
    EXPECT_EQ(result.remarks,
              std::vector<std::string>{"La référence <S1BIS> est confondue avec la station !"});
    // Rounded to six decimals, a full turn being 0.
    EXPECT_NEAR(RoundV0(123.4567894), 123.456789, 1e-12);
    EXPECT_NEAR(RoundV0(-0.5), 399.5, 1e-12);
    EXPECT_EQ(RoundV0(-0.0000001), 0.0);
}

TEST(StationV0, DistanceAndHeightChecksWarnButKeepTheReference) {
    Job job(5.0);
    CVisee& a = job.Sighting(0);
    const double tooLong = 0.1 / std::sin(a.av() / kGonPerRadian);
    a.setDI(a.di() + tooLong);                                      // 10 cm too long: beyond 3.10 cm
    job.carnet.As<CPointGen>(job.carnet.findMat("B"))->setZ(99.25); // 5 cm too high: beyond 3.77 cm
    const V0Result result = job.Compute();
    EXPECT_EQ(
        result.warnings,
        (std::vector<std::string>{
            "L'écart entre les distances horizontales mesurées et calculées\n"
            "vers la référence <A> est hors tolérance!\n"
            "Calculée :     100.000m / Mesurée :     100.100m\nEcart :      -0.100m",
            "L'écart entre les dénivelées mesurées et calculées\nvers la référence <B> est hors tolérance!\n"
            "Calculée :      -0.750m / Mesurée :      -0.800m\nEcart :       0.050m"}));
    EXPECT_EQ(result.used, 3);
    EXPECT_NEAR(result.v0, 5.0, kCentimilligon);

    // A scale of -200 ppm makes the 100 m measured 99.980 m.
    a.setDI(a.di() - tooLong);
    EXPECT_NEAR(job.Compute(true, false, -200.0).references[0].measuredDistance, 99.98, kTenthMm);
}

TEST(StationV0, ReferencesOfferedAndChosenAtFirst) {
    CCarnet carnet;
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
    EXPECT_EQ(StationPlaceAt(carnet, s2).Designation(), "S1(2)");
}

// Orienting many stations reads each point's place once and keeps it: what it keeps must be what the
// GéoBase says, for a station point known in parts, a station set up again, one set up off its point and
// one without coordinates, whether the place is read the first time or found again.
TEST(StationV0, PlacesKeptForManyStationsAreThoseOfTheGeoBase) {
    CCarnet carnet;
    carnet.Add(std::make_unique<CPointGen>("S1", 100.0), kKindPoint); // its height first, then its plan
    carnet.Add(std::make_unique<CPointGen>("S1", kStation.x, kStation.y), kKindPoint);
    AddPoint(carnet, "A", {1000.0, 2100.0, 101.0});
    AddPoint(carnet, "B", {1200.0, 2000.0, 99.2});
    const Place s2{1150.0, 2050.0, 98.0};
    AddPoint(carnet, "S2", s2);
    std::vector<int> stations{AddStation(carnet, "S1", kHi)};
    for (const char* name : {"A", "B", "S2"})
        AddSighting(carnet, name, kStation, kHi,
                    name[0] == 'A'   ? Place{1000.0, 2100.0, 101.0}
                    : name[0] == 'B' ? Place{1200.0, 2000.0, 99.2}
                                     : s2,
                    1.3, 50.0);
    stations.push_back(AddStation(carnet, "S2", 1.6));
    AddSighting(carnet, "S1", s2, 1.6, {kStation.x, kStation.y, 100.0}, 1.3, 120.0, kKindMesure);
    AddSighting(carnet, "A", s2, 1.6, {1000.0, 2100.0, 101.0}, 1.3, 120.0, kKindMesure);
    carnet.Add(std::make_unique<CCommande>(std::string(kExcentVer), "0.250"), kKindExcentrement);
    stations.push_back(AddStation(carnet, "S1", 1.45, 49.9));
    AddSighting(carnet, "B", kStation, 1.7, {1200.0, 2000.0, 99.2}, 1.3, 50.0);
    stations.push_back(AddStation(carnet, "S9", 1.5)); // no point S9
    AddSighting(carnet, "A", {900.0, 2000.0, 0.0}, 1.5, {1000.0, 2100.0, 101.0}, 1.3, 10.0);

    V0Settings settings;
    PointPlaces kept(carnet, true);
    for (int pass = 0; pass < 2; ++pass)
        for (int i : stations) {
            SCOPED_TRACE(Sprintf("station %d, pass %d", i, pass));
            const StationPlace expected = StationPlaceAt(carnet, i), station = kept.Station(i);
            EXPECT_EQ(station.name, expected.name);
            EXPECT_EQ(station.reprise, expected.reprise);
            for (auto [value, wanted] : {std::pair{station.x, expected.x},
                                         {station.y, expected.y},
                                         {station.z, expected.z},
                                         {station.hi, expected.hi},
                                         {station.v0, expected.v0}})
                EXPECT_EQ(value, wanted);
            const std::vector<int> references = DefaultReferences(kept, i);
            ASSERT_EQ(references, DefaultReferences(carnet, i));
            const V0Result result = ComputeStationV0(kept, station, references, settings);
            const V0Result plain = ComputeStationV0(carnet, expected, references, settings);
            EXPECT_EQ(result.v0, plain.v0);
            EXPECT_EQ(result.warnings, plain.warnings);
            ASSERT_EQ(result.references.size(), plain.references.size());
            for (std::size_t r = 0; r < plain.references.size(); ++r)
                EXPECT_EQ(result.references[r].z, plain.references[r].z);
        }
    EXPECT_EQ(kept.Station(stations[2]).Designation(), "S1(2)");
    EXPECT_FALSE(kept.Station(stations[3]).HasPlace());
}

} // namespace
} // namespace pyr::test
