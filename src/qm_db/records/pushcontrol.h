// The control that a pushover load case is run with.
#pragma once

#include "qm_db/records.h"

/// The global control with what the load case has of its own. The initial loads of a case that
/// starts from the end of another one (`initialCase`) do not count: that one's stand.
inline T_POGC_D PushControlOf(const T_MODEL& model, const T_POLC_D& loadCase)
{
    T_POGC_D control = model.pushControl;
    if (loadCase.initialLoads) control.initialLoads = *loadCase.initialLoads;
    if (loadCase.pDelta) control.pDelta = *loadCase.pDelta;
    if (loadCase.steps) control.steps = *loadCase.steps;
    if (loadCase.onFailure) control.onFailure = *loadCase.onFailure;
    return control;
}
