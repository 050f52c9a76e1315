// The optimising methods behind one door.
#pragma once

#include "qm_solver/factors/ulfanswer.h"

/// Solves a problem that has passed CheckUlfProblem by the method of its objective. Codes -1, 0
/// and 5 to 10.
T_ULF_ANSWER SolveUlf(const T_ULF_PROBLEM& problem);

/// Whether there is any solution: code 0, 5 to 7 with the rows that contradict each other, or 8 to
/// 10 where neither could be shown (9: met within kUlfRelaxedTol). The objective does not matter.
T_ULF_ANSWER MeetUlf(const T_ULF_PROBLEM& problem);
