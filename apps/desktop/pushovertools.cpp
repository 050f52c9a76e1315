#include "pushovertools.h"

void RegisterPushoverViews(CViewFactory&) {}

T_COMMANDS PushoverCommands(T_DESKTOP&)
{
    return {};
}

bool OpenPushoverRecord(T_DESKTOP&, EXPLORER_TABLE, int)
{
    return false;
}

std::vector<T_WINDOW_EXAMPLE> PushoverWindowExamples()
{
    return {};
}
