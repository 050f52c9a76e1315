// One side of a plastic hinge of a concrete member end: strength, shear and backbone by a code.
#pragma once

#include "qm_rps/codes/codebackbone.h"
#include "qm_rps/generate/rcmember.h"

/// What a hinge stands on. SI.
struct T_RC_END {
    HINGE_CODE code = HINGE_CODE::Asce17;
    bool secondary = false; // member
    bool column = false;    // else a beam, whose axial force does not count
    bool aboutY = true;
    T_SECT_D section; // with its properties
    T_MATL_D material;
    double clear = 0.0;  // length between the offsets; the shear span is half of it
    double axial = 0.0;  // compression positive
    double EI = 0.0;     // of the model: up to yield it bends with 6 EI / length
    double length = 0.0; // of the member in the model
};

struct T_RC_SIDE {
    double moment = 0.0;       // strength at the axial force
    double momentAtZero = 0.0; // without one
    double shear = 0.0;        // at the moments of both ends, no load along the member
    double shearStrength = 0.0;
    double hingeLength = 0.0; // chord codes: Lpl (A.5)
    T_CODE_BACKBONE bone;
    std::vector<T_CODE_TRACE> trace;
    std::vector<T_CODE_WARNING> warnings;
};
/// (+) compresses the side +z (about y) or +y, (-) the other. The strength is the bending capacity
/// with the parabola-rectangle of EN 1992-1-1 for the strengths of RcMaterial; V = (M(+) + M(-)) /
/// clear length, its strength ASCE 41 Eq. (10-3) of columns, ACI 318 of beams, EN 1998-3 (A.12).
/// Strength does not rise beyond yield. 1 done; 0 with the reason in words, `out` unchanged.
[[nodiscard]] int RcHinge(const T_RC_END& end, T_SIDES<T_RC_SIDE>& out, std::string& reason);

/// The section's material with the assessed strengths in place of the characteristic ones, as the
/// section calculator takes it.
T_MATL_D AssessedMaterial(const T_MATL_D& material, const T_RC_MATERIAL& strengths);
