// The numerical problem of unknown load factors, as its solver and its diagnosis take it.
#pragma once

#include <cstddef>
#include <span>

/// Find the factors x with row * x = rhs for the first nEq rows, row * x <= rhs for the others,
/// and sign * x >= 0, that make the objective smallest. The arrays belong to the caller and must
/// live as long as the problem is used.
struct T_ULF_PROBLEM {
    int nVar = 0;                         // unknown load factors
    int nEq = 0;                          // equalities; they stand before the inequalities
    std::span<const double> coefficients; // rhs.size() x nVar, row after row
    std::span<const double> rhs;
    std::span<const double> weights; // nVar, one per unknown, not negative
    int objective = 2;               // 1 sum of |w x|, 2 sum of (w x)^2, 3 the largest |w x|
    int sign = 0;                    // 1 no factor negative, -1 no factor positive, 0 free

    std::size_t Rows() const { return rhs.size(); }
    std::span<const double> Row(std::size_t i) const
    {
        return coefficients.subspan(i * static_cast<std::size_t>(nVar),
                                    static_cast<std::size_t>(nVar));
    }
};

/// Outcome of the solver; the numbers are those that its caller reads.
enum ULF_CODE : int {
    ULF_UNKNOWN_OBJECTIVE = -1,
    ULF_SOLVED = 0,
    ULF_BAD_INPUT = 4, // no unknowns, sizes that do not fit, NaN, negative weight
    ULF_EQUALITIES_CONTRADICT = 5,
    ULF_NO_SOLUTION = 6,     // equalities and inequalities together
    ULF_OTHER_SIGN_ONLY = 7, // only without the sign restriction
    ULF_ITERATION_LIMIT = 8,
    ULF_RELAXED = 9,        // solved, a constraint is met only within kUlfRelaxedTol
    ULF_NOT_CERTIFIED = 10, // an answer was found but not proved: it is not given
};

// Tolerances. Rows are compared after scaling (factors/ulfscaling.h): y = m x, each row divided by
// the 2-norm that it then has, right-hand sides divided by the largest one that x = 0 fails to
// meet. They are relative to the larger of 1 and the 2-norm of y, the solution in the same scale.
constexpr double kUlfFeasibleTol = 1e-11;  // violation of a row that counts as met
constexpr double kUlfRelaxedTol = 1e-8;    // violation that is still an answer, with code 9
constexpr double kUlfStationaryTol = 1e-9; // gradient of the Lagrangian
constexpr double kUlfGapTol = 1e-9;        // difference of primal and dual objective
constexpr double kUlfRankTol = 1e-12;      // pivots below this part of the largest are zero
constexpr double kUlfUnmetTol = 1e-6;      // an equation of exact mode that is not met
constexpr double kUlfFreeWeight = 1e-3;    // stands for a zero weight, see below
constexpr double kUlfSpread = 1e3;         // of what the rows feel of the unknowns, by weight

// A zero weight: the unknown is free and has no part in any objective. Which of several optima is
// given: the one with the smallest sum of (w x)^2, in which a zero weight counts as kUlfFreeWeight
// times the smallest positive one (all weights zero: all count 1).

/// 1 when the problem can be used: sizes fit, sign is -1, 0 or 1, everything is finite and no
/// weight is negative. 0 otherwise.
[[nodiscard]] int CheckUlfProblem(const T_ULF_PROBLEM& problem);
