#include "ulftools.h"

void RegisterUlfViews(CViewFactory&) {}

T_COMMANDS UlfCommands(T_DESKTOP&)
{
    return {};
}

bool OpenUlfRecord(T_DESKTOP&, EXPLORER_TABLE, int)
{
    return false;
}

std::vector<T_WINDOW_EXAMPLE> UlfWindowExamples()
{
    return {};
}
