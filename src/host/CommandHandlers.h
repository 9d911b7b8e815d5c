#pragma once

#include "host/CommandTable.h"

// The handlers of the commands. Each runs the common flow of a command (CommandFlow.h) around its
// dialog.
namespace pyr::host {

// "PyrCalTopo15": shows the toolbar of the application again.
void OnShowToolbar(const CommandEntry& command);
// "GeoEdit" and "GeoEdit2": the GéoBase editor.
void OnGeoEdit(const CommandEntry& command);
// "CalcOpt": the options sheet of the calculations.
void OnCalcOpt(const CommandEntry& command);
// "CalculV0": the orientation of stations.
void OnCalculV0(const CommandEntry& command);
// "CalInter": a point by intersection.
void OnCalInter(const CommandEntry& command);
// "CalRelev": a station by resection.
void OnCalRelev(const CommandEntry& command);
// "CalRecou": a station by the combined method.
void OnCalRecou(const CommandEntry& command);
// "CalExcen": an eccentric station.
void OnCalExcen(const CommandEntry& command);
// "CalRayon": the radiated points.
void OnCalRayon(const CommandEntry& command);
void OnCalChem(const CommandEntry& command);
// "CalNivSm": levelling runs, simple.
void OnCalNivSm(const CommandEntry& command);
// "CalNivSt": levelling runs by double station.
void OnCalNivSt(const CommandEntry& command);
// The eleven readings of field books, told apart by their local name: each converts a field book of its
// format into a GéoBase.
void OnReadFieldBook(const CommandEntry& command);
// The eight exports of a GéoBase, told apart by their local name.
void OnExport(const CommandEntry& command);
// "CalTabCode": the table of codes, which needs the scale services too.
void OnTabCode(const CommandEntry& command);
// A command whose dialog this version does not have yet.
void OnPending(const CommandEntry& command);

// Whether the command's handler does its work in this version, rather than saying it is not available.
bool CommandAvailable(const CommandEntry& command);

} // namespace pyr::host
