#pragma once

#include "TestSupport.h"
#include "geobase/Elements.h"
#include "settings/IniFileStore.h"
#include "settings/ParamStore.h"
#include "ui/ScriptedFrontEnd.h"

#include <csignal>
#include <gtest/gtest.h>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace pyr::test {

// The bytes of a literal, NULs included: BytesOf("a\0b") is three bytes.
template <std::size_t N>
std::string BytesOf(const char (&literal)[N]) {
    return std::string(literal, N - 1);
}

// Runs `write` in a child process whose files may not grow past `limit` bytes, as on a full disk: a write
// past it fails (EFBIG) instead of ending the process. Returns what `write` returns, -1 when the child
// did not end normally.
template <class Write>
int InChildWithFileSizeLimit(rlim_t limit, Write write) {
    const pid_t child = fork();
    if (child == 0) {
        std::signal(SIGXFSZ, SIG_IGN);
        const rlimit size{limit, limit};
        setrlimit(RLIMIT_FSIZE, &size);
        _exit(write());
    }
    int status = 0;
    waitpid(child, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

// Every test of the store starts with no remembered parameter file, none said not to be text, messages going
// to a scripted front end, and the registry hive in a folder of its own: never the user's real configuration.
class SettingsTest : public ::testing::Test {
protected:
    SettingsTest()
        : scopedFrontEnd_(frontEnd), registryFolder_("PYRALIS_REGISTRE", folder / "registre"),
          paramsFile_("PYRALIS_PARAMS", path) {
        ResetParamErrorMemory();
        ForgetUnreadableParamFiles();
    }
    // The store's decimals and axis order are class-wide, set by reading the options: every test leaves
    // them as a fresh program has them.
    ~SettingsTest() override {
        ResetParamErrorMemory();
        ForgetUnreadableParamFiles();
        SetStoreDecimals(4, 3, 5);
        CPointGen::setSwapXY(false);
    }

    // The texts of the messages shown, each checked to be captioned "PYRALIS" with that icon.
    static std::vector<std::string> Texts(const ui::ScriptedFrontEnd& shown, int icon) {
        std::vector<std::string> texts;
        for (const auto& message : shown.messages) {
            EXPECT_EQ(message.caption, "PYRALIS");
            EXPECT_EQ(message.icon, icon);
            texts.push_back(message.text);
        }
        return texts;
    }

    TempDir folder;
    const std::string path = folder / "Pyralis.ini";
    ui::ScriptedFrontEnd frontEnd;

private:
    ui::ScopedApplicationFrontEnd scopedFrontEnd_;
    ScopedEnv registryFolder_;
    ScopedEnv paramsFile_;
};

} // namespace pyr::test
