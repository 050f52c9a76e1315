// The desktop's tools of the structure: sections and materials.
#pragma once

#include "command.h"
#include "desktop.h"
#include "windowpictures.h"

#include "qm_rps/desk/recordgrid.h"

void RegisterStructureViews(CViewFactory& factory);
/// Commands in the order of the menus. The desktop must outlive them.
T_COMMANDS StructureCommands(T_DESKTOP& desktop);
/// Opens the window of a record. False: the table is not one of these tools.
bool OpenStructureRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key);
std::vector<T_WINDOW_EXAMPLE> StructureWindowExamples();
