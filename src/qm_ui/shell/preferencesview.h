// The view of the preferences.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterPreferencesView(CViewFactory& factory);
