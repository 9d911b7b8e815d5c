#pragma once

#include "settings/ParamStore.h"
#include "ui/ScriptedFrontEnd.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <optional>
#include <sstream>
#include <string>
#include <unistd.h>

namespace pyr::test {

// A fresh folder under /tmp, removed with everything in it at the end of the test.
class TempFolder {
public:
    TempFolder() {
        char pattern[] = "/tmp/pyr-settings-XXXXXX";
        const char* made = mkdtemp(pattern);
        if (made) path_ = made;
    }
    ~TempFolder() {
        std::error_code ignored;
        std::filesystem::remove_all(path_, ignored);
    }
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;

    const std::filesystem::path& Path() const { return path_; }
    std::string operator/(std::string_view name) const { return (path_ / name).string(); }

private:
    std::filesystem::path path_;
};

// Sets (or, with nothing, removes) an environment variable for the life of a scope.
class ScopedEnv {
public:
    ScopedEnv(const char* name, std::optional<std::string> value) : name_(name) {
        if (const char* old = std::getenv(name)) old_ = old;
        if (value)
            setenv(name, value->c_str(), 1);
        else
            unsetenv(name);
    }
    ~ScopedEnv() {
        if (old_)
            setenv(name_, old_->c_str(), 1);
        else
            unsetenv(name_);
    }
    ScopedEnv(const ScopedEnv&) = delete;
    ScopedEnv& operator=(const ScopedEnv&) = delete;

private:
    const char* name_;
    std::optional<std::string> old_;
};

inline void WriteBytes(const std::string& path, std::string_view bytes) {
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

inline std::string ReadBytes(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream bytes;
    bytes << in.rdbuf();
    return bytes.str();
}

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

    TempFolder folder;
    ui::ScriptedFrontEnd frontEnd;

private:
    ui::ScopedApplicationFrontEnd scopedFrontEnd_;
    ScopedEnv registryFolder_;
    ScopedEnv paramsFile_;
};

} // namespace pyr::test
