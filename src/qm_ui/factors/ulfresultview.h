// Windows of the result of unknown load factors and of its explanation.
#pragma once

#include "qm_ui/factors/ulfviewparts.h"

void RegisterUlfResultViews(CViewFactory& factory, const T_ULF_HOOKS& hooks);
