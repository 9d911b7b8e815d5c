#include "hostrt/CommandStack.h"

#include "core/Strings.h"

#include <algorithm>

using pyr::EqualIgnoringCase;

bool AcEdCommandStack::addCommand(std::string_view group, std::string_view globalName,
                                  std::string_view localName, std::int32_t flags, AcRxFunctionPtr handler) {
    if (group.empty() || globalName.empty() || localName.empty()) return false;
    for (const AcEdCommand& command : m_commands)
        if (EqualIgnoringCase(command.group, group) && (EqualIgnoringCase(command.globalName, globalName) ||
                                                        EqualIgnoringCase(command.localName, localName)))
            return false;
    m_commands.push_back(
        {std::string(group), std::string(globalName), std::string(localName), flags, std::move(handler)});
    return true;
}

bool AcEdCommandStack::removeGroup(std::string_view group) {
    const auto removed = std::erase_if(
        m_commands, [&](const AcEdCommand& command) { return EqualIgnoringCase(command.group, group); });
    return removed > 0;
}

const AcEdCommand* AcEdCommandStack::lookupGlobalCmd(std::string_view name) const {
    for (const AcEdCommand& command : m_commands)
        if (EqualIgnoringCase(command.globalName, name)) return &command;
    return nullptr;
}

const AcEdCommand* AcEdCommandStack::lookupLocalCmd(std::string_view name) const {
    for (const AcEdCommand& command : m_commands)
        if (EqualIgnoringCase(command.localName, name)) return &command;
    return nullptr;
}

const AcEdCommand* AcEdCommandStack::lookupCmd(std::string_view name) const {
    if (const AcEdCommand* command = lookupGlobalCmd(name)) return command;
    return lookupLocalCmd(name);
}

bool AcEdCommandStack::runCommand(std::string_view name) const {
    const AcEdCommand* command = lookupCmd(name);
    if (!command || !command->handler) return false;
    // A copy: the handler may add or remove commands while it runs.
    const AcRxFunctionPtr handler = command->handler;
    handler();
    return true;
}
