// Checks of hinges and stages before a push.
#pragma once

#include "qm_solver/frame/framedofs.h"
#include "qm_solver/frameresult.h"
#include "qm_solver/pushmodel.h"

#include <optional>

namespace solver {

/// The first fault of the hinges of a checked frame, as BadModel with the element: a place or a
/// component that the element does not have or that is released, two laws of one component at one
/// place, no strength, a strength of 0, deformations that fall, axial strengths that do not ascend.
std::optional<T_SOLVER_ERROR> CheckHinges(const T_PUSH_MODEL& model);

/// The first fault of a stage: the control node or its direction does not move, a target of 0,
/// steps that do not rise to 1, stops out of range. Its loads are checked when they are taken.
std::optional<T_SOLVER_ERROR> CheckStage(const T_PUSH_MODEL& model, const CFrameDofs& dofs,
                                         const T_PUSH_STAGE& stage, std::size_t number);

} // namespace solver
