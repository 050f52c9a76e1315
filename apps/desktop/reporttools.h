// The window of the report.
#pragma once

#include "command.h"
#include "desktop.h"
#include "windowpictures.h"

/// Opens the window; in the menu File.
T_COMMAND ReportCommand(T_DESKTOP& desktop);
std::vector<T_WINDOW_EXAMPLE> ReportWindowExamples();
