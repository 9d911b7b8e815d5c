#include "ui/DialogModel.h"

namespace pyr::ui {

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

void DialogOptions::Switch(std::string name, std::string help, std::function<std::string()> action) {
    Apply apply = [action = std::move(action)](const std::string&) {
        return action ? action() : std::string();
    };
    m_options.push_back({std::move(name), std::string(), std::move(help), false, std::move(apply)});
}

} // namespace pyr::ui
