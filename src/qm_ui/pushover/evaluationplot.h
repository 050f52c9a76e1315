// The picture of an evaluation: capacity and demand spectra in ADRS with what the method found.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"
#include "qm_ui/plot/plotdata.h"

/// Capacity, elastic demand, reduced demand, locus, trials, performance point or limit states,
/// initial-stiffness and effective-period lines, with units, legend and results below.
T_PLOT EvaluationPlot(const T_PUSH_EVALUATION& e);

/// The demand spectrum alone, and the reduced one, over what the evaluation shows it.
T_PLOT DemandPlot(const T_PUSH_EVALUATION& e);

// Parts that other pictures of an evaluation share.
std::string PlotStepText(int step);
/// The load case; "PX (out of date)" where its results are older than the model.
std::string ShownPushName(const T_PUSH_EVALUATION& e);
std::string PlotSubtitle(const T_PUSH_EVALUATION& e);
/// Displacements of the further nodes, against the forces of the plotted curve.
void AddMonitoredNodes(T_PLOT& plot, const T_PUSH_EVALUATION& e);
/// The results below the picture.
void AddEvaluationNotes(T_PLOT& plot, const T_PUSH_EVALUATION& e);
