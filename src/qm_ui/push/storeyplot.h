// Pictures of a push by storey: a value over the height.
#pragma once

#include "qm_rps/pushoverstoreydlg.h"
#include "qm_ui/plot/plotdata.h"

/// Displacements are joined from the ground up; drifts and shears are constant over a storey.
T_PLOT StoreyPlot(const CPushOverStoreyDlg& shown, STOREY_VALUE value);
