// "pyralis CalChem" run as a script runs it: a traverse measured by a perfect instrument between two known
// and oriented stations, its stations written back with their V0, its listing; what is refused.
#include "HostTestSupport.h"
#include "calc/TraverseJob.h"

namespace pyr::test {
namespace {

using namespace traverse_job;
constexpr double kTenthMm = 1e-4;

class ChemCommand : public PyralisTest {
protected:
    // The traverse job, CH1 written unless `withTraverse` is off.
    void Write(bool withTraverse = true, double t2Shift = 0.0, double twist = 0.0) {
        TraverseJobOptions options;
        options.t2Shift = t2Shift;
        options.twist = twist;
        options.sideShot = true;
        if (withTraverse) options.traverses = {kTraverseCH1};
        ASSERT_EQ(TraverseJob(options).Save(dir / "chantier.geo"), 1);
    }
    Outcome Run(const std::string& arguments) {
        return RunPyralis(dir.Root(), "CalChem --geobase chantier.geo " + arguments);
    }
};

TEST_F(ChemCommand, ALinkedTraverseWritesItsStationsAndItsListing) {
    Write();
    const Outcome outcome = Run("--cheminement CH1 --enregistrer --listing chem.ccp");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Cheminement CH1 (encadré), 4 station(s)", "Fermeture angulaire",
                                "Fermeture planimétrique", "Fermeture altimétrique",
                                "2 station(s) et 4 V0 écrit(s) dans la GéoBase.",
                                "1 point(s) rayonné(s) depuis les stations des cheminements."});
    const CCarnet saved = Saved();
    for (const auto& [name, place] : {std::pair{"T1", kT1}, {"T2", kT2}, {"P1", kP1}}) {
        SCOPED_TRACE(name);
        const int at = saved.findMat(name);
        ASSERT_GE(at, 0);
        EXPECT_NEAR(saved.xAt(at), place.x, kTenthMm);
        EXPECT_NEAR(saved.yAt(at), place.y, kTenthMm);
        EXPECT_NEAR(saved.zAt(at), place.z, kTenthMm);
    }
    EXPECT_NEAR(saved.v0At(saved.findStaRep("T1", 1)), 210.0, 1e-4);
    const std::string listing = ReadBytes(dir / "chem.ccp");
    ExpectInOrder(listing, {"Cheminement CH1 : encadré", "Fermeture = ", "Tronçons", "Gis. compensé",
                            "fx = ", "Stations compensées", "Altimétrie"});
    EXPECT_TRUE(Has(ReadBytes(dir / "chantier.jnl"), "Calcul de cheminements polygonaux"));
}

TEST_F(ChemCommand, TheSwitchesOfTheOptionsChooseWhatIsWritten) {
    Write();
    // 16: no V0 written; without 32: no point radiated.
    WriteBytes(dir / "Pyralis.ini", "[Options_Calculs]\r\nCheminements=16\r\n");
    const Outcome outcome = Run("--enregistrer");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "2 station(s) et 0 V0 écrit(s)")) << outcome.out;
    const CCarnet saved = Saved();
    EXPECT_GE(saved.findMat("T1"), 0);
    EXPECT_LT(saved.findMat("P1"), 0);
    EXPECT_EQ(saved.v0At(saved.findStaRep("T1", 1)), kUndefined);
}

TEST_F(ChemCommand, OutOfToleranceItIsWrittenOnlyWhenTheSurveyorSaysSo) {
    Write(true, 0.05); // T2 seen 5 cm east from T1: the traverse does not close
    Outcome outcome = Run("--enregistrer --non");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "HORS TOLÉRANCE")) << outcome.out;
    EXPECT_TRUE(Has(outcome.err, "Le cheminement <CH1> est hors tolérance (planimétrique")) << outcome.err;
    EXPECT_LT(Saved().findMat("T1"), 0);
    outcome = Run("--enregistrer --oui");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_GE(Saved().findMat("T1"), 0);
}

// 8 mgon over 4 angles measured with instruments that give no precision: within 4.3 mgon x sqrt(8) for
// ordinary work, beyond 1.8 mgon x sqrt(8) for precise work, and against "FermAngulaire" when the
// tolerances are the surveyor's own.
TEST_F(ChemCommand, TheAngularToleranceFollowsTheKindOfTolerances) {
    Write(true, 0.0, 0.008);
    Outcome outcome = Run("--non --listing chem.ccp");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "Fermeture angulaire 0.0080 gr, tolérance 0.0122 gr\n")) << outcome.out;
    EXPECT_TRUE(Has(ReadBytes(dir / "chem.ccp"), "angulaire 2.7 sigma x racine(2n) gr (sigma de l'appareil, "
                                                 "0.0043"));
    WriteBytes(dir / "Pyralis.ini", "[Options_Tolerances]\r\nTypeTolerance=1\r\n");
    outcome = Run("--enregistrer --non");
    EXPECT_TRUE(Has(outcome.out, "tolérance 0.0051 gr  HORS TOLÉRANCE")) << outcome.out;
    EXPECT_TRUE(Has(outcome.err, "(angulaire")) << outcome.err;
    WriteBytes(dir / "Pyralis.ini", "[Options_Tolerances]\r\nTypeTolerance=2\r\nFermAngulaire=0.009\r\n");
    outcome = Run("--non");
    EXPECT_TRUE(Has(outcome.out, "tolérance 0.0090 gr\n")) << outcome.out;
}

TEST_F(ChemCommand, TheSearchFindsTheTraverseWritesItAndTheComputationFollows) {
    Write(false);
    Outcome outcome = Run("--recherche --enregistrer");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Cheminement CH1 trouvé : A - T1 - T2 - B",
                                "Recherche des cheminements : 1 trouvé(s), 1 ajouté(s) dans la GéoBase.",
                                "Cheminement CH1 (encadré)"});
    const CCarnet saved = Saved();
    EXPECT_GE(saved.Find(kKindChemin, "CH1"), 0);
    EXPECT_NEAR(saved.xAt(saved.findMat("T2")), kT2.x, kTenthMm);
    // Searched again: its stations are known now, nothing lies between known stations to compute.
    outcome = Run("--recherche");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "0 trouvé(s), 0 ajouté(s)")) << outcome.out;
}

TEST_F(ChemCommand, WhatCannotBeComputedIsNamedAndNothingWritten) {
    Write(false);
    const std::string before = ReadBytes(dir / "chantier.geo");
    Outcome outcome = Run("--enregistrer");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "ne contient aucun cheminement")) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "chantier.geo"), before);
    Write();
    // A traverse through a station the GéoBase does not hold: named on screen and in the listing.
    CCarnet withGap = Saved();
    auto broken = std::make_unique<CChemin>("CH2");
    for (const char* name : {"A", "T9", "B"})
        broken->add(name);
    withGap.Add(std::move(broken), kKindChemin);
    ASSERT_EQ(withGap.Save(dir / "chantier.geo"), 1);
    outcome = Run("--cheminement CH2 --enregistrer --listing ch2.ccp");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.out, "Cheminement CH2 non calculé : la station <T9> n'est pas dans la GéoBase"))
        << outcome.out;
    EXPECT_TRUE(Has(ReadBytes(dir / "ch2.ccp"), "la station <T9> n'est pas dans la GéoBase")) << outcome.err;
    outcome = Run("--cheminement CH9 --enregistrer");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "Le cheminement <CH9> n'est pas dans la GéoBase !")) << outcome.err;
    EXPECT_EQ(Saved().findMat("T1"), -1);
}

} // namespace
} // namespace pyr::test
