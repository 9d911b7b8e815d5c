// The reduction of stations, on GéoBases built here: each expected value comes from the geometry the
// GéoBase was built from (a point at a known horizontal distance and height difference, a second
// set-up turned by a known angle, raised by a known height) or from a count worked out by hand.
#include "TestSupport.h"
#include "calc/StationReduction.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <chrono>
#include <cmath>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr double kMgon = 1e-4;    // 0.1 mgon
constexpr double kTenthMm = 1e-4; // 0.1 mm

// The zenith angle (gr) and slope distance of a line of sight h metres long horizontally, rising v.
double Zenith(double h, double v) {
    return RadiansToGrads(std::atan2(h, v));
}

// A GéoBase written line by line, in field order.
struct Geo {
    CCarnet carnet;
    Geo& Sta(const char* name, double hi, double v0 = kUndefined) {
        carnet.Add(std::make_unique<CStation>(name, hi, v0), kKindStation);
        return *this;
    }
    Geo& Ref(const char* point, double hp, double ah, double av, double di, const char* code = "") {
        carnet.Add(std::make_unique<CReference>(point, hp, ah, av, di, code), kKindReference);
        return *this;
    }
    Geo& Mes(const char* point, double hp, double ah, double av, double di, const char* code = "") {
        carnet.Add(std::make_unique<CMesure>(point, hp, ah, av, di, code), kKindMesure);
        return *this;
    }
    Geo& Pt(const char* point, double x, double y, double z) {
        carnet.Add(std::make_unique<CPointGen>(point, x, y, z), kKindPoint);
        return *this;
    }
    Geo& Exc(std::string_view word, double metres) {
        carnet.Add(std::make_unique<CCommande>(std::string(word), FormatShortest(metres)), kKindExcentrement);
        return *this;
    }
    Geo& App(const char* name, double collimation, double prism) {
        carnet.Add(std::make_unique<CAppareil>(name, collimation, prism), kKindAppareil);
        return *this;
    }
    Geo& Comment(const char* text) {
        carnet.Add(std::make_unique<CComment>(text), kKindComment);
        return *this;
    }
    int Size() const { return carnet.GetSize(); }
    int Kind(int i) const { return carnet.GetType(i); }
    std::string Mat(int i) const { return carnet.matAt(i); }
    double AH(int i) const { return carnet.ahAt(i); }
    double AV(int i) const { return carnet.avAt(i); }
    double DI(int i) const { return carnet.diAt(i); }
    double HP(int i) const { return carnet.hpAt(i); }
    double HI(int i) const { return carnet.hiAt(i); }
    int Count(int kind) const {
        int n = 0;
        for (int i = 0; i < Size(); ++i)
            n += Kind(i) == kind;
        return n;
    }
};

class Reduction : public ::testing::Test {
protected:
    // Reduces with the options given, everything else off.
    void Reduce(ReductionOptions options) {
        dialog.SetCarnet(&geo.carnet);
        dialog.Options() = options;
        dialog.Reduce(frontEnd);
    }
    static ReductionOptions Only(bool ReductionOptions::*member) {
        ReductionOptions options;
        options.visComm = false;
        options.*member = true;
        return options;
    }

    Geo geo;
    CReduction_Station dialog;
    ui::ScriptedFrontEnd frontEnd;
};

// ---------------------------------------------------------------- the formulas

TEST(ReductionFormulas, RepetitionsComeBackByHalfOrWholeTurnsExceptBetween250And300) {
    const struct {
        double ah, mean, expected;
    } cases[] = {
        {300.0020, 100.0, 100.0020}, // 200.002 away, beyond the mean: the other face, back by 200
        {0.0020, 200.0, 200.0020},   // 199.998 away, short of the mean: forward by 200
        {5.0, 395.0, 405.0},         // 390 away across zero: a whole turn
        {395.0, 5.0, -5.0},          {280.0, 10.0, 280.0}, // 270 away: averaged as it stands
        {310.0, 10.0, 310.0},                              // 300 away: as it stands
        {160.0, 10.0, 160.0},                              // 150 away: as it stands
        {260.0, 10.0, 260.0},                              // 250 away: as it stands
        {10.0003, 10.0, 10.0003},
    };
    for (const auto& c : cases)
        EXPECT_NEAR(BringNearMean(c.ah, c.mean), c.expected, 1e-9) << c.ah << " / " << c.mean;
}

TEST(ReductionFormulas, OrientationOffsetsAreMeanedAcrossZeroAndWrapped) {
    EXPECT_EQ(MeanOrientationOffset({}), kUndefined);
    // B is A turned back by 5 gr: pairs on both sides of zero all say 5.
    EXPECT_NEAR(MeanOrientationOffset({{2.0, 397.0002}, {110.0, 104.9998}, {250.0, 245.0}}), 5.0, 1e-9);
    EXPECT_NEAR(MeanOrientationOffset({{397.0, 2.0002}, {104.9998, 109.9996}}), 395.0, 1e-9);
    EXPECT_NEAR(V0Offset(350.0, 10.0), 60.0, 1e-9);
    EXPECT_NEAR(V0Offset(10.0, 350.0), 340.0, 1e-9);
}

// ---------------------------------------------------------------- repeated sightings

TEST_F(Reduction, RepeatedSightingsAreAveragedIntoTheFirst) {
    const double z = 99.0;
    geo.Sta("S1", 1.5)
        .Mes("P1", 1.6, 100.0000, z, 40.0, "BORNE")
        .Mes("P2", 1.6, 399.9990, z, 40.0)
        .Mes("P3", 1.6, 10.0, z, 40.0)
        .Mes("P1", 1.6, 300.0020, z, 40.0)        // 200.002 from the mean: back by 200
        .Mes("P2", 1.6, 0.0030, z, 40.0)          // across zero: a whole turn
        .Mes("P3", 1.6, 280.0, z, 40.0, "ARBRE"); // 270 from the mean: as it stands
    Reduce(Only(&ReductionOptions::doMeans));

    ASSERT_EQ(geo.Size(), 4);
    const struct {
        const char* point;
        double ah;
        const char* code;
    } expected[] = {{"P1", 100.0010, "BORNE"}, {"P2", 0.0010, ""}, {"P3", 145.0, "ARBRE"}};
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(geo.Mat(i + 1), expected[i].point);
        EXPECT_NEAR(geo.AH(i + 1), expected[i].ah, kMgon) << expected[i].point;
        EXPECT_NEAR(geo.AV(i + 1), z, kMgon);
        EXPECT_NEAR(geo.DI(i + 1), 40.0, kTenthMm);
        EXPECT_EQ(geo.carnet.symAt(i + 1), expected[i].code);
    }
    EXPECT_TRUE(dialog.Changed());
}

TEST_F(Reduction, ARepetitionOnAnotherTargetHeightIsBroughtToTheFirstTarget) {
    // The point is 30 m away horizontally; the first target 0.6 m above the line of the instrument,
    // the second one 1 m higher. Brought to the first target, both say the same.
    const double h = 30.0, v = 0.6;
    geo.Sta("S1", 1.5)
        .Mes("P", 1.5, 50.0, Zenith(h, v), std::hypot(h, v))
        .Ref("P", 2.5, 50.0004, Zenith(h, v + 1.0), std::hypot(h, v + 1.0));
    Reduce(Only(&ReductionOptions::doMeans));

    ASSERT_EQ(geo.Size(), 2);
    EXPECT_EQ(geo.Kind(1), kKindReference); // a reference among the repetitions makes the mean one
    EXPECT_NEAR(geo.AH(1), 50.0002, kMgon);
    EXPECT_NEAR(geo.AV(1), Zenith(h, v), kMgon);
    EXPECT_NEAR(geo.DI(1), std::hypot(h, v), kTenthMm);
    EXPECT_NEAR(geo.HP(1), 1.5, 1e-9);
}

TEST_F(Reduction, AFaceRightRepetitionIsAveragedUnturned) {
    // The first sighting is read face left, its repetition face right (AH + 200, AV 400 - 94). The
    // repetition's direction comes back by the half-turn rule; its zenith angle enters as it was read,
    // seen below the horizon: -94 gr against 95.
    const double d = 50.0;
    geo.Sta("S1", 1.5).Mes("P", 1.5, 10.0, 95.0, d).Mes("P", 1.5, 210.0004, 306.0, d);
    Reduce(Only(&ReductionOptions::doMeans));

    ASSERT_EQ(geo.Size(), 2);
    EXPECT_NEAR(geo.AH(1), 10.0002, kMgon);
    EXPECT_NEAR(geo.AV(1), (95.0 - 94.0) / 2.0, kMgon);
    const double horizontal = (d * SinGrads(95.0) - d * SinGrads(94.0)) / 2.0;
    EXPECT_NEAR(geo.DI(1), horizontal / SinGrads(0.5), kTenthMm);

    // The first sighting itself, read face right, is turned before anything is averaged into it.
    Geo turned;
    turned.Sta("S1", 1.5).Mes("P", 1.5, 210.0, 305.0, d).Mes("P", 1.5, 10.0004, 95.0, d);
    dialog.SetCarnet(&turned.carnet);
    dialog.Reduce(frontEnd);
    EXPECT_NEAR(turned.AH(1), 10.0002, kMgon);
    EXPECT_NEAR(turned.AV(1), 95.0, kMgon);
    EXPECT_NEAR(turned.DI(1), d, kTenthMm);
}

// ---------------------------------------------------------------- instruments and eccentric offsets

TEST(ReductionOptionsFile, InstrumentCorrectionsAreFoldedInAndTheInstrumentsRemoved) {
    const struct {
        const char* defaultNumber;
        double collimation, prism; // of the station without an instrument element
    } cases[] = {{"1", -0.0015, 0.0175}, {"0", 0.0, 0.0}, {"7", 0.0, 0.0}};
    for (const auto& c : cases) {
        TempDir dir;
        WriteBytes(dir / "Pyralis.ini",
                   std::string("[Définitions_Des_Appareils]\nAppareil0=Appareil Standard\n"
                               "Appareil1=TCR 1\nCollVerticale1=-0.0015\nConstPrisme1=0.0175\n"
                               "[Options_Calculs]\nAppareilParDefaut=") +
                       c.defaultNumber + "\n[Reduction_des_Stations]\nInAppareil=1\n");
        Geo geo;
        geo.Sta("S0", 1.5)
            .Mes("P", 1.5, 10.0, 99.0, 100.0)
            .App("TS 2", 0.0020, 0.0300)
            .Sta("S1", 1.5)
            .Mes("P", 1.5, 20.0, 101.0, 80.0)
            .App("TS 3", 0.5, 0.5) // after the station: not the one it uses
            .Mes("Q", 1.5, 30.0, kUndefined, 0.0);
        CReduction_Station dialog(&geo.carnet);
        dialog.SetInputs({"", dir / "Pyralis.ini", "", ""});
        ui::ScriptedFrontEnd frontEnd;
        ASSERT_EQ(dialog.Run(frontEnd), ui::DialogResult::Ok);

        ASSERT_EQ(geo.Size(), 5) << c.defaultNumber;
        EXPECT_EQ(geo.Count(kKindAppareil), 0);
        EXPECT_NEAR(geo.AV(1), 99.0 + c.collimation, 1e-9) << c.defaultNumber;
        EXPECT_NEAR(geo.DI(1), 100.0 + c.prism, 1e-9) << c.defaultNumber;
        EXPECT_NEAR(geo.AV(3), 101.0020, 1e-9);
        EXPECT_NEAR(geo.DI(3), 80.0300, 1e-9);
        EXPECT_EQ(geo.AV(4), kUndefined); // nothing to correct
        EXPECT_EQ(geo.DI(4), 0.0);
        ASSERT_EQ(frontEnd.messages.size(), 1u);
        EXPECT_EQ(frontEnd.messages[0].text,
                  "ATTENTION : Vérifier que la codification n'est pas altérée par cette commande !");
        EXPECT_EQ(frontEnd.messages[0].caption, "PYRALIS");
        EXPECT_EQ(frontEnd.messages[0].icon, ui::kIconWarning);
    }
}

TEST_F(Reduction, EccentricOffsetsAreFoldedInAndTheirElementsRemoved) {
    // A face-right sighting of a target 0.5 m short of the point along the line of sight; a vertical
    // offset of the station raises the instrument, one of the next target lowers its height.
    geo.Exc(kExcentVer, 0.10)
        .Sta("S1", 1.50)
        .Exc(kExcentRad, 0.5)
        .Mes("P", 1.6, 310.0, 300.0, 20.0)
        .Exc(kExcentVer, 0.25)
        .Mes("Q", 1.6, 50.0, 100.0, 12.0)
        .Mes("R", 1.6, 60.0, 100.0, 12.0);
    Reduce(Only(&ReductionOptions::inExcent));

    ASSERT_EQ(geo.Size(), 4);
    EXPECT_EQ(geo.Count(kKindExcentrement), 0);
    EXPECT_NEAR(geo.HI(0), 1.60, 1e-9);
    EXPECT_NEAR(geo.AH(1), 110.0, kMgon);
    EXPECT_NEAR(geo.AV(1), 100.0, kMgon);
    EXPECT_NEAR(geo.DI(1), 20.5, kTenthMm);
    EXPECT_NEAR(geo.HP(2), 1.35, 1e-9);
    EXPECT_NEAR(geo.HP(3), 1.6, 1e-9); // an offset applies to the one sighting after it
}

// ---------------------------------------------------------------- set-ups merged

// Two set-ups on S1: the second one's circle is turned back by 5 gr (its directions read 395 gr more)
// and its instrument stands 0.15 m lower, so that it sees the targets on A and B, level from the first
// instrument, 0.15 m up. A known point is noted among the first set-up's sightings.
Geo TwoSetUps(double v0First = kUndefined, double v0Second = kUndefined) {
    Geo geo;
    geo.Sta("S1", 1.60, v0First)
        .Ref("A", 1.3, 2.0000, 100.0, 50.0)
        .Ref("B", 1.3, 110.0000, 100.0, 60.0)
        .Pt("A", 1000.0, 2000.0, 50.0)
        .Mes("P", 1.3, 200.0, 100.0, 30.0)
        .Sta("S2", 1.55)
        .Ref("S1", 1.3, 0.0, 100.0, 70.0)
        .Sta("S1", 1.45, v0Second)
        .Ref("A", 1.3, 397.0002, Zenith(50.0, 0.15), std::hypot(50.0, 0.15))
        .Ref("B", 1.3, 104.9998, Zenith(60.0, 0.15), std::hypot(60.0, 0.15))
        .Mes("Q", 1.2, 300.0, 100.0, 25.0);
    return geo;
}

TEST_F(Reduction, TwoSetUpsAreMergedByTheirCommonSightingsAfterTheOldOnes) {
    geo = TwoSetUps();
    Reduce(ReductionOptions{});

    // Kept as they were, the merged station after them: the first set-up's station and sightings, then
    // the second's sightings, turned by 5 gr and brought to the first instrument height; the known
    // point is not copied.
    ASSERT_EQ(geo.Size(), 11 + 7);
    EXPECT_EQ(geo.Count(kKindPoint), 1);
    EXPECT_EQ(geo.Kind(11), kKindStation);
    EXPECT_EQ(geo.Mat(11), "S1");
    EXPECT_NEAR(geo.HI(11), 1.60, 1e-9);
    const struct {
        const char* point;
        double ah, hp;
    } merged[] = {{"A", 2.0, 1.3},     {"B", 110.0, 1.3},     {"P", 200.0, 1.3},
                  {"A", 2.0002, 1.45}, {"B", 109.9998, 1.45}, {"Q", 305.0, 1.35}};
    for (int i = 0; i < 6; ++i) {
        EXPECT_EQ(geo.Mat(12 + i), merged[i].point) << i;
        EXPECT_NEAR(geo.AH(12 + i), merged[i].ah, kMgon) << i;
        EXPECT_NEAR(geo.HP(12 + i), merged[i].hp, 1e-9) << i;
    }
    EXPECT_EQ(geo.carnet.findStaRep("S1", 3), 11);
    EXPECT_TRUE(dialog.Changed());
}

TEST_F(Reduction, WithTheAnglesFoldedTheHeightDifferenceGoesIntoTheZenithAngle) {
    // The second set-up's sighting of Q: 25 m away horizontally, 0.4 m up from its instrument; from an
    // instrument 0.15 m higher it climbs 0.25 m.
    geo = TwoSetUps();
    const int q = 10;
    geo.carnet.As<CVisee>(q)->setAV(Zenith(25.0, 0.4));
    geo.carnet.As<CVisee>(q)->setDI(std::hypot(25.0, 0.4));
    dialog.SetFoldVertical(true);
    Reduce(ReductionOptions{});

    const int copy = geo.Size() - 1;
    ASSERT_EQ(geo.Mat(copy), "Q");
    EXPECT_NEAR(geo.AV(copy), Zenith(25.0, 0.25), kMgon);
    EXPECT_NEAR(geo.DI(copy), std::hypot(25.0, 0.25), kTenthMm);
    EXPECT_NEAR(geo.HP(copy), 1.2, 1e-9);
}

TEST_F(Reduction, KnownOrientationsMergeSetUpsWithoutCommonSightings) {
    geo = TwoSetUps(350.0, 10.0);
    Reduce(Only(&ReductionOptions::v0BasedOn));

    // V0_B - V0_A = 60 gr, whatever the common sightings say.
    ASSERT_EQ(geo.Size(), 18);
    EXPECT_NEAR(geo.AH(15), WrapGrads(397.0002 + 60.0), kMgon);
    EXPECT_NEAR(geo.AH(17), 360.0, kMgon);
}

TEST_F(Reduction, SetUpsWithoutOffsetsAreMergedOnlyWhenAsked) {
    geo = TwoSetUps();
    Reduce(ReductionOptions{.visComm = false});
    EXPECT_EQ(geo.Size(), 11);
    EXPECT_FALSE(dialog.Changed());

    Reduce(ReductionOptions{.visComm = false, .otherSight = true});
    ASSERT_EQ(geo.Size(), 18);
    EXPECT_NEAR(geo.AH(15), 397.0002, kMgon); // as they stand
    EXPECT_NEAR(geo.HP(17), 1.2 + 0.15, 1e-9);
}

TEST_F(Reduction, SuppressRemovesTheOldSetUpsAndKeepsTheirPoints) {
    geo = TwoSetUps();
    Reduce(ReductionOptions{.suppress = true, .doMeans = true});

    // Left: S2 and its sighting, then the merged S1 with the known point copied, A and B averaged on the
    // first set-up's targets: level again, at their horizontal distances.
    ASSERT_EQ(geo.Size(), 2 + 6);
    EXPECT_EQ(geo.Mat(0), "S2");
    EXPECT_EQ(geo.Kind(2), kKindStation);
    EXPECT_EQ(geo.carnet.findStaRep("S1", 2), -1);
    const char* order[] = {"A", "B", "A", "P", "Q"};
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(geo.Mat(3 + i), order[i]) << i;
    EXPECT_EQ(geo.Kind(5), kKindPoint);
    EXPECT_NEAR(geo.AH(3), 2.0001, kMgon);
    EXPECT_NEAR(geo.AH(4), 109.9999, kMgon);
    for (int i : {3, 4}) {
        EXPECT_EQ(geo.Kind(i), kKindReference);
        EXPECT_NEAR(geo.HP(i), 1.3, 1e-9);
        EXPECT_NEAR(geo.AV(i), 100.0, kMgon);
    }
    EXPECT_NEAR(geo.DI(3), 50.0, kTenthMm);
    EXPECT_NEAR(geo.DI(4), 60.0, kTenthMm);
    EXPECT_EQ(dialog.MergedStation(), 2);
}

// ---------------------------------------------------------------- blocks and steps run alone

TEST_F(Reduction, BlocksRunFromTheOffsetsInFrontOfTheStationToItsLastSighting) {
    geo.Comment("début")
        .Sta("S1", 1.5)
        .Mes("P", 1.5, 1.0, 100.0, 10.0)
        .Pt("P", 1, 2, 3)
        .App("TS", 0, 0)
        .Exc(kExcentVer, 0.1)
        .Sta("S1", 1.6)
        .Exc(kExcentRad, 0.2)
        .Mes("P", 1.5, 2.0, 100.0, 10.0)
        .Pt("Z", 1, 2, 3);
    dialog.SetCarnet(&geo.carnet);
    dialog.BuildRepriseBlocks("S1");
    const CRepriseList& blocks = dialog.Blocks();
    ASSERT_EQ(blocks.size(), 2u);
    EXPECT_EQ(blocks[0].startIndex, 0); // a comment in front goes with the station
    EXPECT_EQ(blocks[0].endIndex, 3);   // the point after the last sighting is not the block's
    EXPECT_EQ(blocks[1].startIndex, 4);
    EXPECT_EQ(blocks[1].stationIndex, 6);
    EXPECT_EQ(blocks[1].repriseNumber, 2);
    EXPECT_EQ(blocks[1].endIndex, 10); // the last station's block runs to the end

    // Run alone, a step deletes at once, and the blocks follow.
    dialog.IntegrateEccentricities(dialog.Blocks()[0]);
    dialog.IntegrateEccentricities(dialog.Blocks()[1]);
    EXPECT_EQ(geo.Size(), 8);
    EXPECT_EQ(blocks[1].startIndex, 4);
    EXPECT_EQ(blocks[1].stationIndex, 5);
    EXPECT_EQ(blocks[1].endIndex, 8);
    EXPECT_NEAR(geo.HI(5), 1.7, 1e-9);
    EXPECT_NEAR(geo.DI(6), 10.2, kTenthMm);
}

TEST_F(Reduction, TheBlocksFollowTheOffsetsDeletedBetweenCommonSightings) {
    // Three set-ups of S1, the common sightings of A behind eccentric offsets; the second set-up's
    // circle reads 10 gr more.
    for (double turn : {0.0, 10.0, 20.0})
        geo.Exc(kExcentVer, 0.1)
            .Sta("S1", 1.5)
            .Exc(kExcentRad, 0.2)
            .Ref("A", 1.3, 50.0 + turn, 100.0, 40.0)
            .Exc(kExcentRad, 0.3)
            .Mes("P", 1.3, 150.0 + turn, 100.0, 20.0);
    dialog.SetCarnet(&geo.carnet);
    dialog.BuildRepriseBlocks("S1");
    dialog.CommonSightOffset(dialog.Blocks(), 0, 1);

    EXPECT_EQ(geo.Size(), 18 - 4); // the radial offsets of A and P in the first two set-ups
    EXPECT_NEAR(geo.DI(2), 40.2, kTenthMm);
    const CRepriseList shifted = dialog.Blocks();
    ASSERT_EQ(shifted[0].links, std::vector<int>{1});
    EXPECT_NEAR(shifted[0].offsets[0], 390.0, kMgon);
    dialog.BuildRepriseBlocks("S1");
    for (std::size_t b = 0; b < 3; ++b) {
        EXPECT_EQ(shifted[b].startIndex, dialog.Blocks()[b].startIndex) << b;
        EXPECT_EQ(shifted[b].stationIndex, dialog.Blocks()[b].stationIndex) << b;
        EXPECT_EQ(shifted[b].endIndex, dialog.Blocks()[b].endIndex) << b;
    }
}

TEST(ReductionOptionsFile, TheSwitchesAreReadWithTheirDefaultsAndWrittenOnOK) {
    TempDir dir;
    const std::string ini = dir / "Pyralis.ini";
    CCarnet carnet;
    CReduction_Station dialog(&carnet);
    dialog.SetInputs({"", ini, "", ""});
    dialog.OnInitDialog();
    EXPECT_TRUE(dialog.Options().visComm);
    EXPECT_FALSE(dialog.Options().suppress);

    WriteBytes(ini, "[Reduction_des_Stations]\nVisComm=0\nSuppress=1\nDoMeans=7\n");
    ui::DialogOptions options;
    dialog.DeclareOptions(options);
    ASSERT_EQ(options.Options().size(), 7u);
    EXPECT_EQ(options.Options()[0].name, "VisComm");
    EXPECT_EQ(options.Options()[0].help, "Réduire les reprises à partir des visées communes");
    EXPECT_EQ(options.Options()[3].apply("oui"), "--Suppress : 0 ou 1 attendu, et non « oui ».");
    EXPECT_EQ(options.Options()[3].apply("0"), "");
    dialog.OnInitDialog();
    EXPECT_FALSE(dialog.Options().visComm);
    EXPECT_FALSE(dialog.Options().suppress); // the command line holds over the file
    EXPECT_TRUE(dialog.Options().doMeans);   // clamped to 1

    ui::ScriptedFrontEnd frontEnd;
    dialog.OnOK(frontEnd);
    const std::string written = ReadBytes(ini);
    for (const char* line : {"VisComm=0", "V0BasedOn=0", "OtherSight=0", "Suppress=0", "DoMeans=1",
                             "InExcent=0", "InAppareil=0"})
        EXPECT_NE(written.find(line), std::string::npos) << line;
}

// 10 000 stations: 5 000 points occupied twice, each set-up with three references (one of them
// repeated) and a face-right measure on an eccentric target; the second set-up turned back by 7 gr.
TEST(ReductionSpeed, TenThousandStationsReduceInWellUnderASecond) {
    Geo geo;
    for (int s = 0; s < 5000; ++s) {
        const std::string name = "S" + std::to_string(s), point = "P" + std::to_string(s);
        std::string refs[3];
        for (int r = 0; r < 3; ++r)
            refs[r] = "R" + std::to_string(s) + "_" + std::to_string(r);
        for (int reprise = 0; reprise < 2; ++reprise) {
            const double turn = reprise * 7.0;
            geo.Exc(kExcentVer, 0.05).Sta(name.c_str(), 1.5 + 0.1 * reprise);
            for (int r = 0; r < 3; ++r)
                geo.Ref(refs[r].c_str(), 1.3, WrapGrads(r * 100.0 - turn), 100.0, 50.0);
            geo.Exc(kExcentRad, 0.1).Mes(point.c_str(), 1.3, WrapGrads(250.0 - turn), 300.0, 20.0);
            geo.Ref(refs[0].c_str(), 1.3, WrapGrads(-turn), 100.0, 50.0);
            geo.Pt(name.c_str(), s, s, 0);
        }
    }
    geo.Sta("FIN", 1.0);
    CReduction_Station dialog(&geo.carnet);
    dialog.Options() = ReductionOptions{.suppress = true, .doMeans = true, .inExcent = true};
    ui::ScriptedFrontEnd frontEnd;
    const auto start = std::chrono::steady_clock::now();
    dialog.Reduce(frontEnd);
    const double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();

    // Each point: its two known points where they were; at the end, after the last station, its merged
    // station with the three references and the measure, every repetition averaged.
    ASSERT_EQ(geo.Size(), 5000 * 7 + 1);
    EXPECT_EQ(geo.Count(kKindStation), 5001);
    const int first = 10001; // the merged S0
    EXPECT_EQ(geo.Mat(first), "S0");
    EXPECT_NEAR(geo.HI(first), 1.55, 1e-9);
    const double ah[] = {0.0, 100.0, 200.0, 50.0};
    for (int i = 0; i < 4; ++i)
        EXPECT_NEAR(geo.AH(first + 1 + i), ah[i], kMgon) << i;
    EXPECT_NEAR(geo.DI(first + 4), 20.1, kTenthMm);
    EXPECT_EQ(geo.Mat(geo.Size() - 5), "S4999");
    // Generous enough for a sanitized debug build; a scan of the whole GéoBase per station takes minutes.
    EXPECT_LT(seconds, 5.0);
}

} // namespace
} // namespace pyr
