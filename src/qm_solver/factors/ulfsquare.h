// Smallest weighted square sum, and whether there is any solution at all.
#pragma once

#include "qm_solver/factors/ulfactiveset.h"
#include "qm_solver/factors/ulfanswer.h"

/// Objective 2. In the metric of the weights and without free unknowns that is the shortest y.
/// Elsewhere the square sum curves little or not at all along some unknowns, and the shortest y is
/// found again and again from the one before, with a metric between that of the weights and that of
/// the columns (proximal points: Rockafellar 1976), until the certificate holds. Free unknowns are
/// then made as short as the others allow.
T_ULF_ANSWER SolveUlfSquare(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                            ULF_PRECISION precision);

/// Whether there is any solution, and the shortest y. Equalities are met first, then the
/// inequalities, then the signs: the stage that fails is the code (5, 6, 7). It does not depend on
/// the objective. Code 0: `y` and `multipliers` of the shortest one, not certified.
T_ULF_ANSWER MeetUlf(const T_ULF_SCALED& scaled, ULF_PRECISION precision,
                     std::vector<long double>& y);

/// Adds sign * y >= 0 for every unknown; nothing where the sign is free.
void AddUlfSigns(const T_ULF_SCALED& scaled, T_ULF_ROWS& rows);
