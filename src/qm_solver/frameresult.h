// What the analysis engine gives: results of a load case and modes, in the units of the model.
#pragma once

#include "qm_solver/framemodel.h"
#include "qm_solver/solverreason.h"

#include <string>
#include <tuple>

namespace solver {

/// Positions of beam forces: I-end, 1/4, 2/4, 3/4, J-end of the flexible length.
inline constexpr std::size_t kBeamPositions = 5;

/// Relative error of a load case, estimated by iterative refinement; 0 where none was needed.
struct T_ACCURACY {
    double unrefined = 0.0; // of the displacements of the direct solution
    double error = 0.0;     // of the result: of displacements or of equilibrium, the larger
};

/// Results of one load case, all arrays by the model's indices.
///
/// Signs of beam forces. They act on the face whose outward normal is local x (towards J), that of
/// the part from I to the cut:
///   axial     along +x: tension
///   shear y   along +y        d(moment z)/dx = -(shear y)
///   shear z   along +z        d(moment y)/dx = +(shear z)
///   torsion   turns +x by the right hand
///   moment y  turns +y: tension on the side of +z
///   moment z  turns +z: tension on the side of -y
/// so that the normal stress is N / A + (moment y) z / Iy - (moment z) y / Iz. A beam along X with
/// z up, under its own weight on two supports, has a negative moment y at mid-span (tension below)
/// and a shear z that goes from minus to plus half of its weight.
/// At a point load or moment exactly on a position the cut lies just before it; at J all loads lie
/// before the cut, at I none, so that both ends give the forces of the ends.
struct T_RESULT {
    std::vector<T_VEC6> displacement; // by node, global
    /// By node, global: force of supports and point springs on the structure; 0 elsewhere.
    std::vector<T_VEC6> reaction;
    /// By element: six components per position. Beam: axial, shear y, shear z, torsion, moment y,
    /// moment z in local axes, internal forces of the cut seen from the I side (axial positive in
    /// tension; the end forces on the element at I are minus these). Truss: axial alone, the same
    /// at all positions for loads at its nodes. Link: stiffness times (displacement of j minus
    /// that of i), global axes, the same at all positions. Spring: 0.
    std::vector<std::array<T_VEC6, kBeamPositions>> force;
    T_ACCURACY accuracy;
};
inline auto Numbers(const T_RESULT& r)
{
    return std::tie(r.displacement, r.reaction, r.force);
}

struct T_MODE {
    double omega2 = 0.0;       // squared circular frequency, 1/s2
    double period = 0.0;       // s
    std::vector<T_VEC6> shape; // by node, normalised to the modal mass 1
    T_VEC6 participation{};    // L / M per direction X, Y, Z; rotations about the origin
    T_VEC6 massPercent{};      // effective modal mass in per cent of the direction's total
};
inline auto Numbers(const T_MODE& m)
{
    return std::tie(m.omega2, m.period, m.shape, m.participation, m.massPercent);
}

enum class SOLVER_FAULT {
    None,
    BadModel,  // element and reason named
    Mechanism, // node and direction named
    NoMass,    // modes of a model without mass
    NotConverged,
    Cancelled,
    Failed, // the factorisation failed for another reason
};

/// Where a fault sits; the caller knows the users' names of nodes and elements.
struct T_SOLVER_ERROR {
    SOLVER_FAULT fault = SOLVER_FAULT::None;
    /// Index of the node or element that is at fault, -1 for none.
    long node = -1, element = -1;
    long loadCase = -1; // index of the load case at fault, -1 for none
    long stage = -1;    // index of the construction stage at fault, -1 for none
    int direction = -1; // 0 to 5, of a mechanism at a node
    /// Nodes of a part of the model that moves as a rigid body; empty otherwise.
    std::vector<std::size_t> part;
    T_SOLVER_REASON reason; // zero length; the part is free to move along X and to turn about Z
};

} // namespace solver
