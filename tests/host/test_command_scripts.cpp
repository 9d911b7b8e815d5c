// "pyralis CalculV0", "pyralis GeoEdit --reduction" and "--changement-repere" run as a script runs them: the
// exit status, what is shown and the GéoBase written back.
#include "HostTestSupport.h"
#include "calc/test_v0_geometry.h"

#include <tuple>

namespace pyr::test {
namespace {

using CommandScript = PyralisTest;

class CalculV0Command : public CommandScript {
protected:
    // Two stations oriented at 50 and 120 gr on the same three points, every sighting read exactly.
    CalculV0Command() {
        const Place s1{1000.0, 2000.0, 100.0}, s2{1100.0, 2100.0, 102.0};
        const std::pair<std::string, Place> references[] = {
            {"A", {1000.0, 2100.0, 101.0}}, {"B", {1200.0, 2000.0, 99.2}}, {"C", {700.0, 2000.0, 104.5}}};
        CCarnet carnet;
        AddPoint(carnet, "S1", s1);
        AddPoint(carnet, "S2", s2);
        for (const auto& [name, place] : references)
            AddPoint(carnet, name, place);
        for (const auto& [station, place, v0] : {std::tuple{"S1", s1, 50.0}, {"S2", s2, 120.0}}) {
            AddStation(carnet, station, 1.5);
            for (const auto& [name, target] : references)
                AddSighting(carnet, name, place, 1.5, target, 1.3, v0);
        }
        carnet.Save(dir / "chantier.geo");
    }
    Outcome V0(const std::string& arguments) { return Run("CalculV0 --geobase chantier.geo " + arguments); }
    double V0Of(const char* station) const {
        const CCarnet carnet = SavedGeoBase(dir / "chantier.geo");
        return carnet.v0At(carnet.findStaRep(station, 1));
    }
};

TEST_F(CalculV0Command, AllStationsAreOrientedSavedListedAndJournalled) {
    const Outcome outcome = V0("--type toutes --enregistrer --listing v0.cv0 --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    ExpectInOrder(outcome.out, {"Station S1(1) : V0 = 50.00000 gr (3 référence(s) retenue(s) sur 3)",
                                "Station S2(1) : V0 = 120.00000 gr"});
    EXPECT_NEAR(V0Of("S1"), 50.0, 1e-5);
    EXPECT_NEAR(V0Of("S2"), 120.0, 1e-5);
    EXPECT_FALSE(Has(outcome.err, "Voulez-vous enregistrer les résultats")) << "the listing was asked for";

    ExpectInOrder(ReadBytes(dir / "v0.cv0"),
                  {"CALCUL DES V0 DE STATIONS", "| Calcul de la station S1, reprise 1 |", "Remarques",
                   "| Calcul de la station S2, reprise 1 |", "calcul pondéré     : 120.00000 |"});
    EXPECT_TRUE(Has(ReadBytes(dir / "chantier.jnl"), " - Calcul des V0 de stations\nStation   S1(1) : V0 =  "
                                                     "50.00000\nStation   S2(1) : V0 = 120.00000"));
}

TEST_F(CalculV0Command, OneStationIsRefusedComputedOrGivenItsV0ByHand) {
    for (const auto& [arguments, status, said] :
         {std::tuple{"--station S9", 1, "La station <S9> n'existe pas dans la GéoBase !"},
          {"--type bidon", 1, "Type de calcul inconnu : « bidon » (unique, liste ou toutes)."},
          {"--liste 'S9-S2'", 1, "La liste de sélection des points n'est pas correcte !"},
          {"--station S2 --references A --non", 0, "Station S2(1) : V0 = 120.00000 gr (1 référence(s)"}}) {
        const Outcome outcome = V0(arguments);
        EXPECT_EQ(outcome.status, status) << arguments << "\n" << outcome.err;
        EXPECT_TRUE(Has(outcome.err + outcome.out, said)) << arguments << "\n" << outcome.err << outcome.out;
    }
    EXPECT_EQ(V0Of("S2"), kUndefined) << "nothing written without --enregistrer";

    ASSERT_EQ(V0("--station 'S2(1)' --v0 12.5 --enregistrer --non").status, 0);
    EXPECT_EQ(V0Of("S2"), 12.5);
    EXPECT_EQ(V0Of("S1"), kUndefined);
    EXPECT_FALSE(std::filesystem::exists(dir / "chantier.cv0")) << "No to the listing";
}

TEST_F(CommandScript, GeoEditReductionSavesWithABackupOnlyWhenItChangedTheGeoBase) {
    // The second set-up on S1 is turned back by 5 gr and stands 0.25 m lower: merged, its sighting of B
    // reads 105, on a target 0.25 m taller.
    const std::string twoSetUps = "GEOBASE PYRALIS\t1\n"
                                  "1001\tS1\t1.75\t-999999\n"
                                  "1002\tA\t1.25\t2\t100\t50\n"
                                  "1001\tS1\t1.5\t-999999\n"
                                  "1002\tA\t1.25\t397\t100\t50\n"
                                  "1003\tB\t1.25\t100\t100\t20\n";
    WriteBytes(dir / "a.geo", twoSetUps);
    ASSERT_EQ(Run("GeoEdit --geobase a.geo").status, 0); // without --reduction, only shown
    EXPECT_FALSE(std::filesystem::exists(dir / "a.bak"));

    const Outcome reduced = Run("GeoEdit --geobase a.geo --reduction --Suppress 1");
    ASSERT_EQ(reduced.status, 0) << reduced.err;
    EXPECT_EQ(ReadBytes(dir / "a.bak"), twoSetUps);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), "GEOBASE PYRALIS\t1\n"
                                        "1001\tS1\t1.75\t-999999\n"
                                        "1002\tA\t1.25\t2\t100\t50\n"
                                        "1002\tA\t1.5\t2\t100\t50\n"
                                        "1003\tB\t1.5\t105\t100\t20\n");
    EXPECT_TRUE(
        Has(reduced.err, "ATTENTION : Vérifier que la codification n'est pas altérée par cette commande !"));
    EXPECT_TRUE(Has(reduced.out, "GéoBase enregistrée dans <a.geo>.")) << reduced.out;
    EXPECT_TRUE(Has(reduced.out, "GéoBase <a.geo> : 4 élément(s).")) << "shown as it now stands";

    // Once merged, nothing is left to reduce: the file and its backup stay as they are.
    std::filesystem::remove(dir / "a.bak");
    const std::string merged = ReadBytes(dir / "a.geo");
    EXPECT_TRUE(
        Has(Run("GeoEdit --geobase a.geo --reduction").out, "Aucune modification apportée à la GéoBase !"));
    EXPECT_EQ(ReadBytes(dir / "a.geo"), merged);
    EXPECT_FALSE(std::filesystem::exists(dir / "a.bak"));
}

// Frame 2 is frame 1 turned by exactly 100 gr about the origin, then moved 1000 m east: (X, Y) becomes
// (1000 - Y, X); the station's V0 of 50 gr turns to 350 gr.
TEST_F(CommandScript, GeoEditChangesTheFrameOfItsPointsAndStationsAndSaves) {
    WriteBytes(dir / "a.geo", "GEOBASE PYRALIS\t1\n"
                              "1006\tP1\t10\t20\t101.5\t-\n"
                              "1006\tP2\t-35.5\t4.25\t-999999\t-\n"
                              "1001\tP1\t1.5\t50\n");
    const Outcome outcome =
        Run("GeoEdit a.geo --changement-repere --repere1 0,0,0,100 --repere2 1000,0,900,0 "
            "--modif-v0 1 --tous-les-points 1");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(
        Has(outcome.out + outcome.err, "2 Points ont été calculés\n1 Orientations de station modifiées"))
        << outcome.out << outcome.err;
    const CCarnet saved = SavedGeoBase(dir / "a.geo");
    const int p1 = saved.findMat("P1"), p2 = saved.findMat("P2");
    EXPECT_NEAR(saved.xAt(p1), 980.0, 1e-4);
    EXPECT_NEAR(saved.yAt(p1), 10.0, 1e-4);
    EXPECT_NEAR(saved.zAt(p1), 101.5, 1e-4);
    EXPECT_NEAR(saved.xAt(p2), 995.75, 1e-4);
    EXPECT_NEAR(saved.yAt(p2), -35.5, 1e-4);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("P1", 1)), 350.0, 1e-5);
    EXPECT_TRUE(std::filesystem::exists(dir / "a.bak"));

    const std::string moved = ReadBytes(dir / "a.geo");
    const Outcome refused = Run("GeoEdit a.geo --changement-repere --repere1 0,0,0,100 --repere2 1000,0");
    EXPECT_EQ(refused.status, 1);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), moved);
}

} // namespace
} // namespace pyr::test
