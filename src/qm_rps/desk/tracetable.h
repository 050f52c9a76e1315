// The trace of numbers that a code gives, as a table of windows.
#pragma once

#include "qm_rps/codes/codesheet.h"
#include "qm_rps/dialog/texttable.h"

/// Symbol, value, unit, formula, clause, mark; a row for each line.
T_TEXT_TABLE TraceTable(const std::vector<T_CODE_TRACE>& trace, const T_UNITS& units);
