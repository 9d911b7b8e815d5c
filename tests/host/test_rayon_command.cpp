// "pyralis CalRayon" run as a script runs it: the points written back, the listing and the journal, the
// questions on points out of tolerance, and what is refused. Every sighting is what a perfect instrument
// would read (test_v0_geometry.h), so that every point radiated falls on the place the test gave it.
#include "HostTestSupport.h"
#include "calc/test_v0_geometry.h"

namespace pyr::test {
namespace {

const Place kS1{1000.0, 2000.0, 100.0}, kS2{1100.0, 2050.0, 102.0};
const Place kK1{1080.0, 2150.0, 104.0}, kK2{920.0, 1900.0, 98.0};
const Place kP1{1030.0, 2040.0, 100.5}, kP2{960.0, 2010.0, 99.2}, kP3{1050.0, 1980.0, 101.1};
constexpr double kHi = 1.55, kHp = 1.3, kV0S1 = 123.456, kV0S2 = 301.25;
constexpr double kTenthMm = 1e-4;

class RayonCommand : public PyralisTest {
protected:
    RayonCommand() { Write(); }

    // S1 (oriented) radiates P1, P2 and P3, checks K2 and sights P4 without a distance; S2 (not
    // oriented) references K1 and S1, and radiates P3 again, `p3Shift` metres east of its place.
    void Write(double p3Shift = 0.0) {
        CCarnet carnet;
        for (const auto& [name, place] : {std::pair{"S1", kS1}, {"S2", kS2}, {"K1", kK1}, {"K2", kK2}})
            AddPoint(carnet, name, place);
        AddStation(carnet, "S1", kHi, kV0S1);
        AddSighting(carnet, "K2", kS1, kHi, kK2, kHp, kV0S1);
        for (const auto& [name, place] : {std::pair{"P1", kP1}, {"P2", kP2}, {"P3", kP3}})
            AddSighting(carnet, name, kS1, kHi, place, kHp, kV0S1, kKindMesure);
        carnet.As<CVisee>(AddSighting(carnet, "P4", kS1, kHi, kP1, kHp, kV0S1, kKindMesure))
            ->setDI(-999999.0);
        AddStation(carnet, "S2", kHi);
        AddSighting(carnet, "K1", kS2, kHi, kK1, kHp, kV0S2);
        AddSighting(carnet, "S1", kS2, kHi, kS1, kHp, kV0S2);
        AddSighting(carnet, "P3", kS2, kHi, Place{kP3.x + p3Shift, kP3.y, kP3.z}, kHp, kV0S2, kKindMesure);
        ASSERT_EQ(carnet.Save(dir / "chantier.geo"), 1);
    }
    void ComputeV0(bool on) {
        WriteBytes(dir / "Pyralis.ini", std::string("[Options_Calculs]\r\nRayonV0Calcule=") +
                                            (on ? "1" : "0") +
                                            "\r\n[Options_Listings]\r\nRayonContenu=N,X,Y,Z,GI,DH,CS\r\n");
    }
    Outcome Run(const std::string& arguments) {
        return RunPyralis(dir.Root(), "CalRayon --geobase chantier.geo " + arguments);
    }
    void ExpectPoint(const CCarnet& saved, const char* name, Place place) {
        SCOPED_TRACE(name);
        const int at = saved.findMat(name);
        ASSERT_GE(at, 0);
        EXPECT_NEAR(saved.xAt(at), place.x, kTenthMm);
        EXPECT_NEAR(saved.yAt(at), place.y, kTenthMm);
        EXPECT_NEAR(saved.zAt(at), place.z, kTenthMm);
    }
};

TEST_F(RayonCommand, EveryStationRadiatesItsPointsWrittenListedAndJournalled) {
    ComputeV0(true);
    const Outcome outcome = Run("--type toutes --enregistrer --listing rayon.cpr --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out,
                  {"Station S1(1) : 3 point(s) rayonné(s), 1 contrôle(s), V0 calculé = 123.45600 gr",
                   "Visée sur <P4> non calculée : sans distance",
                   "Station S2(1) : 1 point(s) rayonné(s), 2 contrôle(s), V0 calculé = 301.25000",
                   "3 point(s) nouveau(x) rayonné(s) depuis 2 station(s).",
                   "3 point(s) et 2 V0 de station(s) écrit(s) dans la GéoBase."});
    const CCarnet saved = Saved();
    ExpectPoint(saved, "P1", kP1);
    ExpectPoint(saved, "P2", kP2);
    ExpectPoint(saved, "P3", kP3);
    EXPECT_EQ(saved.findMat("P4"), -1);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("S2", 1)), kV0S2, 1e-5);

    ExpectInOrder(ReadBytes(dir / "rayon.cpr"), {"Tolérances des déterminations multiples",
                                                 "Station S1, reprise 1",
                                                 "X = 1000.0000",
                                                 "V0 = 123.45600 calculé sur 1 référence(s)",
                                                 "Points rayonnés",
                                                 "Matricule",
                                                 "Gis.",
                                                 "DH",
                                                 "Code",
                                                 "P1",
                                                 "1030.0000",
                                                 "2040.0000",
                                                 "100.500",
                                                 "Contrôle des points connus",
                                                 "K2",
                                                 "Visées non calculées",
                                                 "P4 : sans distance",
                                                 "Station S2, reprise 1",
                                                 "V0 = 301.25000 calculé sur 2 référence(s)",
                                                 "Points déterminés plusieurs fois",
                                                 "P3",
                                                 "S1(1)",
                                                 "S2(1)",
                                                 "Moyenne",
                                                 "1050.0000",
                                                 "Ecarts : 0.0000 m"});
    ExpectInOrder(ReadBytes(dir / "chantier.jnl"),
                  {" - Calcul de points rayonnés", "\nStation   S2(1) : V0 = 301.25000",
                   "Point      P1 : X =    1030.0000"});
}

// Without "RayonV0Calcule" a station without V0 is named with its reason; one station or a list, and
// some points only.
TEST_F(RayonCommand, StationsAndPointsChosenAndAStationWithoutV0Named) {
    ComputeV0(false);
    Outcome outcome = Run("--type toutes");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "Station S2(1) non utilisée : pas de V0")) << outcome.out;
    EXPECT_TRUE(Has(outcome.err + outcome.out, "1 station(s) non utilisée(s)")) << outcome.err;
    EXPECT_EQ(Saved().findMat("P1"), -1) << "nothing written without --enregistrer";

    outcome = Run("--station S1 --points P1,P3 --enregistrer --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    const CCarnet saved = Saved();
    ExpectPoint(saved, "P1", kP1);
    ExpectPoint(saved, "P3", kP3);
    EXPECT_EQ(saved.findMat("P2"), -1);

    outcome = Run("--liste S2");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_TRUE(Has(outcome.err, "Aucun point n'a pu être rayonné !")) << outcome.err;
}

// P3 seen from S2 5 cm east of where S1 puts it: beyond the 1 cm of "TolDistances", it is written only
// when the surveyor says so.
TEST_F(RayonCommand, APointOutOfToleranceIsWrittenOnlyWhenTheSurveyorAgrees) {
    ComputeV0(true);
    Write(0.05);
    Outcome outcome = Run("--enregistrer --listing --non");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Point <P3> : 2 déterminations, écarts 0.050 m en XY", "HORS TOLÉRANCE",
                                "Point <P3> hors tolérance : non enregistré."});
    EXPECT_EQ(Saved().findMat("P3"), -1);
    EXPECT_TRUE(Has(ReadBytes(dir / "chantier.cpr"), "HORS TOLERANCE"));

    outcome = Run("--enregistrer --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectPoint(Saved(), "P3", Place{kP3.x + 0.025, kP3.y, kP3.z});
}

// A job of two hundred stations is radiated on every core the machine has: each station's points, some of
// them seen again from the next station, come out where the test put them, as from one station at a time.
TEST_F(RayonCommand, AJobOfManyStationsRadiatedOnEveryCoreGivesEveryPointItsPlace) {
    ComputeV0(false);
    CCarnet carnet;
    constexpr int kStations = 200, kPoints = 6;
    auto stationPlace = [](int s) {
        return Place{1000.0 + 80.0 * (s % 20), 2000.0 + 80.0 * (s / 20), 100.0 + s % 7};
    };
    auto pointPlace = [&](int s, int p) {
        const Place at = stationPlace(s);
        return Place{at.x + 7.0 * (p + 1), at.y - 5.0 * p, at.z + 0.3 * p};
    };
    for (int s = 0; s < kStations; ++s)
        AddPoint(carnet, "S" + std::to_string(s), stationPlace(s));
    for (int s = 0; s < kStations; ++s) {
        const double v0 = std::fmod(17.3 * s, 400.0);
        AddStation(carnet, "S" + std::to_string(s), kHi, v0);
        for (int p = 0; p < kPoints; ++p)
            AddSighting(carnet, "P" + std::to_string(s) + "_" + std::to_string(p), stationPlace(s), kHi,
                        pointPlace(s, p), kHp, v0, kKindMesure);
        if (s > 0) // the first point of the station before, seen again
            AddSighting(carnet, "P" + std::to_string(s - 1) + "_0", stationPlace(s), kHi,
                        pointPlace(s - 1, 0), kHp, v0, kKindMesure);
    }
    ASSERT_EQ(carnet.Save(dir / "chantier.geo"), 1);

    const Outcome outcome = Run("--type toutes --enregistrer --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(
        Has(outcome.out, std::to_string(kStations * kPoints) + " point(s) nouveau(x) rayonné(s) depuis 200"))
        << outcome.out;
    const CCarnet saved = Saved();
    for (int s = 0; s < kStations; ++s)
        for (int p = 0; p < kPoints; ++p) {
            const std::string name = "P" + std::to_string(s) + "_" + std::to_string(p);
            ExpectPoint(saved, name.c_str(), pointPlace(s, p));
        }
}

TEST_F(RayonCommand, BadRequestsAreRefusedWithAFrenchMessage) {
    for (const auto& [arguments, said] :
         {std::pair{"--station ZZ", "La station <ZZ> n'existe pas"},
          {"--type parfois", "Type de calcul inconnu : « parfois »"},
          {"--liste ZZ", "Aucune station de la GéoBase n'est dans la liste <ZZ>"}}) {
        const Outcome outcome = Run(arguments);
        EXPECT_EQ(outcome.status, 1) << arguments;
        EXPECT_TRUE(Has(outcome.err, said)) << arguments << "\n" << outcome.err;
    }
}

class RayonCommandAsUser : public RayonCommand {};

TEST_F(RayonCommandAsUser, AReadOnlyGeoBaseIsLeftAsItWas) {
    SKIP_WHEN_ROOT();
    ExpectReadOnlyGeoBaseKept("CalRayon --geobase chantier.geo --station S1 --enregistrer --oui");
}

} // namespace
} // namespace pyr::test
