// Solutions that balance their loads.
#pragma once

#include "qm_solver/frame/refinement.h"

namespace solver {

/// Solves the load cases of a block with the factor of `k`, refines where digits were lost, and
/// makes sure that the loads are balanced: forces out of balance are at most 1e-5 of the largest
/// load of the column, moments taken over `extent`; a refined solution is known to 1e-6 of itself.
/// A motion that escaped the factorisation passes neither.
/// 1 done; 0 `reason` filled, `column` the case at fault or the number of cases where it is none.
[[nodiscard]] int SolveBalanced(const CCaseBlock& block, const CFrameDofs& dofs, double extent,
                                const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor,
                                T_SOLUTION& solution, std::size_t& column, T_SOLVER_REASON& reason);

} // namespace solver
