// The picture of a comparison: every method's answer on one capacity spectrum.
#pragma once

#include "qm_rps/pushovercomparison.h"
#include "qm_ui/plotdata.h"

T_PLOT ComparisonPlot(const T_PUSH_COMPARISON& c);
