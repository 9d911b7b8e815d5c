#include "RegistryStore.h"

#include "ConfigPaths.h"
#include "ParamStore.h"
#include "RegistryPlatform.h"
#include "SettingsMessages.h"
#include "SettingsText.h"
#include "core/Files.h"
#include "core/Strings.h"

#include <array>
#include <cstdlib>
#include <filesystem>

namespace pyr {

namespace {

struct RootEntry {
    RegistryRoot root;
    std::string_view name;
};

constexpr std::array<RootEntry, 7> kRoots = {{
    {RegistryRoot::LocalMachine, "HKEY_LOCAL_MACHINE"},
    {RegistryRoot::CurrentUser, "HKEY_CURRENT_USER"},
    {RegistryRoot::ClassesRoot, "HKEY_CLASSES_ROOT"},
    {RegistryRoot::Users, "HKEY_USERS"},
    {RegistryRoot::PerformanceData, "HKEY_PERFORMANCE_DATA"},
    {RegistryRoot::CurrentConfig, "HKEY_CURRENT_CONFIG"},
    {RegistryRoot::DynData, "HKEY_DYN_DATA"},
}};

void Report(bool report, ui::FrontEnd* parent, const std::string& text) {
    if (report) ShowParamMessage(parent, text, ui::kIconError);
}

// A write that failed is a failure of the command. Where the registry is a hive of files, its codes are
// the system's errno, and the reason in words follows the message.
void ReportWriteFailure(bool report, ui::FrontEnd* parent, std::string text, int code) {
    if (!report) return;
#ifndef _WIN32
    if (code != 0) text += Sprintf(kMsgFailureCause, SystemErrorText(code).c_str());
#else
    (void)code;
#endif
    ReportParamFailure(parent, text, ui::kIconError);
}

// The checks common to reads and writes: a known root, a key path.
std::optional<RegistryRoot> CheckedRoot(std::string_view rootName, std::string_view keyPath, bool report,
                                        ui::FrontEnd* parent) {
    const auto root = RegistryRootFromName(rootName);
    if (!root) {
        Report(report, parent, kMsgRegistryBadRoot);
        return std::nullopt;
    }
    if (keyPath.empty()) {
        Report(report, parent, kMsgRegistryNoKeyName);
        return std::nullopt;
    }
    return root;
}

} // namespace

std::optional<RegistryRoot> RegistryRootFromName(std::string_view name) {
    if (name.data() == nullptr) return std::nullopt;
    for (const RootEntry& entry : kRoots) {
        if (EqualIgnoringCase(name, entry.name)) return entry.root;
    }
    return std::nullopt;
}

std::string RegistryHiveFolder() {
    if (const char* folder = std::getenv("PYRALIS_REGISTRE"); folder && *folder) return folder;
    return (std::filesystem::path(PyralisConfigFolder()) / "registre").string();
}

std::string_view RegistryRootName(RegistryRoot root) {
    for (const RootEntry& entry : kRoots) {
        if (entry.root == root) return entry.name;
    }
    return {};
}

bool ReadRegistryValue(std::string_view rootName, std::string_view keyPath, std::string_view name,
                       std::string& value, bool report, ui::FrontEnd* parent) {
    const auto root = CheckedRoot(rootName, keyPath, report, parent);
    if (!root) return false;
    const std::string key(keyPath);
    const std::string valueName(name);
    std::string text;
    const registry_detail::Outcome outcome = registry_detail::ReadValue(*root, key, valueName, text);
    switch (outcome.failedAt) {
    case registry_detail::Step::Done:
        break;
    case registry_detail::Step::Open:
        Report(report, parent, Sprintf(kMsgRegistryOpenFailed, key.c_str(), outcome.code));
        return false;
    default:
        Report(report, parent, Sprintf(kMsgRegistryReadFailed, valueName.c_str(), key.c_str(), outcome.code));
        return false;
    }
    CutToValueBuffer(text, kRegistryValueBuffer);
    value = std::move(text);
    return true;
}

bool WriteRegistryValue(std::string_view rootName, std::string_view keyPath, std::string_view name,
                        std::string_view value, bool report, ui::FrontEnd* parent) {
    const auto root = RegistryRootFromName(rootName);
    if (!root) {
        ReportWriteFailure(report, parent, kMsgRegistryBadRoot, 0);
        return false;
    }
    if (keyPath.empty()) {
        ReportWriteFailure(report, parent, kMsgRegistryNoKeyName, 0);
        return false;
    }
    const std::string key(keyPath);
    const std::string valueName(name);
    const registry_detail::Outcome outcome =
        registry_detail::WriteValue(*root, key, valueName, std::string(value));
    switch (outcome.failedAt) {
    case registry_detail::Step::Done:
        return true;
    case registry_detail::Step::Create:
    case registry_detail::Step::Open:
        ReportWriteFailure(report, parent, Sprintf(kMsgRegistryCreateFailed, key.c_str(), outcome.code),
                           outcome.code);
        return false;
    default:
        ReportWriteFailure(report, parent,
                           Sprintf(kMsgRegistryWriteFailed, valueName.c_str(), key.c_str(), outcome.code),
                           outcome.code);
        return false;
    }
}

} // namespace pyr
