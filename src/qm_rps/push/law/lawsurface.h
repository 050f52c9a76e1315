// The surface that both moments of a hinge share, from section and material.
#pragma once

#include "qm_rps/hinge/hingesources.h"
#include "qm_solver/pushmodel.h"

#include <string>
#include <vector>

/// Shape of the surface of section and material (keys) in the engine's measure, for `law`, one of
/// the two bending laws, whose axial forces its rows span. Beside an axis it is that of bending
/// about the axis alone; where that leaves a corner within the line of its neighbours, the corner
/// is moved out to the line, 3 % at most. 1 done; 0 with the reason: the section has no shape, or
/// is not symmetric enough (bending about an axis alone needs a moment about the other one).
[[nodiscard]] int SurfaceShape(const CHingeSources& sources, int section, int material,
                               const solver::T_HINGE_LAW& law,
                               std::vector<solver::T_AXIAL_SHAPE>& out, std::string& reason);
