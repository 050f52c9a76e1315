// Why unknown load factors are what they are, or why there are none.
#pragma once

#include "qm_solver/ulfproblem.h"

#include <functional>
#include <optional>
#include <vector>

/// A constraint at its limit and what moving the limit does.
struct T_ULF_HELD {
    int index = 0;           // row, or unknown for a sign
    double multiplier = 0.0; // change of the objective for a unit more of the limit
    /// The same of a row to each side, for a unit of the limit at first: where rows repeat each
    /// other, lowering one of them costs and raising it does not. Empty: no solution is left, or
    /// there are more than kUlfMostPriced rows.
    std::optional<double> raised{}, lowered{};
};
inline constexpr std::size_t kUlfMostPriced = 200;

/// The answer with what holds it. Objective: sum of |w x|, sum of (w x)^2 or largest |w x|.
struct T_ULF_EXPLANATION {
    std::vector<double> factors;
    double objective = 0.0;
    std::vector<T_ULF_HELD> rows;  // active rows: d objective / d rhs; never positive for <=
    std::vector<T_ULF_HELD> signs; // factors held at zero: d objective / d bound, for a bound of
                                   // sign * x >= bound; what is zero is left out
};

/// The influence matrix in the scale of ulfproblem.h (unknowns by weight, rows of unit length), so
/// that mixed units do not count; a zero weight counts as the smallest positive one.
struct T_ULF_MATRIX {
    int rank = 0;                       // singular values above kUlfRankTol times the largest
    double condition = 0.0;             // largest over smallest of those; 0 for a zero matrix
    std::vector<double> singularValues; // descending
    std::vector<int> unfelt; // unknowns whose entries are below kUlfRankTol of every row's length
};

/// The factors that violate the rows least and keep the sign.
struct T_ULF_COMPROMISE {
    std::vector<double> factors;
    std::vector<double> violation; // row * x - rhs in the units of the row; 0 for <= that are met
    double sumOfSquares = 0.0;     // of the violations divided by the length of row / weights
};

/// NotProved: rows that nearly repeat each other leave open whether there is a solution.
enum class ULF_CONFLICT { Found, Solvable, Cancelled, BadInput, NotProved };

/// Rows and the sign restriction that contradict each other; without any one of them the others
/// have a solution.
struct T_ULF_CONFLICT {
    ULF_CONFLICT state = ULF_CONFLICT::BadInput;
    std::vector<int> rows; // ascending
    bool sign = false;     // the sign restriction is one of them
};

/// Explains a problem of CRps_UnknownLoadFactorManager in the caller's units. State: none.
class CUlfDiagnosis {
public:
    /// Solves, and gives the multipliers (Karush, Kuhn and Tucker) of the answer. Where several
    /// sets of multipliers are right (repeated rows) it is one of them; to each side there is one,
    /// found with the limit moved by 1e-7 in the scale of ulfproblem.h. 1 done; 0 the problem can't
    /// be used or has no certified answer, `out` as it was.
    [[nodiscard]] int Explain(const T_ULF_PROBLEM& problem, T_ULF_EXPLANATION& out) const;
    /// Singular values of the matrix. 1 done; 0 the problem can't be used, `out` as it was.
    [[nodiscard]] int Examine(const T_ULF_PROBLEM& problem, T_ULF_MATRIX& out) const;
    /// Smallest sum of squared scaled violations under the sign restriction, and among equals the
    /// smallest sum of (w x)^2. 1 done; 0 the problem can't be used or no convergence, `out` as it
    /// was.
    [[nodiscard]] int Compromise(const T_ULF_PROBLEM& problem, T_ULF_COMPROMISE& out) const;
    /// Smallest contradicting set by the deletion filter (Chinneck and Dravnieks 1991): what is
    /// left still contradicts itself without a member: the member goes. Starts from the rows of the
    /// solver's own proof. `progress` (members tried, members) may be empty; false cancels.
    T_ULF_CONFLICT Conflict(const T_ULF_PROBLEM& problem,
                            const std::function<bool(int, int)>& progress) const;
};
