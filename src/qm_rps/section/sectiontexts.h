// Words of the section calculator: why there is no answer, what governs, how a curve ends.
#pragma once

#include "qm_rps/section/sectioncurves.h"

/// Why the calculator refused the section or the request.
std::string SectionErrorText(const solver::T_SECTION_ERROR& error, const T_UNITS& units);

/// "concrete crushes", "bar 3, tension"; "-" for None.
std::string FibreText(const solver::T_FIBRE& fibre);

std::string CurvatureEndText(const T_SECTION_CURVATURE& curvature);

/// "characteristic values, parabola-rectangle of EN 1992-1-1".
std::string SectionOptionsText(const T_SECTION_ANSWER& answer);
