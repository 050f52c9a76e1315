// The picture of a section's results.
#pragma once

#include "qm_rps/section/sectioncurves.h"
#include "qm_ui/plot/plotdata.h"

/// Moment-curvature with yield, ultimate and idealisation; moments over axial forces with their
/// extremes; contours My-Mz at axial forces; capacities as points My-Mz.
T_PLOT SectionPlot(const T_SECTION_ANSWER& answer, const T_UNITS& units);
