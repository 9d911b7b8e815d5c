// "pyralis CalInter" run as a script runs it: the exit status, what is shown, the GéoBase written back and
// what is refused. P is read exactly from three oriented stations; Q from one station only.
#include "HostTestSupport.h"
#include "calc/test_v0_geometry.h"

namespace pyr::test {
namespace {

const Place kS1{1000.0, 2000.0, 100.0}, kS2{1100.0, 2000.0, 101.0}, kS3{1120.0, 2150.0, 99.0};
const Place kP{1050.0, 2080.0, 103.2}, kQ{1180.0, 2050.0, 100.0};

class CalInterCommand : public PyralisTest {
protected:
    CalInterCommand() { Write(); }

    void Write(bool invariantP = false) {
        CCarnet carnet;
        for (const auto& [name, place] : {std::pair{"S1", kS1}, {"S2", kS2}, {"S3", kS3}})
            AddPoint(carnet, name, place);
        if (invariantP) {
            auto p = std::make_unique<CPointGen>("P", 1.0, 2.0, 3.0);
            p->setInvariantXY(true);
            p->setInvariantZ(true);
            carnet.Add(std::move(p), kKindPoint);
        }
        for (const auto& [name, place, v0, hi] :
             {std::tuple{"S1", kS1, 50.0, 1.5}, {"S2", kS2, 120.0, 1.6}, {"S3", kS3, 333.3, 1.45}}) {
            AddStation(carnet, name, hi, v0);
            AddSighting(carnet, "P", place, hi, kP, 1.3, v0, kKindMesure);
            if (std::string(name) == "S2") AddSighting(carnet, "Q", place, hi, kQ, 1.3, v0, kKindMesure);
        }
        ASSERT_EQ(carnet.Save(dir / "chantier.geo"), 1);
    }
    Outcome Inter(const std::string& arguments) {
        return RunPyralis(dir.Root(), "CalInter --geobase chantier.geo " + arguments);
    }
};

TEST_F(CalInterCommand, APointIsComputedShownWrittenListedAndJournalled) {
    const Outcome outcome = Inter("--point P --enregistrer --listing inter.cin --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Point P : X = 1050.0000  Y = 2080.0000  EMQ X 0.0000  EMQ Y 0.0000",
                                "Point P : Z = 103.200", "S3(1)"});
    const CCarnet saved = Saved();
    const int p = saved.findMat("P");
    ASSERT_GE(p, 0);
    EXPECT_NEAR(saved.xAt(p), kP.x, 1e-9);
    EXPECT_NEAR(saved.zAt(p), kP.z, 1e-9);

    ExpectInOrder(ReadBytes(dir / "inter.cin"),
                  {"CALCUL PAR INTERSECTION", "Calcul du point P", "Calcul en planimétrie",
                   "P calculé  :", "Calcul en altimétrie", "Z calculé  :"});
    EXPECT_TRUE(
        Has(ReadBytes(dir / "chantier.jnl"),
            " - Calcul de points par intersection\nPoint       P : X =    1050.0000 Y =    2080.0000 Z ="));
}

TEST_F(CalInterCommand, EveryComputablePointOfASelectionAndTheSightingsOfSomeStations) {
    Outcome outcome = Inter("--points 'P Q' --visees S1,S3");
    EXPECT_EQ(outcome.status, 1) << "Q is not seen from S1 or S3";
    EXPECT_TRUE(Has(outcome.out, "Point P : X = 1050.0000")) << outcome.out;
    EXPECT_TRUE(Has(outcome.err, "Aucune visée du point <Q> ne vient des stations <S1,S3> !")) << outcome.err;

    outcome = Inter("--point Q");
    EXPECT_EQ(outcome.status, 1);
    ExpectInOrder(outcome.out, {"Point Q : Une seule visée : Calcul impossible !", "Point Q : Z = 100.000"});
    EXPECT_EQ(Saved().findMat("Q"), -1) << "nothing written without --enregistrer";
}

TEST_F(CalInterCommand, BadRequestsAreRefusedWithAFrenchMessage) {
    for (const auto& [arguments, said] :
         {std::pair{"chantier.geo --point ZZ", "Le point <ZZ> n'est visé depuis aucune station orientée"},
          {"chantier.geo", "Aucun point à calculer : indiquez --point ou --points."},
          {"absente.geo --point P", "absente.geo"},
          {"chantier.geo --point P --plani 2", "--plani : 0 ou 1 attendu, et non « 2 »."}}) {
        const Outcome outcome = RunPyralis(dir.Root(), std::string("CalInter --geobase ") + arguments);
        EXPECT_EQ(outcome.status, 1) << arguments;
        EXPECT_TRUE(Has(outcome.err, said)) << arguments << "\n" << outcome.err;
    }
}

TEST_F(CalInterCommand, InvariantCoordinatesAreKeptOnNo) {
    Write(true);
    const Outcome outcome = Inter("--point P --enregistrer --non");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.err, {"Le point 'P' possède déjà des coordonnées X et Y",
                                "Le point 'P' possède déjà une altitude"});
    const CCarnet saved = Saved();
    EXPECT_DOUBLE_EQ(saved.xAt(saved.findMat("P")), 1.0);
    EXPECT_DOUBLE_EQ(saved.zAt(saved.findMat("P")), 3.0);
}

class CalInterCommandAsUser : public CalInterCommand {};

TEST_F(CalInterCommandAsUser, AReadOnlyGeoBaseIsLeftAsItWas) {
    SKIP_WHEN_ROOT();
    ExpectReadOnlyGeoBaseKept("CalInter --geobase chantier.geo --point P --enregistrer --oui");
}

} // namespace
} // namespace pyr::test
