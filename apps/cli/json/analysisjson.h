// Results of linear analysis as JSON.
#pragma once

#include "analysis/analysisresults.h"

#include <string>

using T_ACCURACY_BY_NAME = std::vector<std::pair<std::string, T_LOST_DIGITS>>;

/// Writes {"displacements": {CASE: {NODE: [6]}}, "reactions": ..., "truss": {CASE: {ELEMENT: N}},
/// "beam": {CASE: {ELEMENT: [[6] at I, 1/4, 2/4, 3/4, J]}}, "modes": [...]}; cases in the order
/// given, ids ascending, numbers in their shortest form.
/// Where load cases lost digits also "accuracy": {CASE: {"unrefined", "error"}}, estimated relative
/// errors of the displacements before and after refinement; the name of all stages is "".
/// With stages also "stages": {STAGE: {"step": N, "load": LOAD, "elements": number that stand,
/// "displacements": {NODE: [6]}, "reactions": ..., "truss": ..., "beam": ...}}, of what stands.
std::string AnalysisJson(const std::vector<T_SHOWN_CASE>& shown,
                         const std::vector<T_CASE_RESULTS>& results,
                         const std::vector<T_MODE_RESULTS>& modes,
                         const std::vector<T_SHOWN_STAGE>& stages,
                         const T_ACCURACY_BY_NAME& accuracy);
