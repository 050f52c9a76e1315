// The hinges at the points of an evaluation as text, in the chosen language.
#pragma once

#include "qm_rps/push/pushatpoint.h"

/// "elastic", "B-IO" ... "failed".
std::string PushStateText(PUSH_STATE state);
/// "performance point", "SD: demand".
std::string PointName(const T_PUSH_POINT& point);
/// Why a point has no values; empty: it has.
std::string WhyNot(AT_POINT found);

/// One line a point: displacement, components in each state that occurs, the worst hinge, the
/// largest drift. Empty where there is nothing to say.
std::string HingesAtTable(const T_HINGES_AT& hinges);
/// The same for a report, with the worst hinges and the storeys of every point.
std::string HingesAtReport(const T_HINGES_AT& hinges);
