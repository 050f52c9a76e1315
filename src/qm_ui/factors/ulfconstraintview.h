// Windows of the constraints of unknown load factors: their list, one of them.
#pragma once

#include "qm_ui/factors/ulfviewparts.h"

void RegisterUlfConstraintViews(CViewFactory& factory);
