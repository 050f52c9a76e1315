// Mechanisms that the factorisation of a stiffness matrix shows.
#pragma once

#include "qm_solver/element/elementstiffness.h"
#include "qm_solver/frame/framedofs.h"
#include "qm_solver/frameresult.h"
#include "qm_solver/sparse/sparsefactor.h"

#include <functional>
#include <optional>
#include <string>

namespace solver {

/// Says whether a displacement of the unknowns strains nothing.
using StrainlessFn = std::function<bool(std::span<const double> displacement)>;

/// A displacement without resistance, by equation, found with the factorisation of `k` in `factor`;
/// nothing if there is none. The candidates are the null vectors that vanished pivots name and the
/// softest shape of inverse iteration, which shows a singularity that no pivot showed. `strainless`
/// decides: the matrix itself can't, since a soft member beside one stiffer by 1e14 is within the
/// rounding of its entries.
/// Returns 1 with `out` set or empty; 0 `reason` filled (the solution failed).
[[nodiscard]] int FindMechanism(const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor,
                                const StrainlessFn& strainless,
                                std::optional<std::vector<double>>& out, T_SOLVER_REASON& reason);

/// Factorises the stiffness matrix of a frame, whose pattern `factor` has analysed, and makes sure
/// that nothing moves: a mechanism is one whose strain energy, element by element from their
/// deformations, is nothing. Where pivots vanish and no mechanism is behind it the matrix is
/// factorised again as it is. 1 done; 0 error filled: a Mechanism with the node and the direction
/// of the largest movement, or Failed. axial: by element, as the matrix has it; empty: first order.
[[nodiscard]] int FactorStable(const T_FRAME& frame, const CFrameDofs& dofs,
                               const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor,
                               T_SOLVER_ERROR& error, std::span<const T_AXIAL> axial = {});

} // namespace solver
