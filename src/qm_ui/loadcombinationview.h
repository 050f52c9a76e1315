// Window of a load combination.
#pragma once

#include "qm_ui/viewfactory.h"

void RegisterLoadCombinationView(CViewFactory& factory);
