// Mechanisms that the factorisation of a stiffness matrix shows.
#pragma once

#include "qm_solver/framedofs.h"
#include "qm_solver/frameresult.h"
#include "qm_solver/sparsefactor.h"

#include <optional>

namespace solver {

/// A displacement without resistance, by equation, found with the factorisation of `k` in `factor`;
/// nothing if there is none. The candidates are the null vectors that vanished pivots name and the
/// softest shape of inverse iteration, which shows a singularity that no pivot showed.
///
/// A candidate v counts when its strain energy v'Kv, summed in extended precision, is not above the
/// rounding of K itself: eps times the root of the sum of the squares of |v_i| (|K||v|)_i. On
/// assembled frames that move the energy was 0.01 to 0.5 times this bound; a soft spring under a
/// chain stiffer by 1e14, whose pivot vanishes wrongly, is above it.
/// Returns 1 with `out` set or empty; 0 `reason` filled (the solution failed).
[[nodiscard]] int FindMechanism(const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor,
                                std::optional<std::vector<double>>& out, std::string& reason);

/// Factorises the stiffness matrix of a frame, whose pattern `factor` has analysed, and makes sure
/// that nothing moves. Where pivots vanish and no mechanism is behind it the matrix is factorised
/// again as it is. 1 done; 0 error filled: a Mechanism with the node and the direction of the
/// largest movement, or Failed.
[[nodiscard]] int FactorStable(const T_SYMMETRIC_MATRIX& k, const CFrameDofs& dofs,
                               CSparseFactor& factor, T_SOLVER_ERROR& error);

} // namespace solver
