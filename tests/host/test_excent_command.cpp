// "pyralis CalExcen" run as a script runs it: the exit status, what is shown, the GéoBase written back,
// the listing and the journal, and what is refused. The stations E and F stand 2 m and 20 m from the
// centre C, at places known to the test only; every sighting is what a perfect instrument would read
// (test_v0_geometry.h), so that the places, the V0 and the altitudes found are known beforehand.
#include "HostTestSupport.h"
#include "calc/test_v0_geometry.h"

namespace pyr::test {
namespace {

// E is 2 m from C (1.2 east, 1.6 north), F 20 m from it (12 east, 16 south).
const Place kC{1000.0, 2000.0, 100.0};
const Place kE{1001.2, 2001.6, 98.4}, kF{1012.0, 1984.0, 99.25};
const Place kA{1060.0, 2080.0, 105.0}, kB{1090.0, 1950.0, 97.0}, kD{940.0, 1930.0, 102.0};
constexpr double kHi = 1.5, kHp = 1.3, kV0E = 37.5, kV0F = 312.25;
constexpr double kTenthMm = 1e-4;

class ExcentCommand : public PyralisTest {
protected:
    ExcentCommand() { Write(); }

    // C, A, B and D known, E and F not. E sights C with a distance, A without one (a reference read for
    // its direction only), B and D with one; F sights C, A and B; G sights only C.
    void Write(bool centreWithZ = true) {
        CCarnet carnet;
        AddPoint(carnet, "C", centreWithZ ? kC : Place{kC.x, kC.y, -999999.0});
        for (const auto& [name, place] : {std::pair{"A", kA}, {"B", kB}, {"D", kD}})
            AddPoint(carnet, name, place);
        AddStation(carnet, "E", kHi);
        AddSighting(carnet, "C", kE, kHi, kC, kHp, kV0E);
        carnet.As<CVisee>(AddSighting(carnet, "A", kE, kHi, kA, kHp, kV0E))->setDI(-999999.0);
        AddSighting(carnet, "B", kE, kHi, kB, kHp, kV0E);
        AddSighting(carnet, "D", kE, kHi, kD, kHp, kV0E, kKindMesure);
        AddStation(carnet, "F", kHi);
        for (const auto& [name, place] : {std::pair{"C", kC}, {"A", kA}, {"B", kB}})
            AddSighting(carnet, name, kF, kHi, place, kHp, kV0F);
        AddStation(carnet, "G", kHi);
        AddSighting(carnet, "C", Place{990.0, 2000.0, 99.0}, kHi, kC, kHp, 0.0);
        ASSERT_EQ(carnet.Save(dir / "chantier.geo"), 1);
    }
    Outcome Run(const std::string& arguments) {
        return RunPyralis(dir.Root(), "CalExcen --geobase chantier.geo " + arguments);
    }
};

TEST_F(ExcentCommand, AStationTwoMetresFromItsCentreIsComputedShownWrittenListedAndJournalled) {
    const Outcome outcome = Run("--station E --centre C --enregistrer --listing excent.cex --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out,
                  {"Station E (1) : centre C à DH = 2.0000 m", "Station E (1) : X = 1001.2000  Y = 2001.6000",
                   "Station E (1) : V0 = 37.5000", "Station E (1) : Z = 98.400 (depuis le centre C)",
                   "---> A", "eV0 =", "---> B", "---> D"});
    const CCarnet saved = Saved();
    const int e = saved.findMat("E");
    ASSERT_GE(e, 0);
    EXPECT_NEAR(std::hypot(saved.xAt(e) - kE.x, saved.yAt(e) - kE.y), 0.0, kTenthMm);
    EXPECT_NEAR(saved.zAt(e), kE.z, kTenthMm);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("E", 1)), kV0E, 1e-4);

    ExpectInOrder(ReadBytes(dir / "excent.cex"),
                  {"CALCUL DE STATIONS EXCENTREES", "Calcul de la station E, reprise 1",
                   "Coordonnées des points d'appui", "Matricule", "centre", "appui",
                   "Calcul du V0 de la station (tolérance = ", "St exc.", "eV0 Gr",
                   "Valeur du V0 définitif : 37.5000", "Calcul en planimétrie", "St calc.", "2.0000",
                   "1001.2000", "Calcul en altimétrie, hauteur d'instrument = 1.500", "Z St.",
                   "Z calculé :", "98.400", "Tableau récapitulatif des résultats"});
    ExpectInOrder(ReadBytes(dir / "chantier.jnl"),
                  {" - Calcul d'une station excentrée\nPoint       E : X =    1001.2000 Y =    2001.6000 Z =",
                   "\nStation    E(1) : V0 =  37.50000"});
}

// The farther station, a choice of references, and the altimetry alone.
TEST_F(ExcentCommand, TwentyMetresAwaySomeReferencesOnlyOrTheAltitudeAlone) {
    Outcome outcome = Run("--station F --centre C");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"centre C à DH = 20.0000 m", "X = 1012.0000  Y = 1984.0000", "V0 = 312.2500",
                                "Z = 99.250"});
    EXPECT_EQ(Saved().findMat("F"), -1) << "nothing written without --enregistrer";

    outcome = Run("--station E --centre C --appuis B");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"X = 1001.2000  Y = 2001.6000", "V0 = 37.5000", "---> B"});
    EXPECT_FALSE(Has(outcome.out, "---> A") || Has(outcome.out, "---> D")) << outcome.out;

    outcome = Run("--station E --centre C --plani 0");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "Z = 98.400 (depuis le centre C)")) << outcome.out;
    EXPECT_FALSE(Has(outcome.out, "X = ")) << outcome.out;
}

// Without C's altitude, the station's comes from the zenith angles on the references, which this
// computation takes without curvature and refraction: a few tenths of a millimetre at 100 m.
TEST_F(ExcentCommand, ACentreWithoutAltitudeTakesItFromTheReferences) {
    Write(false);
    const Outcome outcome = Run("--station E --centre C --enregistrer --listing --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"X = 1001.2000  Y = 2001.6000", "EMQ (cm) = ", "(3 point(s) d'appui)"});
    const CCarnet saved = Saved();
    EXPECT_NEAR(saved.zAt(saved.findMat("E")), kE.z, 2e-3);
    ExpectInOrder(ReadBytes(dir / "chantier.cex"),
                  {"Calcul en altimétrie", "eAV Gr",
                   "Z approché :", "Z compensé :", "EMQ (cm) :", "Tableau récapitulatif des résultats"});
}

TEST_F(ExcentCommand, BadRequestsAreRefusedWithAFrenchMessage) {
    for (const auto& [arguments, said] :
         {std::pair{"--station ZZ --centre C", "La station <ZZ> n'existe pas"},
          {"--centre C", "Aucune station à calculer : indiquez --station."},
          {"--station E", "Aucun centre de station : indiquez --centre."},
          {"--station E --centre ZZ",
           "Le point <ZZ> n'est pas visé avec une distance depuis la station <E (1)> !"},
          {"--station E --centre A",
           "Le point <A> n'est pas visé avec une distance depuis la station <E (1)> !"},
          {"--station E --centre C --appuis ZZ", "Aucune visée de la station <E (1)> ne porte sur <ZZ> !"},
          {"--station G --centre C", "La station <G (1)> ne vise aucun point d'appui autre que <C> !"}}) {
        const Outcome outcome = Run(arguments);
        EXPECT_EQ(outcome.status, 1) << arguments;
        EXPECT_TRUE(Has(outcome.err, said)) << arguments << "\n" << outcome.err;
    }
}

class ExcentCommandAsUser : public ExcentCommand {};

TEST_F(ExcentCommandAsUser, AReadOnlyGeoBaseIsLeftAsItWas) {
    SKIP_WHEN_ROOT();
    ExpectReadOnlyGeoBaseKept("CalExcen --geobase chantier.geo --station E --centre C --enregistrer --oui");
}

} // namespace
} // namespace pyr::test
