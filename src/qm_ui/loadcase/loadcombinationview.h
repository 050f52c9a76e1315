// Window of a load combination.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterLoadCombinationView(CViewFactory& factory);
