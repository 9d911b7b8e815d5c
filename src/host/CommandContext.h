#pragma once

#include <string>

namespace pyr::host {

// The state of the working drawing around a command: on opening, the host variables that a command
// must leave as it found them are recorded, the command echo and the UCS following are turned off and
// dialogs take the module's resources; closing puts everything back.
class CCmdContext {
public:
    CCmdContext() = default;
    ~CCmdContext() { Close(); }
    CCmdContext(const CCmdContext&) = delete;
    CCmdContext& operator=(const CCmdContext&) = delete;

    // Records the drawing's state on the first opening only.
    void Open();
    void Close();
    bool IsOpen() const { return m_open; }

    // What was recorded ("CLAYER", "AFLAGS", "UCSFOLLOW", "DWGPREFIX", "DWGNAME", "CMDECHO").
    const std::string& Recorded(const char* variable) const;

private:
    struct Variable {
        const char* name;
        bool restored; // DWGPREFIX and DWGNAME say where the drawing is: read, never written
        std::string value;
        bool known = false;
    };

    bool m_recorded = false;
    bool m_open = false;
    Variable m_variables[6] = {{"CLAYER", true, {}},     {"AFLAGS", true, {}},   {"UCSFOLLOW", true, {}},
                               {"DWGPREFIX", false, {}}, {"DWGNAME", false, {}}, {"CMDECHO", true, {}}};
};

} // namespace pyr::host
