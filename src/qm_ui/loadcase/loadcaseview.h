// Views of pushover load cases: the case itself, the list, the selection.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterLoadCaseForms(CViewFactory& factory);
