// Reinforced concrete by ASCE 41: plastic rotations and acceptance of beams, columns, joints and
// walls. Strengths f are expected ones (lower-bound where the formula says so), in Pa.
#pragma once

#include "qm_rps/codes/codebackbone.h"

/// ASCE 41-17; ASCE 41-13; FEMA 356 for primary and for secondary components.
enum class ASCE_EDITION { Asce17, Asce13, Fema356Primary, Fema356Secondary };

/// Beam, Table 10-7 (FEMA 356 Table 6-7).
struct T_ASCE_BEAM {
    double bw = 0.0, d = 0.0;  // m
    double fc = 0.0, fy = 0.0; // concrete, longitudinal bars
    double Es = 200e9;
    double tensionRatio = 0.0;     // rho = As / (bw d)
    double compressionRatio = 0.0; // rho'
    double spacing = 0.0;          // of the hoops, m
    double shear = 0.0;            // V, design shear force, N
    double hoopShear = 0.0;        // Vs, strength of the hoops
    double ductility = 0.0;        // ductility demand, where known; 0: taken as 2 or more
    // Conditions beside flexure; the least of each value holds.
    bool shearControls = false; // ii, instead of i
    bool poorSplice = false;    // iii: development or splicing within the span
    bool poorEmbedment = false; // iv: embedment into the joint
};
std::optional<T_CODE_PLASTIC> AsceBeam(const T_ASCE_BEAM& beam, ASCE_EDITION edition,
                                       CCodeSheet& sheet);

/// Ties: hooks of 135 degrees, 90 degrees, or others (lap-spliced, open).
enum class TIE_HOOKS { Hooks135, Hooks90, Other };

/// Column, Tables 10-8 and 10-9.
struct T_ASCE_COLUMN {
    bool circular = false;    // with spiral or seismic hoops: Table 10-9
    double bw = 0.0, d = 0.0; // m
    double Ag = 0.0;          // m2
    double fc = 0.0;
    double fyt = 0.0;           // of the ties
    double axial = 0.0;         // N_UD, compression positive
    double tieRatio = 0.0;      // rho_t = Av / (bw s)
    double spacing = 0.0;       // m
    double shear = 0.0;         // V_yE, or the shear at plastic moments V_p
    double shearStrength = 0.0; // V_ColOE, or V_n
    double hoopShear = 0.0;     // Vs; FEMA 356 alone
    TIE_HOOKS hooks = TIE_HOOKS::Hooks135;
    bool tiesAnchored = true; // into the core; else rho_t counts up to 0.0075 (41-17)
    // Controlled by development or splicing along the clear height.
    bool poorSplice = false;
    double longRatio = 0.0;   // rho_l
    double fyl = 0.0;         // of the longitudinal bars
    bool twoTiesInLap = true; // at least two groups of ties within the lap
};
std::optional<T_CODE_PLASTIC> AsceColumn(const T_ASCE_COLUMN& column, ASCE_EDITION edition,
                                         CCodeSheet& sheet);

enum class JOINT_KIND {
    InteriorWithBeams, // a: transverse beams on both sides
    Interior,          // b
    ExteriorWithBeams, // c
    Exterior,          // d
    Knee               // e
};
/// Beam-column joint, Tables 10-11 and 10-12. Shear angles.
struct T_ASCE_JOINT {
    JOINT_KIND kind = JOINT_KIND::Interior;
    double hc = 0.0;             // depth of the column along the beam, m
    double spacing = 0.0;        // of the hoops within the joint, m; 0: none
    double fc = 0.0;             // expected for the table, lower bound for the strength
    double Ag = 0.0, area = 0.0; // of the column; of the joint, Aj
    double axial = 0.0;          // compression positive
    double shear = 0.0;          // V
    double lambda = 1.0;         // 0.75: lightweight concrete
};
/// Vj of Table 10-12.
std::optional<double> AsceJointStrength(const T_ASCE_JOINT& joint, CCodeSheet& sheet);
std::optional<T_CODE_PLASTIC> AsceJoint(const T_ASCE_JOINT& joint, CCodeSheet& sheet);

/// Wall, Tables 10-19 and 10-20.
struct T_ASCE_WALL {
    double thickness = 0.0, length = 0.0; // tw, lw, m
    double fc = 0.0, fy = 0.0;
    double As = 0.0, AsPrime = 0.0; // tension and compression reinforcement, m2
    double Ast = 0.0;               // all vertical bars, m2
    double axial = 0.0;             // P, compression positive
    double shear = 0.0;             // V
    bool confinedBoundary = false;
};
/// Controlled by flexure: rotations.
std::optional<T_CODE_PLASTIC> AsceWallFlexure(const T_ASCE_WALL& wall, CCodeSheet& sheet);

/// Controlled by shear: total drifts (not percent), F the strength at cracking over the yield
/// strength, g the drift at yield.
struct T_ASCE_WALL_SHEAR {
    double g = 0.0, d = 0.0, e = 0.0;
    double f = 0.0, c = 0.0;
    double IO = 0.0, LS = 0.0, CP = 0.0;
    bool forceControlled = false; // P > 0.15 Ag f'c
};
std::optional<T_ASCE_WALL_SHEAR> AsceWallShear(const T_ASCE_WALL& wall, CCodeSheet& sheet);
/// B at the drift g, where the strength is the yield strength; the elastic line ends at f of it.
/// `dim`: of the drifts, a length where they are displacements.
std::optional<T_CODE_BACKBONE> BackboneOfWallShear(const T_ASCE_WALL_SHEAR& wall, double yield,
                                                   CCodeSheet& sheet, T_DIM dim = kDimNone);
