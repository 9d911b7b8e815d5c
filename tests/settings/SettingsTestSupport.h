#pragma once

#include "TestSupport.h"
#include "settings/ParamStore.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>

namespace pyr::test {

// Every test of the store starts with no remembered parameter file, messages going to a scripted front
// end, and the registry hive in a folder of its own: never the user's real configuration.
class SettingsTest : public ::testing::Test {
protected:
    SettingsTest()
        : scopedFrontEnd_(frontEnd), registryFolder_("PYRALIS_REGISTRE", folder / "registre"),
          paramsFile_("PYRALIS_PARAMS", folder / "Pyralis.ini") {
        ResetParamErrorMemory();
    }
    ~SettingsTest() override { ResetParamErrorMemory(); }

    TempDir folder;
    ui::ScriptedFrontEnd frontEnd;

private:
    ui::ScopedApplicationFrontEnd scopedFrontEnd_;
    ScopedEnv registryFolder_;
    ScopedEnv paramsFile_;
};

} // namespace pyr::test
