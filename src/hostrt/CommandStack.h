#pragma once

#include "hostrt/AcRx.h"

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

// Command flags.
inline constexpr std::int32_t ACRX_CMD_MODAL = 0;
inline constexpr std::int32_t ACRX_CMD_TRANSPARENT = 1;

using AcRxFunctionPtr = std::function<void()>;

struct AcEdCommand {
    std::string group;
    std::string globalName;
    std::string localName;
    std::int32_t flags = ACRX_CMD_MODAL;
    AcRxFunctionPtr handler;
};

// The host's commands, in registration order. Names are compared without regard to case, as a person
// types them.
class AcEdCommandStack : public AcRxObject {
public:
    // False (and nothing added) when the group already holds a command of that global or local name, or
    // when a name is empty.
    bool addCommand(std::string_view group, std::string_view globalName, std::string_view localName,
                    std::int32_t flags, AcRxFunctionPtr handler);
    // Removes every command of the group; false when it had none.
    bool removeGroup(std::string_view group);

    const AcEdCommand* lookupGlobalCmd(std::string_view name) const;
    const AcEdCommand* lookupLocalCmd(std::string_view name) const;
    // By global name first, then by local name.
    const AcEdCommand* lookupCmd(std::string_view name) const;

    // Runs the command of that name (global or local); false when there is none.
    bool runCommand(std::string_view name) const;

    const std::vector<AcEdCommand>& commands() const { return m_commands; }

private:
    std::vector<AcEdCommand> m_commands;
};
