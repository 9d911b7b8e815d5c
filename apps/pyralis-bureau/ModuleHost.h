#pragma once

#include <string>
#include <vector>

namespace pyr::host {
class CPyrMainServices;
}

namespace pyr::bureau {

// One command of the module, as the window offers it.
struct CommandInfo {
    std::string globalName;
    std::string localName;
    std::string title;      // empty for the command that shows the toolbar again
    bool available = false; // false for a command this version does not have yet
};

// The module loaded as a CAD host loads it: found beside the program, loaded through the host runtime's
// dynamic linker, told that the drawing is open. Its commands are then run by name.
class ModuleHost {
public:
    ModuleHost() = default;
    ~ModuleHost() { Unload(); }
    ModuleHost(const ModuleHost&) = delete;
    ModuleHost& operator=(const ModuleHost&) = delete;

    // Loads the module from `programFolder`. False with the reason in Failure().
    bool Load(const std::string& programFolder);
    void Unload();
    const std::string& Failure() const { return m_failure; }

    // The module's commands in the order it registered them.
    std::vector<CommandInfo> Commands() const;
    // The command of that global or local name (case ignored), or null.
    bool IsCommand(const std::string& name) const;
    // Runs a command; false when there is none of that name.
    bool Run(const std::string& name) const;

    // The main services, once the module loaded them (null before).
    host::CPyrMainServices* Services() const;
    // The current parameter path, as the services give it to the commands.
    std::string ParamPath() const;
    // The GéoBase last used by a command ("Derniere").
    std::string LastGeoBase() const;

private:
    bool m_loaded = false;
    std::string m_failure;
};

} // namespace pyr::bureau
