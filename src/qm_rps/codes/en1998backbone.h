// The hinge of a concrete member end by EN 1998-3 or the Circolare 2019, from section to curve.
#pragma once

#include "qm_rps/codes/en1998rotation.h"

struct T_EN_HINGE_IN {
    T_EN_MEMBER member;
    THETA_Y form = THETA_Y::A10b; // the Circolare has its own two
    double concreteShear = 0.0;   // VRd,c of the member, N: cracks in shear below My / LV
    double strengthCap = 0.0;     // ultimate over yield moment; 0: C at the yield strength
    double residual = 0.0;        // beyond theta_um, over the yield strength
};
struct T_EN_ROTATIONS {
    T_EN_YIELD yield;
    double thetaY = 0.0, thetaUm = 0.0;
    T_CHORD_LIMITS limits;
};
std::optional<T_EN_ROTATIONS> EnRotations(const T_EN_HINGE_IN& in, CCodeSheet& sheet);

struct T_EN_HINGE {
    T_EN_YIELD yield;
    double thetaY = 0.0, thetaUm = 0.0;
    T_CODE_BACKBONE backbone;
};
std::optional<T_EN_HINGE> EnHinge(const T_EN_HINGE_IN& in, CCodeSheet& sheet);
