// "pyralis CalChem" run as a script runs it: a traverse measured by a perfect instrument between two known
// and oriented stations, its stations written back with their V0, its listing; what is refused.
#include "HostTestSupport.h"
#include "calc/test_v0_geometry.h"

namespace pyr::test {
namespace {

const Place kA{651200.000, 6862300.000, 52.310}, kB{651688.731, 6862554.562, 49.870};
const Place kT1{651325.412, 6862371.905, 53.874}, kT2{651502.118, 6862492.447, 55.021};
const Place kR1{651050.118, 6862512.447, 55.0}, kR2{651900.0, 6862300.0, 48.0};
const Place kP1{651390.5, 6862350.25, 54.1}; // a point sighted from T1 only
constexpr double kHi = 1.55, kHp = 1.3;
constexpr double kTenthMm = 1e-4;

class ChemCommand : public PyralisTest {
protected:
    // A, B and their references known; T1 and T2 set up between them; the traverse CH1 written, unless
    // `withTraverse` is off. `t2Shift` moves where T2 really stood (metres east) when T1 sights it.
    // `twist` turns T2's reading on B (grads): an angular misclosure of that much.
    void Write(bool withTraverse = true, double t2Shift = 0.0, double twist = 0.0) {
        CCarnet carnet;
        for (const auto& [name, place] : {std::pair{"A", kA}, {"R1", kR1}, {"B", kB}, {"R2", kR2}})
            AddPoint(carnet, name, place);
        const Place t2Seen{kT2.x + t2Shift, kT2.y, kT2.z};
        AddStation(carnet, "A", kHi);
        AddSighting(carnet, "R1", kA, kHi, kR1, kHp, 12.5);
        AddSighting(carnet, "T1", kA, kHi, kT1, kHp, 12.5, kKindMesure);
        AddStation(carnet, "T1", kHi);
        AddSighting(carnet, "A", kT1, kHi, kA, kHp, 210.0, kKindMesure);
        AddSighting(carnet, "T2", kT1, kHi, t2Seen, kHp, 210.0, kKindMesure);
        AddSighting(carnet, "P1", kT1, kHi, kP1, kHp, 210.0, kKindMesure);
        AddStation(carnet, "T2", kHi);
        AddSighting(carnet, "T1", kT2, kHi, kT1, kHp, 399.995, kKindMesure);
        AddSighting(carnet, "B", kT2, kHi, kB, kHp, 399.995 - twist, kKindMesure);
        AddStation(carnet, "B", kHi);
        AddSighting(carnet, "T2", kB, kHi, kT2, kHp, 77.0, kKindMesure);
        AddSighting(carnet, "R2", kB, kHi, kR2, kHp, 77.0);
        if (withTraverse) {
            auto chain = std::make_unique<CChemin>("CH1");
            for (const char* name : {"A", "T1", "T2", "B"})
                chain->add(name);
            carnet.Add(std::move(chain), kKindChemin);
        }
        ASSERT_EQ(carnet.Save(dir / "chantier.geo"), 1);
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
