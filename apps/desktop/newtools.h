// The desktop's tools that make models and parts of them.
#pragma once

#include "command.h"
#include "desktop.h"
#include "windowpictures.h"

#include "qm_rps/desk/recordgrid.h"

/// Property of the main window while a file that was dropped on it makes a new model: its path.
inline constexpr const char* kDroppedCurve = "droppedCurve";

void RegisterNewViews(CViewFactory& factory);
/// Commands in the order of the menu File. The desktop must outlive them.
T_COMMANDS NewCommands(T_DESKTOP& desktop);
/// Spectra and storeys, in the menus Pushover and Edit.
T_COMMANDS PartCommands(T_DESKTOP& desktop);
/// Opens the window of a record. False: the table is not one of these tools.
bool OpenNewRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key);
std::vector<T_WINDOW_EXAMPLE> NewWindowExamples();
