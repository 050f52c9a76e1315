// A hinge type of the FEMA or Eurocode family out of what a code gives for the ends of a member.
#pragma once

#include "qm_rps/generate/memberend.h"

/// Both ends at an axial force, compression positive.
struct T_CODE_AXIAL {
    double axial = 0.0;
    T_ENDS<T_SIDES<T_CODE_SIDE>> ends;
};

/// One component: both ends of a member, both sides of each. Hinges of shear and axial force stand
/// in the middle, and both ends are alike.
struct T_CODE_COMPONENT {
    HINGE_COMPONENT component = HINGE_COMPONENT::My;
    HINGE_LOCATION location = HINGE_LOCATION::BothEnds;
    /// Bending: sides of the section, (+) compresses +z or +y. Axial: (+) tension.
    T_ENDS<T_SIDES<T_CODE_SIDE>> ends;
    std::vector<T_CODE_AXIAL> byAxial{}; // curves by axial force, ascending
};

struct T_CODE_HINGE {
    std::vector<T_CODE_COMPONENT> components;
    T_PHGT_D type; // SI, without a name
    std::vector<T_CODE_WARNING> warnings;
};

/// The hinge of a member by a code. Of columns and walls the strength follows the axial force along
/// eleven points of the section's own curve (steel: of the code's formulas), among them the forces
/// of the initial loads; the type's yield strength is then the one without an axial force. Where
/// bars are so that bending without curvature has a moment, the curve is left out with a warning.
/// With an axial range they have curves at seven forces instead, each with its own strength.
/// A released end has no hinge.
/// 1 done; 0 with the reason in words, `out` unchanged.
[[nodiscard]] int MakeCodeHinge(const T_MODEL& model, const T_HINGE_MEMBER& member,
                                const T_CODE_OPTIONS& options, T_CODE_HINGE& out,
                                std::string& reason);

/// The same but for rounding; names and keys of sections do not count.
bool SameHinge(T_PHGT_D a, T_PHGT_D b);
