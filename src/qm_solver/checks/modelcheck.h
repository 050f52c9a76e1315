// Checks of a frame and of load cases before anything is computed.
#pragma once

#include "qm_solver/frame/framedofs.h"
#include "qm_solver/frameresult.h"

#include <optional>

namespace solver {

/// The first fault of the model, as BadModel with the node or element and the reason; a beam
/// that its releases leave free inside is a Mechanism. Empty: indices are in range, numbers are
/// finite, every element has a length, a stiffness and local axes.
std::optional<T_SOLVER_ERROR> CheckModel(const T_FRAME& frame);

/// The first fault of load case `loadCase` on a checked frame: loads on things that are missing
/// or can't take them, numbers that are not finite, settlements of free directions or against
/// the constraints, loads on directions that nothing gives stiffness to.
std::optional<T_SOLVER_ERROR> CheckCase(const T_FRAME& frame, const CFrameDofs& dofs,
                                        const T_LOAD_CASE& load, std::size_t loadCase);

/// "X", "Y", "Z", "RX", "RY", "RZ".
const char* DirectionName(std::size_t direction);

} // namespace solver
