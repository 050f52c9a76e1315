#include "toolcommands.h"

void RegisterViews(CViewFactory&) {}

T_COMMANDS ToolCommands(T_DESKTOP&)
{
    return {};
}

void OpenRecord(T_DESKTOP&, EXPLORER_TABLE, int) {}
