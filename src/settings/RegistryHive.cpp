// The registry form on platforms without a system registry: one initialisation file per root.
#ifndef _WIN32

#include "IniFileStore.h"
#include "RegistryPlatform.h"

#include <cerrno>
#include <filesystem>
#include <system_error>

namespace pyr {

namespace registry_detail {

namespace {

// A key or a value that does not exist: the code the system registry gives for it (2), which is also
// what errno calls a missing file.
constexpr int kNotFound = ENOENT;

std::string HiveFile(RegistryRoot root) {
    return (std::filesystem::path(RegistryHiveFolder()) / (std::string(RegistryRootName(root)) + ".ini"))
        .string();
}

} // namespace

Outcome ReadValue(RegistryRoot root, const std::string& keyPath, const std::string& name,
                  std::string& value) {
    IniFile hive;
    int code = LoadParamFileToRead(hive, HiveFile(root));
    if (code == 0 && !hive.HasSection(keyPath)) code = kNotFound;
    if (code != 0) return {Step::Open, code};
    if (!hive.Get(keyPath, name, value)) return {Step::Query, kNotFound};
    return {};
}

Outcome WriteValue(RegistryRoot root, const std::string& keyPath, const std::string& name,
                   const std::string& value) {
    const std::string file = HiveFile(root);
    IniFile hive;
    // A hive file that is not text is moved aside first; one that cannot be read is never written over.
    const int code = LoadParamFileToWrite(hive, file);
    if (code != 0 && code != ENOENT) return {Step::Create, code};
    if (code == ENOENT || !hive.HasSection(keyPath)) {
        std::error_code error;
        std::filesystem::create_directories(RegistryHiveFolder(), error);
        if (error) return {Step::Create, error.value()};
    }
    hive.Set(keyPath, name, value);
    if (const int saved = hive.Save(file); saved != 0) return {Step::Set, saved};
    return {};
}

} // namespace registry_detail

} // namespace pyr

#endif // !_WIN32
