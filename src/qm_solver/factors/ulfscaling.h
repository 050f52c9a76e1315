// The problem in the scale in which all comparisons are made.
#pragma once

#include "qm_solver/ulfproblem.h"

#include <vector>

/// y = m x / rhsScale with a metric m; each row divided by the 2-norm of row / m, so that it has
/// unit length and mixed units disappear; the right-hand sides also divided by rhsScale, a power of
/// two near the largest right-hand side that y = 0 fails to meet. With unit rows no solution is
/// shorter than that, and a bound of 1e30 that means "none" does not drown the others.
struct T_ULF_SCALED {
    std::size_t nVar = 0, nCon = 0, nEq = 0;
    int sign = 0;
    std::vector<double> rows;         // nCon x nVar; a zero row stays zero
    std::vector<double> rhs;          // nCon
    std::vector<double> cost;         // nVar: weight / metric, 0 where the weight is zero
    std::vector<long double> rowNorm; // 1 for a zero row
    std::vector<long double> metric;  // positive
    long double rhsScale = 1.0L;
    bool isByWeight = true; // every cost is 0 or 1
};

/// In the metric of the weights (UlfWeights); where the rows feel some weighted unknowns
/// kUlfSpread times more than others, in that of UlfColumnSizes, so that unit loads of any size are
/// told from rounding. The problem must have passed CheckUlfProblem.
T_ULF_SCALED ScaleUlf(const T_ULF_PROBLEM& problem);
T_ULF_SCALED ScaleUlf(const T_ULF_PROBLEM& problem, std::vector<long double> metric);

/// How much the rows feel each unknown, when every row and every column is brought to a largest
/// entry of about 1, times a common factor that makes the costs 1 in the geometric mean of the
/// largest and the smallest. An unknown that no row feels has its weight (1 where that is zero).
std::vector<long double> UlfColumnSizes(const T_ULF_PROBLEM& problem);

/// The factors x of a scaled solution, rounded to double; what is only rounding, and what is past
/// the sign by less than a tolerance, becomes zero.
std::vector<double> UnscaleUlf(const T_ULF_SCALED& scaled, std::span<const long double> y);

/// The weights as the square sum counts them, all positive.
std::vector<long double> UlfWeights(std::span<const double> weights);
