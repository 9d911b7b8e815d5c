// Radiated points, against stations and points built from exact coordinates (ExactReadings.h): a perfect
// instrument reads the sightings, so every point comes back where it was built, whatever the face, the
// target's offsets, the instrument's constants or the scale. Deviations and spreads are put in on purpose
// and found again by hand.
#include "ExactReadings.h"
#include "GeoLines.h"
#include "TestSupport.h"
#include "calc/Radiation.h"
#include "calc/RadiationListing.h"
#include "calc/RadiationTexts.h"
#include "geobase/Selection.h"
#include "settings/ListingObject.h"
#include "ui/ScriptedFrontEnd.h"

#include <string>
#include <vector>

namespace pyr::test {
namespace {

constexpr Place kS1{1652345.678, 8176543.21, 150.0};
constexpr double kHi = 1.55, kV0 = 37.415, kHp = 1.3;
constexpr Place Near(double dx, double dy, double z) {
    return {kS1.x + dx, kS1.y + dy, z};
}
// One point in each quadrant around S1, above and below it; K1 is known in the GéoBase.
constexpr Place kP[] = {Near(120.0, 85.0, 153.2), Near(-64.0, 230.0, 147.1), Near(-310.0, -12.0, 160.4),
                        Near(45.0, -150.0, 139.8)};
constexpr Place kK1 = Near(400.0, 300.0, 151.0);

enum class Face { Left, Right };

// The reading of `to`, on a target `hp` over it, from an instrument `hi` over `from` oriented at `v0`.
Geo& Sight(Geo& geo, const std::string& name, const Place& from, double hi, double v0, const Place& to,
           double hp, Face face = Face::Left, const char* code = "", int kind = kKindMesure) {
    Reading r = Read(from, hi, v0, to, hp);
    if (face == Face::Right) r.ah = std::fmod(r.ah + 200.0, 400.0), r.av = 400.0 - r.av;
    return kind == kKindMesure ? geo.Mes(name, hp, r.ah, r.av, r.di, code)
                               : geo.Ref(name, hp, r.ah, r.av, r.di, code);
}
Geo& SightFromS1(Geo& geo, const std::string& name, const Place& to, double hp = kHp, Face face = Face::Left,
                 const char* code = "") {
    return Sight(geo, name, kS1, kHi, kV0, to, hp, face, code);
}

void ExpectAt(const RadiatedSighting& s, const Place& p, bool withZ = true) {
    EXPECT_NEAR(s.x, p.x, kTenthMm) << s.mat;
    EXPECT_NEAR(s.y, p.y, kTenthMm) << s.mat;
    if (withZ) {
        EXPECT_NEAR(s.z, p.z, kTenthMm) << s.mat;
    }
}

void ExpectAllFinite(const RadiatedStation& r) {
    ExpectFinite({r.station.x, r.station.y, r.station.z, r.station.hi, r.station.v0, r.v0.v0});
    for (const RadiatedSighting& s : r.points)
        ExpectFinite({s.hp, s.ah, s.av, s.di, s.dh, s.bearing, s.x, s.y, s.z});
    for (const RadiationCheck& c : r.checks)
        ExpectFinite({c.sighting.x, c.sighting.y, c.sighting.z, c.knownX, c.knownY, c.knownZ, c.along,
                      c.across, c.dz});
}

std::vector<std::string> Mats(const RadiatedSightings& points) {
    std::vector<std::string> mats;
    for (const RadiatedSighting& s : points)
        mats.emplace_back(s.mat);
    return mats;
}

// S1 placed and oriented, its backsight on K1, then P1 to P4 (P2 face right, P4 on a target of 0), and
// its own point, which gives nothing.
Geo OneStation() {
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Pt("K1", kK1.x, kK1.y, kK1.z).Sta("S1", kHi, kV0);
    Sight(geo, "K1", kS1, kHi, kV0, kK1, 1.6, Face::Left, "", kKindReference);
    SightFromS1(geo, "P1", kP[0], kHp, Face::Left, "BORNE");
    SightFromS1(geo, "P2", kP[1], kHp, Face::Right);
    geo.Mes("S1", 0.0, 0.0, 100.0, 0.0);
    SightFromS1(geo, "P3", kP[2]);
    SightFromS1(geo, "P4", kP[3], 0.0);
    return geo;
}

TEST(RadiationSightings, ExactReadingsGiveThePointsBackAndKnownPointsBecomeChecks) {
    const Geo geo = OneStation();
    const RadiatedStation r = RadiateStation(geo, 2, RadiationSettings{});
    ASSERT_TRUE(r.usable);
    EXPECT_FALSE(r.v0Computed);
    EXPECT_EQ(r.station.v0, kV0);
    ASSERT_EQ(Mats(r.points), (std::vector<std::string>{"P1", "P2", "P3", "P4"}));
    for (std::size_t i = 0; i < 4; ++i) {
        const RadiatedSighting& s = r.points[i];
        ExpectAt(s, kP[i]);
        EXPECT_NEAR(s.bearing, BearingTo(kS1.x, kS1.y, kP[i].x, kP[i].y), kHundredthMgon);
        EXPECT_NEAR(s.dh, std::hypot(kP[i].x - kS1.x, kP[i].y - kS1.y), kTenthMm);
        EXPECT_LT(s.av, 200.0); // face right turned to face left
        EXPECT_EQ(s.repetitions, 1);
        EXPECT_FALSE(s.reference);
    }
    EXPECT_EQ(r.points[0].index, 4);
    EXPECT_EQ(r.points[0].code, "BORNE");
    EXPECT_EQ(r.points[3].hp, 0.0);

    ASSERT_EQ(r.checks.size(), 1u);
    const RadiationCheck& k = r.checks[0];
    EXPECT_EQ(k.sighting.mat, "K1");
    EXPECT_TRUE(k.sighting.reference);
    EXPECT_EQ(k.knownX, kK1.x);
    EXPECT_EQ(k.knownZ, kK1.z);
    EXPECT_NEAR(k.along, 0.0, kTenthMm);
    EXPECT_NEAR(k.across, 0.0, kTenthMm);
    EXPECT_NEAR(k.dz, 0.0, kTenthMm);
    EXPECT_TRUE(r.skipped.empty());
    ExpectAllFinite(r);

    // A list of points leaves the others aside, known or not.
    const auto chosen = CSelection::Parse("P2-P3");
    ASSERT_TRUE(chosen);
    const RadiatedStation some = RadiateStation(geo, 2, RadiationSettings{}, &*chosen);
    EXPECT_EQ(Mats(some.points), (std::vector<std::string>{"P2", "P3"}));
    EXPECT_TRUE(some.checks.empty());
}

// A known point north, south and west of the station; each reading aims 0.03 m beyond it and 0.02 m to
// its right as seen from the station (east, west and north of it), 0.01 m above or 0.005 m below.
TEST(RadiationSightings, ChecksMeasureTheRadiatedPointAlongAndAcrossTheLineOfSight) {
    const Place st{1000.0, 2000.0, 100.0};
    const Place known[] = {{1000.0, 2100.0, 101.0}, {1000.0, 1900.0, 99.0}, {900.0, 2000.0, 100.5}};
    const Place aimed[] = {{1000.02, 2100.03, 101.01}, {999.98, 1899.97, 98.995}, {899.97, 2000.02, 100.51}};
    const double dz[] = {0.01, -0.005, 0.01};
    Geo geo;
    geo.Pt("S", st.x, st.y, st.z).Pt("N", known[0].x, known[0].y, known[0].z);
    geo.Pt("Sud", known[1].x, known[1].y, known[1].z).Pt("O", known[2].x, known[2].y, known[2].z);
    geo.Sta("S", 1.5, 0.0);
    Sight(geo, "N", st, 1.5, 0.0, aimed[0], 1.3);
    Sight(geo, "Sud", st, 1.5, 0.0, aimed[1], 1.3);
    Sight(geo, "O", st, 1.5, 0.0, aimed[2], 1.3);
    const RadiatedStation r = RadiateStation(geo, 4, RadiationSettings{});
    ASSERT_EQ(r.checks.size(), 3u);
    for (std::size_t i = 0; i < 3; ++i) {
        SCOPED_TRACE(r.checks[i].sighting.mat);
        EXPECT_NEAR(r.checks[i].along, 0.03, kHundredthMm);
        EXPECT_NEAR(r.checks[i].across, 0.02, kHundredthMm);
        EXPECT_NEAR(r.checks[i].dz, dz[i], kHundredthMm);
    }
    EXPECT_TRUE(r.points.empty());
    ExpectAllFinite(r);
}

// The prism of P1 stands off the point: P1 lies 0.35 m beyond it along the line of sight and 0.20 m to
// its left, and the target height written (1.60) is 0.15 m more than the prism's height over P1. A second
// set-up of S1 has an instrument whose zenith angles read 2.1 mgon short and whose distances miss the
// prism constant of 17.5 mm.
TEST(RadiationSightings, EccentricTargetsAndInstrumentConstantsAreReducedToThePoints) {
    const Place prism = Near(180.0, -95.0, 0.0);
    const double dh = std::hypot(prism.x - kS1.x, prism.y - kS1.y);
    const double ux = (prism.x - kS1.x) / dh, uy = (prism.y - kS1.y) / dh; // along; (uy, -ux) is to the right
    const double er = 0.35, et = -0.20, ev = 0.15;
    const Place p1{prism.x + er * ux + et * uy, prism.y + er * uy - et * ux, 146.3};
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Sta("S1", kHi, kV0);
    geo.Exc(kExcentRad, er).Exc(kExcentTan, et).Exc(kExcentVer, ev);
    Reading onPrism = Read(kS1, kHi, kV0, {prism.x, prism.y, p1.z}, 1.60 - ev);
    geo.Mes("P1", 1.60, onPrism.ah, onPrism.av, onPrism.di);

    const double collimation = 0.0021, prismConstant = 0.0175;
    geo.Inst("T", collimation, prismConstant).Sta("S1", kHi, kV0);
    const Reading onP2 = Read(kS1, kHi, kV0, kP[1], kHp);
    geo.Mes("P2", kHp, onP2.ah, onP2.av - collimation, onP2.di - prismConstant);

    RadiationSettings settings;
    settings.reduction.instrumentConstants = true;
    const RadiatedStation first = RadiateStation(geo, 1, settings);
    ASSERT_EQ(first.points.size(), 1u);
    ExpectAt(first.points[0], p1);
    EXPECT_NEAR(first.points[0].hp, 1.45, 1e-12);
    const RadiatedStation second = RadiateStation(geo, 7, settings);
    ASSERT_EQ(second.points.size(), 1u);
    ExpectAt(second.points[0], kP[1]);
    ExpectAllFinite(second);

    settings.reduction.instrumentConstants = false; // the point falls short by the prism constant
    const RadiatedStation raw = RadiateStation(geo, 7, settings);
    ASSERT_EQ(raw.points.size(), 1u);
    EXPECT_NEAR(std::hypot(raw.points[0].x - kP[1].x, raw.points[0].y - kP[1].y), prismConstant, 0.001);
}

// The instrument measured on the ground, where lengths are 120 ppm shorter than in the projection
// ("AlterLineaire" 150 mm/km, reduction to the level surface −30 mm/km): the readings are of points
// brought 120 ppm nearer the station, and the radiation puts them back. The altitude follows the same
// corrected distance as in every computation and is not the subject here.
TEST(RadiationSightings, ScaleCorrectionLengthensTheHorizontalDistances) {
    RadiationSettings settings;
    settings.reduction.correction.linearAlteration = 150.0;
    settings.reduction.correction.levelReduction = -30.0;
    const double ground = 1.0 / (1.0 + 120e-6);
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Sta("S1", kHi, kV0);
    for (int i = 0; i < 4; ++i)
        SightFromS1(geo, "P" + std::to_string(i + 1),
                    {kS1.x + (kP[i].x - kS1.x) * ground, kS1.y + (kP[i].y - kS1.y) * ground, kP[i].z});
    const RadiatedStation r = RadiateStation(geo, 1, settings);
    ASSERT_EQ(r.points.size(), 4u);
    for (std::size_t i = 0; i < 4; ++i)
        ExpectAt(r.points[i], kP[i], false);
}

// A target height of 0 written for a pole 1.80 m high; P2's after a vertical offset of 0.25 m, P3 with its
// own height.
TEST(RadiationSightings, AZeroTargetHeightIsReplacedBeforeTheAltitude) {
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Sta("S1", kHi, kV0);
    Reading r1 = Read(kS1, kHi, kV0, kP[0], 1.80), r2 = Read(kS1, kHi, kV0, kP[1], 1.55);
    geo.Mes("P1", 0.0, r1.ah, r1.av, r1.di).Exc(kExcentVer, 0.25).Mes("P2", 0.0, r2.ah, r2.av, r2.di);
    SightFromS1(geo, "P3", kP[2], 1.2);
    RadiationSettings settings;
    settings.replaceZeroTargetHeight = true;
    settings.zeroTargetHeight = 1.80;
    const RadiatedStation r = RadiateStation(geo, 1, settings);
    ASSERT_EQ(r.points.size(), 3u);
    for (std::size_t i = 0; i < 3; ++i)
        ExpectAt(r.points[i], kP[i]);
    EXPECT_NEAR(r.points[1].hp, 1.55, 1e-12);
    EXPECT_EQ(r.points[2].hp, 1.2);

    settings.replaceZeroTargetHeight = false; // as written: P1 seen 1.80 m too high
    EXPECT_NEAR(RadiateStation(geo, 1, settings).points[0].z, kP[0].z + 1.80, kTenthMm);
    settings.replaceZeroTargetHeight = true;
    settings.reduction.targetHeights = false; // no target heights at all: none is put back
    EXPECT_EQ(RadiateStation(geo, 1, settings).points[0].hp, 0.0);
}

// P1 read face left with its direction 0.4 mgon over and its distance 1 mm long, then face right with
// both as much short, then on a 2.00 m target: the mean of the three is the point.
TEST(RadiationSightings, RepetitionsOfAPointAreMergedIntoItsFirstSighting) {
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Sta("S1", kHi, kV0);
    const Reading r = Read(kS1, kHi, kV0, kP[0], kHp), high = Read(kS1, kHi, kV0, kP[0], 2.0);
    geo.Mes("P1", kHp, r.ah + 0.0004, r.av, r.di + 0.001);
    SightFromS1(geo, "P2", kP[1]);
    geo.Ref("P1", kHp, std::fmod(r.ah - 0.0004 + 200.0, 400.0), 400.0 - r.av, r.di - 0.001, "ARBRE");
    geo.Mes("P1", 2.0, high.ah, high.av, high.di);
    const RadiatedStation merged = RadiateStation(geo, 1, RadiationSettings{});
    ASSERT_EQ(Mats(merged.points), (std::vector<std::string>{"P1", "P2"}));
    const RadiatedSighting& p1 = merged.points[0];
    EXPECT_EQ(p1.index, 2);
    EXPECT_EQ(p1.repetitions, 3);
    EXPECT_EQ(p1.code, "ARBRE");
    EXPECT_TRUE(p1.reference);
    EXPECT_NEAR(p1.hp, kHp, 1e-12);
    EXPECT_NEAR(p1.ah, r.ah, kHundredthMgon);
    EXPECT_NEAR(p1.av, r.av, kHundredthMgon);
    ExpectAt(p1, kP[0]);
    ExpectAt(merged.points[1], kP[1]);
    ExpectAllFinite(merged);
}

TEST(RadiationSightings, SightingsWithoutDistanceOrDirectionAreNamedAndUnknownHeightsLeaveZUnknown) {
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Sta("S1", kHi, kV0);
    geo.Mes("A", kHp, 10.0, 100.0, 0.0).Mes("A", kHp, 10.0, 100.0, 0.0); // 2, 3: twice without distance
    geo.Mes("B", kHp, kUndefined, 100.0, 50.0);                          // 4
    geo.Mes("C", kHp, 30.0, kUndefined, 50.0).Mes("E", kHp, 40.0, 0.0, 50.0);
    const Reading r = Read(kS1, kHi, kV0, kP[0], kHp);
    geo.Mes("F", kHp, r.ah, r.av, 0.0).Mes("F", kHp, r.ah, r.av, r.di); // measured at the second go
    geo.Mes("G", kUndefined, r.ah, r.av, r.di);
    // Two sightings without identifier, complete: no point to write, both named once.
    geo.Mes("", kHp, r.ah, r.av, r.di).Mes("", kHp, r.ah + 10.0, r.av, r.di);
    const RadiatedStation with = RadiateStation(geo, 1, RadiationSettings{});
    ASSERT_EQ(with.skipped.size(), 5u);
    const std::pair<const char*, const char*> expected[] = {{"A", rayon::kReasonNoDistance},
                                                            {"B", rayon::kReasonNoDirection},
                                                            {"C", rayon::kReasonNoZenith},
                                                            {"E", rayon::kReasonNoDistance},
                                                            {"", rayon::kReasonNoName}};
    for (std::size_t i = 0; i < 5; ++i) {
        EXPECT_EQ(with.skipped[i].mat, expected[i].first);
        EXPECT_EQ(with.skipped[i].reason, expected[i].second);
    }
    EXPECT_EQ(with.skipped[0].index, 2);
    ASSERT_EQ(Mats(with.points), (std::vector<std::string>{"F", "G"}));
    ExpectAt(with.points[0], kP[0]);
    ExpectAt(with.points[1], kP[0], false);
    EXPECT_EQ(with.points[1].z, kUndefined);
    ExpectAllFinite(with);

    Geo flat; // a station without altitude and without instrument height
    flat.Pt("S1", kS1.x, kS1.y, kUndefined).Sta("S1", kUndefined, kV0);
    SightFromS1(flat, "P1", kP[0]);
    const RadiatedStation without = RadiateStation(flat, 1, RadiationSettings{});
    ASSERT_EQ(without.points.size(), 1u);
    ExpectAt(without.points[0], kP[0], false);
    EXPECT_EQ(without.points[0].z, kUndefined);
    ExpectAllFinite(without);
}

// S9 has no coordinates; S1 is first set up without a V0 and backsights K1 and P1 (known here), then a
// second time with its own V0 and no reference; S2 is placed but neither oriented nor backsighting.
TEST(RadiationStation, AStationNeedsItsPlaceAndAV0OwnOrComputedFromItsReferences) {
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Pt("K1", kK1.x, kK1.y, kK1.z).Pt("P1", kP[0].x, kP[0].y, kP[0].z);
    geo.Pt("S2", kP[3].x, kP[3].y, kP[3].z);
    geo.Sta("S9", 1.5, 0.0).Mes("X", 1.3, 10.0, 100.0, 20.0); // 4
    geo.Sta("S1", kHi);                                       // 6
    Sight(geo, "K1", kS1, kHi, kV0, kK1, kHp, Face::Left, "", kKindReference);
    Sight(geo, "P1", kS1, kHi, kV0, kP[0], kHp, Face::Right, "", kKindReference);
    SightFromS1(geo, "P3", kP[2]);
    geo.Sta("S1", kHi, 12.0).Mes("P3", 1.3, 10.0, 100.0, 20.0); // 10
    geo.Sta("S2", 1.5).Mes("P3", 1.3, 10.0, 100.0, 20.0);       // 12

    RadiationSettings own;
    const RadiatedStation s9 = RadiateStation(geo, 4, own);
    EXPECT_FALSE(s9.usable);
    EXPECT_EQ(s9.reason, rayon::kReasonNoPlace);
    EXPECT_TRUE(s9.points.empty() && s9.skipped.empty());
    EXPECT_EQ(RadiateStation(geo, 6, own).reason, rayon::kReasonNoV0);

    RadiationSettings computed;
    computed.computeV0 = true;
    const RadiatedStation s1 = RadiateStation(geo, 6, computed);
    ASSERT_TRUE(s1.usable);
    EXPECT_TRUE(s1.v0Computed);
    EXPECT_EQ(s1.v0.used, 2);
    EXPECT_NEAR(s1.station.v0, kV0, kHundredthMgon);
    ASSERT_EQ(s1.points.size(), 1u);
    ExpectAt(s1.points[0], kP[2]);
    EXPECT_EQ(s1.checks.size(), 2u);
    ExpectAllFinite(s1);

    const RadiatedStation again = RadiateStation(geo, 10, computed); // no reference: its own V0
    EXPECT_TRUE(again.usable);
    EXPECT_FALSE(again.v0Computed);
    EXPECT_EQ(again.station.v0, 12.0);
    const RadiatedStation s2 = RadiateStation(geo, 12, computed);
    EXPECT_FALSE(s2.usable);
    EXPECT_EQ(s2.reason, rayon::kReasonNoReference);
}

// P from S1 and S2, the distance from S2 8 mm long and its target height written 6 mm too high, and from
// S3, which has no altitude; Q from S1 only, R from S2 only.
TEST(RadiationMerge, APointFromSeveralStationsKeepsTheMeanAndItsSpread) {
    const Place s2 = Near(-150.0, 260.0, 152.0), s3 = Near(200.0, 300.0, 0.0), p = Near(40.0, 180.0, 149.2);
    Geo geo;
    geo.Pt("S1", kS1.x, kS1.y, kS1.z).Pt("S2", s2.x, s2.y, s2.z).Pt("S3", s3.x, s3.y, kUndefined);
    geo.Sta("S1", kHi, kV0);
    SightFromS1(geo, "P", p);
    SightFromS1(geo, "Q", kP[0]);
    geo.Sta("S2", 1.6, 250.0);
    Sight(geo, "R", s2, 1.6, 250.0, kP[1], kHp);
    const Reading fromS2 = Read(s2, 1.6, 250.0, p, kHp);
    geo.Mes("P", kHp + 0.006, fromS2.ah, fromS2.av, fromS2.di + 0.008);
    geo.Sta("S3", 1.5, 100.0);
    Sight(geo, "P", s3, 1.5, 100.0, p, kHp);

    std::vector<RadiatedStation> stations;
    for (int index : {3, 6, 9})
        stations.push_back(RadiateStation(geo, index, RadiationSettings{}));
    Tolerances tolerances;
    RadiatedPoints points = MergeDeterminations(stations, tolerances);
    ASSERT_EQ(points.size(), 3u);
    EXPECT_EQ(points[0].mat, "P");
    EXPECT_EQ(points[1].mat, "Q");
    EXPECT_EQ(points[2].mat, "R");

    // From S2, P lies 8 mm × sin(AV) beyond its place and 8 mm × cos(AV) − 6 mm above it.
    const double zenith = fromS2.av / kGonPerRadian, g = BearingTo(s2.x, s2.y, p.x, p.y) / kGonPerRadian;
    const double off = 0.008 * std::sin(zenith), up = 0.008 * std::cos(zenith) - 0.006;
    const RadiatedPoint& mp = points[0];
    ASSERT_EQ(mp.determinations.size(), 3u);
    EXPECT_EQ(mp.determinations[1].station, 1u);
    EXPECT_EQ(mp.determinations[1].point, 1u);
    RadiatedPoint copy = mp, moved = std::move(copy); // each with its own determinations
    copy = moved;
    ASSERT_EQ(copy.determinations.size(), 3u);
    EXPECT_EQ(copy.determinations[2].station, 2u);
    EXPECT_EQ(moved.determinations[2].station, 2u);
    EXPECT_NEAR(mp.x, p.x + off * std::sin(g) / 3.0, kTenthMm);
    EXPECT_NEAR(mp.y, p.y + off * std::cos(g) / 3.0, kTenthMm);
    EXPECT_NEAR(mp.z, p.z + up / 2.0, kTenthMm); // S3 gives no altitude
    EXPECT_NEAR(mp.spreadXY, off, kHundredthMm);
    EXPECT_NEAR(mp.spreadZ, std::fabs(up), kHundredthMm);
    EXPECT_FALSE(mp.outOfTolerance);
    for (std::size_t i : {1u, 2u}) {
        EXPECT_EQ(points[i].determinations.size(), 1u);
        EXPECT_EQ(points[i].spreadXY, 0.0);
        EXPECT_EQ(points[i].spreadZ, 0.0);
        EXPECT_FALSE(points[i].outOfTolerance);
    }
    EXPECT_NEAR(points[1].x, kP[0].x, kTenthMm);
    EXPECT_NEAR(points[1].y, kP[0].y, kTenthMm);
    EXPECT_NEAR(points[1].z, kP[0].z, kTenthMm);

    // Sightings made elsewhere, without the key RadiateStation gives, are grouped by identifier alike.
    std::vector<RadiatedStation> unkeyed = stations;
    unkeyed[1].points[0].key = -1;
    const RadiatedPoints byName = MergeDeterminations(unkeyed, tolerances);
    ASSERT_EQ(byName.size(), points.size());
    for (std::size_t i = 0; i < points.size(); ++i) {
        EXPECT_EQ(byName[i].mat, points[i].mat);
        ASSERT_EQ(byName[i].determinations.size(), points[i].determinations.size());
        for (std::size_t d = 0; d < points[i].determinations.size(); ++d)
            EXPECT_EQ(byName[i].determinations[d].station, points[i].determinations[d].station);
        EXPECT_EQ(byName[i].x, points[i].x);
        EXPECT_EQ(byName[i].spreadXY, points[i].spreadXY);
    }

    tolerances.customDistance = 0.007; // 8 mm sin(AV) is more
    EXPECT_TRUE(MergeDeterminations(stations, tolerances)[0].outOfTolerance);
    tolerances.customDistance = 0.01;
    tolerances.customHeight = std::fabs(up) - 0.0005;
    EXPECT_TRUE(MergeDeterminations(stations, tolerances)[0].outOfTolerance);
}

// The listing in plain text, byte for byte: each station's points in the surveyor's columns (the code
// first, so left-aligned with the identifiers), its checks of known points, the sightings that gave
// nothing, then the points seen from several stations with their mean.
TEST(RadiationListing, StationsTheirPointsChecksAndRepeatedPointsAreTabulated) {
    Geo geo = OneStation();
    const Reading again = Read(kS1, kHi, kV0, kP[2], kHp);
    geo.Sta("S1", kHi, kV0).Mes("P3", kHp, again.ah, again.av, again.di + 0.004, "MUR");
    geo.Mes("P5", kHp, 50.0, 100.0, 0.0);
    std::vector<RadiatedStation> stations;
    for (int index : {2, 9})
        stations.push_back(RadiateStation(geo, index, RadiationSettings{}));
    const RadiatedPoints points = MergeDeterminations(stations, Tolerances{});
    const std::vector<std::string> columns = RadiationColumns("CS,N,X,Y,Z,GI");

    ui::ScriptedFrontEnd frontEnd;
    TempDir folder;
    const std::string file = folder / "rayon.cpr";
    CDlgCfgListing listing{frontEnd};
    listing.SetFormat(kListingTextNoPageCount);
    listing.SetDeciCoor(3);
    listing.SetDeciAlti(3);
    listing.SetDeciDist(3);
    listing.SetDeciDeni(3);
    listing.SetDeciAngl(4);
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    WriteRadiation(listing, {stations, points, columns, true});
    ASSERT_TRUE(listing.CloseListing(file, false));
    EXPECT_EQ(ReadBytes(file), R"(| Station S1, reprise 1 |
X = 1652345.678   Y = 8176543.210   Z = 150.000   HI = 1.550
V0 = 37.4150 (celui de la GéoBase)

Points rayonnés
---------------
| Code  | Matricule |      X      |      Y      |    Z    |   Gis.   |
| BORNE |        P1 | 1652465.678 | 8176628.210 | 153.200 |  60.7653 |
|       |        P2 | 1652281.678 | 8176773.210 | 147.100 | 382.7224 |
|       |        P3 | 1652035.678 | 8176531.210 | 160.400 | 297.5369 |
|       |        P4 | 1652390.678 | 8176393.210 | 139.800 | 181.4453 |

Contrôle des points connus
--------------------------
| Matricule |  Gis.   |   DH    | Ecart long. | Ecart transv. | Ecart Z |
| K1        | 59.0334 | 500.000 |      +0.000 |        +0.000 |  +0.000 |

| Station S1, reprise 2 |
X = 1652345.678   Y = 8176543.210   Z = 150.000   HI = 1.550
V0 = 37.4150 (celui de la GéoBase)

Points rayonnés
---------------
| Code | Matricule |      X      |      Y      |    Z    |   Gis.   |
| MUR  |        P3 | 1652035.674 | 8176531.210 | 160.400 | 297.5369 |

| Visées non calculées |
| P5 : sans distance   |

| Points déterminés plusieurs fois |

| Matricule | Station |      X      |      Y      |    Z    |
| P3        | S1(1)   | 1652035.678 | 8176531.210 | 160.400 |
| P3        | S1(2)   | 1652035.674 | 8176531.210 | 160.400 |
| P3        | Moyenne | 1652035.676 | 8176531.210 | 160.400 |
Ecarts : 0.004 m en XY, 0.000 m en Z

)");
}

} // namespace
} // namespace pyr::test
