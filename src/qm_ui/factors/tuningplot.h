// Deck of a structure whose load factors are tuned: displacements and moments, before and now.
#pragma once

#include "qm_rps/ulftuningdlg.h"
#include "qm_ui/plot/plotdata.h"

T_PLOT TuningDisplacementPlot(const CUlfTuningDlg& tuned);
T_PLOT TuningMomentPlot(const CUlfTuningDlg& tuned);
