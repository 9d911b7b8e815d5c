#include "TestSupport.h"
#include "ui/ConsoleFrontEnd.h"

#include <cstdio>
#include <gtest/gtest.h>
#include <string>
#include <sys/stat.h>

namespace {

// An "editor" that writes the arguments it was given into a file, one a line, and its command line as
// $VISUAL would hold it ("sh <script> <marker>"), to check the words and the path that reach it.
class ShowFile : public ::testing::Test {
protected:
    ShowFile() {
        WriteBytes(script, "for a in \"$@\"; do printf '%s\\n' \"$a\"; done > \"$MARQUE\"\n");
        chmod(script.c_str(), 0755);
    }
    ~ShowFile() override {
        std::fclose(in);
        std::fclose(out);
        std::fclose(err);
    }

    TempDir folder;
    const std::string script = folder / "editeur.sh";
    const std::string marker = folder / "marque";
    const std::string listing = folder / "relevé d'été $HOME.cin";
    std::FILE* in = std::tmpfile();
    std::FILE* out = std::tmpfile();
    std::FILE* err = std::tmpfile();
    ScopedEnv markerEnv{"MARQUE", marker};
    ScopedEnv visual{"VISUAL", "sh  " + script + " -x"};
};

TEST_F(ShowFile, APersonGetsTheEditorOnThePathAsOneArgumentAndTheCallWaitsForIt) {
    pyr::ui::ConsoleFrontEnd console(in, out, err);
    console.SetInteractive(true);
    console.ShowFile(listing);
    // The marker exists as soon as the call returns: the editor was waited for.
    EXPECT_EQ(ReadBytes(marker), "-x\n" + listing + "\n");
    EXPECT_EQ(Contents(err), "");
}

TEST_F(ShowFile, BatchRunsNothingAndNamesTheFile) {
    pyr::ui::ConsoleFrontEnd console(in, out, err);
    console.SetInteractive(false);
    console.ShowFile(listing);
    EXPECT_FALSE(std::filesystem::exists(marker));
    EXPECT_EQ(Contents(err), "Fichier à consulter : " + listing + "\n");
}

TEST_F(ShowFile, AnEditorThatCannotBeStartedNamesTheFile) {
    ScopedEnv missing("VISUAL", folder / "absent");
    pyr::ui::ConsoleFrontEnd console(in, out, err);
    console.SetInteractive(true);
    console.ShowFile(listing);
    EXPECT_EQ(Contents(err), "Fichier à consulter : " + listing + "\n");
}

} // namespace
