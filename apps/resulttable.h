// Results as short text tables for the terminal.
#pragma once

#include "qm_rps/pushevaluation.h"

#include <string>
#include <vector>

/// One line per evaluation, then limit states and outcomes.
std::string ResultTable(const std::vector<T_PUSH_EVALUATION>& results);

/// The trials of one evaluation, one line each.
std::string TraceTable(const T_PUSH_EVALUATION& e);

/// What a document holds: title, units, counts, load cases, evaluations, stored steps.
std::string InfoText(CDBDoc& doc);
