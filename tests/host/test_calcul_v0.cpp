// "pyralis CalculV0" run as a script runs it, on a GéoBase built from exact coordinates.
#include "HostTestSupport.h"
#include "calc/test_v0_geometry.h"

#include <gtest/gtest.h>
#include <sys/wait.h>

namespace pyr::test {
namespace {

struct Outcome {
    int status;
    std::string out, err;
};

class CalculV0Command : public ::testing::Test {
protected:
    // Two stations oriented at 50 and 120 gr on the same three points.
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

    Outcome Run(const std::string& arguments) {
        const std::string command = "cd '" + dir.Root().string() + "' && '" + ProgramFile("pyralis") +
                                    "' --params Pyralis.ini CalculV0 --geobase chantier.geo " + arguments +
                                    " </dev/null >sortie.txt 2>erreurs.txt";
        const int raw = std::system(command.c_str());
        return {WIFEXITED(raw) ? WEXITSTATUS(raw) : -1, ReadBytes(dir / "sortie.txt"),
                ReadBytes(dir / "erreurs.txt")};
    }
    double V0Of(const char* station) const {
        CCarnet carnet;
        carnet.Load(nullptr, dir / "chantier.geo");
        return carnet.v0At(carnet.findStaRep(station, 1));
    }

    TempDir dir;
};

bool Has(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

TEST_F(CalculV0Command, AllStationsAreOrientedSavedListedAndJournalled) {
    const Outcome outcome = Run("--type toutes --enregistrer --listing v0.cv0 --oui");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_TRUE(Has(outcome.out, "Station S1(1) : V0 = 50.00000 gr (3 référence(s) retenue(s) sur 3)"))
        << outcome.out;
    EXPECT_TRUE(Has(outcome.out, "Station S2(1) : V0 = 120.00000 gr")) << outcome.out;
    EXPECT_NEAR(V0Of("S1"), 50.0, 1e-5);
    EXPECT_NEAR(V0Of("S2"), 120.0, 1e-5);
    EXPECT_FALSE(Has(outcome.err, "Voulez-vous enregistrer les résultats")) << "the listing was asked for";

    const std::string listing = ReadBytes(dir / "v0.cv0");
    std::size_t at = 0;
    for (const char* part :
         {"CALCUL DES V0 DE STATIONS", "| Calcul de la station S1, reprise 1 |", "Remarques",
          "| Calcul de la station S2, reprise 1 |", "calcul pondéré     : 120.00000 |"}) {
        at = listing.find(part, at);
        ASSERT_NE(at, std::string::npos) << part << "\n" << listing;
    }
    const std::string journal = ReadBytes(dir / "chantier.jnl");
    EXPECT_TRUE(Has(journal, " - Calcul des V0 de stations\nStation   S1(1) : V0 =  50.00000\n"
                             "Station   S2(1) : V0 = 120.00000"))
        << journal;
}

TEST_F(CalculV0Command, ExitStatusSaysWhetherItRanWasRefusedOrMisused) {
    const struct {
        const char* arguments;
        int status;
        const char* said;
    } cases[] = {
        {"--station S9", 1, "La station <S9> n'existe pas dans la GéoBase !"},
        {"--type bidon", 1, "Type de calcul inconnu : « bidon » (unique, liste ou toutes)."},
        {"--liste 'S9-S2'", 1, "La liste de sélection des points n'est pas correcte !"},
        {"--ponderation", 2, "Valeur manquante pour --ponderation"},
        {"--help", 0, "--listing [FICHIER]"},
        {"--station S2 --references A --non", 0, "Station S2(1) : V0 = 120.00000 gr (1 référence(s)"},
    };
    for (const auto& c : cases) {
        const Outcome outcome = Run(c.arguments);
        EXPECT_EQ(outcome.status, c.status) << c.arguments << "\n" << outcome.err;
        EXPECT_TRUE(Has(outcome.err + outcome.out, c.said)) << c.arguments << "\n"
                                                            << outcome.err << outcome.out;
    }
    EXPECT_EQ(V0Of("S2"), kUndefined) << "nothing written without --enregistrer";
}

TEST_F(CalculV0Command, AV0FixedByHandIsWrittenIntoTheStation) {
    const Outcome outcome = Run("--station 'S2(1)' --v0 12.5 --enregistrer --non");
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(V0Of("S2"), 12.5);
    EXPECT_EQ(V0Of("S1"), kUndefined);
    EXPECT_FALSE(std::filesystem::exists(dir / "chantier.cv0")) << "No to the listing";
}

} // namespace
} // namespace pyr::test
