#pragma once

#include "ui/FrontEnd.h"

#include <optional>
#include <string>
#include <string_view>

// The registry form of the parameter store. The parameter path is a root name; the section is the key
// path under that root (levels separated by backslashes); the parameter key is the value name; values
// are text. On Windows it is the system registry. Elsewhere it is a hive of initialisation files: one
// file per root, named after the root ("HKEY_CURRENT_USER.ini"), one section per key path.
namespace pyr {

enum class RegistryRoot {
    LocalMachine,
    CurrentUser,
    ClassesRoot,
    Users,
    PerformanceData,
    CurrentConfig,
    DynData,
};

// The root that the whole text names, case ignored ("hkey_current_user" names one;
// "HKEY_CURRENT_USER\Software" does not). Nothing for any other text, the null one included.
std::optional<RegistryRoot> RegistryRootFromName(std::string_view name);

// "HKEY_CURRENT_USER" and so on.
std::string_view RegistryRootName(RegistryRoot root);

// A value read from the registry goes through a buffer of this size, its end of text included: longer
// values are cut to 8191 bytes.
inline constexpr std::size_t kRegistryValueBuffer = 8192;

// The folder of the hive files, where there is no system registry: $PYRALIS_REGISTRE when set, else
// $XDG_CONFIG_HOME/pyralis/registre, else ~/.config/pyralis/registre.
std::string RegistryHiveFolder();

// Reads a value. The root name is checked, the key path must not be empty, the key must exist and hold
// the value; `value` is changed only when all of that holds. Each refusal and failure is shown as a
// message box (error icon) when `report` is set, silently returned as false otherwise. The codes in the
// messages are the system's: 2 for a key or value that does not exist.
bool ReadRegistryValue(std::string_view rootName, std::string_view keyPath, std::string_view name,
                       std::string& value, bool report, ui::FrontEnd* parent = nullptr);

// Writes a value as text, creating the key (and the hive's folder and file) when it does not exist yet.
// Refusals and failures as for ReadRegistryValue, each reported as a failure of the command running;
// in a hive of files the message ends with the reason in words (kMsgFailureCause). A hive file that is
// not text is moved aside and a new one made, as a parameter file is (IniFileStore.h).
bool WriteRegistryValue(std::string_view rootName, std::string_view keyPath, std::string_view name,
                        std::string_view value, bool report, ui::FrontEnd* parent = nullptr);

} // namespace pyr
