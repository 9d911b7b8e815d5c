#pragma once

#include "host/CommandTable.h"

// The handlers of the commands. Each runs the common flow of a command (CommandFlow.h) around its
// dialog.
namespace pyr::host {

// "PyrCalTopo15": shows the toolbar of the application again.
void OnShowToolbar(const CommandSpec& command);
// "GeoEdit" and "GeoEdit2": the GéoBase editor.
void OnGeoEdit(const CommandSpec& command);
// "CalcOpt": the options sheet of the calculations.
void OnCalcOpt(const CommandSpec& command);
// The eight exports of a GéoBase, told apart by their title.
void OnExport(const CommandSpec& command);
// "CalTabCode": the table of codes, which needs the scale services too.
void OnTabCode(const CommandSpec& command);
// A command whose dialog this version does not have yet.
void OnPending(const CommandSpec& command);

} // namespace pyr::host
