// The lowest eigenvalues of K x = lambda M x for a factorised K and a lumped M.
#pragma once

#include "qm_solver/frame/massroot.h"
#include "qm_solver/framesolver.h"

namespace solver {

struct T_EIGEN_PROBLEM {
    const T_SYMMETRIC_MATRIX& stiffness; // positive definite
    std::span<const int> block;          // of the unknowns, as CSparseFactor takes it
    CSparseFactor& factor;               // of the stiffness
    const CMassRoot& root;
};

struct T_EIGENPAIRS {
    std::vector<double> lambda; // ascending
    std::vector<double> shape;  // x after x over the unknowns, x'Mx = 1
};

/// The lowest `count` pairs, or all where the mass has a smaller rank.
///
/// Method: with M = L L' the inverse problem L' K^-1 L y = y / lambda is an ordinary symmetric one
/// of the rank of the mass. Few unknowns with mass, or a large part of all pairs: dense. Otherwise
/// Lanczos with implicit restarts from a fixed start vector; then Sylvester's law of inertia on
/// K - sigma M counts the eigenvalues below a sigma between two of them, and pairs that a Krylov
/// space does not see (multiple eigenvalues) are looked for with the known ones deflated, until
/// the counts agree.
/// 1 done; 0 error filled (NoMass, NotConverged, Cancelled, Failed), `out` empty. `progress` counts
/// solutions with K, of an estimated total.
[[nodiscard]] int SolveEigen(const T_EIGEN_PROBLEM& problem, std::size_t count, T_EIGENPAIRS& out,
                             T_SOLVER_ERROR& error, const ProgressFn& progress = {});

} // namespace solver
