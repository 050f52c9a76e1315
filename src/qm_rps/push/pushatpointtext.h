// The hinges at the points of an evaluation as text, in the chosen language.
#pragma once

#include "qm_rps/push/pushatpoint.h"

/// "elastic", "B-IO" ... "failed".
std::string PushStateText(PUSH_STATE state);
/// "performance point", "SD: demand".
std::string PointName(const T_PUSH_POINT& point);
/// Why a point has no values; empty: it has.
std::string WhyNot(AT_POINT found);

/// "12 J My"; "0.83 CP", "-" without a ratio.
std::string HingePlaceText(const T_PUSH_LAW_PLACE& place);
std::string HingeRatioText(const T_HINGE_AT_POINT& hinge);
/// The worst hinge of a point, and its largest drift with the storey; "-": there is none.
std::string WorstHingeText(const T_PUSH_AT_POINT& at);
std::string LargestDriftText(const T_PUSH_AT_POINT& at);
/// States that some point has.
using T_STATES_SEEN = std::array<bool, kPushStateNames.size()>;
T_STATES_SEEN StatesSeen(const T_HINGES_AT& hinges);

/// One line a point: displacement, components in each state that occurs, the worst hinge, the
/// largest drift. Empty where there is nothing to say.
std::string HingesAtTable(const T_HINGES_AT& hinges);
/// The same for a report, with the worst hinges and the storeys of every point.
std::string HingesAtReport(const T_HINGES_AT& hinges);
