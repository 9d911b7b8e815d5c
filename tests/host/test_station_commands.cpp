// "pyralis CalRelev" and "CalRecou" run as a script runs them: the exit status, what is shown,
// the GéoBase written back, the listing and the journal, and what is refused. The station E stands at a
// place known to the test only; every sighting is what a perfect instrument would read.
#include "HostTestSupport.h"
#include "calc/test_v0_geometry.h"

namespace pyr::test {
namespace {

const Place kE{1040.0, 2030.0, 101.5};
const Place kA{1000.0, 2100.0, 100.0}, kB{1120.0, 2080.0, 102.0}, kC{1090.0, 1950.0, 99.0},
    kD{980.0, 1980.0, 101.0};
constexpr double kHiE = 1.55, kV0E = 37.5;

class StationCommands : public PyralisTest {
protected:
    StationCommands() { Write(); }

    // A, B, C and D known; E sights them all; S, set up on A and oriented, sights E. With `invariantE`,
    // E already has invariant coordinates, wrong ones.
    void Write(bool invariantE = false) {
        CCarnet carnet;
        for (const auto& [name, place] : {std::pair{"A", kA}, {"B", kB}, {"C", kC}, {"D", kD}})
            AddPoint(carnet, name, place);
        if (invariantE) {
            auto e = std::make_unique<CPointGen>("E", 1.0, 2.0, 3.0);
            e->setInvariantXY(true);
            e->setInvariantZ(true);
            carnet.Add(std::move(e), kKindPoint);
        }
        AddStation(carnet, "E", kHiE);
        for (const auto& [name, place] : {std::pair{"A", kA}, {"B", kB}, {"C", kC}, {"D", kD}})
            AddSighting(carnet, name, kE, kHiE, place, 1.3, kV0E);
        AddStation(carnet, "A", 1.6, 50.0);
        AddSighting(carnet, "E", kA, 1.6, kE, 1.4, 50.0, kKindMesure);
        ASSERT_EQ(carnet.Save(dir / "chantier.geo"), 1);
    }
    Outcome Run(const std::string& command, const std::string& arguments) {
        return RunPyralis(dir.Root(), command + " --geobase chantier.geo " + arguments);
    }
};

TEST_F(StationCommands, AResectionIsComputedShownWrittenListedAndJournalled) {
    const Outcome outcome = Run("CalRelev", "--station E --enregistrer --listing relev.crl --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Station E (1) : X = 1040.0000  Y = 2030.0000  EMQ X 0.0000  EMQ Y 0.0000",
                                "Station E (1) : V0 = 37.5000", "Station E (1) : Z = 101.500", "---> D"});
    const CCarnet saved = Saved();
    const int e = saved.findMat("E");
    ASSERT_GE(e, 0);
    EXPECT_NEAR(std::hypot(saved.xAt(e) - kE.x, saved.yAt(e) - kE.y), 0.0, 1e-9);
    EXPECT_NEAR(saved.zAt(e), kE.z, 1e-9);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("E", 1)), kV0E, 1e-9);

    ExpectInOrder(ReadBytes(dir / "relev.crl"),
                  {"CALCUL PAR RELEVEMENT", "Calcul de la station E, reprise 1", "Calcul en planimétrie",
                   "Matricule  visée", "P calculé", "EMQ (m/Gr)",
                   "Calcul en altimétrie, hauteur d'instrument = 1.550", "Z St.", "Z calculé"});
    ExpectInOrder(
        ReadBytes(dir / "chantier.jnl"),
        {" - Calcul de points par relèvement\nPoint       E : X =    1040.0000 Y =    2030.0000 Z =",
         "\nStation    E(1) : V0 =  37.50000"});
}

TEST_F(StationCommands, SomeSightingsOnlyAndTooFew) {
    Outcome outcome = Run("CalRelev", "--station 'E(1)' --visees A,B,C");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "X = 1040.0000  Y = 2030.0000  EMQ X -  EMQ Y -")) << outcome.out;
    EXPECT_EQ(Saved().findMat("E"), -1) << "nothing written without --enregistrer";

    outcome = Run("CalRelev", "--station E --visees A,B");
    EXPECT_EQ(outcome.status, 1);
    for (const std::string& said : {outcome.out, outcome.err})
        EXPECT_TRUE(Has(said, "Calcul impossible : il faut au moins trois visées !")) << said;
}

TEST_F(StationCommands, BadRequestsAreRefusedWithAFrenchMessage) {
    for (const auto& [arguments, said] :
         {std::pair{"CalRelev --geobase chantier.geo --station ZZ", "La station <ZZ> n'existe pas"},
          {"CalRelev --geobase chantier.geo --station 'E(2)'", "La station <E(2)> n'existe pas"},
          {"CalRelev --geobase chantier.geo", "Aucune station à calculer : indiquez --station."},
          {"CalRelev --geobase chantier.geo --station E --visees ZZ", "Aucune visée de la station <E (1)>"},
          {"CalRelev --geobase absente.geo --station E", "absente.geo"}}) {
        const Outcome outcome = RunPyralis(dir.Root(), arguments);
        EXPECT_EQ(outcome.status, 1) << arguments;
        EXPECT_TRUE(Has(outcome.err, said)) << arguments << "\n" << outcome.err;
    }
}

TEST_F(StationCommands, InvariantCoordinatesOfTheStationAreKeptOnNo) {
    Write(true);
    const Outcome outcome = Run("CalRelev", "--station E --enregistrer --non");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.err, {"La station 'E' possède déjà des coordonnées X et Y",
                                "La station 'E' possède déjà une altitude"});
    const CCarnet saved = Saved();
    EXPECT_DOUBLE_EQ(saved.xAt(saved.findMat("E")), 1.0);
    EXPECT_DOUBLE_EQ(saved.zAt(saved.findMat("E")), 3.0);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("E", 1)), kV0E, 1e-9) << "the V0 is no coordinate";
}

TEST_F(StationCommands, TheCombinedMethodTakesTheSightingsOnTheStationToo) {
    Outcome outcome = Run("CalRecou", "--station E --enregistrer --listing recoup.crc --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out,
                  {"Station E (1) : X = 1040.0000  Y = 2030.0000", "Station E (1) : V0 = 37.5000",
                   "Station E (1) : Z = 101.500", "---> A", "<--- A (1)"});
    const CCarnet saved = Saved();
    EXPECT_NEAR(saved.yAt(saved.findMat("E")), kE.y, 1e-9);
    ExpectInOrder(ReadBytes(dir / "recoup.crc"),
                  {"CALCUL PAR RECOUPEMENT", "Calcul de la station E, reprise 1", "Matricule visée R",
                   "<-- A (1)", "Calcul en altimétrie", "<-- A (1)"});
    ExpectInOrder(ReadBytes(dir / "chantier.jnl"),
                  {" - Calcul de points par recoupement\nPoint       E", "\nStation    E(1)"});

    // Resection sightings alone are not enough.
    outcome = Run("CalRecou", "--station E --visees B,C,D");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.out, "1 visée d'intersection et 2 visées de relèvement minimun")) << outcome.out;
}

class StationCommandsAsUser : public StationCommands {};

TEST_F(StationCommandsAsUser, AReadOnlyGeoBaseIsLeftAsItWas) {
    SKIP_WHEN_ROOT();
    ExpectReadOnlyGeoBaseKept("CalRelev --geobase chantier.geo --station E --enregistrer --oui");
}

} // namespace
} // namespace pyr::test
