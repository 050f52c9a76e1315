#include "loadcasetools.h"

void RegisterLoadCaseViews(CViewFactory&) {}

T_COMMANDS LoadCaseCommands(T_DESKTOP&)
{
    return {};
}

bool OpenLoadCaseRecord(T_DESKTOP&, EXPLORER_TABLE, int)
{
    return false;
}

std::vector<T_WINDOW_EXAMPLE> LoadCaseWindowExamples()
{
    return {};
}
