// The tools of the desktop: their commands, their views, and the windows of records.
#pragma once

#include "command.h"
#include "desktop.h"

#include "qm_rps/desk/recordgrid.h"

/// The views of every dialog model.
void RegisterViews(CViewFactory& factory);

/// Commands of every tool, in the order of the menus. The desktop must outlive them.
T_COMMANDS ToolCommands(T_DESKTOP& desktop);

/// Opens the window of a record of a table. False: it has none.
bool OpenRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key);
