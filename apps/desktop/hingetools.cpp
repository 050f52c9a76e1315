#include "hingetools.h"

void RegisterHingeViews(CViewFactory&) {}

T_COMMANDS HingeCommands(T_DESKTOP&)
{
    return {};
}

bool OpenHingeRecord(T_DESKTOP&, EXPLORER_TABLE, int)
{
    return false;
}

std::vector<T_WINDOW_EXAMPLE> HingeWindowExamples()
{
    return {};
}
