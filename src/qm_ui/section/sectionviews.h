// The window with the curves of sections.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterSectionViews(CViewFactory& factory);
