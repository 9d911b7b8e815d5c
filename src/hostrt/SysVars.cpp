#include "hostrt/SysVars.h"

#include "core/Strings.h"

#include <charconv>
#include <filesystem>
#include <vector>

namespace {

struct SysVar {
    std::string name;
    std::string value;
    pyr::SysVarKind kind;
};

std::vector<SysVar> StandardSysVars() {
    using pyr::SysVarKind;
    std::error_code error;
    std::string prefix = std::filesystem::current_path(error).string();
    if (prefix.empty() || prefix.back() != '/') prefix += '/';
    return {
        {"CMDECHO", "1", SysVarKind::Integer},   {"UCSFOLLOW", "0", SysVarKind::Integer},
        {"CLAYER", "0", SysVarKind::Text},       {"AFLAGS", "0", SysVarKind::Integer},
        {"DWGPREFIX", prefix, SysVarKind::Text}, {"DWGNAME", "Dessin1.dwg", SysVarKind::Text},
    };
}

std::vector<SysVar>& SysVars() {
    static std::vector<SysVar> vars = StandardSysVars();
    return vars;
}

SysVar* Find(std::string_view name) {
    for (SysVar& var : SysVars())
        if (pyr::EqualIgnoringCase(var.name, name)) return &var;
    return nullptr;
}

bool IsWholeNumber(std::string_view text) {
    int number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    return error == std::errc() && end == text.data() + text.size();
}

} // namespace

int acedGetVar(std::string_view name, std::string& value) {
    const SysVar* var = Find(name);
    if (!var) return RTERROR;
    value = var->value;
    return RTNORM;
}

int acedSetVar(std::string_view name, std::string_view value) {
    SysVar* var = Find(name);
    if (!var) return RTERROR;
    if (var->kind == pyr::SysVarKind::Integer && !IsWholeNumber(value)) return RTERROR;
    var->value = value;
    return RTNORM;
}

namespace pyr {

void DefineSysVar(std::string_view name, std::string_view value, SysVarKind kind) {
    if (SysVar* var = Find(name)) {
        var->value = value;
        var->kind = kind;
        return;
    }
    SysVars().push_back({std::string(name), std::string(value), kind});
}

void ResetSysVars() {
    SysVars() = StandardSysVars();
}

} // namespace pyr
