// What the evaluation window draws: the chosen evaluation, or the ticked ones in one plot.
#pragma once

#include "qm_rps/evaluationdeskdlg.h"
#include "qm_ui/plot/plotdata.h"

/// On the axes that the person has set, else on the region of demand and points.
T_PLOT DeskPlot(CEvaluationDeskDlg& desk);
