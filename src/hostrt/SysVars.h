#pragma once

#include "hostrt/AcRx.h"

#include <string>
#include <string_view>

// The host's system variables, kept as text; names are compared without regard to case. The runtime
// starts with the standard ones: CMDECHO "1", UCSFOLLOW "0", CLAYER "0", AFLAGS "0", DWGPREFIX the
// current folder (with its final '/'), DWGNAME "Dessin1.dwg".

// RTERROR for a variable that the host does not have.
int acedGetVar(std::string_view name, std::string& value);
// RTERROR for a variable that the host does not have, or a text that is not a whole number for an
// integer variable.
int acedSetVar(std::string_view name, std::string_view value);

namespace pyr {

enum class SysVarKind { Text, Integer };

// Adds (or redefines) a variable of the host.
void DefineSysVar(std::string_view name, std::string_view value, SysVarKind kind = SysVarKind::Text);
// Back to the standard variables and their starting values only.
void ResetSysVars();

} // namespace pyr
