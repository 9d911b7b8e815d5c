// The command-line host, run as a person or a script runs it: standard output, standard error and the
// exit status.
#include "HostTestSupport.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace {

class Pyralis : public ::testing::Test {
protected:
    Outcome Run(const std::string& arguments, const std::string& input = "",
                const std::string& program = ProgramFile("pyralis")) {
        return RunPyralis(dir.Root(), arguments, input, RLIM_INFINITY, program);
    }
    std::string Params() const { return dir / "Pyralis.ini"; }

    TempDir dir;
};

TEST_F(Pyralis, AloneItListsTheCommandsInRegistrationOrder) {
    const Outcome outcome = Run("");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    const auto lines = outcome.OutLines();
    ASSERT_EQ(lines.size(), 37u) << outcome.out;
    EXPECT_EQ(lines[23], "PyraCalInter   CalInter     calcul d'un point par intersections de visées");
}

TEST_F(Pyralis, ExitStatusSaysWhetherTheCommandRanWasRefusedOrMisused) {
    const struct {
        const char* arguments;
        int status;
        const char* said; // on standard error, or on standard output for the help
    } cases[] = {{"CALTRIAN", 1,
                  "La commande CalTrian (calcul d'un point par triangulation) n'est pas encore disponible"},
                 {"CalInconnu", 2, "commande inconnue « CalInconnu »"},
                 {"CalInter --bidon", 2, "--bidon"},
                 {"--bidon CalInter", 2, "--bidon"},
                 {"CalInter --help", 0, "--geobase"},
                 {"--help", 0, "--params"}};
    for (const auto& c : cases) {
        const Outcome outcome = Run(c.arguments);
        EXPECT_EQ(outcome.status, c.status) << c.arguments;
        EXPECT_TRUE(Has(outcome.err + outcome.out, c.said)) << c.arguments;
    }
}

TEST_F(Pyralis, CalcOptRefusesAnOptionOutOfItsLimitsAndSetsOneWithin) {
    const Outcome refused = Run("CalcOpt --regler Options_Corrections/RayonTerre=5000");
    EXPECT_EQ(refused.status, 1);
    EXPECT_TRUE(Has(refused.err, "la valeur 5000 est hors des limites (6000 à 7000).")) << refused.err;
    EXPECT_FALSE(std::filesystem::exists(Params()));

    const Outcome set = Run("CalcOpt --regler Options_Corrections/RayonTerre=6378");
    EXPECT_EQ(set.status, 0) << set.err;
    EXPECT_TRUE(Has(Run("calcopt --afficher").out, "\nRayonTerre=6378.000000\n"));
}

TEST_F(Pyralis, APersonTypesCommandsAtThePrompt) {
    const Outcome outcome = Run("--interactif", "caltrian\n\"PyrCalTopo15\"\nFIN\n");
    EXPECT_EQ(outcome.status, 0);
    EXPECT_TRUE(Has(outcome.err, "Commande : ")) << outcome.err;
    EXPECT_TRUE(Has(outcome.err, "n'est pas encore disponible"));
    EXPECT_TRUE(Has(outcome.out, "Barre d'outils « Calculs Topo » affichée.")) << outcome.out;
}

TEST_F(Pyralis, WithoutItsServicesModuleTheHostStops) {
    // The host and the module alone in a folder: the services are nowhere to be found.
    namespace fs = std::filesystem;
    fs::create_directories(dir.Root() / "seul");
    for (const char* file : {"pyralis", "PyrCalTopo15.arx"})
        fs::copy_file(ProgramFile(file), dir.Root() / "seul" / file);
    const Outcome outcome = Run("CalInter", "", dir / "seul/pyralis");
    EXPECT_NE(outcome.status, 0);
    EXPECT_TRUE(Has(outcome.err, "Impossible de trouver le module <Pyr2000Srv.arx>!!!")) << outcome.err;
}

} // namespace
