// Steps of a push at what its evaluations find.
#pragma once

#include "qm_rps/push/pushrun.h"

#include <span>

/// Displacements of the control node (m) at the performance points and targets of the evaluations
/// of a load case, to be steps of its push; its results must be those of the document. Empty where
/// the load case does not ask for them, was cancelled, or was pushed in several directions.
std::vector<double> StepsOfEvaluations(CDBDoc& doc, std::span<const T_PUSH_RUN> runs);
