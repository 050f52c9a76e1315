// The picture of an evaluation: capacity and demand spectra in ADRS with what the method found.
#pragma once

#include "qm_rps/pushevaluation.h"
#include "qm_ui/plotdata.h"

/// Capacity, elastic demand, reduced demand, locus, trials, performance point or limit states,
/// initial-stiffness and effective-period lines, with units, legend and results below.
T_PLOT EvaluationPlot(const T_PUSH_EVALUATION& e);
