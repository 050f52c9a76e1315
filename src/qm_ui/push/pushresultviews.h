// Windows of a push: its run, its hinges by step, its storeys.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterPushRunView(CViewFactory& factory);
void RegisterPushResultViews(CViewFactory& factory);
