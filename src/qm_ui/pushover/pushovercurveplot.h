// The picture of the pushover curve window: an evaluation with what the person wants shown, on the
// axes of any plot type, with one trial pointed out.
#pragma once

#include "qm_rps/pushovercurveedit.h"
#include "qm_ui/plot/plotdata.h"

class CPushOverCurveDampParamUser;

/// The capacity spectrum picture, or the curve of another plot type on its own axes. trial: from 1;
/// 0 none.
T_PLOT PushoverCurvePlot(const T_PUSH_EVALUATION& e, const T_PUSH_SHOW& show, int trial);

/// The kappa of a person's own points over the hysteretic damping.
T_PLOT UserDampingPlot(const CPushOverCurveDampParamUser& points);
