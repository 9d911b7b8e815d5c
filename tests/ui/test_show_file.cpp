#include "TestSupport.h"
#include "ui/ConsoleFrontEnd.h"

#include <gtest/gtest.h>

namespace {

TEST(ShowFile, TheEditorGetsThePathAsOneArgumentOtherwiseTheFileIsNamed) {
    TempDir folder;
    const std::string marker = folder / "marque", listing = folder / "relevé d'été $HOME.cin";
    // An "editor" that writes the arguments it was given into the marker, one a line; $VISUAL holds its
    // command line, words to split.
    WriteBytes(folder / "editeur.sh", "for a in \"$@\"; do printf '%s\\n' \"$a\"; done > \"$MARQUE\"\n");
    ScopedEnv markerEnv("MARQUE", marker);
    ScopedEnv visual("VISUAL", "sh  " + (folder / "editeur.sh") + " -x");
    // What the console writes on its error stream when it shows the listing.
    const auto show = [&](bool interactive) {
        std::FILE* streams[] = {std::tmpfile(), std::tmpfile(), std::tmpfile()};
        pyr::ui::ConsoleFrontEnd console(streams[0], streams[1], streams[2]);
        console.SetInteractive(interactive);
        console.ShowFile(listing);
        const std::string err = Contents(streams[2]);
        for (std::FILE* stream : streams)
            std::fclose(stream);
        return err;
    };

    const std::string named = "Fichier à consulter : " + listing + "\n";
    EXPECT_EQ(show(false), named);
    EXPECT_FALSE(std::filesystem::exists(marker)) << "nothing is run in batch";
    EXPECT_EQ(show(true), "");
    EXPECT_EQ(ReadBytes(marker), "-x\n" + listing + "\n") << "written before the call returned: waited for";

    ScopedEnv missing("VISUAL", folder / "absent");
    EXPECT_EQ(show(true), named) << "an editor that cannot be started";
}

} // namespace
