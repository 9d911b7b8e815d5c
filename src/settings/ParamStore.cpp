#include "ParamStore.h"

#include "ConfigPaths.h"
#include "IniFileStore.h"
#include "RegistryStore.h"
#include "SettingsMessages.h"
#include "SettingsText.h"
#include "core/Files.h"
#include "core/Numbers.h"
#include "core/Strings.h"

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <system_error>

namespace pyr {

namespace {

// The last parameter file written or reported, one for the process; every command runs in the host's one
// thread, so it needs no lock. A null path is remembered as such, distinct from the empty name the memory
// starts with.
struct RememberedFile {
    bool null = false;
    std::string name;
};

RememberedFile& LastParamFile() {
    static RememberedFile last;
    return last;
}

bool IsRemembered(std::string_view path) {
    const RememberedFile& last = LastParamFile();
    if (path.data() == nullptr) return last.null;
    return !last.null && EqualIgnoringCase(path, last.name);
}

void Remember(std::string_view path) {
    RememberedFile& last = LastParamFile();
    last.null = path.data() == nullptr;
    last.name.assign(path.data() ? path : std::string_view());
}

bool PathExists(const std::string& path) {
    std::error_code error;
    return std::filesystem::exists(path, error);
}

// What the store delivers for a read. A file delivers the stored text or else the default, cut to the
// file buffer, as the file reader copies either into it; the registry delivers only a stored text.
struct Delivery {
    bool registry = false;
    bool found = false;
    std::string text;
};

Delivery ReadFromStore(std::string_view path, std::string_view section, std::string_view key,
                       std::string_view defaultValue) {
    Delivery delivery;
    if (IsRegistryParamPath(path)) {
        delivery.registry = true;
        delivery.found = ReadRegistryValue(path, section, key, delivery.text, /*report*/ false);
        return delivery;
    }
    if (!path.empty()) {
        IniFile file;
        delivery.found =
            LoadParamFileToRead(file, std::string(path)) == 0 && file.Get(section, key, delivery.text);
    }
    if (!delivery.found) delivery.text.assign(defaultValue);
    CutToValueBuffer(delivery.text, kFileValueBuffer);
    return delivery;
}

// The text a typed read converts: what the store delivered, else (registry) the default text. Returns
// whether the store delivered any characters.
bool ReadNumberText(std::string_view path, std::string_view section, std::string_view key,
                    const std::string& defaultText, std::string& text) {
    Delivery delivery = ReadFromStore(path, section, key, defaultText);
    if (delivery.registry && !delivery.found) {
        text = defaultText;
        return false;
    }
    text = std::move(delivery.text);
    return !text.empty();
}

// Writes one value into a file. Returns 0 or the errno of the failure.
int WriteFileValue(std::string_view path, std::string_view section, std::string_view key,
                   std::string_view value) {
    if (path.data() == nullptr || key.empty()) return EINVAL;
    if (path.empty()) return ENOENT;
    const std::string name(path);
    IniFile file;
    if (const int code = LoadParamFileToWrite(file, name); code != 0 && code != ENOENT)
        return code; // a file that cannot be read is never written over
    file.Set(section, key, value);
    return file.Save(name);
}

void ReportFileFailure(std::string_view path, std::string_view key, int code) {
    std::string text;
    if (path.data() == nullptr) {
        text = Sprintf(kMsgParamFileNullName, code);
    } else if (path.empty()) {
        text = Sprintf(kMsgParamFileNoName, code);
    } else {
        const std::string name(path);
        text = Sprintf(PathExists(name) ? kMsgParamFileSaveFailed : kMsgParamFileMissing, name.c_str(), code);
        // The refusal of an empty key is ours: the system's words for its code would not fit it.
        const std::string cause = key.empty() ? std::string(kCauseNoKeyName) : SystemErrorText(code);
        text += Sprintf(kMsgFailureCause, cause.c_str());
    }
    ReportParamFailure(nullptr, text, ui::kIconWarning);
}

bool WriteText(std::string_view path, std::string_view section, std::string_view key,
               std::string_view value) {
    if (IsRegistryParamPath(path)) return WriteRegistryValue(path, section, key, value, /*report*/ true);
    const int code = WriteFileValue(path, section, key, value);
    if (code == 0) {
        Remember(path);
        return true;
    }
    if (!IsRemembered(path)) {
        ReportFileFailure(path, key, code);
        Remember(path);
    }
    return false;
}

} // namespace

bool IsRegistryParamPath(std::string_view path) {
    return RegistryRootFromName(path).has_value();
}

std::string DefaultParamFilePath() {
    if (const char* path = std::getenv("PYRALIS_PARAMS"); path && *path) return path;
    return (std::filesystem::path(PyralisConfigFolder()) / "Pyralis.ini").string();
}

bool ReadParamString(std::string_view path, std::string_view section, std::string_view key,
                     std::string_view defaultValue, std::string& result) {
    Delivery delivery = ReadFromStore(path, section, key, defaultValue);
    if (delivery.registry) {
        result = delivery.found ? std::move(delivery.text) : std::string(defaultValue);
        return delivery.found;
    }
    result = std::move(delivery.text);
    return true;
}

bool ReadParamString(std::string_view path, std::string_view section, std::string_view key,
                     std::string& value) {
    const std::string defaultValue = value;
    return ReadParamString(path, section, key, defaultValue, value);
}

bool ReadParamInt(std::string_view path, std::string_view section, std::string_view key, int defaultValue,
                  int minimum, int maximum, int& result) {
    std::string text;
    const bool delivered = ReadNumberText(path, section, key, std::to_string(defaultValue), text);
    int value = LenientAtoi(text);
    if (value < minimum) value = minimum;
    if (value > maximum) value = maximum;
    result = value;
    return delivered;
}

bool ReadParamDouble(std::string_view path, std::string_view section, std::string_view key,
                     double defaultValue, double minimum, double maximum, double& result) {
    std::string text;
    const bool delivered = ReadNumberText(path, section, key, FormatFixed(defaultValue, 6), text);
    double value = LenientAtof(text);
    if (!(value >= minimum)) // not-a-number too
        value = minimum;
    if (value > maximum) value = maximum;
    result = value;
    return delivered;
}

bool WriteParamBool(std::string_view path, std::string_view section, std::string_view key,
                    unsigned char value) {
    return WriteText(path, section, key, std::to_string(static_cast<int>(value)));
}

bool WriteParamInt(std::string_view path, std::string_view section, std::string_view key, int value) {
    return WriteText(path, section, key, std::to_string(value));
}

bool WriteParamDouble(std::string_view path, std::string_view section, std::string_view key, double value) {
    return WriteText(path, section, key, FormatFixed(value, 6));
}

bool WriteParamString(std::string_view path, std::string_view section, std::string_view key,
                      std::string_view value) {
    return WriteText(path, section, key, value);
}

void ResetParamErrorMemory() {
    LastParamFile() = RememberedFile{};
}

std::string FormatDecimals(double value, int decimals) {
    return decimals < 0 ? FormatGeneral(value) : FormatFixed(value, decimals);
}

void ShowParamMessage(ui::FrontEnd* parent, std::string_view text, int icon) {
    ui::FrontEnd& frontEnd = parent ? *parent : ui::ApplicationFrontEnd();
    frontEnd.MessageBox(text, ui::kCaption, icon);
}

void ReportParamFailure(ui::FrontEnd* parent, std::string_view text, int icon) {
    ui::FrontEnd& frontEnd = parent ? *parent : ui::ApplicationFrontEnd();
    frontEnd.ReportFailure(text, icon);
}

} // namespace pyr
