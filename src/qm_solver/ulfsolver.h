// The optimising methods behind one door.
#pragma once

#include "qm_solver/factors/ulfanswer.h"

/// Solves a problem that has passed CheckUlfProblem by the method of its objective. Codes -1, 0
/// and 5 to 10.
T_ULF_ANSWER SolveUlf(const T_ULF_PROBLEM& problem);
