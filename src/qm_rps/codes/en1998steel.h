// Deformation capacities of steel members by EN 1998-3 Annex B, recalled.
#pragma once

#include "qm_rps/codes/codebackbone.h"

enum class STEEL_ACTION {
    Bending,          // beams and columns, axial ratio up to 0.30
    BraceCompression, // beyond the deformation at buckling
    BraceTension,     // beyond yield
    MemberTension     // beams and columns in tension
};
struct T_EN_STEEL {
    STEEL_ACTION action = STEEL_ACTION::Bending;
    int sectionClass = 1;     // 1 or 2; of bending and of braces in compression
    double axialRatio = 0.0;  // N / Npl; of bending
    double yieldDeform = 0.0; // theta_y in rad, Delta_c or Delta_t in m
};
/// DL, SD, NC as total deformations: the code's multiples are plastic ones.
std::optional<T_CHORD_LIMITS> EnSteelLimits(const T_EN_STEEL& steel, CCodeSheet& sheet);

/// Circolare 2019 [C8.7.2.13]: theta_y = M_e,Rd LV / (2 E I).
std::optional<double> CircolareSteelThetaY(double moment, double shearSpan, double EI,
                                           CCodeSheet& sheet);
