// The hinges at the points of an evaluation as tables of a report.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/push/pushatpoint.h"

/// A row for each point: displacement, components in each state that occurs, the worst hinge, the
/// largest drift; or why there is nothing.
T_TEXT_TABLE PointCells(const T_HINGES_AT& hinges);
/// The worst hinges of every point that was reached, and the storeys there.
T_TEXT_TABLE WorstHingeCells(const T_HINGES_AT& hinges);
T_TEXT_TABLE StoreyCells(const T_HINGES_AT& hinges);
