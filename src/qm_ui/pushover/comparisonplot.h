// The picture of a comparison: every method's answer on one capacity spectrum.
#pragma once

#include "qm_rps/pushover/evaluation/pushovercomparison.h"
#include "qm_ui/plot/plotdata.h"

T_PLOT ComparisonPlot(const T_PUSH_COMPARISON& c);
