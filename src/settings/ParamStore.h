#pragma once

#include "ui/FrontEnd.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

// The parameter store: every setting of the program (calculation options, the last GéoBase, the state of
// each dialog, the parameters of each field-book format) is a named value in a section of a store.
//
// The store is named by one text, the parameter path:
//  - exactly one of the seven registry root names ("HKEY_CURRENT_USER" ...), the whole text compared
//    without regard to case: the registry form (RegistryStore.h), where the section is the key path
//    and the parameter key the value name;
//  - any other text, "HKEY_CURRENT_USER\Software" included: an initialisation file of that name.
// The path is taken as a std::string_view. A default-constructed view (data() == nullptr, kNullParamPath)
// is the null path, reported as such by the writes; "" is the empty path, a file without a name.
//
// Values are text in both forms: integers and switches "%d" (a switch is 0 or 1), reals "%f" (six
// decimals, always with a '.', whatever the user's locale), strings as they are.
//
// Reads never fail: an absent store, section or key gives the default, and numbers are brought within
// their limits. They show no message, but for a parameter file that is not text (binary, UTF-16): it
// gives the defaults and is named once (IniFileStore.h). A failed write shows a message, once per file
// (below).
namespace pyr {

inline constexpr std::string_view kNullParamPath{};

// A value read from a file goes through a buffer of this size, its end of text included: longer values
// (and defaults) are cut to 4095 bytes, at a character boundary.
inline constexpr std::size_t kFileValueBuffer = 4096;

bool IsRegistryParamPath(std::string_view path);

// The current parameter file when no other path is named: $PYRALIS_PARAMS when set, else
// $XDG_CONFIG_HOME/pyralis/Pyralis.ini, else ~/.config/pyralis/Pyralis.ini.
std::string DefaultParamFilePath();

// --- Reads -------------------------------------------------------------------------------------------

// The stored text, else the default. Returns true for a file path; for a registry path, whether the
// value was found.
bool ReadParamString(std::string_view path, std::string_view section, std::string_view key,
                     std::string_view defaultValue, std::string& result);

// The same, the string's present contents serving as the default.
bool ReadParamString(std::string_view path, std::string_view section, std::string_view key,
                     std::string& value);

// The default goes to the store as its "%d" text, as a default of the store itself would. The text
// delivered is read as C's atoi reads it (leading blanks skipped, the longest leading integer, 0 for
// a text without one), then brought within [minimum, maximum]: below the minimum it becomes the minimum,
// then above the maximum the maximum. Returns whether the store delivered any characters: a file
// delivers the stored text or the default text, so false only for a key stored empty; the registry
// delivers only a stored, non-empty text.
bool ReadParamInt(std::string_view path, std::string_view section, std::string_view key, int defaultValue,
                  int minimum, int maximum, int& result);

// As ReadParamInt, the default going as its "%f" text (so a default with more than six decimals is
// rounded to six) and the text read as C's atof reads it. A text that reads as not-a-number gives the
// minimum, so that the result is always within the limits.
bool ReadParamDouble(std::string_view path, std::string_view section, std::string_view key,
                     double defaultValue, double minimum, double maximum, double& result);

// --- Writes --------------------------------------------------------------------------------------------
//
// Each returns true when the value is stored.
//
// A file is written whole through a temporary file renamed over it; a file that does not exist is
// created when its folder exists. A file that is not text is never written over: the first write moves
// it aside (LoadParamFileToWrite, IniFileStore.h) and makes a new file. On failure a message (warning
// icon) names the file and the system's error code (errno), then the reason in words
// (kMsgFailureCause), unless the file is the last parameter file written or reported: a dialog writing
// twenty values to a read-only file is reported once, and a file just written successfully is not
// reported when a later write to it fails. The message is a failure of the command (ReportFailure). The
// messages, in this order:
//   null path: kMsgParamFileNullName; empty path: kMsgParamFileNoName; the file exists:
//   kMsgParamFileSaveFailed; it does not (its folder is missing): kMsgParamFileMissing.
// The remembered name starts empty, so a failing write to the empty path is reported only once another
// file has been written or reported. An empty key cannot be stored in a file: refused, with EINVAL.
//
// A registry path writes through WriteRegistryValue, asking for its reports (error icon).

bool WriteParamBool(std::string_view path, std::string_view section, std::string_view key,
                    unsigned char value);
bool WriteParamInt(std::string_view path, std::string_view section, std::string_view key, int value);
bool WriteParamDouble(std::string_view path, std::string_view section, std::string_view key, double value);
bool WriteParamString(std::string_view path, std::string_view section, std::string_view key,
                      std::string_view value);

// Forgets the last parameter file written or reported: the next failure of any file is reported.
void ResetParamErrorMemory();

// --- Formatting and messages ----------------------------------------------------------------------------

// The value with that many decimals, as "%.<decimals>f" formats it; a negative number of decimals formats
// with "%g". Always with a '.', whatever the user's locale.
std::string FormatDecimals(double value, int decimals);

// A message box captioned "PYRALIS", on the parent front end when one is given, else on the
// application's own. Parameter-file messages take the warning icon, registry messages the error icon.
void ShowParamMessage(ui::FrontEnd* parent, std::string_view text, int icon = ui::kIconWarning);
// The same for a failure of something asked for (a value not written): the command running then ends on
// a failure status.
void ReportParamFailure(ui::FrontEnd* parent, std::string_view text, int icon = ui::kIconWarning);

// --- The parameter-file object ----------------------------------------------------------------------------

// A parameter path held by a dialog, with the reads and writes on it. A default-constructed one holds
// the null path.
class CParamFile {
public:
    CParamFile() = default;
    explicit CParamFile(std::string path) : path_(std::move(path)) {}

    std::string_view Path() const { return path_ ? std::string_view(*path_) : kNullParamPath; }
    bool IsRegistry() const { return IsRegistryParamPath(Path()); }

    bool ReadString(std::string_view section, std::string_view key, std::string_view defaultValue,
                    std::string& result) const {
        return ReadParamString(Path(), section, key, defaultValue, result);
    }
    bool ReadString(std::string_view section, std::string_view key, std::string& value) const {
        return ReadParamString(Path(), section, key, value);
    }
    bool ReadInt(std::string_view section, std::string_view key, int defaultValue, int minimum, int maximum,
                 int& result) const {
        return ReadParamInt(Path(), section, key, defaultValue, minimum, maximum, result);
    }
    bool ReadDouble(std::string_view section, std::string_view key, double defaultValue, double minimum,
                    double maximum, double& result) const {
        return ReadParamDouble(Path(), section, key, defaultValue, minimum, maximum, result);
    }

    bool WriteBool(std::string_view section, std::string_view key, unsigned char value) const {
        return WriteParamBool(Path(), section, key, value);
    }
    bool WriteInt(std::string_view section, std::string_view key, int value) const {
        return WriteParamInt(Path(), section, key, value);
    }
    bool WriteDouble(std::string_view section, std::string_view key, double value) const {
        return WriteParamDouble(Path(), section, key, value);
    }
    bool WriteString(std::string_view section, std::string_view key, std::string_view value) const {
        return WriteParamString(Path(), section, key, value);
    }

private:
    std::optional<std::string> path_;
};

} // namespace pyr
