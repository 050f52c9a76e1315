// Windows of the unknown load factor items: their list, a static item, one of construction stages.
#pragma once

#include "qm_ui/factors/ulfviewparts.h"

void RegisterUlfItemViews(CViewFactory& factory, const T_ULF_HOOKS& hooks);
