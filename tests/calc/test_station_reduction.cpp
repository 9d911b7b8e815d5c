// The reduction of stations, on GéoBases built here: each expected value comes from the geometry the
// GéoBase was built from (a point at a known horizontal distance and height difference, a second
// set-up turned by a known angle, raised by a known height) or from a count worked out by hand.
#include "TestSupport.h"
#include "calc/GeoLines.h"
#include "calc/StationReduction.h"
#include "calc/StationReductionDriver.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <array>
#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kMgon = 1e-4;    // 0.1 mgon
constexpr double kTenthMm = 1e-4; // 0.1 mm

// The zenith angle (gr) of a line of sight h metres long horizontally, rising v.
double Zenith(double h, double v) {
    return RadiansToGrads(std::atan2(h, v));
}

// The sighting at `i`: its point, its direction and zenith angle to 0.1 mgon, its distance to 0.1 mm and
// its target height.
void ExpectSighting(const CCarnet& geo, int i, const char* point, double ah, double av, double di,
                    double hp) {
    SCOPED_TRACE(point);
    EXPECT_EQ(geo.matAt(i), point);
    EXPECT_NEAR(geo.ahAt(i), ah, kMgon);
    EXPECT_NEAR(geo.avAt(i), av, kMgon);
    EXPECT_NEAR(geo.diAt(i), di, kTenthMm);
    EXPECT_NEAR(geo.hpAt(i), hp, 1e-9);
}

class Reduction : public ::testing::Test {
protected:
    void Reduce(ReductionOptions options) {
        dialog.SetCarnet(&geo);
        dialog.Options() = options;
        dialog.Reduce(frontEnd);
    }

    Geo geo;
    CReduction_Station dialog;
    ui::ScriptedFrontEnd frontEnd;
};

// The repeated sightings below cover the plain half turn, the whole turn and a direction left as it
// stands; here, the way forward by 200, the whole turn the other way and the limits of the rule.
TEST(ReductionFormulas, RepetitionsComeBackByHalfOrWholeTurnsAndOffsetsAreMeanedAcrossZero) {
    // clang-format off
    const struct { double ah, mean, expected; } cases[] = {
        {0.002, 200.0, 200.002}, // 199.998 away, short of the mean: forward by 200
        {395.0, 5.0, -5.0},      // 390 away across zero: a whole turn back
        {310.0, 10.0, 310.0}, {160.0, 10.0, 160.0}, {260.0, 10.0, 260.0}, // 300, 150, 250 away: as they stand
    };
    // clang-format on
    for (const auto& c : cases)
        EXPECT_NEAR(BringNearMean(c.ah, c.mean), c.expected, 1e-9) << c.ah << " / " << c.mean;

    // One pair says 394.9998, the other -4.9998: meaned across zero to 395, not to 195.
    EXPECT_NEAR(MeanOrientationOffset({{397.0, 2.0002}, {104.9998, 109.9996}}), 395.0, 1e-9);
}

TEST_F(Reduction, RepeatedSightingsAreAveragedIntoTheFirst) {
    // P1 comes back by 200 (200.002 from the mean), P2 across zero by a whole turn, P3 stays (270 from
    // the mean). P4 is repeated on a target 1 m higher, as a reference. P5's repetition is read face right,
    // and so is P6's first sighting.
    const double z = 99.0, h = 30.0, v = 0.6, d = 50.0;
    geo.Sta("S1", 1.5).Mes("P1", 1.6, 100.0, z, 40.0, "BORNE").Mes("P2", 1.6, 399.999, z, 40.0);
    geo.Mes("P3", 1.6, 10.0, z, 40.0).Mes("P4", 1.5, 50.0, Zenith(h, v), std::hypot(h, v));
    geo.Mes("P5", 1.5, 10.0, 95.0, d).Mes("P6", 1.5, 210.0, 305.0, d);
    geo.Mes("P1", 1.6, 300.002, z, 40.0).Mes("P2", 1.6, 0.003, z, 40.0);
    geo.Mes("P3", 1.6, 280.0, z, 40.0, "ARBRE")
        .Ref("P4", 2.5, 50.0004, Zenith(h, v + 1), std::hypot(h, v + 1));
    geo.Mes("P5", 1.5, 210.0004, 306.0, d).Mes("P6", 1.5, 10.0004, 95.0, d);
    Reduce({.visComm = false, .doMeans = true});

    // P4 is brought to the first target, and its reference makes the mean one. The face-right repetition
    // of P5 comes back by the half-turn rule; its zenith angle enters as it was read, below the horizon:
    // -94 gr against 95. P6 is turned to face left before anything is averaged into it.
    const double h5 = (d * SinGrads(95.0) - d * SinGrads(94.0)) / 2.0;
    ASSERT_EQ(geo.GetSize(), 7);
    ExpectSighting(geo, 1, "P1", 100.0010, z, 40.0, 1.6);
    ExpectSighting(geo, 2, "P2", 0.0010, z, 40.0, 1.6);
    ExpectSighting(geo, 3, "P3", 145.0, z, 40.0, 1.6);
    ExpectSighting(geo, 4, "P4", 50.0002, Zenith(h, v), std::hypot(h, v), 1.5);
    ExpectSighting(geo, 5, "P5", 10.0002, 0.5, h5 / SinGrads(0.5), 1.5);
    ExpectSighting(geo, 6, "P6", 10.0002, 95.0, d, 1.5);
    EXPECT_EQ(geo.symAt(1), "BORNE"); // a code kept, or taken from a repetition
    EXPECT_EQ(geo.symAt(3), "ARBRE");
    EXPECT_EQ(geo.GetType(4), kKindReference);
    EXPECT_TRUE(dialog.Changed());
}

// Run as the GéoBase editor runs it: the switches read from the parameter file, those of the command line
// holding over them, and written back on OK.
TEST(ReductionOptionsFile, InstrumentCorrectionsAreFoldedInAndTheSwitchesKept) {
    // The stations without an instrument element take the default one: instrument 1, or the standard
    // instrument (no correction) for a number beyond the list.
    for (const auto& [number, collimation, prism] : {std::tuple{"1", -0.0015, 0.0175}, {"7", 0.0, 0.0}}) {
        TempDir dir;
        const std::string ini = dir / "Pyralis.ini";
        WriteBytes(ini,
                   std::string("[Définitions_Des_Appareils]\nAppareil0=Appareil Standard\nAppareil1=TCR 1\n"
                               "CollVerticale1=-0.0015\nConstPrisme1=0.0175\n[Options_Calculs]\n"
                               "AppareilParDefaut=") +
                       number + "\n[Reduction_des_Stations]\nInAppareil=1\nSuppress=1\nDoMeans=7\n");
        // S0 without an instrument element; S1 with its own, then one that it does not use.
        Geo geo;
        geo.Sta("S0", 1.5).Mes("P", 1.5, 10.0, 99.0, 100.0);
        geo.Put(std::make_unique<CAppareil>("TS 2", 0.0020, 0.0300), kKindAppareil);
        geo.Sta("S1", 1.5).Mes("P", 1.5, 20.0, 101.0, 80.0);
        geo.Put(std::make_unique<CAppareil>("TS 3", 0.5, 0.5), kKindAppareil)
            .Mes("Q", 1.5, 30.0, kUndefined, 0.0);
        CReductionDriver dialog;
        dialog.Reduction().SetCarnet(&geo);
        dialog.SetInputs({"", ini, "", ""});
        ui::DialogOptions options;
        dialog.DeclareOptions(options);
        ASSERT_EQ(options.Options().size(), 7u);
        EXPECT_EQ(options.Options()[3].apply("oui"), "--Suppress : 0 ou 1 attendu, et non « oui ».");
        EXPECT_EQ(options.Options()[3].apply("0"), "");
        ui::ScriptedFrontEnd frontEnd;
        ASSERT_EQ(dialog.Run(frontEnd), ui::DialogResult::Ok);

        ASSERT_EQ(geo.GetSize(), 5) << number; // both instruments removed
        EXPECT_NEAR(geo.avAt(1), 99.0 + collimation, 1e-9) << number;
        EXPECT_NEAR(geo.diAt(1), 100.0 + prism, 1e-9) << number;
        EXPECT_NEAR(geo.avAt(3), 101.0020, 1e-9);
        EXPECT_NEAR(geo.diAt(3), 80.0300, 1e-9);
        EXPECT_EQ(geo.avAt(4), kUndefined); // nothing to correct
        EXPECT_EQ(geo.diAt(4), 0.0);
        EXPECT_EQ(frontEnd.messages.size(), 1u); // the warning on the codes
        // Suppress from the command line, DoMeans held to 1.
        for (const char* line : {"Suppress=0", "DoMeans=1"})
            EXPECT_NE(ReadBytes(ini).find(line), std::string::npos) << line;
    }
}

// Two set-ups on S1: the second one's circle is turned back by 5 gr (its directions read 395 gr more)
// and its instrument stands 0.15 m lower, so that it sees the targets on A and B, level from the first
// instrument, 0.15 m up; Q is 25 m away and 0.4 m up from it. A known point is noted among the first
// set-up's sightings.
Geo TwoSetUps(double v0First = kUndefined, double v0Second = kUndefined) {
    Geo geo;
    geo.Sta("S1", 1.60, v0First).Ref("A", 1.3, 2.0, 100.0, 50.0).Ref("B", 1.3, 110.0, 100.0, 60.0);
    geo.Pt("A", 1000.0, 2000.0, 50.0).Mes("P", 1.3, 200.0, 100.0, 30.0);
    geo.Sta("S2", 1.55).Ref("S1", 1.3, 0.0, 100.0, 70.0);
    geo.Sta("S1", 1.45, v0Second).Ref("A", 1.3, 397.0002, Zenith(50.0, 0.15), std::hypot(50.0, 0.15));
    geo.Ref("B", 1.3, 104.9998, Zenith(60.0, 0.15), std::hypot(60.0, 0.15));
    geo.Mes("Q", 1.2, 300.0, Zenith(25.0, 0.4), std::hypot(25.0, 0.4));
    return geo;
}

TEST_F(Reduction, SetUpsAreMergedAfterTheOldOnesByCommonSightingsKnownV0OrAsTheyStand) {
    const struct {
        const char* name;
        ReductionOptions options;
        bool foldVertical;
        double v0First, v0Second;
        double turn; // what the second set-up's directions turn by
    } cases[] = {
        {"common sightings", {}, false, kUndefined, kUndefined, 5.0},
        {"height folded", {}, true, kUndefined, kUndefined, 5.0},
        {"known V0", {.visComm = false, .v0BasedOn = true}, false, 350.0, 10.0, 60.0}, // V0_B - V0_A
        {"as they stand", {.visComm = false, .otherSight = true}, false, kUndefined, kUndefined, 0.0},
    };
    geo = TwoSetUps();
    Reduce({.visComm = false}); // nothing asked: nothing merged
    EXPECT_EQ(geo.GetSize(), 11);
    EXPECT_FALSE(dialog.Changed());
    for (const auto& c : cases) {
        geo = TwoSetUps(c.v0First, c.v0Second);
        dialog.SetFoldVertical(c.foldVertical);
        Reduce(c.options);
        // The old set-ups kept, the merged station after them: the first set-up's station and sightings
        // (not its known point), then the second's turned and brought to the first instrument height,
        // into the target heights or, folded, into the zenith angles and distances.
        ASSERT_EQ(geo.GetSize(), 18) << c.name;
        EXPECT_EQ(geo.findStaRep("S1", 3), 11);
        EXPECT_NEAR(geo.hiAt(11), 1.60, 1e-9);
        const char* points[] = {"A", "B", "P", "A", "B", "Q"};
        const double ah[] = {2.0, 110.0, 200.0, 397.0002 + c.turn, 104.9998 + c.turn, 300.0 + c.turn};
        const double up = c.foldVertical ? 0.0 : 0.15;
        const double hp[] = {1.3, 1.3, 1.3, 1.3 + up, 1.3 + up, 1.2 + up};
        for (int i = 0; i < 6; ++i) {
            EXPECT_EQ(geo.matAt(12 + i), points[i]) << c.name;
            EXPECT_NEAR(geo.ahAt(12 + i), WrapGrads(ah[i]), kMgon) << c.name << " " << i;
            EXPECT_NEAR(geo.hpAt(12 + i), hp[i], 1e-9) << c.name << " " << i;
        }
        const double rise = c.foldVertical ? 0.25 : 0.4; // Q seen from 0.15 m higher, or on a taller target
        EXPECT_NEAR(geo.avAt(17), Zenith(25.0, rise), kMgon) << c.name;
        EXPECT_NEAR(geo.diAt(17), std::hypot(25.0, rise), kTenthMm) << c.name;
        EXPECT_TRUE(dialog.Changed()) << c.name;
    }
}

// The dialog as a desktop host shows it: a check box given before it opens holds over the parameter file,
// and the listeners learn of the switches read, then of the GéoBase once it is reduced.
TEST(ReductionDialog, AGivenSwitchHoldsOverTheFileAndTheReductionIsAnnouncedOnceDone) {
    TempDir dir;
    const std::string ini = dir / "Pyralis.ini";
    WriteBytes(ini, "[Reduction_des_Stations]\nSuppress=1\nV0BasedOn=1\n");
    Geo geo = TwoSetUps();
    CReduction_Station dialog(&geo);
    dialog.SetInputs({"", ini, "", ""});
    std::vector<std::pair<int, int>> notices; // the parts, and the size of the GéoBase then
    dialog.Listen([&](int parts) { notices.emplace_back(parts, geo.GetSize()); });

    dialog.GiveSwitch(3, false); // "Supprimer les anciennes stations" cleared
    dialog.OnInitDialog();
    EXPECT_FALSE(dialog.Switch(3));
    EXPECT_TRUE(dialog.Options().v0BasedOn); // the other switches as the file says
    ui::ScriptedFrontEnd frontEnd;
    dialog.OnOK(frontEnd);

    EXPECT_EQ(geo.GetSize(), 18); // merged by the common sightings, the old set-ups kept
    using R = CReduction_Station;
    const std::vector<std::pair<int, int>> expected{
        {R::kPartSwitches, 11}, {R::kPartSwitches, 11}, {R::kPartGeoBase, 18}};
    EXPECT_EQ(notices, expected); // the file written back: in test_calc_forms
}

TEST_F(Reduction, SuppressRemovesTheOldSetUpsAndKeepsTheirPoints) {
    geo = TwoSetUps();
    Reduce({.suppress = true, .doMeans = true});

    // Left: S2 and its sighting, then the merged S1 with the known point copied, A and B averaged on the
    // first set-up's targets: level again, at their horizontal distances.
    ASSERT_EQ(geo.GetSize(), 2 + 6);
    EXPECT_EQ(geo.matAt(0), "S2");
    EXPECT_EQ(dialog.MergedStation(), 2);
    EXPECT_EQ(geo.findStaRep("S1", 2), -1);
    EXPECT_EQ(geo.GetType(3), kKindReference);
    EXPECT_EQ(geo.GetType(5), kKindPoint);
    EXPECT_EQ(geo.matAt(5) + geo.matAt(6) + geo.matAt(7), "APQ");
    ExpectSighting(geo, 3, "A", 2.0001, 100.0, 50.0, 1.3);
    ExpectSighting(geo, 4, "B", 109.9999, 100.0, 60.0, 1.3);
}

TEST_F(Reduction, BlocksRunFromTheOffsetsInFrontOfTheStationToItsLastSightingAndFollowEachStep) {
    // Two set-ups of S1, the second one's circle reading 10 gr more; the sightings of A behind radial
    // offsets. The second set-up also sights T face right on a target 0.5 m short of it, and Q on a
    // target lowered by a vertical offset.
    geo.Put(std::make_unique<CComment>("début"), kKindComment).Exc(kExcentVer, 0.1).Sta("S1", 1.5);
    geo.Exc(kExcentRad, 0.2).Ref("A", 1.3, 50.0, 100.0, 40.0).Mes("P", 1.3, 150.0, 100.0, 20.0);
    geo.Pt("P", 1, 2, 3).Exc(kExcentVer, 0.1).Sta("S1", 1.5);
    geo.Exc(kExcentRad, 0.2).Ref("A", 1.3, 60.0, 100.0, 40.0).Mes("P", 1.3, 160.0, 100.0, 20.0);
    geo.Exc(kExcentRad, 0.5).Mes("T", 1.6, 310.0, 300.0, 20.0).Exc(kExcentVer, 0.25);
    geo.Mes("Q", 1.6, 50.0, 100.0, 12.0).Mes("R", 1.6, 60.0, 100.0, 12.0).Pt("Z", 1, 2, 3);
    dialog.SetCarnet(&geo);
    dialog.BuildRepriseBlocks("S1");
    using Spans = std::vector<std::array<int, 3>>; // start, station, end
    const auto spans = [&] {
        Spans all;
        for (const CRepriseBlock& block : dialog.Blocks())
            all.push_back({block.startIndex, block.stationIndex, block.endIndex});
        return all;
    };
    // A comment in front goes with the station, a point after its last sighting does not; the last
    // station's block runs to the end.
    EXPECT_EQ(spans(), (Spans{{0, 2, 6}, {7, 8, 18}}));
    EXPECT_EQ(dialog.Blocks()[1].repriseNumber, 2);

    // Run alone, a step deletes at once, and the blocks follow.
    dialog.CommonSightOffset(dialog.Blocks(), 0, 1);
    ASSERT_EQ(geo.GetSize(), 16); // both radial offsets folded into the sightings of A
    EXPECT_NEAR(geo.diAt(3), 40.2, kTenthMm);
    ASSERT_EQ(dialog.Blocks()[0].links, std::vector<int>{1});
    EXPECT_NEAR(dialog.Blocks()[0].offsets[0], 390.0, kMgon);

    // The station's vertical offset goes into its height, T is turned to face left and reduced, and an
    // offset applies to the one sighting after it.
    dialog.IntegrateEccentricities(dialog.Blocks()[1]);
    ASSERT_EQ(geo.GetSize(), 13);
    EXPECT_EQ(spans(), (Spans{{0, 2, 5}, {6, 6, 13}}));
    EXPECT_NEAR(geo.hiAt(6), 1.6, 1e-9);
    ExpectSighting(geo, 9, "T", 110.0, 100.0, 20.5, 1.6);
    EXPECT_NEAR(geo.hpAt(10), 1.35, 1e-9);
    EXPECT_NEAR(geo.hpAt(11), 1.6, 1e-9);
}

} // namespace
} // namespace pyr
