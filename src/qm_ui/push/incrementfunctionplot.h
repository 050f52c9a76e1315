// Picture of an increment function.
#pragma once

#include "qm_db/records.h"
#include "qm_ui/plot/plotdata.h"

/// Factor over step, from the origin; each stored step of the push is a whole number of steps.
T_PLOT IncrementFunctionPlot(const T_POFC_D& function);
