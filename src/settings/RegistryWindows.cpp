// The registry form on Windows: the system registry. Texts are UTF-8 in the program and UTF-16 in the
// registry; the wide functions are used so that accented key and value names come through whole.
#ifdef _WIN32

#include "RegistryPlatform.h"

#define NOMINMAX
#define WIN32_LEAN_AND_MEAN
#include <cwchar>
#include <windows.h>

namespace pyr::registry_detail {

namespace {

HKEY RootKey(RegistryRoot root) {
    switch (root) {
    case RegistryRoot::LocalMachine:
        return HKEY_LOCAL_MACHINE;
    case RegistryRoot::CurrentUser:
        return HKEY_CURRENT_USER;
    case RegistryRoot::ClassesRoot:
        return HKEY_CLASSES_ROOT;
    case RegistryRoot::Users:
        return HKEY_USERS;
    case RegistryRoot::PerformanceData:
        return HKEY_PERFORMANCE_DATA;
    case RegistryRoot::CurrentConfig:
        return HKEY_CURRENT_CONFIG;
    case RegistryRoot::DynData:
        return HKEY_DYN_DATA;
    }
    return HKEY_CURRENT_USER;
}

std::wstring Widen(const std::string& utf8) {
    if (utf8.empty()) return {};
    const int size = MultiByteToWideChar(CP_UTF8, 0, utf8.data(), static_cast<int>(utf8.size()), nullptr, 0);
    std::wstring wide(static_cast<std::size_t>(size > 0 ? size : 0), L'\0');
    if (size > 0)
        MultiByteToWideChar(CP_UTF8, 0, utf8.data(), static_cast<int>(utf8.size()), wide.data(), size);
    return wide;
}

std::string Narrow(const std::wstring& wide) {
    if (wide.empty()) return {};
    const int size = WideCharToMultiByte(CP_UTF8, 0, wide.data(), static_cast<int>(wide.size()), nullptr, 0,
                                         nullptr, nullptr);
    std::string utf8(static_cast<std::size_t>(size > 0 ? size : 0), '\0');
    if (size > 0)
        WideCharToMultiByte(CP_UTF8, 0, wide.data(), static_cast<int>(wide.size()), utf8.data(), size,
                            nullptr, nullptr);
    return utf8;
}

} // namespace

Outcome ReadValue(RegistryRoot root, const std::string& keyPath, const std::string& name,
                  std::string& value) {
    HKEY key = nullptr;
    LONG rc = RegOpenKeyExW(RootKey(root), Widen(keyPath).c_str(), 0, KEY_READ, &key);
    if (rc != ERROR_SUCCESS) return {Step::Open, static_cast<int>(rc)};

    const std::wstring wideName = Widen(name);
    DWORD type = 0;
    DWORD size = 0;
    rc = RegQueryValueExW(key, wideName.c_str(), nullptr, &type, nullptr, &size);
    if (rc == ERROR_SUCCESS && type != REG_SZ && type != REG_EXPAND_SZ) rc = ERROR_UNSUPPORTED_TYPE;
    std::wstring text;
    if (rc == ERROR_SUCCESS) {
        // One more character than announced: a stored text need not end with its terminator.
        text.assign(size / sizeof(wchar_t) + 1, L'\0');
        DWORD got = static_cast<DWORD>(text.size() * sizeof(wchar_t));
        rc = RegQueryValueExW(key, wideName.c_str(), nullptr, &type, reinterpret_cast<BYTE*>(text.data()),
                              &got);
        if (rc == ERROR_SUCCESS) text.resize(wcsnlen(text.c_str(), got / sizeof(wchar_t)));
    }
    RegCloseKey(key);
    if (rc != ERROR_SUCCESS) return {Step::Query, static_cast<int>(rc)};
    value = Narrow(text);
    return {};
}

Outcome WriteValue(RegistryRoot root, const std::string& keyPath, const std::string& name,
                   const std::string& value) {
    const std::wstring widePath = Widen(keyPath);
    HKEY key = nullptr;
    LONG rc = RegOpenKeyExW(RootKey(root), widePath.c_str(), 0, KEY_ALL_ACCESS, &key);
    if (rc != ERROR_SUCCESS) {
        rc = RegCreateKeyExW(RootKey(root), widePath.c_str(), 0, nullptr, REG_OPTION_NON_VOLATILE,
                             KEY_ALL_ACCESS, nullptr, &key, nullptr);
        if (rc != ERROR_SUCCESS) return {Step::Create, static_cast<int>(rc)};
    }
    const std::wstring wideValue = Widen(value);
    rc = RegSetValueExW(key, Widen(name).c_str(), 0, REG_SZ, reinterpret_cast<const BYTE*>(wideValue.c_str()),
                        static_cast<DWORD>((wideValue.size() + 1) * sizeof(wchar_t)));
    RegCloseKey(key);
    if (rc != ERROR_SUCCESS) return {Step::Set, static_cast<int>(rc)};
    return {};
}

} // namespace pyr::registry_detail

#endif // _WIN32
