// A hinge type of the FEMA or Eurocode family out of what a code gives for the ends of a member.
#pragma once

#include "qm_rps/generate/memberend.h"

/// Both ends of a member, both sides of each, about one axis.
struct T_CODE_BENDING {
    HINGE_COMPONENT component = HINGE_COMPONENT::My;
    T_ENDS<T_SIDES<T_RC_SIDE>> ends; // sides of the section: (+) compresses +z or +y
};

struct T_CODE_HINGE {
    std::vector<T_CODE_BENDING> bending;
    T_PHGT_D type; // SI, without a name
    std::vector<T_CODE_WARNING> warnings;
};

/// The hinge of a member by a code. Of columns the strength follows the axial force along eleven
/// points of the section's own curve, among them the forces of the initial loads; the type's yield
/// strength is then the one without an axial force. Where the bars are so that bending without
/// curvature has a moment, the curve is left out with a warning. A released end has no hinge.
/// 1 done; 0 with the reason in words, `out` unchanged.
[[nodiscard]] int MakeCodeHinge(const T_MODEL& model, const T_RC_MEMBER& member, HINGE_CODE code,
                                bool secondary, T_CODE_HINGE& out, std::string& reason);

/// The same but for rounding; names and keys of sections do not count.
bool SameHinge(T_PHGT_D a, T_PHGT_D b);
