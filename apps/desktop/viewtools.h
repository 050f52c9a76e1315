// What can be done with the view of the frame: hide and show parts, fit, perspective.
#pragma once

#include "command.h"
#include "framepane.h"
#include "windowpictures.h"

/// The context menu of the view at a place of the screen.
void ShowViewMenu(CFramePane& pane, QPoint global);
/// Its commands for a menu. The pane must outlive them.
T_COMMANDS ViewPartCommands(CFramePane& pane, const char* menu);
std::vector<T_WINDOW_EXAMPLE> ViewWindowExamples();
