#pragma once

#include "TestSupport.h"
#include "settings/ParamStore.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace pyr::test {

// Every test of the store starts with no remembered parameter file, messages going to a scripted front
// end, and the registry hive in a folder of its own: never the user's real configuration.
class SettingsTest : public ::testing::Test {
protected:
    SettingsTest()
        : scopedFrontEnd_(frontEnd), registryFolder_("PYRALIS_REGISTRE", folder / "registre"),
          paramsFile_("PYRALIS_PARAMS", path) {
        ResetParamErrorMemory();
    }
    ~SettingsTest() override { ResetParamErrorMemory(); }

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
