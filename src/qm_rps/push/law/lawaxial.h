// Strength of a bending component by the axial force.
#pragma once

#include "qm_rps/hinge/hingesources.h"
#include "qm_solver/pushmodel.h"

#include <span>
#include <string>
#include <vector>

/// Strengths and yield surfaces of sections call a moment positive that compresses the side +z (My)
/// or +y (Mz). An analysis prints the first one as negative: its (+) and (-) change places.
inline bool IsSectionSignOpposite(HINGE_COMPONENT component)
{
    return component == HINGE_COMPONENT::My;
}

/// What the strengths of a component stand on.
struct T_AXIAL_BASIS {
    const T_PHGT_D& type;
    HINGE_COMPONENT component = HINGE_COMPONENT::My; // My or Mz
    const T_SKEL_CURVE& curve;
    T_SIDES<double> yield;        // without an axial force, magnitudes, by the signs of an analysis
    const CHingeSources& sources; // SI
    int section = 0, material = 0; // of the element
};

/// Yield strengths by axial force, tension positive, ascending; empty: the axial force does not
/// count. Curves by axial force: their entered strengths, beyond the list those of its ends. Else
/// by the interaction of the component. PMM: the moments of the type's yield surface; where it has
/// none, section and material of the element. User: the P-M curves of the type. Section and user
/// curves give the shape alone: the yield strength of the hinge is that at no axial force (MY0), so
/// it may be below the largest one. Curves by axial force with automatic strengths
/// follow section and material.
/// A side of a curve may be entered with negative moments throughout.
/// 1 done; 0 with the reason: there is no curve, it does not reach a force of 0, or its moments
/// have both signs.
[[nodiscard]] int StrengthsByAxial(const T_AXIAL_BASIS& basis,
                                   std::vector<solver::T_AXIAL_STRENGTH>& out, std::string& reason);

/// Strengths at an axial force, tension positive; beyond the rows those of their ends.
T_SIDES<double> StrengthAt(std::span<const solver::T_AXIAL_STRENGTH> rows, double axial);
