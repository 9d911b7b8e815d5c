#include "ui/DialogModel.h"

#include "core/Strings.h"

namespace pyr::ui {

namespace {

constexpr const char* kMsgNotZeroOrOne = "--%s : 0 ou 1 attendu, et non « %s ».";

} // namespace

void DialogOptions::Value(std::string name, std::string valueName, std::string help, Apply apply,
                          bool repeatable) {
    // An option without a value name would read as a switch: it takes a value, so it gets a name.
    if (valueName.empty()) valueName = "VALEUR";
    m_options.push_back(
        {std::move(name), std::move(valueName), std::move(help), repeatable, std::move(apply)});
}

void DialogOptions::OptionalValue(std::string name, std::string valueName, std::string help, Apply apply) {
    Value(std::move(name), std::move(valueName), std::move(help), std::move(apply));
    m_options.back().optional = true;
}

void DialogOptions::ZeroOrOne(std::string name, std::string help, std::function<void(bool)> set) {
    Apply apply = [name, set = std::move(set)](const std::string& value) {
        if (value != "0" && value != "1") return Sprintf(kMsgNotZeroOrOne, name.c_str(), value.c_str());
        set(value == "1");
        return std::string();
    };
    Value(std::move(name), "0|1", std::move(help), std::move(apply));
}

void DialogOptions::Switch(std::string name, std::string help, std::function<std::string()> action) {
    Apply apply = [action = std::move(action)](const std::string&) {
        return action ? action() : std::string();
    };
    m_options.push_back({std::move(name), std::string(), std::move(help), false, std::move(apply)});
}

} // namespace pyr::ui
