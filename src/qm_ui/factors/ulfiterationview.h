// Windows of the iterative analysis for pretension: settings, run, result between iterations.
#pragma once

#include "qm_ui/factors/ulfviewparts.h"

void RegisterUlfIterationViews(CViewFactory& factory);
