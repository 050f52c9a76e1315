// Least violation of contradictory rows.
#pragma once

#include "qm_solver/factors/ulfscaling.h"

/// Minimises the sum of squared violations of the scaled rows under the sign restriction, then
/// y * y among the minima.
/// Method: Newton's method on the piecewise quadratic sum with an exact line search, factors at
/// zero held while they push against their sign; then the dual active-set method with the rows
/// moved by what they are violated. 1 done; 0 no convergence, `y` as it was.
[[nodiscard]] int LeastViolation(const T_ULF_SCALED& scaled, std::vector<long double>& y);
