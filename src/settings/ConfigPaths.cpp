#include "ConfigPaths.h"

#include <cstdlib>
#include <filesystem>

#ifndef _WIN32
#include <pwd.h>
#include <unistd.h>
#endif

namespace pyr {

namespace {

std::string HomeFolder() {
    if (const char* home = std::getenv("HOME"); home && *home) return home;
#ifndef _WIN32
    if (const passwd* account = getpwuid(getuid()); account && account->pw_dir) return account->pw_dir;
#else
    if (const char* profile = std::getenv("USERPROFILE"); profile && *profile) return profile;
#endif
    return ".";
}

} // namespace

std::string PyralisConfigFolder() {
    // A relative XDG_CONFIG_HOME is invalid and is ignored, as the XDG rules ask.
    if (const char* config = std::getenv("XDG_CONFIG_HOME"); config && *config == '/')
        return (std::filesystem::path(config) / "pyralis").string();
    return (std::filesystem::path(HomeFolder()) / ".config" / "pyralis").string();
}

} // namespace pyr
