// Views of pushover load cases: the case itself, the list, the selection.
#pragma once

#include "qm_ui/viewfactory.h"

void RegisterLoadCaseForms(CViewFactory& factory);
