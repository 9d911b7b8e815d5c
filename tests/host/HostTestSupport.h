#pragma once

// What the tests of the module share: the folder of the built programs and modules, a front end that
// notes the host's state while a dialog runs, and the services as the module sees them.
#include "TestSupport.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "hostrt/HostRuntime.h"
#include "ui/DialogModel.h"
#include "ui/ScriptedFrontEnd.h"

#include <string>

inline std::string ProgramFile(const char* name) {
    return std::string(PYR_PROGRAM_DIR) + "/" + name;
}

inline pyr::host::CPyrMainServices* RegisteredServices() {
    return static_cast<pyr::host::CPyrMainServices*>(
        acrxServiceDictionary()->at(pyr::host::kMainServicesName));
}

inline std::string SysVar(const char* name) {
    std::string value;
    acedGetVar(name, value);
    return value;
}

// The scripted front end, noting for each dialog what the host and the dialog looked like while it ran.
class RecordingFrontEnd : public pyr::ui::ScriptedFrontEnd {
public:
    struct Seen {
        std::string title;
        std::string geoBase;
        bool geoBaseNamed = false;
        std::string paramPath;
        std::string cmdecho;
        std::string ucsfollow;
        std::string resources;
    };
    std::vector<Seen> seen;
    std::string layerSetByDialog; // a dialog that changes the current layer, when not empty

    pyr::ui::DialogResult DoModal(pyr::ui::DialogModel& dialog) override {
        pyr::ui::DialogResult result = ScriptedFrontEnd::DoModal(dialog);
        Seen now{dialog.Inputs().title,
                 dialog.GeoBase(),
                 dialog.GeoBaseNamed(),
                 dialog.Inputs().paramPath,
                 SysVar("CMDECHO"),
                 SysVar("UCSFOLLOW"),
                 RegisteredServices() ? RegisteredServices()->ResourceModule() : std::string()};
        seen.push_back(now);
        if (!layerSetByDialog.empty()) acedSetVar("CLAYER", layerSetByDialog);
        return result;
    }
};
