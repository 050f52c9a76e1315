// Looks for parts of a frame that the supports leave free to move as a rigid body.
#pragma once

#include "qm_solver/frameresult.h"

#include <optional>

namespace solver {

/// Mechanism error of the first part (in the order of its lowest node) that can move as a rigid
/// body, with the part's nodes and the free motions in words; nothing if the supports hold every
/// part. For a checked model (indices in range).
///
/// Method: elements, diaphragms and equal displacements connect nodes to parts. The six rigid-body
/// motions about the centroid of a part, rotations times its size, are tested by the rank of what
/// resists them: fixed directions, springs to the ground, and links and equal displacements between
/// nodes apart, which resist turning, as nodes of a diaphragm do that are not of one height. A
/// motion that moves no displacement of the part is no motion: a straight chain of trusses that
/// spins about its axis. Only rotations that beams, links or constraints tie to the part count, so
/// a fixed rotation of a node of trusses holds nothing. Mechanisms inside a part are not seen here;
/// the factorisation finds those.
std::optional<T_SOLVER_ERROR> CheckRigidBodies(const T_FRAME& frame);

} // namespace solver
