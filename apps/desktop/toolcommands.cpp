#include "toolcommands.h"

#include "hingetools.h"
#include "loadcasetools.h"
#include "newtools.h"
#include "pushovertools.h"
#include "pushtools.h"
#include "shell/shell.h"
#include "structuretools.h"
#include "ulftools.h"

#include "qm_ui/document/reportview.h"
#include "qm_ui/shell/preferencesview.h"

void RegisterViews(CViewFactory& factory)
{
    RegisterPushViews(factory);
    RegisterPushoverViews(factory);
    RegisterLoadCaseViews(factory);
    RegisterStructureViews(factory);
    RegisterHingeViews(factory);
    RegisterUlfViews(factory);
    RegisterReportView(factory);
    RegisterPreferencesView(factory);
    RegisterNewViews(factory);
}

T_COMMANDS ToolCommands(T_DESKTOP& desktop)
{
    T_COMMANDS all;
    for (const T_COMMANDS& part :
         {PushCommands(desktop), PushoverCommands(desktop), LoadCaseCommands(desktop),
          StructureCommands(desktop), HingeCommands(desktop), UlfCommands(desktop),
          PartCommands(desktop), ShellCommands(desktop)})
        all.insert(all.end(), part.begin(), part.end());
    return all;
}

bool OpenRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key)
{
    for (const auto open : {OpenPushoverRecord, OpenLoadCaseRecord, OpenStructureRecord,
                            OpenHingeRecord, OpenUlfRecord, OpenNewRecord})
        if (open(desktop, table, key)) return true;
    return false;
}
