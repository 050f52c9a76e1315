// Iterative refinement of solutions that lose digits.
#pragma once

#include "qm_solver/frame/caseblock.h"
#include "qm_solver/sparse/sparsefactor.h"

#include <span>

namespace solver {

/// Columns of the solution of `k x = sides` that may have lost more than 1e-8 of itself are
/// refined: residuals from the deformations of the elements, which keep the digits that the
/// assembled matrix has rounded away, solved with the same factor until they change nothing any
/// more (Wilkinson; Higham, Accuracy and Stability of Numerical Algorithms, chapter 12). The loss
/// is bounded by the rounding of the stiffness energies of the unknowns one by one over the work of
/// the loads: a column of 2,000 elements or a link stiffer by 1e10 has much of the first and little
/// of the second. extent: length that compares rotations with translations. 1 done; 0 `reason`
/// filled (the solution failed).
[[nodiscard]] int Refine(const CCaseBlock& block, const CFrameDofs& dofs, double extent,
                         const T_SYMMETRIC_MATRIX& k, std::span<const double> sides,
                         CSparseFactor& factor, T_SOLUTION& solution, T_SOLVER_REASON& reason);

} // namespace solver
