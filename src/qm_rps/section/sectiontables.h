// The results of a section as tables: what text, sheet and window show.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/section/sectioncurves.h"

/// One row for each state: a capacity; yield, ultimate and idealisation of a moment-curvature. None
/// of an interaction and a surface.
T_TEXT_TABLE SectionStates(const T_SECTION_ANSWER& answer, const T_UNITS& units);

/// The points of the curves. None of capacities.
T_TEXT_TABLE SectionPoints(const T_SECTION_ANSWER& answer, const T_UNITS& units);

/// "characteristic values, ...": what stands above the tables; strengths, then warnings, a line
/// each.
std::vector<std::string> SectionHead(const T_SECTION_ANSWER& answer, const T_UNITS& units);
