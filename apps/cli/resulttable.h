// Results as short text tables for the terminal.
#pragma once

#include "qm_rps/pushover/evaluation/pushovercomparison.h"

#include <string>
#include <vector>

/// One line per evaluation, then limit states and outcomes.
std::string ResultTable(const std::vector<T_PUSH_EVALUATION>& results);

/// The trials of one evaluation, one line each.
std::string TraceTable(const T_PUSH_EVALUATION& e);

/// All methods side by side, with the spread.
std::string ComparisonTable(const T_PUSH_COMPARISON& c);
