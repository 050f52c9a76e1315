// Forces at the ends of members in the steps of a push. SI.
#pragma once

#include "qm_rps/push/pushrun.h"

/// Which end of which element, bent about which of its axes; of a brace Fx, which is of both ends.
struct T_END_PLACE {
    int element = 0;
    bool atJ = false;
    HINGE_COMPONENT component = HINGE_COMPONENT::My; // Mz, Fx
    bool operator==(const T_END_PLACE&) const = default;
};

/// With the signs of an analysis but for the axial force.
struct T_END_FORCES {
    double N = 0.0; // compression positive
    double M = 0.0, V = 0.0;
    double across = 0.0; // moment about the other axis
};

/// Axial force, shears, torsion and moments of an end in a step, with the signs of an analysis.
const solver::T_VEC6& ForcesAt(int element, bool atJ, const T_STEP_FORCES& step);

/// All loads are in them: the initial ones, those along the member, those of the push. Of Fx: N
/// alone.
T_END_FORCES EndForces(const T_END_PLACE& place, const T_STEP_FORCES& step);
