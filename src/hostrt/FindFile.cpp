#include "hostrt/FindFile.h"

#include <algorithm>
#include <filesystem>

namespace fs = std::filesystem;

namespace {

std::vector<std::string>& Folders() {
    static std::vector<std::string> folders;
    return folders;
}

bool IsFile(const fs::path& path) {
    std::error_code error;
    return fs::is_regular_file(path, error);
}

std::string Absolute(const fs::path& path) {
    std::error_code error;
    fs::path absolute = fs::absolute(path, error);
    return (error ? path : absolute).lexically_normal().string();
}

} // namespace

int acedFindFile(std::string_view name, std::string& found) {
    std::string wanted(name);
    std::replace(wanted.begin(), wanted.end(), '\\', '/');
    if (wanted.empty()) return RTERROR;
    const fs::path path(wanted);
    if (IsFile(path)) {
        found = Absolute(path);
        return RTNORM;
    }
    if (path.is_absolute()) return RTERROR;
    for (const std::string& folder : Folders()) {
        const fs::path candidate = fs::path(folder) / path;
        if (IsFile(candidate)) {
            found = Absolute(candidate);
            return RTNORM;
        }
    }
    return RTERROR;
}

namespace pyr {

void SetSupportPath(std::vector<std::string> folders) {
    for (std::string& folder : folders)
        std::replace(folder.begin(), folder.end(), '\\', '/');
    Folders() = std::move(folders);
}

const std::vector<std::string>& SupportPath() {
    return Folders();
}

} // namespace pyr
