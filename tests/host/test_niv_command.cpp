// "pyralis CalNivSm" and "CalNivSt" run as a script runs them: a levelling run read by a perfect level
// between two benchmarks gives the heights back; a misclosure of a few millimetres is shared along it; out
// of tolerance, it is written only when the surveyor says so; what cannot be computed writes nothing.
#include "HostTestSupport.h"
#include "calc/LevelJob.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <memory>

namespace pyr::test {
namespace {

constexpr double kTenthMm = 1e-4;

using namespace level_job;

class NivCommand : public PyralisTest {
protected:
    LevelJob job;

    void WriteSimple(double zB) {
        job.SimpleRun(zB);
        Save();
    }
    void Save() { ASSERT_EQ(job.carnet.Save(dir / "chantier.geo"), 1); }
    double SavedZ(const CCarnet& saved, const char* name) {
        const int at = saved.findMat(name);
        return at >= 0 ? saved.zAt(at) : kUndefined;
    }
};

TEST_F(NivCommand, AMisclosureOfSixMillimetresIsSharedAlongTheRunAndWritten) {
    WriteSimple(kB + 0.006); // f = -6 mm over three equal set-ups: +2 mm each
    const Outcome outcome = Run("CalNivSm --geobase chantier.geo --enregistrer --listing niv.cns");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out,
                  {"Cheminement A - B : 3 dénivelée(s), longueur 180.000 m",
                   "Fermeture -0.0060 m, tolérance 0.0100 m", "3 altitude(s) écrite(s) dans la GéoBase."});
    EXPECT_FALSE(Has(outcome.out, "HORS TOLÉRANCE"));
    const CCarnet saved = Saved();
    EXPECT_NEAR(SavedZ(saved, "T1"), kT1 + 0.002, kTenthMm);
    EXPECT_NEAR(SavedZ(saved, "T2"), kT2 + 0.004, kTenthMm);
    EXPECT_NEAR(SavedZ(saved, "S"), kS + 0.002, kTenthMm); // from T1's compensated height
    EXPECT_NEAR(SavedZ(saved, "B"), kB + 0.006, kTenthMm); // the benchmarks keep theirs
    EXPECT_NEAR(SavedZ(saved, "A"), kA, kTenthMm);
    EXPECT_FALSE(saved.As<CPointGen>(saved.findMat("T1"))->hasXY());

    const std::string listing = ReadBytes(dir / "niv.cns");
    ExpectInOrder(listing,
                  {"Cheminement altimétrique de A à B", "Stations du niveau", "Lect. AR", "Dénivelée",
                   "Correction", "T1", "+0.0020", "Points rayonnés", "S", "Fermeture = -0.0060 m",
                   "tolérance 0.0100 m", "Compensation proportionnelle aux portées."});
    EXPECT_TRUE(Has(ReadBytes(dir / "chantier.jnl"), "Calcul de cheminements altimétriques"));
}

// "TypeNivel" 2 shares it by the height differences, 1.234 + 1.358 + 0.667 = 3.259 m of climb: T2 takes
// +0.006 x 2.592 / 3.259 = +0.0047720 (by the sights' lengths, +0.004).
TEST_F(NivCommand, TheMisclosureIsSharedByTheHeightDifferencesWhenTheOptionsSaySo) {
    WriteSimple(kB + 0.006);
    WriteBytes(dir / "Pyralis.ini", "[Options_Nivellement]\r\nTypeNivel=2\r\n");
    const Outcome outcome = Run("CalNivSm --geobase chantier.geo --enregistrer --listing niv.cns");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(ReadBytes(dir / "niv.cns"), "Compensation proportionnelle aux dénivelées."));
    EXPECT_NEAR(SavedZ(Saved(), "T2"), kT2 + 0.0047720, 0.0005); // the GéoBase's millimetre
}

TEST_F(NivCommand, ExactReadingsGiveTheTrueHeightsAndTheRunsCanBeChosen) {
    WriteSimple(kB);
    Outcome outcome = Run("CalNivSm --geobase chantier.geo --depart B --enregistrer");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "ne correspond au départ et à l'arrivée demandés (départ B)"))
        << outcome.err;
    EXPECT_FALSE(IsKnown(SavedZ(Saved(), "T1")));

    outcome = Run("CalNivSm --geobase chantier.geo --depart A --arrivee B --enregistrer");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    const CCarnet saved = Saved();
    EXPECT_NEAR(SavedZ(saved, "T1"), kT1, kTenthMm);
    EXPECT_NEAR(SavedZ(saved, "T2"), kT2, kTenthMm);
    EXPECT_NEAR(SavedZ(saved, "S"), kS, kTenthMm);
}

TEST_F(NivCommand, OutOfToleranceItIsWrittenOnlyWhenTheSurveyorSaysSo) {
    WriteSimple(kB + 0.030); // f = -30 mm, tolerance 10 mm
    Outcome outcome = Run("CalNivSm --geobase chantier.geo --enregistrer --non --listing niv.cns");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "Fermeture -0.0300 m, tolérance 0.0100 m  HORS TOLÉRANCE")) << outcome.out;
    EXPECT_TRUE(Has(outcome.err, "Le cheminement altimétrique de <A> à <B> est hors tolérance"))
        << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "Cheminement A - B : non enregistré.")) << outcome.out;
    EXPECT_FALSE(IsKnown(SavedZ(Saved(), "T1")));
    EXPECT_TRUE(Has(ReadBytes(dir / "niv.cns"), "HORS TOLÉRANCE"));

    outcome = Run("CalNivSm --geobase chantier.geo --enregistrer --oui");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_NEAR(SavedZ(Saved(), "T1"), kT1 + 0.010, kTenthMm);
    EXPECT_NEAR(SavedZ(Saved(), "T2"), kT2 + 0.020, kTenthMm);
}

TEST_F(NivCommand, DoubleStationAveragesEachPairAndNamesThePairOutOfTolerance) {
    // A - T1 levelled twice within 2 mm; T1 - B twice, 30 mm apart (tolerance 10 mm).
    job.Benchmark("A", kA);
    job.Benchmark("B", kB);
    job.SetUp("A", kA, "T1", kT1 + 0.001, 1.4);
    job.SetUp("A", kA, "T1", kT1 - 0.001, 1.6);
    job.SetUp("T1", kT1, "B", kB + 0.015, 1.3);
    job.SetUp("T1", kT1, "B", kB - 0.015, 1.7);
    Save();
    Outcome outcome = Run("CalNivSt --geobase chantier.geo --enregistrer --oui --listing niv.cna");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Cheminement A - B : 2 dénivelée(s)", "Fermeture 0.0000 m",
                                "Attention : les deux dénivelées de T1 à B", "diffèrent de 0.0300 m"});
    EXPECT_TRUE(Has(outcome.err, "dénivelées mal contrôlées")) << outcome.err;
    EXPECT_NEAR(SavedZ(Saved(), "T1"), kT1, kTenthMm); // the mean of the pair
    ExpectInOrder(ReadBytes(dir / "niv.cna"),
                  {"Nivellement par double station de A à B", "Moyenne", "Écart", "+0.0020", "+0.0300 *",
                   "Remarques", "les deux dénivelées de T1 à B"});
    EXPECT_TRUE(Has(ReadBytes(dir / "chantier.jnl"), "Calcul de nivellement par double station"));

    Save(); // T1 unknown again: the same run refused this time
    outcome = Run("CalNivSt --geobase chantier.geo --enregistrer --non");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_FALSE(IsKnown(SavedZ(Saved(), "T1")));
}

TEST_F(NivCommand, WithoutStaffReadingOrBenchmarkItSaysSoAndWritesNothing) {
    job.Benchmark("A", kA);
    Save();
    std::string before = ReadBytes(dir / "chantier.geo");
    Outcome outcome = Run("CalNivSm --geobase chantier.geo --enregistrer");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "ne contient aucune lecture sur mire !")) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "chantier.geo"), before);

    job.carnet = CCarnet();
    job.SetUp("P1", 10.0, "P2", 11.0);
    job.SetUp("P2", 11.0, "P3", 12.0);
    Save();
    before = ReadBytes(dir / "chantier.geo");
    outcome = Run("CalNivSt --geobase chantier.geo --enregistrer");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.out, "le cheminement de P1 à P3 ne passe par aucun repère d'altitude connue"))
        << outcome.out;
    EXPECT_TRUE(Has(outcome.err, "Aucun cheminement altimétrique n'a pu être calculé")) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "chantier.geo"), before);
}

// A digital level's GSI book: BM1 (100.000 m) to BM2 (100.880 m) through T1 and T2, staff readings 331
// (back) and 332 (fore) with their distances 32, and on each fore line the height the level computed, 83,
// unadjusted: T1 100.4645, T2 100.6745, BM2 100.8745. The run's height differences give the level's
// heights back; f = 100.8745 - 100.880 = -5.5 mm, shared over 49, 53 and 50 m of sights:
// T1 100.4645 + 0.0055 x 49 / 152 = 100.46627, T2 100.6745 + 0.0055 x 102 / 152 = 100.67819.
constexpr const char* kLevelBook = "410001+0000LINE 42....+00000001 \r\n"
                                   "110001+00000BM1 83..18+10000000 \r\n"
                                   "110002+00000BM1 32...8+02500000 331.08+00145210 \r\n"
                                   "110003+000000T1 32...8+02400000 332.08+00098760 83..08+10046450 \r\n"
                                   "110004+000000T1 32...8+02600000 331.08+00132100 \r\n"
                                   "110005+000000T2 32...8+02700000 332.08+00111100 83..08+10067450 \r\n"
                                   "110006+000000T2 32...8+02500000 331.08+00120000 \r\n"
                                   "110007+00000BM2 32...8+02500000 332.08+00100000 83..08+10087450 \r\n"
                                   "110008+00000BM2 83..18+10088000 \r\n";

// Heights are written in the GéoBase to its millimetre.
constexpr double kGeoBaseMm = 0.0005;

TEST_F(NivCommand, ALevelsGsiBookIsReadAndComputedAndARunNamedByItsEndsIsComputedAgain) {
    WriteBytes(dir / "niv.gsi", kLevelBook);
    Outcome outcome = Run("--oui LecWild niv.gsi --geobase chantier.geo");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    outcome = Run("CalNivSm --geobase chantier.geo --enregistrer --listing niv.cns");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Cheminement BM1 - BM2 : 3 dénivelée(s), longueur 152.000 m",
                                "Fermeture -0.0055 m, tolérance 0.0100 m"});
    // The level's own heights, before the adjustment: 100 + 0.4645, + 0.2100, + 0.2000.
    ExpectInOrder(ReadBytes(dir / "niv.cns"), {"| BM1     | T1    |", "+0.4645", "| T1      | T2    |",
                                               "+0.2100", "| T2      | BM2   |", "+0.2000"});
    CCarnet saved = Saved();
    EXPECT_NEAR(SavedZ(saved, "T1"), 100.46627, kGeoBaseMm);
    EXPECT_NEAR(SavedZ(saved, "T2"), 100.67819, kGeoBaseMm);

    // T1 and T2 now have heights: run again as it stands, each set-up is a run of its own...
    outcome = Run("CalNivSm --geobase chantier.geo");
    EXPECT_TRUE(Has(outcome.out, "Cheminement BM1 - T1 : 1 dénivelée(s)")) << outcome.out;
    // ...but named by its two benchmarks, the run passes through them again. A fore reading on T1
    // corrected by 1 mm (0.9866) raises T1 and T2 by 1 mm less its share of the new misclosure.
    std::string geo = ReadBytes(dir / "chantier.geo");
    const std::size_t reading = geo.find("0.9876");
    ASSERT_NE(reading, std::string::npos);
    geo.replace(reading, 6, "0.9866");
    WriteBytes(dir / "chantier.geo", geo);
    outcome = Run("--oui CalNivSm --geobase chantier.geo --depart BM1 --arrivee BM2 --enregistrer");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Cheminement BM1 - BM2 : 3 dénivelée(s)", "Fermeture -0.0045 m"});
    saved = Saved();
    EXPECT_NEAR(SavedZ(saved, "T1"), 100.4655 + 0.0045 * 49 / 152, kGeoBaseMm);
    EXPECT_NEAR(SavedZ(saved, "T2"), 100.6755 + 0.0045 * 102 / 152, kGeoBaseMm);
    EXPECT_NEAR(SavedZ(saved, "BM2"), 100.880, kGeoBaseMm);
}

} // namespace
} // namespace pyr::test
