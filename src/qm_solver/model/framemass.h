// Lumped mass of a frame.
#pragma once

#include "qm_solver/framemodel.h"

#include <vector>

namespace solver {

/// density A length of a beam (flexible length) or truss; 0 of others.
double ElementMass(const T_FRAME& frame, const T_ELEMENT& element);

/// Translational mass by node: the nodal masses and, with density, half of each beam's and
/// truss's mass (density A length; of a beam the flexible length) at either node. Checked model.
std::vector<T_VEC3> LumpedMass(const T_FRAME& frame);

} // namespace solver
