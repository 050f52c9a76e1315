// Picture of an iterative analysis for pretension: factors and tolerance by iteration.
#pragma once

#include "qm_rps/factors/ulfiteration.h"
#include "qm_ui/plot/plotdata.h"

/// Both on one logarithmic axis, where a tolerance that falls by the same ratio in each iteration
/// is a straight line. Factors that are not above zero are not drawn, tolerances that are far below
/// the wanted one at a line that the notes name; notes have the last factors.
[[nodiscard]] T_PLOT IterationPlot(const std::string& item, const T_ULF_ITER_SETTINGS& settings,
                                   const std::vector<T_ULF_ITER_STEP>& history);
