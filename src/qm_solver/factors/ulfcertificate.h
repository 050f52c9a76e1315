// Proof that factors are an answer, from the rows as they were given.
#pragma once

#include "qm_solver/factors/ulfscaling.h"

/// How far factors and multipliers are from optimality (Karush, Kuhn and Tucker), in the scale of
/// T_ULF_SCALED. Computed in long double from the original rows.
struct T_ULF_CERTIFICATE {
    double violation = 0.0;  // largest violation of a row or a sign, see kUlfFeasibleTol
    double stationary = 0.0; // largest miss of the multipliers
    double gap = 0.0;        // primal less dual objective, relative to the objective
    double objective = 0.0;  // in the problem's own units

    /// Meets the tolerances of ulfproblem.h, rows within `rowTol`.
    bool Holds(double rowTol) const;
};

/// `multipliers`: one per row, for the objective y * y / 2 (objective 2) or sum or largest of |y|.
/// A negative one of an inequality counts as a miss.
T_ULF_CERTIFICATE CertifyUlf(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                             std::span<const double> x, std::span<const long double> multipliers);

/// The objective of factors x in the problem's own units. Zero weights: as ulfproblem.h says.
double UlfObjective(const T_ULF_PROBLEM& problem, std::span<const double> x);
