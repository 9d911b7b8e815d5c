// "pyralis GeoEdit --reduction" as a script runs it: the GéoBase rewritten, with its backup, only when
// the reduction changed it.
#include "HostTestSupport.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <sys/wait.h>

namespace {

// Runs pyralis in the folder with its own parameter file; the exit status.
int RunIn(const TempDir& dir, const std::string& arguments) {
    const std::string command = "cd '" + dir.Root().string() + "' && '" + ProgramFile("pyralis") +
                                "' --params Pyralis.ini " + arguments + " >sortie.txt 2>erreurs.txt";
    const int raw = std::system(command.c_str());
    return WIFEXITED(raw) ? WEXITSTATUS(raw) : -1;
}

TEST(GeoEditReduction, TheGeoBaseIsSavedWithItsBackupOnlyWhenTheReductionChangedIt) {
    TempDir dir;
    // The second set-up on S1 is turned back by 5 gr and stands 0.25 m lower: merged, its sighting of B
    // reads 105, on a target 0.25 m taller.
    const std::string twoSetUps = "GEOBASE PYRALIS\t1\n"
                                  "1001\tS1\t1.75\t-999999\n"
                                  "1002\tA\t1.25\t2\t100\t50\n"
                                  "1001\tS1\t1.5\t-999999\n"
                                  "1002\tA\t1.25\t397\t100\t50\n"
                                  "1003\tB\t1.25\t100\t100\t20\n";
    WriteBytes(dir / "a.geo", twoSetUps);
    ASSERT_EQ(RunIn(dir, "GeoEdit --geobase a.geo --reduction --Suppress 1"), 0)
        << ReadBytes(dir / "erreurs.txt");
    EXPECT_EQ(ReadBytes(dir / "a.bak"), twoSetUps);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), "GEOBASE PYRALIS\t1\n"
                                        "1001\tS1\t1.75\t-999999\n"
                                        "1002\tA\t1.25\t2\t100\t50\n"
                                        "1002\tA\t1.5\t2\t100\t50\n"
                                        "1003\tB\t1.5\t105\t100\t20\n");
    const std::string shown = ReadBytes(dir / "sortie.txt");
    EXPECT_NE(shown.find("000004  Mesure"), std::string::npos) << shown;
    EXPECT_NE(ReadBytes(dir / "erreurs.txt").find("ATTENTION : Vérifier que la codification"),
              std::string::npos);

    // Once merged, nothing is left to reduce: the file and its backup stay as they are.
    std::filesystem::remove(dir / "a.bak");
    const std::string reduced = ReadBytes(dir / "a.geo");
    ASSERT_EQ(RunIn(dir, "GeoEdit --geobase a.geo --reduction"), 0);
    EXPECT_EQ(ReadBytes(dir / "a.geo"), reduced);
    EXPECT_FALSE(std::filesystem::exists(dir / "a.bak"));
    EXPECT_NE(ReadBytes(dir / "sortie.txt").find("Aucune modification apportée à la GéoBase !"),
              std::string::npos);
}

} // namespace
