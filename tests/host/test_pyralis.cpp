// The command-line host, run as a person or a script runs it: standard output, standard error and the
// exit status.
#include "HostTestSupport.h"

namespace {

using Pyralis = PyralisTest;

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

// A setting accepted is run by SettingsSafety; here the refusal's status, and nothing written.
TEST_F(Pyralis, CalcOptRefusesAnOptionOutOfItsLimits) {
    const Outcome refused = Run("CalcOpt --regler Options_Corrections/RayonTerre=5000");
    EXPECT_EQ(refused.status, 1);
    EXPECT_TRUE(Has(refused.err, "la valeur 5000 est hors des limites (6000 à 7000).")) << refused.err;
    EXPECT_FALSE(std::filesystem::exists(dir / "Pyralis.ini"));
}

TEST_F(Pyralis, APersonTypesCommandsAtThePrompt) {
    const Outcome outcome = RunPyralis(dir.Root(), "--interactif", "caltrian\n\"PyrCalTopo15\"\nFIN\n");
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
    const Outcome outcome = RunPyralis(dir.Root(), "CalInter", "", RLIM_INFINITY, dir / "seul/pyralis");
    EXPECT_NE(outcome.status, 0);
    EXPECT_TRUE(Has(outcome.err, "Impossible de trouver le module <Pyr2000Srv.arx>!!!")) << outcome.err;
}

} // namespace
