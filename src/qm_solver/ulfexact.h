// Simultaneous equations.
#pragma once

#include "qm_solver/ulfproblem.h"

#include <vector>

struct T_ULF_EXACT {
    std::vector<double> x;
    int rank = 0;
    std::vector<int> unmet; // rows that x misses by more than kUlfUnmetTol, ascending
};

/// Solves coefficients * x = rhs, every row taken as an equation.
/// Method: rows and unknowns equilibrated by powers of two, QR with column pivoting, rank at
/// kUlfRankTol, refined in long double. Singular and consistent: the solution with the smallest
/// weighted square sum. Contradictory: the smallest sum of squared row residuals, rows taken as
/// T_ULF_SCALED scales them, and among equals the smallest weighted square sum.
/// A row counts as met when its residual is at most kUlfUnmetTol times the larger of |rhs| and the
/// sum of |coefficient * factor| (and beyond rounding of the longest solution).
/// The problem must have passed CheckUlfProblem. 1 done; 0 the factors overflow, `out` as it was.
[[nodiscard]] int SolveUlfExact(const T_ULF_PROBLEM& problem, T_ULF_EXACT& out);
