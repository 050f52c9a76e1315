// Modes of a frame with what they take part in.
#pragma once

#include "qm_solver/framesolver.h"
#include "qm_solver/sparse/sparsefactor.h"

namespace solver {

class CFrameDofs;

/// The lowest modes, ascending, at most as many as there are degrees of freedom with mass; `factor`
/// is that of `stiffness`. Shapes have modal mass 1 and a positive largest translation. Of equal
/// frequencies the first shape takes all that X excites, the next what is left of Y, and so on, so
/// that the modes of a doubly symmetric building lie along its axes.
///
/// Participation of direction d: L = phi' M r (modal mass 1), r the rigid-body motion of the whole
/// model in d, rotations about the origin. Effective mass L^2, in per cent of the mass that can
/// move in that direction: r' M r over what is not restrained, so that all modes sum up to 100 %.
/// Mass on restrained directions is not part of the total. A direction without mass has 0.
/// 1 done; 0 error filled, `out` cleared.
[[nodiscard]] int SolveModes(const T_FRAME& frame, const CFrameDofs& dofs,
                             const T_SYMMETRIC_MATRIX& stiffness, CSparseFactor& factor,
                             std::size_t count, std::vector<T_MODE>& out, T_SOLVER_ERROR& error,
                             const ProgressFn& progress = {});

} // namespace solver
