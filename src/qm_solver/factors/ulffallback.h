// The linear objectives by the linear programming library.
#pragma once

#include "qm_solver/factors/ulfanswer.h"
#include "qm_solver/factors/ulflinear.h"

/// An optimum of the linear objective and the multipliers of its rows, as the library gives them.
struct T_ULF_VERTEX {
    std::vector<double> y;           // unknowns of `rows`
    std::vector<double> multipliers; // rows of `rows`, wide ones first
};

/// Minimises cost * y plus the caps of violated elastic rows by the primal simplex method of Clp,
/// with the unknowns in a wide box (its dual method called solvable problems infeasible). 1 found;
/// 0 not, and `vertex` is as it was.
[[nodiscard]] int SolveUlfVertex(const T_ULF_LINEAR& linear, T_ULF_VERTEX& vertex);

/// Objectives 1 and 3: a vertex from the library, then the smallest square sum on the optimal face,
/// which is held by the rows with a multiplier at the vertex. The answer needs the same certificate
/// as any other.
T_ULF_ANSWER SolveUlfFallback(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                              ULF_PRECISION precision);
