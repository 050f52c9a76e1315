// An evaluation in other units than those of the model: windows may show any.
#pragma once

#include "qm_rps/pushover/overview/evaluationentry.h"

/// The same result with lengths, forces and masses in these units; accelerations in g stay. Texts
/// of messages keep the units that they name.
T_PUSH_EVALUATION InUnits(T_PUSH_EVALUATION e, const T_UNITS& units);
