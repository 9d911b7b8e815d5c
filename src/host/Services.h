#pragma once

#include "hostrt/AcRx.h"

#include <string>
#include <string_view>

namespace pyr::ui {
class FrontEnd;
}

// What the suite's services modules offer to the module, found in the host's service dictionary. The
// objects live in the services modules; the module only calls them.
namespace pyr::host {

// "PyralisMainServices r17.2", registered by "Pyr2000Srv.arx".
class CPyrMainServices : public AcRxObject {
public:
    // A module announces itself (with its configuration text) and takes its leave.
    virtual void RegisterModule(std::string_view appName, std::string_view configuration) = 0;
    virtual void UnregisterModule(std::string_view appName) = 0;
    virtual bool IsModuleRegistered(std::string_view appName) const = 0;

    // Dialogs take their resources from the module while a command runs, from the host otherwise.
    virtual void SwitchToModuleResources(std::string_view appName) = 0;
    virtual void RestoreHostResources() = 0;
    // The module whose resources are in use, empty for the host's.
    virtual std::string ResourceModule() const = 0;

    // The window that parents every dialog and message box: the host's front end.
    virtual ui::FrontEnd* GetParentWindow() = 0;

    // The toolbar of a menu group, installed for an application, shown or hidden.
    virtual bool InstallToolbar(std::string_view menuGroup, std::string_view appName) = 0;
    virtual void ShowToolbar(std::string_view menuGroup, bool show) = 0;
    virtual void RemoveToolbar(std::string_view menuGroup) = 0;
    virtual bool IsToolbarInstalled(std::string_view menuGroup) const = 0;
    virtual bool IsToolbarVisible(std::string_view menuGroup) const = 0;

    // The current parameter path (an initialisation file or a registry root).
    virtual std::string GetParamFilePath() const = 0;
    // The installation folder, ending with a separator: its "Config" folder holds the default settings
    // files of the formats.
    virtual std::string GetConfigFolder() const = 0;

    // The title of the command that runs: the caption of its dialogs and messages.
    virtual void SetCommandTitle(std::string_view title) = 0;
    virtual std::string CommandTitle() const = 0;
};

// "PyralisEchelleServices r17.2", registered by "PyrSrvEchelle15.arx": the drawing scale of the coded
// survey processing.
class CPyrEchelleServices : public AcRxObject {
public:
    // The denominator of the drawing scale (500 for 1/500).
    virtual int ScaleDenominator() const = 0;
    virtual void SetScaleDenominator(int denominator) = 0;
};

// What the module registers under kCommandTitlesName: the title of each of its commands, for a host
// that lists them.
class CPyrCommandTitles : public AcRxObject {
public:
    // The title of the command of that global name, empty when it has none.
    virtual std::string Title(std::string_view globalName) const = 0;
    // Whether this version does the command's work (the others say that it is not available yet): a
    // desktop host greys their buttons.
    virtual bool Available(std::string_view globalName) const = 0;
};

} // namespace pyr::host
