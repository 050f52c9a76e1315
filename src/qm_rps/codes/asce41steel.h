// Steel members by ASCE 41: yield rotation, plastic rotations and acceptance of beams, columns
// and braces. All deformations come out absolute: rad, or m for braces.
#pragma once

#include "qm_rps/codes/asce41concrete.h"

/// I-shape and its member; expected strengths.
struct T_STEEL_MEMBER {
    double Fye = 0.0, E = 200e9; // Pa
    double Z = 0.0, I = 0.0;     // about the axis of bending, m3, m4
    double A = 0.0;              // m2
    double length = 0.0;         // clear length, m
    double bf = 0.0, tf = 0.0;   // m
    double h = 0.0, tw = 0.0;    // clear web depth, m
    double ry = 0.0;             // m; Table 9-7.1 and AISC 342
    double axial = 0.0;          // of gravity, compression positive, N
    double axialStrength = 0.0;  // P_CL, lower bound; 41-13 and FEMA 356
};
struct T_STEEL_PLASTIC {
    double yieldRotation = 0.0; // theta_y
    T_CODE_PLASTIC plastic;     // rad
    bool forceControlled = false;
};

/// Eq. (9-1): theta_y = Z Fye L / (6 E I), double curvature. With an axial force Eq. (9-2) takes
/// (1 - P/Pye) and, in 41-17, the stiffness tau_b.
std::optional<double> AsceSteelYieldRotation(const T_STEEL_MEMBER& m, bool column,
                                             ASCE_EDITION edition, CCodeSheet& sheet);

/// Table 9-6: a, b in multiples of theta_y, by compactness of flange and web; the worse governs.
std::optional<T_STEEL_PLASTIC> AsceSteelBeam(const T_STEEL_MEMBER& m, ASCE_EDITION edition,
                                             CCodeSheet& sheet);

/// 41-17: Table 9-7.1 by P/Pye; 41-13 and FEMA 356: by P/P_CL. Compression alone: a tension counts
/// as 0.
std::optional<T_STEEL_PLASTIC> AsceSteelColumn(const T_STEEL_MEMBER& m, ASCE_EDITION edition,
                                               CCodeSheet& sheet);
/// AISC 342-22 C3.6; highly ductile members alone (AISC 341 Table D1.1), force-controlled above
/// P/Pye 0.6.
std::optional<T_STEEL_PLASTIC> Aisc342Column(const T_STEEL_MEMBER& m, CCodeSheet& sheet);

/// Table 9-6: 0 compact to 1 slender, the worse of flange and web.
double AsceSlenderShare(const T_STEEL_MEMBER& m, const char* clause, CCodeSheet& sheet);

/// Expected plastic moment with the axial force.
std::optional<double> AsceSteelMoment(const T_STEEL_MEMBER& m, ASCE_EDITION edition,
                                      CCodeSheet& sheet);

enum class BRACE_SHAPE { WideFlange, Tube, Angle }; // 2L in plane as W, out of plane as tube
struct T_STEEL_BRACE {
    BRACE_SHAPE shape = BRACE_SHAPE::WideFlange;
    double slenderness = 0.0; // KL / r
    double Fy = 0.0, E = 200e9;
    double yieldDeform = 0.0; // Delta_c at buckling, or Delta_T at tension yield, m
    bool tension = false;
    bool primary = true; // of the tension row's LS and CP
};
std::optional<T_STEEL_PLASTIC> AsceBrace(const T_STEEL_BRACE& brace, CCodeSheet& sheet);

// ---- for the files of steel alone --------------------------------------------------------------

/// Table 9-6 ladder between compact (0) and slender (1), in multiples of theta_y.
T_CODE_PLASTIC SteelBeamLadder(double slenderShare, ASCE_EDITION edition, const char* clause,
                               CCodeSheet& sheet);
bool SoundSteel(const T_STEEL_MEMBER& m, CCodeSheet& sheet);
