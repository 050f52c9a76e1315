// Results of linear analysis as tables.
#pragma once

#include "analysis/resultchoice.h"

#include <string>

/// What the tables and the summary call it: stage "S1", step 2 of 3, sum, 12 elements.
std::string StageTitle(const T_SHOWN_STAGE& stage);

/// Tables of one load case, of what is chosen: displacements, reactions, truss and beam forces.
/// What is below 1e-12 of the largest displacement or force is rounding and is shown as 0.
std::string CaseTables(const T_SHOWN_CASE& shown, const T_CASE_RESULTS& results,
                       const T_RESULT_CHOICE& choice, const T_UNITS& units);
/// Smallest and largest values over the load cases, one component to a line, with the cases' names.
/// Rounding is left out as in the tables.
std::string EnvelopeTables(const std::vector<T_SHOWN_CASE>& shown,
                           const std::vector<T_CASE_RESULTS>& results,
                           const T_RESULT_CHOICE& choice, const T_UNITS& units);
/// The largest values of one load case, and the sum of the reactions.
std::string CaseSummary(const T_SHOWN_CASE& shown, const T_CASE_RESULTS& results,
                        const T_UNITS& units);
/// Periods, participation factors and effective masses.
std::string ModeTable(const std::vector<T_MODE_RESULTS>& modes);

/// "kN", "m", "kN*m".
std::string ForceName(const T_UNITS& units);
std::string LengthName(const T_UNITS& units);
std::string MomentName(const T_UNITS& units);
