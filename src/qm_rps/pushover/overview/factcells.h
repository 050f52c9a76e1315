// Inputs and facts of an evaluation as one table: symbol, value, definition, clause, formula.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/pushover/pushevaluation.h"

/// One row for each; the title of a group stands in a row of its own. spectrum: the record of the
/// evaluation; null: there is none.
T_TEXT_TABLE FactCells(const T_PUSH_EVALUATION& e, const T_SPFC_D* spectrum);

/// What was asked for in one line: "Method ATC-40; Load case PX; ...".
std::string InputLine(const T_PUSH_EVALUATION& e, const T_SPFC_D* spectrum);
