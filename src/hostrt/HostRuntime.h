#pragma once

// Everything that a module may ask of its host.
#include "hostrt/AcRx.h"
#include "hostrt/CommandStack.h"
#include "hostrt/DynamicLinker.h"
#include "hostrt/FindFile.h"
#include "hostrt/MainWindow.h"
#include "hostrt/SysVars.h"
