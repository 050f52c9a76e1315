// View of the window in which stays are tuned.
#pragma once

#include "qm_ui/factors/ulfviewparts.h"

void RegisterUlfTuningView(CViewFactory& factory, const T_ULF_HOOKS& hooks);
