// Beam-column joints in the steps of a push. SI.
#pragma once

#include "qm_rps/generate/jointcheck.h"
#include "qm_rps/generate/steeljoint.h"
#include "qm_rps/judge/endstate.h"

/// A joint in a vertical plane of its beams.
struct T_JUDGED_JOINT {
    /// An end of a member at the node.
    struct T_PART {
        int element = 0;
        bool atJ = false;
        T_MEMBER_AXES axes;
    };
    int node = 0;
    std::array<double, 3> forth{}, up{}; // unit vectors, global
    std::string axis;                    // that the plane runs along: "X", "Y", "X+30" (degrees)
    std::vector<T_PART> beams;
    std::optional<T_PART> above;       // column
    T_JOINT joint;                     // its code alone where it can't be judged, and of steel
    std::optional<T_PANEL_ZONE> panel; // of steel
};

/// M: the beams' moments on the joint that push its top forth; V: the force of the column above on
/// the joint, backwards; N: compression of the column above.
T_END_STATE JointState(const T_JUDGED_JOINT& joint, const T_STEP_FORCES& step);

/// "X+30": of a horizontal direction, from the first horizontal axis towards the second.
std::string PlaneName(const std::array<double, 3>& forth, std::size_t up);
