#include "ui/Dialog.h"

#include "core/Strings.h"
#include "ui/Form.h"

namespace pyr::ui {

namespace {

constexpr const char* kMsgNotZeroOrOne = "--%s : 0 ou 1 attendu, et non « %s ».";

} // namespace

void DialogOptions::Value(std::string name, std::string valueName, std::string help, Apply apply,
                          bool repeatable) {
    // An option without a value name would read as a switch: it takes a value, so it gets a name.
    if (valueName.empty()) valueName = "VALEUR";
    Option option;
    option.name = std::move(name);
    option.valueName = std::move(valueName);
    option.help = std::move(help);
    option.repeatable = repeatable;
    option.apply = std::move(apply);
    m_options.push_back(std::move(option));
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

void DialogOptions::Values(std::string name, std::vector<std::string> valueNames, std::string help,
                           ApplyValues apply) {
    std::string shown;
    for (const auto& valueName : valueNames)
        shown += (shown.empty() ? "" : " ") + valueName;
    const int count = static_cast<int>(valueNames.size());
    Value(std::move(name), std::move(shown), std::move(help), nullptr);
    m_options.back().count = count < 1 ? 1 : count;
    m_options.back().applyValues = std::move(apply);
}

void DialogOptions::Positional(std::string valueName, std::string help, Apply apply) {
    m_positionals.push_back({std::move(valueName), std::move(help), std::move(apply)});
}

void DialogOptions::Switch(std::string name, std::string help, std::function<std::string()> action) {
    Apply apply = [action = std::move(action)](const std::string&) {
        return action ? action() : std::string();
    };
    Option option;
    option.name = std::move(name);
    option.help = std::move(help);
    option.apply = std::move(apply);
    m_options.push_back(std::move(option));
}

std::unique_ptr<Form> Dialog::MakeForm() {
    return nullptr;
}

} // namespace pyr::ui
