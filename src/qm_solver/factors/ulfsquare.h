// Smallest weighted square sum, and whether there is any solution at all.
#pragma once

#include "qm_solver/factors/ulfactiveset.h"
#include "qm_solver/factors/ulfanswer.h"

/// Objective 2. Equalities are met first, then the inequalities, then the signs: the stage that
/// fails is the code (5, 6, 7), and it does not depend on the objective, so that the other
/// objectives ask here why they have no solution.
T_ULF_ANSWER SolveUlfSquare(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled);

/// Adds sign * y >= 0 for every unknown; nothing where the sign is free.
void AddUlfSigns(const T_ULF_SCALED& scaled, T_ULF_ROWS& rows);
