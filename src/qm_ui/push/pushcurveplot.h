// Pictures of a push: base reaction over displacement.
#pragma once

#include "qm_rps/pushoverresultdlg.h"
#include "qm_rps/pushoverrundlg.h"
#include "qm_ui/plot/plotdata.h"

#include <span>

/// One curve through the steps of each run, from the state before its push on. Marked are the
/// points at which hinges reach B (they yield; of trilinear curves: crack) and C for the first
/// time: of a run alone all of them, with the exact path through its events; of several the first
/// ones. The first B has its hinge's name.
T_PLOT PushCurvePlot(std::span<const T_PUSH_RUN> runs, const T_UNITS& units,
                     const std::string& title);
/// The curves of a run as far as they have come; those with their events once it has ended.
T_PLOT GrowingCurvePlot(const CPushOverRunDlg& run);
/// The curve of the shown result, with its events and the shown step.
T_PLOT StepCurvePlot(const CPushOverResultDlg& shown);
