// The desktop's tools of the push: its run, and the windows on its results.
#pragma once

#include "command.h"
#include "desktop.h"
#include "windowpictures.h"

void RegisterPushViews(CViewFactory& factory);
/// Commands in the order of the menu. The desktop must outlive them.
T_COMMANDS PushCommands(T_DESKTOP& desktop);
/// Pushes what can be pushed in the window of the push, then shows the hinges of the first result.
void PushAtOnce(T_DESKTOP& desktop);
std::vector<T_WINDOW_EXAMPLE> PushWindowExamples();
